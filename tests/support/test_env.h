#pragma once

#include <QString>

namespace etq::test {

// The source tree, for tests that read committed files (samples, definitions).
QString sourceDir();

// Empties the settings folder of this test run.
void resetSettings();

// The INI file the store keeps for an application name.
QString settingsFile(const QString& application);

}  // namespace etq::test

#pragma once

#include <QString>
#include <vector>

#include "support/recording_messages.h"

namespace etq::test {

// Empties the settings folder of this test run and restores the plain application name, the
// default connection parameters and Hebrew.
void resetSettings();

// The INI file the store keeps for an application name.
QString settingsFile(const QString& application);

// Writes a dBASE III file with one character field and no records.
void writeEmptyDbf(const QString& path, const QByteArray& fieldName, int fieldLength);

}  // namespace etq::test

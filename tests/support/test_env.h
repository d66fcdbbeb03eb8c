#pragma once

#include <QString>

namespace etq::test {

// The source tree, for tests that read committed files (samples, definitions).
QString sourceDir();

}  // namespace etq::test

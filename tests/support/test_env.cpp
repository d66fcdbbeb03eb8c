#include "support/test_env.h"

#include <QtGlobal>

namespace etq::test {

QString sourceDir() {
    return qEnvironmentVariable("ETIQUON_SOURCE_DIR", ETIQUON_SOURCE_DIR);
}

}  // namespace etq::test

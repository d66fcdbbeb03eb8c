#include "support/test_env.h"

#include <QDir>
#include <QStandardPaths>
#include <QtGlobal>

namespace etq::test {

QString sourceDir() {
    return qEnvironmentVariable("ETIQUON_SOURCE_DIR", ETIQUON_SOURCE_DIR);
}

void resetSettings() {
    QDir(QStandardPaths::writableLocation(QStandardPaths::GenericConfigLocation) + "/Etiquon")
        .removeRecursively();
}

QString settingsFile(const QString& application) {
    return QStandardPaths::writableLocation(QStandardPaths::GenericConfigLocation) + "/Etiquon/" +
           application + ".ini";
}

}  // namespace etq::test

#include "platform/user_paths.h"

#include <QDir>
#include <QStandardPaths>

#include "platform/failure.h"
#include "platform/private_folder.h"

namespace etq {

QString userDataFolder() {
    return joinPath(QStandardPaths::writableLocation(QStandardPaths::GenericDataLocation),
                    QStringLiteral("Etiquon"));
}

QString defaultLabelFile() {
    return joinPath(QDir::homePath(), QStringLiteral("mylabel.lbl"));
}

QString joinPath(const QString& folder, const QString& fileName) {
    if (folder.endsWith(u'/')) return folder + fileName;
    return folder + u'/' + fileName;
}

QString privateTempFolder(QString* error) {
    try {
        return openPrivateTempFolder().path;
    } catch (const Failure& failure) {
        if (error) *error = failure.description();
        return {};
    }
}

}  // namespace etq

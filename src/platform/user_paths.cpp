#include "platform/user_paths.h"

#include <unistd.h>
#include <QDir>
#include <QFileInfo>
#include <QStandardPaths>

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
    // The session's runtime folder when there is one; without it Qt would make one under the
    // shared /tmp (and warn), so the user's cache folder serves instead.
    QString base;
    if (!qEnvironmentVariableIsEmpty("XDG_RUNTIME_DIR"))
        base = QStandardPaths::writableLocation(QStandardPaths::RuntimeLocation);
    if (base.isEmpty())
        base = QStandardPaths::writableLocation(QStandardPaths::GenericCacheLocation);
    const QString folder = joinPath(base, QStringLiteral("etiquon"));
    const auto privateMode = QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner;
    if (!QDir().mkpath(folder) || !QFile::setPermissions(folder, privateMode)) {
        if (error) *error = QStringLiteral("cannot create the private folder %1").arg(folder);
        return {};
    }
    // A folder someone else made in our place is not ours to fill.
    const QFileInfo info(folder);
    const auto othersMode = QFile::ReadGroup | QFile::WriteGroup | QFile::ExeGroup |
                            QFile::ReadOther | QFile::WriteOther | QFile::ExeOther;
    if (!info.isDir() || info.ownerId() != ::getuid() || (info.permissions() & othersMode)) {
        if (error) *error = QStringLiteral("the folder %1 is not private").arg(folder);
        return {};
    }
    return folder;
}

}  // namespace etq

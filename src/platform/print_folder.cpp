#include "platform/print_folder.h"

#include <QDir>
#include <QFile>
#include <stdexcept>

#include "platform/user_paths.h"

namespace etq {

namespace {

[[noreturn]] void failWith(const QString& message) {
    throw std::runtime_error(message.toStdString());
}

}  // namespace

QString printFolder() {
    QString error;
    const QString temp = privateTempFolder(&error);
    if (temp.isEmpty()) failWith(error);
    const QString folder = joinPath(temp, QStringLiteral("etiqon"));
    if (!QDir().mkpath(folder) ||
        !QFile::setPermissions(folder, QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner))
        failWith(QStringLiteral("Cannot create the print folder %1").arg(folder));
    return folder;
}

void deleteFilesIn(const QString& folder) {
    QDir dir(folder);
    const QStringList files = dir.entryList(QDir::Files | QDir::Hidden | QDir::System);
    for (const QString& name : files) {
        if (!dir.remove(name)) failWith(QStringLiteral("Cannot delete %1").arg(dir.filePath(name)));
    }
}

}  // namespace etq

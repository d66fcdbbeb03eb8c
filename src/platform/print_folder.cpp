#include "platform/print_folder.h"

#include <dirent.h>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <QDir>
#include <QFile>
#include <stdexcept>

#include "platform/user_paths.h"

namespace etq {

namespace {

[[noreturn]] void failWith(const QString& message) {
    throw std::runtime_error(message.toStdString());
}

bool isFolder(int dirFd, const dirent& entry) {
    if (entry.d_type != DT_UNKNOWN) return entry.d_type == DT_DIR;
    struct stat info;
    return ::fstatat(dirFd, entry.d_name, &info, AT_SYMLINK_NOFOLLOW) == 0 && S_ISDIR(info.st_mode);
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
    // Straight through the directory: a print run clears thousands of bitmaps.
    const QByteArray path = QFile::encodeName(folder);
    DIR* dir = ::opendir(path.constData());
    if (!dir) failWith(QStringLiteral("Cannot read the folder %1").arg(folder));
    const int fd = ::dirfd(dir);
    QString failed;
    while (const dirent* entry = ::readdir(dir)) {
        if (isFolder(fd, *entry)) continue;
        if (::unlinkat(fd, entry->d_name, 0) != 0 && failed.isEmpty())
            failed = QFile::decodeName(entry->d_name);
    }
    ::closedir(dir);
    if (!failed.isEmpty()) failWith(QStringLiteral("Cannot delete %1/%2").arg(folder, failed));
}

}  // namespace etq

#include "platform/folder_lock.h"

#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>

#include <QFile>
#include <cerrno>
#include <cstring>

#include "platform/failure.h"
#include "platform/user_paths.h"

namespace etq {

namespace {

constexpr int kOpenFlags = O_NOFOLLOW | O_CLOEXEC | O_NONBLOCK;

// A folder others may only read still takes a lock: flock needs no write access.
int openLockFile(const QByteArray& path) {
    const int fd = ::open(path.constData(), O_RDWR | O_CREAT | kOpenFlags, 0666);
    if (fd >= 0 || (errno != EACCES && errno != EROFS)) return fd;
    return ::open(path.constData(), O_RDONLY | kOpenFlags);
}

}  // namespace

FolderLock::FolderLock(const QString& folder) {
    const QString path = joinPath(folder, kLockFileName);
    fd_.reset(openLockFile(QFile::encodeName(path)));
    struct stat info;
    if (!fd_.isOpen() || ::fstat(fd_.get(), &info) != 0)
        throw Failure(QStringLiteral("Cannot lock the database folder %1: %2")
                          .arg(folder, QString::fromLocal8Bit(std::strerror(errno))));
    if (!S_ISREG(info.st_mode))
        throw Failure(QStringLiteral("Cannot lock the database folder %1: %2 is not a file")
                          .arg(folder, path));
    if (::flock(fd_.get(), LOCK_EX | LOCK_NB) != 0) {
        if (errno == EWOULDBLOCK)
            throw FolderBusy(QStringLiteral("The database folder %1 is busy with another run of "
                                            "Etiquon. Try again when it has finished.")
                                 .arg(folder));
        throw Failure(QStringLiteral("Cannot lock the database folder %1: %2")
                          .arg(folder, QString::fromLocal8Bit(std::strerror(errno))));
    }
}

FolderLock::~FolderLock() = default;

}  // namespace etq

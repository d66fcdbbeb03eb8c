#include "platform/private_folder.h"

#include <fcntl.h>
#include <sys/stat.h>

#include <QDir>
#include <QFile>
#include <QStandardPaths>
#include <cerrno>
#include <cstring>

#include "platform/failure.h"
#include "platform/user_paths.h"

namespace etq {

namespace {

constexpr mode_t kOthersMode = S_IRWXG | S_IRWXO;

QString systemError(int error) {
    return QString::fromLocal8Bit(std::strerror(error));
}

// The session's runtime folder when there is one; without it Qt would make one under the
// shared /tmp (and warn), so the user's cache folder serves instead.
QString privateTempBase() {
    QString base;
    if (!qEnvironmentVariableIsEmpty("XDG_RUNTIME_DIR"))
        base = QStandardPaths::writableLocation(QStandardPaths::RuntimeLocation);
    if (base.isEmpty())
        base = QStandardPaths::writableLocation(QStandardPaths::GenericCacheLocation);
    return base;
}

OpenFolder openSystemFolder(const QString& path) {
    QDir().mkpath(path);
    const int fd = ::open(QFile::encodeName(path).constData(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    if (fd < 0)
        throw Failure(
            QStringLiteral("Cannot open the folder %1: %2").arg(path, systemError(errno)));
    return {UniqueFd(fd), path};
}

// Why the folder opened as `fd` is not ours to write in; empty when it is.
QString refusalOf(int fd) {
    struct stat info;
    if (::fstat(fd, &info) != 0) return systemError(errno);
    if (info.st_uid != ::getuid())
        return QStringLiteral("it belongs to another user (uid %1)").arg(info.st_uid);
    if (info.st_mode & kOthersMode)
        return QStringLiteral("other users may enter it (mode %1)")
            .arg(info.st_mode & 07777, 4, 8, QLatin1Char('0'));
    return {};
}

}  // namespace

OpenFolder openPrivateFolder(const OpenFolder& parent, const QString& name) {
    const QString path = joinPath(parent.path, name);
    const QByteArray entry = QFile::encodeName(name);
    if (::mkdirat(parent.fd.get(), entry.constData(), 0700) != 0 && errno != EEXIST)
        throw Failure(QStringLiteral("Cannot create the private folder %1: %2")
                          .arg(path, systemError(errno)));
    const int fd = ::openat(parent.fd.get(), entry.constData(),
                            O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC);
    if (fd < 0) {
        const int error = errno;
        const QString why = error == ELOOP || error == ENOTDIR
                                ? QStringLiteral("it is a link or a file, not a folder")
                                : systemError(error);
        throw Failure(QStringLiteral("The private folder %1 cannot be used: %2. Remove it and "
                                     "try again.")
                          .arg(path, why));
    }
    OpenFolder folder{UniqueFd(fd), path};
    if (const QString why = refusalOf(fd); !why.isEmpty())
        throw Failure(QStringLiteral("The private folder %1 cannot be used: %2. Remove it and "
                                     "try again.")
                          .arg(path, why));
    return folder;
}

OpenFolder openPrivateTempFolder() {
    const QString base = privateTempBase();
    if (base.isEmpty()) throw Failure(QStringLiteral("The user has no runtime or cache folder."));
    return openPrivateFolder(openSystemFolder(base), QStringLiteral("etiquon"));
}

}  // namespace etq

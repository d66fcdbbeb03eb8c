#include "platform/print_folder.h"

#include <dirent.h>
#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <QByteArrayList>
#include <QFile>
#include <QRandomGenerator>
#include <cerrno>
#include <cstring>
#include <ctime>

#include "platform/failure.h"
#include "platform/user_paths.h"

namespace etq {

namespace {

constexpr QByteArrayView kRunPrefix = "run-";
constexpr int kRunNameLength = 10;  // random letters and digits after the prefix
constexpr int kNameAttempts = 100;

QByteArray newRunName() {
    static constexpr char kChars[] =
        "abcdefghijklmnopqrstuvwxyzABCDEFGHIJKLMNOPQRSTUVWXYZ0123456789";
    QByteArray name = kRunPrefix.toByteArray();
    for (int i = 0; i < kRunNameLength; ++i)
        name += kChars[QRandomGenerator::system()->bounded(int(sizeof kChars) - 1)];
    return name;
}

bool isRunName(QByteArrayView name) {
    return name.startsWith(kRunPrefix) && name.size() == kRunPrefix.size() + kRunNameLength;
}

int openFolderAt(int parentFd, const char* name) {
    return ::openat(parentFd, name, O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC);
}

// The names in the folder `fd`, read through a descriptor of its own so that the caller's
// descriptor keeps its place.
QByteArrayList entriesOf(int fd) {
    QByteArrayList names;
    DIR* dir = ::fdopendir(openFolderAt(fd, "."));
    if (!dir) return names;
    while (const dirent* entry = ::readdir(dir)) {
        const QByteArrayView name(entry->d_name);
        if (name != "." && name != "..") names.append(name.toByteArray());
    }
    ::closedir(dir);
    return names;
}

bool isFolderAt(int dirFd, const char* name) {
    struct stat info;
    return ::fstatat(dirFd, name, &info, AT_SYMLINK_NOFOLLOW) == 0 && S_ISDIR(info.st_mode);
}

// A run folder of ours whose run is over: our own, untouched for the age given, and not locked
// by a live run. On true the caller holds its lock until it closes `fd`.
bool isFinishedRun(int fd) {
    struct stat info;
    if (::fstat(fd, &info) != 0 || !S_ISDIR(info.st_mode) || info.st_uid != ::getuid())
        return false;
    const auto age = std::chrono::seconds(std::time(nullptr) - info.st_mtim.tv_sec);
    if (age < PrintRunFolder::kFinishedRunAge) return false;
    return ::flock(fd, LOCK_EX | LOCK_NB) == 0;
}

// Deletes what a run wrote into its folder. unlinkat never follows a link: a link is removed,
// never what it points to. Folders inside are left, and so the run's folder with them.
void emptyRunFolder(int fd) {
    for (const QByteArray& name : entriesOf(fd))
        if (!isFolderAt(fd, name.constData())) ::unlinkat(fd, name.constData(), 0);
}

[[noreturn]] void failToMake(const QString& runs, int error) {
    throw Failure(QStringLiteral("Cannot create a folder for the print run in %1: %2")
                      .arg(runs, QString::fromLocal8Bit(std::strerror(error))));
}

OpenFolder makeRunFolder(const OpenFolder& runs) {
    for (int attempt = 0; attempt < kNameAttempts; ++attempt) {
        const QByteArray name = newRunName();
        if (::mkdirat(runs.fd.get(), name.constData(), 0700) != 0) {
            if (errno == EEXIST) continue;
            failToMake(runs.path, errno);
        }
        UniqueFd fd(openFolderAt(runs.fd.get(), name.constData()));
        if (!fd.isOpen() || ::flock(fd.get(), LOCK_EX | LOCK_NB) != 0) failToMake(runs.path, errno);
        return {std::move(fd), joinPath(runs.path, QFile::decodeName(name))};
    }
    failToMake(runs.path, EEXIST);
}

}  // namespace

PrintRunFolder::PrintRunFolder() {
    const OpenFolder runs = openPrivateFolder(openPrivateTempFolder(), QStringLiteral("etiqon"));
    removeFinishedRuns(runs);
    folder_ = makeRunFolder(runs);
}

PrintRunFolder::~PrintRunFolder() = default;

int removeFinishedRuns(const OpenFolder& runs) {
    int removed = 0;
    for (const QByteArray& name : entriesOf(runs.fd.get())) {
        if (!isRunName(name)) continue;
        // Opened without following links: a link planted under a run's name is no folder.
        const UniqueFd fd(openFolderAt(runs.fd.get(), name.constData()));
        if (!fd.isOpen() || !isFinishedRun(fd.get())) continue;
        emptyRunFolder(fd.get());
        if (::unlinkat(runs.fd.get(), name.constData(), AT_REMOVEDIR) == 0) ++removed;
    }
    return removed;
}

}  // namespace etq

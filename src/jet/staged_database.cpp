#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QRandomGenerator>
#include <cerrno>
#include <cstring>
#include <utility>

#include "jet/connection.h"
#include "jet/database.h"

namespace etq::jet {

namespace {

// What SQLite gives the files it creates.
constexpr mode_t kFileMode = 0644;
constexpr int kNameAttempts = 100;

QByteArray native(const QString& path) {
    return QFile::encodeName(path);
}

QString systemError(int error) {
    return QString::fromLocal8Bit(std::strerror(error));
}

// A new, empty file beside `path` under a name no other file has: hidden, and marked as a
// file that is not done yet.
QString createStagedFile(const QString& path) {
    const QFileInfo target(path);
    if (!target.absoluteDir().exists())
        fail(err::kBadPath, QString("'%1' isn't a valid path.").arg(target.absolutePath()));
    for (int attempt = 0; attempt < kNameAttempts; ++attempt) {
        const QString staged = target.absoluteDir().filePath(
            QString(".%1.%2.new")
                .arg(target.fileName())
                .arg(QRandomGenerator::system()->generate(), 8, 16, QLatin1Char('0')));
        const int fd =
            ::open(native(staged).constData(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, kFileMode);
        if (fd >= 0) {
            ::close(fd);
            return staged;
        }
        if (errno != EEXIST) break;
    }
    fail(err::kCannotOpen,
         QString("Cannot create a file beside '%1': %2.").arg(path, systemError(errno)));
}

void copyFile(const QString& source, const QString& into) {
    QFile in(source);
    QFile out(into);
    if (!in.open(QIODevice::ReadOnly))
        fail(err::kCannotOpen, QString("Cannot read '%1': %2.").arg(source, in.errorString()));
    if (!out.open(QIODevice::WriteOnly | QIODevice::Truncate))
        fail(err::kCannotOpen, QString("Cannot write '%1': %2.").arg(into, out.errorString()));
    constexpr qint64 kChunk = 1 << 20;
    while (!in.atEnd()) {
        const QByteArray chunk = in.read(kChunk);
        if (chunk.isEmpty() && in.error() != QFileDevice::NoError)
            fail(err::kCannotOpen, QString("Cannot read '%1': %2.").arg(source, in.errorString()));
        if (out.write(chunk) != chunk.size())
            fail(err::kCannotOpen, QString("Cannot write '%1': %2.").arg(into, out.errorString()));
    }
}

bool syncToDisk(const QString& path, int flags) {
    const int fd = ::open(native(path).constData(), flags | O_CLOEXEC);
    if (fd < 0) return false;
    const bool synced = ::fsync(fd) == 0;
    ::close(fd);
    return synced;
}

}  // namespace

StagedDatabase::StagedDatabase(FileOnly, const QString& path)
    : path_(QFileInfo(path).absoluteFilePath()), staged_(createStagedFile(path)) {}

StagedDatabase::StagedDatabase(const QString& path, const QString& locale)
    : StagedDatabase(FileOnly{}, path) {
    db_ = Database::initialize(staged_, locale);
}

StagedDatabase StagedDatabase::copyOf(const QString& source, const QString& path) {
    if (!QFileInfo::exists(source))
        fail(err::kFileNotFound, QString("Could not find file '%1'.").arg(source));
    StagedDatabase staged(FileOnly{}, path);
    copyFile(source, staged.staged_);
    staged.db_ = Database::open(staged.staged_);
    return staged;
}

StagedDatabase::StagedDatabase(StagedDatabase&& other) noexcept
    : path_(std::move(other.path_)),
      staged_(std::move(other.staged_)),
      db_(std::move(other.db_)),
      done_(std::exchange(other.done_, true)) {}

StagedDatabase::~StagedDatabase() {
    if (!done_) discard();
}

void StagedDatabase::discard() noexcept {
    db_.close();
    ::unlink(native(staged_).constData());
    ::unlink(native(staged_ + "-journal").constData());
    done_ = true;
}

void StagedDatabase::commit() {
    if (done_) fail(err::kInvalidArgument, QString("'%1' is already in place.").arg(path_));
    if (db_.isOpen() && db_.connection().transactionDepth > 0)
        fail(err::kInvalidArgument,
             QString("'%1' cannot be put in place inside a transaction.").arg(path_));
    db_.close();
    if (!syncToDisk(staged_, O_RDONLY))
        fail(err::kCannotOpen, QString("Cannot write '%1': %2.").arg(staged_, systemError(errno)));
    // A journal that a writer of the old file left when it died would be played back into the
    // new file by the next one to open it.
    for (const char* suffix : {"-journal", "-wal"})
        ::unlink(native(path_ + suffix).constData());
    if (::rename(native(staged_).constData(), native(path_).constData()) != 0)
        fail(err::kCannotOpen, QString("Cannot replace '%1': %2.").arg(path_, systemError(errno)));
    done_ = true;
    // The rename lasts only once the folder is on disk; a folder that cannot be synced (some
    // file systems refuse) keeps the rename as the system keeps it.
    syncToDisk(QFileInfo(path_).absolutePath(), O_RDONLY | O_DIRECTORY);
}

}  // namespace etq::jet

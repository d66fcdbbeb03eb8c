// The lock of a database folder between real processes: a second run is refused while the
// first lives, and a run that is killed leaves no lock behind.
#include "platform/folder_lock.h"

#include <gtest/gtest.h>
#include <signal.h>
#include <sys/wait.h>
#include <unistd.h>

#include <QDir>
#include <QFile>
#include <QTemporaryDir>

#include "platform/failure.h"

namespace etq {
namespace {

// Another process that holds the lock of a folder until it is killed.
class LockHolder {
  public:
    explicit LockHolder(const QString& folder) {
        int ready[2];
        if (::pipe(ready) != 0) return;
        pid_ = ::fork();
        if (pid_ == 0) {
            ::close(ready[0]);
            try {
                const FolderLock lock(folder);
                (void)!::write(ready[1], "L", 1);
                for (;;)
                    ::pause();
            } catch (...) {
                (void)!::write(ready[1], "F", 1);
            }
            ::_exit(1);
        }
        ::close(ready[1]);
        char answer = 0;
        locked_ = ::read(ready[0], &answer, 1) == 1 && answer == 'L';
        ::close(ready[0]);
    }
    ~LockHolder() { kill(); }

    bool locked() const { return locked_; }
    void kill() {
        if (pid_ <= 0) return;
        ::kill(pid_, SIGKILL);
        ::waitpid(pid_, nullptr, 0);
        pid_ = -1;
    }

  private:
    pid_t pid_ = -1;
    bool locked_ = false;
};

TEST(FolderLockTest, ASecondRunIsRefusedUntilTheFirstEndsEvenByAKill) {
    QTemporaryDir busy;
    QTemporaryDir other;
    LockHolder first(busy.path());
    ASSERT_TRUE(first.locked());

    try {
        FolderLock second(busy.path());
        ADD_FAILURE() << "a second lock was given";
    } catch (const FolderBusy& e) {
        EXPECT_TRUE(e.description().contains(busy.path())) << e.what();
        EXPECT_TRUE(e.description().contains("busy with another run")) << e.what();
    }
    EXPECT_NO_THROW(FolderLock{other.path()});  // another folder is free

    first.kill();
    EXPECT_NO_THROW(FolderLock{busy.path()});
}

TEST(FolderLockTest, OneProcessHoldsAFolderOnceAndGivesItBack) {
    QTemporaryDir dir;
    {
        const FolderLock held(dir.path());
        EXPECT_THROW(FolderLock{dir.path()}, FolderBusy);
    }
    EXPECT_NO_THROW(FolderLock{dir.path()});
}

TEST(FolderLockTest, AFolderThatCannotBeLockedIsAFailureNotBusy) {
    QTemporaryDir dir;
    const QString linked = dir.path() + "/linked";
    ASSERT_TRUE(QDir().mkpath(linked));
    ASSERT_TRUE(QFile::link(dir.path() + "/elsewhere", linked + "/" + FolderLock::kLockFileName));
    for (const QString& folder : {dir.path() + "/missing", linked}) {
        SCOPED_TRACE(folder.toStdString());
        try {
            FolderLock lock(folder);
            ADD_FAILURE() << "locked";
        } catch (const FolderBusy& e) {
            ADD_FAILURE() << "busy: " << e.what();
        } catch (const Failure& e) {
            EXPECT_TRUE(e.description().contains(folder)) << e.what();
        }
    }
    EXPECT_FALSE(QFile::exists(dir.path() + "/elsewhere"));
}

}  // namespace
}  // namespace etq

// The private folders and the folders of print runs, on real folders, links and files: what a
// planted link or a folder of someone else makes of a run, and which old runs are cleaned up.
#include "platform/print_folder.h"

#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <fcntl.h>
#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QTemporaryDir>
#include <functional>
#include <optional>

#include "platform/failure.h"
#include "platform/private_folder.h"
#include "support/qt_print.h"

namespace etq {
namespace {

void writeFile(const QString& path, const QByteArray& contents = "x") {
    QFile file(path);
    ASSERT_TRUE(file.open(QIODevice::WriteOnly)) << path.toStdString();
    file.write(contents);
}

QByteArray read(const QString& path) {
    QFile file(path);
    return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
}

mode_t modeOf(const QString& path) {
    struct stat info {};
    ::lstat(QFile::encodeName(path).constData(), &info);
    return info.st_mode & 07777;
}

void makeFolder(const QString& path, mode_t mode) {
    ASSERT_TRUE(QDir().mkpath(path));
    ASSERT_EQ(::chmod(QFile::encodeName(path).constData(), mode), 0);
}

void link(const QString& target, const QString& at) {
    ASSERT_EQ(::symlink(QFile::encodeName(target).constData(), QFile::encodeName(at).constData()),
              0);
}

// Sets a file's or a link's times a day back, as if nothing had touched it since.
void ageADay(const QString& path) {
    struct timespec times[2];
    ::clock_gettime(CLOCK_REALTIME, &times[0]);
    times[0].tv_sec -= 24 * 3600;
    times[1] = times[0];
    ASSERT_EQ(
        ::utimensat(AT_FDCWD, QFile::encodeName(path).constData(), times, AT_SYMLINK_NOFOLLOW), 0);
}

QStringList entries(const QString& folder) {
    return QDir(folder).entryList(QDir::AllEntries | QDir::Hidden | QDir::System |
                                  QDir::NoDotAndDotDot);
}

OpenFolder openedFolder(const QString& path) {
    return {UniqueFd(::open(QFile::encodeName(path).constData(), O_RDONLY | O_DIRECTORY)), path};
}

// A folder of someone else's that a planted link points at: its files and mode must survive.
struct Victim {
    Victim() {
        makeFolder(path(), 0755);
        writeFile(path() + "/precious.txt", "keep me");
    }
    QString path() const { return dir.path() + "/victim"; }
    void expectUntouched() const {
        EXPECT_EQ(entries(path()), QStringList{"precious.txt"});
        EXPECT_EQ(read(path() + "/precious.txt"), "keep me");
        EXPECT_EQ(modeOf(path()), 0755u);
    }
    QTemporaryDir dir;
};

TEST(PrivateFolderTest, RefusesWhatIsNotAPrivateFolderOfTheUser) {
    struct Case {
        const char* what;
        std::function<void(const QString& at, const QString& victim)> plant;
        const char* reason;
    };
    const bool root = ::getuid() == 0;
    const Case cases[] = {
        {"a link to another folder", [](const QString& at, const QString& v) { link(v, at); },
         "it is a link or a file"},
        {"a link to nowhere", [](const QString& at, const QString& v) { link(v + "/none", at); },
         "it is a link or a file"},
        {"a file", [](const QString& at, const QString&) { writeFile(at); },
         "it is a link or a file"},
        {"a folder open to all", [](const QString& at, const QString&) { makeFolder(at, 0777); },
         "other users may enter it (mode 0777)"},
        {"a folder the group may read",
         [](const QString& at, const QString&) { makeFolder(at, 0750); },
         "other users may enter it (mode 0750)"},
        {"another user's folder",
         [](const QString& at, const QString&) {
             makeFolder(at, 0700);
             ASSERT_EQ(::chown(QFile::encodeName(at).constData(), 65534, 65534), 0);
         },
         "it belongs to another user (uid 65534)"},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.what);
        if (QByteArrayView(c.what) == "another user's folder" && !root) continue;
        QTemporaryDir parent;
        const Victim victim;
        const QString at = parent.path() + "/etiqon";
        c.plant(at, victim.path());
        try {
            openPrivateFolder(openedFolder(parent.path()), "etiqon");
            ADD_FAILURE() << "accepted";
        } catch (const Failure& failure) {
            EXPECT_TRUE(failure.description().contains(at)) << failure.what();
            EXPECT_TRUE(failure.description().contains(c.reason)) << failure.what();
        }
        victim.expectUntouched();
    }
}

TEST(PrivateFolderTest, MakesAMissingFolderPrivateAndOpensAnExistingOne) {
    QTemporaryDir parent;
    const OpenFolder made = openPrivateFolder(openedFolder(parent.path()), "etiqon");
    EXPECT_EQ(made.path, parent.path() + "/etiqon");
    EXPECT_EQ(modeOf(made.path), 0700u);
    writeFile(made.path + "/kept");
    const OpenFolder again = openPrivateFolder(openedFolder(parent.path()), "etiqon");
    EXPECT_EQ(entries(again.path), QStringList{"kept"});
}

// Each test gets a runtime folder of its own, as a session has.
class PrintRunFolderTest : public ::testing::Test {
  public:
    QString privateFolder() const { return runtime_.path() + "/etiquon"; }
    QString runsFolder() const { return privateFolder() + "/etiqon"; }

  protected:
    void SetUp() override {
        saved_ = qgetenv("XDG_RUNTIME_DIR");
        qputenv("XDG_RUNTIME_DIR", QFile::encodeName(runtime_.path()));
    }
    void TearDown() override { qputenv("XDG_RUNTIME_DIR", saved_); }

    QTemporaryDir runtime_;
    QByteArray saved_;
};

TEST_F(PrintRunFolderTest, PlantedLinksAndOpenFoldersAreRefusedAndNothingIsTouched) {
    struct Case {
        const char* what;
        std::function<void(PrintRunFolderTest&, const QString& victim)> plant;
    };
    const Case cases[] = {
        {"the print folder a link",
         [](PrintRunFolderTest& t, const QString& victim) {
             makeFolder(t.privateFolder(), 0700);
             link(victim, t.runsFolder());
         }},
        {"the private folder a link",
         [](PrintRunFolderTest& t, const QString& victim) { link(victim, t.privateFolder()); }},
        {"a link inside a private folder open to all",
         [](PrintRunFolderTest& t, const QString& victim) {
             makeFolder(t.privateFolder(), 0777);
             link(victim, t.runsFolder());
         }},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.what);
        QDir(privateFolder()).removeRecursively();
        QFile::remove(privateFolder());
        const Victim victim;
        c.plant(*this, victim.path());
        EXPECT_THROW(PrintRunFolder(), Failure);
        victim.expectUntouched();
    }
}

TEST_F(PrintRunFolderTest, EachRunWritesIntoAPrivateFolderOfItsOwn) {
    const PrintRunFolder first;
    const PrintRunFolder second;
    EXPECT_NE(first.path(), second.path());
    for (const PrintRunFolder* run : {&first, &second}) {
        EXPECT_EQ(QFileInfo(run->path()).path(), runsFolder());
        EXPECT_EQ(modeOf(run->path()), 0700u);
        EXPECT_TRUE(entries(run->path()).isEmpty());
    }
    EXPECT_EQ(modeOf(privateFolder()), 0700u);
    EXPECT_EQ(modeOf(runsFolder()), 0700u);
}

TEST_F(PrintRunFolderTest, ANewRunRemovesOnlyFinishedOldRunsOfOurs) {
    const Victim victim;
    auto finishedRun = [] { return PrintRunFolder().path(); };

    const QString oldRun = finishedRun();
    writeFile(oldRun + "/etiqon1.htm");
    writeFile(oldRun + "/B0400001.BMP");
    link(victim.path() + "/precious.txt", oldRun + "/B0400002.BMP");
    ageADay(oldRun);

    std::optional<PrintRunFolder> live;
    live.emplace();
    writeFile(live->path() + "/etiqon1.htm");
    ageADay(live->path());  // a long run: old, but its lock says it is not done

    const QString youngRun = finishedRun();
    writeFile(youngRun + "/etiqon1.htm");

    const QString plantedLink = runsFolder() + "/run-AAAAAAAAAA";
    link(victim.path(), plantedLink);
    ageADay(plantedLink);
    const QString notARun = runsFolder() + "/mine";
    makeFolder(notARun, 0700);
    ageADay(notARun);

    const PrintRunFolder next;
    EXPECT_FALSE(QFileInfo::exists(oldRun));
    EXPECT_EQ(entries(live->path()), QStringList{"etiqon1.htm"});
    EXPECT_EQ(entries(youngRun), QStringList{"etiqon1.htm"});
    EXPECT_TRUE(QFileInfo(plantedLink).isSymLink());
    EXPECT_TRUE(QFileInfo::exists(notARun));
    victim.expectUntouched();

    // Once the live run is over and old, the next run removes it too.
    const QString liveRun = live->path();
    live.reset();
    ageADay(liveRun);
    const PrintRunFolder later;
    EXPECT_FALSE(QFileInfo::exists(liveRun));
    EXPECT_TRUE(QFileInfo::exists(youngRun));
}

}  // namespace
}  // namespace etq

// The desktop stand-ins the control uses: CUPS printers through its client programs, and the
// user's folders.
#include <gtest/gtest.h>

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QStandardPaths>
#include <QTemporaryDir>

#include "platform/failure.h"
#include "platform/printers.h"
#include "platform/user_paths.h"

namespace etq {
namespace {

// Puts stand-in CUPS programs first on PATH for the life of the object.
class FakeCups {
  public:
    FakeCups() : path_(qgetenv("PATH")) {
        qputenv("PATH", (dir_.path() + ":").toLocal8Bit() + path_);
    }
    ~FakeCups() { qputenv("PATH", path_); }
    void program(const QString& name, const QByteArray& script) {
        QFile file(dir_.filePath(name));
        ASSERT_TRUE(file.open(QIODevice::WriteOnly));
        file.write("#!/bin/sh\n" + script);
        file.close();
        file.setPermissions(file.permissions() | QFile::ExeOwner);
    }
    QString log() const { return dir_.filePath("log"); }

  private:
    QTemporaryDir dir_;
    QByteArray path_;
};

TEST(PrintersTest, DestinationsComeFromCups) {
    FakeCups cups;
    cups.program("lpstat", "[ \"$1\" = -e ] || exit 9\nprintf 'HP_LaserJet\\nZebra_GK420\\n\\n'\n");
    EXPECT_EQ(installedPrinters(), (QStringList{"HP_LaserJet", "Zebra_GK420"}));

    cups.program("lpstat", "echo 'lpstat: Scheduler is not running.' >&2\nexit 1\n");
    try {
        installedPrinters();
        ADD_FAILURE() << "no printers without a scheduler";
    } catch (const Failure& e) {
        EXPECT_TRUE(e.description().contains("Scheduler is not running"));
    }
}

TEST(PrintersTest, TheChosenPrinterBecomesTheDefault) {
    FakeCups cups;
    cups.program("lpoptions", QStringLiteral("echo \"$@\" > %1\n").arg(cups.log()).toLocal8Bit());
    setDefaultPrinter("Zebra_GK420");
    QFile log(cups.log());
    ASSERT_TRUE(log.open(QIODevice::ReadOnly));
    EXPECT_EQ(log.readAll(), "-d Zebra_GK420\n");

    cups.program("lpoptions", "echo 'lpoptions: Unknown printer or class.' >&2\nexit 1\n");
    try {
        setDefaultPrinter("Nowhere");
        ADD_FAILURE() << "an unknown printer is refused";
    } catch (const Failure& e) {
        EXPECT_TRUE(e.description().contains("Unknown printer"));
    }
}

TEST(UserPathsTest, FoldersOfTheUser) {
    EXPECT_EQ(joinPath("/data/etiquon", "etqnitm.kdb"), "/data/etiquon/etqnitm.kdb");
    EXPECT_EQ(joinPath("/data/etiquon/", "etqnitm.kdb"), "/data/etiquon/etqnitm.kdb");
    EXPECT_EQ(defaultLabelFile(), QDir::homePath() + "/mylabel.lbl");
    EXPECT_EQ(userDataFolder(),
              QStandardPaths::writableLocation(QStandardPaths::GenericDataLocation) + "/Etiquon");

    // The private folder is made under the runtime folder; one that others may enter is
    // refused, not repaired (the platform tests try the other ways it can be unfit).
    const QString expected =
        QStandardPaths::writableLocation(QStandardPaths::RuntimeLocation) + "/etiquon";
    QDir(expected).removeRecursively();
    QString error;
    EXPECT_EQ(privateTempFolder(&error), expected) << error.toStdString();
    EXPECT_EQ(QFileInfo(expected).permissions() &
                  (QFile::ReadOther | QFile::WriteOther | QFile::ReadGroup | QFile::WriteGroup),
              QFile::Permissions());
    QFile::setPermissions(expected, QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner |
                                        QFile::ReadOther | QFile::WriteOther | QFile::ExeOther);
    EXPECT_EQ(privateTempFolder(&error), QString());
    EXPECT_TRUE(error.contains("other users may enter it")) << error.toStdString();
    QFile::setPermissions(expected, QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);
}

}  // namespace
}  // namespace etq

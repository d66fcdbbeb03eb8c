// etiquon-cli init-db and upgrade, run as a user runs them.
#include <gtest/gtest.h>

#include <QFile>
#include <QProcess>
#include <QTemporaryDir>

#include "db/file_names.h"
#include "jet/database.h"
#include "jet/recordset.h"

namespace etq::db {
namespace {

struct CliRun {
    int code;
    QString out, err;
};

CliRun cli(const QStringList& args) {
    QProcess p;
    p.start(ETIQUON_CLI, args);
    p.waitForFinished(60000);
    return {p.exitCode(), QString::fromUtf8(p.readAllStandardOutput()),
            QString::fromUtf8(p.readAllStandardError())};
}

TEST(InitDb, PreparesAFolderAndKeepsWhatIsThere) {
    QTemporaryDir dir;
    const QString folder = dir.filePath("data");
    CliRun first = cli({"init-db", "--db", folder});
    ASSERT_EQ(first.code, 0) << first.err.toStdString();
    EXPECT_TRUE(first.out.contains("installed the document database"));
    EXPECT_TRUE(first.out.contains("created the item database"));
    EXPECT_TRUE(first.out.contains("created the working database"));
    jet::Database items = jet::Database::open(inFolder(folder, kItemDatabaseFile));
    EXPECT_TRUE(items.hasTable("tAccountDef"));
    items.execute("INSERT INTO tItems (ItemKey) VALUES ('1')");
    items.close();

    CliRun second = cli({"init-db", "--db", folder});
    ASSERT_EQ(second.code, 0);
    EXPECT_EQ(second.out.count("kept"), 3);
    items = jet::Database::open(inFolder(folder, kItemDatabaseFile));
    EXPECT_TRUE(items.openRecordset("tItems").recordCount() == 1);

    CliRun upgrade = cli({"upgrade", "--db", folder});
    EXPECT_EQ(upgrade.out.trimmed(), "Upgrade failed");  // the tables are there already
    EXPECT_NE(upgrade.code, 0);
}

TEST(InitDb, RefusesADamagedFileAndAnUnusableFolder) {
    QTemporaryDir dir;
    QFile junk(inFolder(dir.path(), kItemDatabaseFile));
    ASSERT_TRUE(junk.open(QIODevice::WriteOnly));
    junk.write("this is not a database");
    junk.close();
    CliRun damaged = cli({"init-db", "--db", dir.path()});
    EXPECT_NE(damaged.code, 0);
    EXPECT_TRUE(damaged.err.contains(kItemDatabaseFile)) << damaged.err.toStdString();

    CliRun unusable = cli({"init-db", "--db", inFolder(junk.fileName(), "sub")});
    EXPECT_NE(unusable.code, 0);
    EXPECT_FALSE(unusable.err.isEmpty());
    EXPECT_EQ(cli({"init-db"}).code, 2);
}

TEST(Upgrade, WithoutAnItemDatabaseThereIsNothingToDo) {
    QTemporaryDir dir;
    CliRun run = cli({"upgrade", "--db", dir.path()});
    EXPECT_EQ(run.code, 0);
    EXPECT_EQ(run.out.trimmed(), "Upgrade successfull");
}

}  // namespace
}  // namespace etq::db

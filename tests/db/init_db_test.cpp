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

CliRun cli(const QStringList& args, const QString& workingFolder = {}) {
    QProcess p;
    if (!workingFolder.isEmpty()) p.setWorkingDirectory(workingFolder);
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

// A file that cannot be used as it stands is replaced, and a copy of it kept: a file that is
// no database, an item database without its item tables (a run killed while making it, before
// files were put in place whole), a working database without its links.
TEST(InitDb, ReplacesUnusableFilesKeepingACopyAndRefusesAnUnusableFolder) {
    QTemporaryDir dir;
    const QString items = inFolder(dir.path(), kItemDatabaseFile);
    const QString docs = inFolder(dir.path(), kDocDatabaseFile);
    const QString work = inFolder(dir.path(), kWorkDatabaseFile);
    QFile junk(docs);
    ASSERT_TRUE(junk.open(QIODevice::WriteOnly));
    junk.write("this is not a database");
    junk.close();
    jet::Database::create(items).createTable({"tItems", {{"ItemKey", jet::FieldType::Text, 20}}});
    jet::Database::create(work);

    CliRun run = cli({"init-db", "--db", dir.path()});
    ASSERT_EQ(run.code, 0) << run.err.toStdString();
    EXPECT_TRUE(run.out.contains("replacing the document database " + docs))
        << run.out.toStdString();
    EXPECT_TRUE(run.out.contains("lacks the tables tAlterKeys, tAlterPrices"));
    EXPECT_TRUE(run.out.contains("replacing the working database " + work));
    EXPECT_EQ(run.out.count("kept as"), 3);
    QFile copy(docs + ".damaged");
    ASSERT_TRUE(copy.open(QIODevice::ReadOnly));
    EXPECT_EQ(copy.readAll(), "this is not a database");
    EXPECT_TRUE(jet::Database::open(docs).hasTable("tDocTypes"));
    EXPECT_TRUE(jet::Database::open(items).hasTable("tAlterPrices"));
    EXPECT_TRUE(jet::Database::open(items).hasTable("tPriceList"));
    EXPECT_TRUE(jet::Database::open(work).hasTable("tItems"));
    EXPECT_EQ(cli({"init-db", "--db", dir.path()}).out.count("kept the"), 3);

    CliRun unusable = cli({"init-db", "--db", inFolder(docs, "sub")});
    EXPECT_NE(unusable.code, 0);
    EXPECT_FALSE(unusable.err.isEmpty());
    EXPECT_EQ(cli({"init-db"}).code, 2);
}

// A folder given relatively, with a ';' in its name: the working database's links name the
// files absolutely and reach them from any working folder.
TEST(InitDb, ARelativeFolderGetsAbsoluteLinks) {
    QTemporaryDir dir;
    ASSERT_EQ(cli({"init-db", "--db", "shop;2/db"}, dir.path()).code, 0);
    const QString folder = dir.path() + "/shop;2/db";
    jet::Database work = jet::Database::open(inFolder(folder, kWorkDatabaseFile));
    ASSERT_FALSE(work.links().isEmpty());
    for (const jet::LinkDef& link : work.links()) {
        EXPECT_TRUE(link.sourcePath().startsWith(folder + "/")) << link.connect.toStdString();
        EXPECT_FALSE(work.tableDef(link.name).fields.isEmpty()) << link.name.toStdString();
    }
    EXPECT_GT(work.openRecordset("tDocTypes").recordCount(), 0);
}

TEST(Upgrade, AnItemDatabaseWithoutItsItemTablesIsNotUpgraded) {
    QTemporaryDir dir;
    jet::Database::create(inFolder(dir.path(), kItemDatabaseFile));
    CliRun run = cli({"upgrade", "--db", dir.path()});
    EXPECT_EQ(run.out.trimmed(), "Upgrade failed");
    EXPECT_NE(run.code, 0);
}

TEST(Upgrade, WithoutAnItemDatabaseThereIsNothingToDo) {
    QTemporaryDir dir;
    CliRun run = cli({"upgrade", "--db", dir.path()});
    EXPECT_EQ(run.code, 0);
    EXPECT_EQ(run.out.trimmed(), "Upgrade successfull");
}

}  // namespace
}  // namespace etq::db

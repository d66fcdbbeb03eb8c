// The creation routines on real files: schemas, links, queries, the merge and the clean-up.
#include <signal.h>
#include <sys/wait.h>
#include <unistd.h>

#include <QDir>
#include <QElapsedTimer>
#include <QProcess>
#include <thread>

#include "db/schemas.h"
#include "db_fixture.h"
#include "platform/captions.h"
#include "platform/context.h"
#include "support/recording_progress.h"

namespace etq::db::test {
namespace {

class LocalDatabasesTest : public DbFolderTest {};

TEST_F(LocalDatabasesTest, TheWorkingDatabaseLinksNineTablesOrTenWithTheLog) {
    ASSERT_EQ(createWork(false), path(kWorkDatabaseFile));
    {
        jet::Database work = jet::Database::open(path(kWorkDatabaseFile));
        QStringList names;
        for (const jet::LinkDef& l : work.links())
            names << l.name;
        EXPECT_EQ(names,
                  QStringList({"tDocTypes", "tCurrencies", "tWizFiles", "tWizFileRanges", "tItems",
                               "tAlterKeys", "tAlterPrices", "tPriceList", "tAccountDef"}));
        EXPECT_EQ(work.links()[4].connect, ";DATABASE=" + path(kItemDatabaseFile));
        EXPECT_EQ(work.tableNames().mid(0, 3),
                  QStringList({"tTempDocHeaders", "tTempDocLines", "tTransports"}));
        EXPECT_EQ(work.tableDef("tTempDocHeaders").fields, schema::tempDocHeaders().fields);
        EXPECT_EQ(work.tableDef("tTempDocLines").primaryKey,
                  QStringList({"WizFileID", "HeadNumber", "LineNum"}));
        EXPECT_EQ(work.queryNames(), QStringList({"qSelectDocHeaders", "qSelectDocLines"}));
        EXPECT_EQ(work.locale(), ";LANGID=0x040D;CP=1255;COUNTRY=0");
        work.execute("INSERT INTO tTempDocHeaders (WizFileID, [Number]) VALUES (1, 1)");
    }
    // Creating again replaces the file: the old documents are gone, and the log is linked.
    ASSERT_EQ(createWork(true), path(kWorkDatabaseFile));
    jet::Database work = jet::Database::open(path(kWorkDatabaseFile));
    ASSERT_EQ(work.links().size(), 10);
    EXPECT_EQ(work.links().last().name, "tStockLog");
    EXPECT_TRUE(rows(work, "SELECT * FROM tTempDocHeaders").isEmpty());
}

TEST_F(LocalDatabasesTest, AFailedCreationThrowsTheEngineDescription) {
    QFile::remove(path(kItemDatabaseFile));
    const auto failed = failureOf([&] { createWork(false); });
    ASSERT_TRUE(failed);
    EXPECT_TRUE(failed->description.contains(kItemDatabaseFile));
    // Nothing half-built is left at the path, nor a temporary file beside it.
    EXPECT_FALSE(QFile::exists(path(kWorkDatabaseFile)));
    EXPECT_EQ(QDir(dir.path()).entryList({".*"}, QDir::Files | QDir::Hidden), QStringList());
    CreateItemDatabase(path(kItemDatabaseFile));
    AddAccountTables(path(kItemDatabaseFile));
    EXPECT_EQ(createWork(false), path(kWorkDatabaseFile));
}

TEST_F(LocalDatabasesTest, AddAccountTablesTwiceFailsTheSecondTime) {
    auto failed = failureOf([&] { AddAccountTables(path(kItemDatabaseFile)); });
    ASSERT_TRUE(failed);
    EXPECT_EQ(failed->description, "Table 'tAccountDef' already exists.");
    EXPECT_TRUE(failureOf([&] { UpgradeItemDatabase(dir.path()); }));

    failed = failureOf([&] { AddAccountTables(path("nothing.kdb")); });
    ASSERT_TRUE(failed);
    EXPECT_EQ(failed->description, "Database not found");
    EXPECT_EQ(failed->title, "Error");
    QFile::remove(path(kItemDatabaseFile));
    EXPECT_FALSE(failureOf([&] { UpgradeItemDatabase(dir.path()); }));  // nothing to upgrade
}

TEST_F(LocalDatabasesTest, MarkedItemsListFirstByKey) {
    jet::Database items = jet::Database::open(path(kItemDatabaseFile));
    items.execute(
        "INSERT INTO tItems (ItemKey, ItemName, PrintLabel, Copies) VALUES ('3', 'c', False, 1), ('1', 'a', False, 1), ('4', 'd', True, 2), ('2', 'b', True, 1)");
    EXPECT_EQ(rows(items, "qSelectItems"),
              QStringList({"2|b|1|True", "4|d|2|True", "1|a|1|False", "3|c|1|False"}));
    EXPECT_EQ(rows(items, "qSelectMarkedItems"), QStringList({"2|b|1|True", "4|d|2|True"}));
    EXPECT_EQ(rows(items, "qEditItems").size(), 4);
}

class MergeTest : public LocalDatabasesTest {
  protected:
    void SetUp() override {
        LocalDatabasesTest::SetUp();
        ASSERT_EQ(CreateTempItemDatabase(path(kTempItemDatabaseFile), path(kItemDatabaseFile)),
                  path(kTempItemDatabaseFile));
        jet::Database items = jet::Database::open(path(kItemDatabaseFile));
        items.execute("INSERT INTO tPriceList VALUES ('100', 1, 10, '¦'), ('100', 2, 20, '¦')");
        items.execute("INSERT INTO tAlterKeys VALUES ('C1', '100', 'A-1', 'BAR-1')");
        items.execute("INSERT INTO tAlterPrices VALUES ('C1', '100', 5, '¦')");
    }
    jet::Database temp() { return jet::Database::open(path(kTempItemDatabaseFile)); }
    QStringList itemRows(const QString& sql) {
        jet::Database items = jet::Database::open(path(kItemDatabaseFile));
        return rows(items, sql);
    }
};

TEST_F(MergeTest, AnEmptyStagingChangesNothing) {
    MergeTempItems(path(kTempItemDatabaseFile));
    EXPECT_EQ(itemRows("SELECT * FROM tPriceList ORDER BY ItemKey, PriceList"),
              QStringList({"100|1|10|¦", "100|2|20|¦"}));
    EXPECT_EQ(itemRows("SELECT * FROM tAlterPrices"), QStringList({"C1|100|5|¦"}));
}

TEST_F(MergeTest, StagedPricesUpdateOrAddAndListElevenStays) {
    {
        jet::Database t = temp();
        t.execute(
            "INSERT INTO tTempPriceList VALUES ('100', 2, 22, '$'), ('200', 10, 7, '¦'), ('200', 11, 8, '¦')");
        t.execute(
            "INSERT INTO tTempAlterPrices VALUES ('C1', '100', 6, '$'), ('C2', '200', 1.5, Null)");
        t.execute("INSERT INTO tTempAlterKeys VALUES ('C1', '100', 'A-2', Null)");
    }
    MergeTempItems(path(kTempItemDatabaseFile));
    EXPECT_EQ(itemRows("SELECT * FROM tPriceList ORDER BY ItemKey, PriceList"),
              QStringList({"100|1|10|¦", "100|2|22|$", "200|10|7|¦"}));
    EXPECT_EQ(itemRows("SELECT * FROM tAlterPrices ORDER BY AccountKey"),
              QStringList({"C1|100|6|$", "C2|200|1.5|Null"}));
    // The alternate barcode is not part of the merge: it survives.
    EXPECT_EQ(itemRows("SELECT * FROM tAlterKeys"), QStringList({"C1|100|A-2|BAR-1"}));
}

TEST_F(MergeTest, CleanTablesFollowsItsTwoBoxes) {
    struct Case {
        bool clean, alterPrices;
        int items, alterPriceRows;
    };
    for (const Case c : {Case{false, false, 1, 1}, Case{false, true, 1, 1}, Case{true, false, 0, 1},
                         Case{true, true, 0, 0}}) {
        {
            jet::Database items = jet::Database::open(path(kItemDatabaseFile));
            items.execute("INSERT INTO tItems (ItemKey) VALUES ('100')");
            items.execute("INSERT INTO tAlterPrices VALUES ('C1', '100', 5, '¦')");
        }
        etq::test::RecordingProgress progress;
        CleanItemTables(path(kItemDatabaseFile), c.clean, c.alterPrices, Context(), progress);
        const QStringList shown = progress.steps;
        EXPECT_EQ(itemRows("SELECT Count(*) FROM tItems"), QStringList{QString::number(c.items)});
        EXPECT_EQ(itemRows("SELECT Count(*) FROM tAlterPrices"),
                  QStringList{QString::number(c.alterPriceRows)});
        EXPECT_EQ(shown, c.clean ? QStringList{GetCaption(42, 0)} : QStringList());
        // Alternate keys, account settings and price lists are never emptied here.
        EXPECT_EQ(itemRows("SELECT Count(*) FROM tAlterKeys"), QStringList{"1"});
        EXPECT_EQ(itemRows("SELECT Count(*) FROM tPriceList"), QStringList{"2"});
    }
}

TEST_F(LocalDatabasesTest, TheStockShellShowsTablesTypesAndQueryTexts) {
    if (QProcess::execute("sqlite3", {"-version"}) != 0) GTEST_SKIP() << "no sqlite3 shell";
    QProcess shell;
    shell.start(
        "sqlite3",
        {path(kItemDatabaseFile),
         "SELECT name FROM sqlite_master WHERE type = 'table' AND name LIKE 't%' ORDER BY rowid; SELECT name || ' ' || type FROM pragma_table_info('tItems') WHERE cid IN (0, 2, 10, 15, 16); SELECT SQL FROM MSysQueries WHERE Name = 'qSelectMarkedItems';"});
    ASSERT_TRUE(shell.waitForFinished());
    EXPECT_EQ(
        QString::fromUtf8(shell.readAllStandardOutput()).split('\n', Qt::SkipEmptyParts),
        QStringList(
            {"tItems", "tAlterKeys", "tAlterPrices", "tAccountDef", "tPriceList",
             "ItemKey TEXT(20)", "ItemSort SHORT", "Price DOUBLE", "Copies BYTE", "PrintLabel BIT",
             "SELECT ItemKey, ItemName, Copies, PrintLabel FROM tItems Where PrintLabel = True ORDER BY tItems.PrintLabel, tItems.Itemkey"}));
}

TEST_F(LocalDatabasesTest, TheDeliveredDocumentDatabaseHoldsTypesFilesRangesAndTheLocalCurrency) {
    jet::Database doc = jet::Database::open(path(kDocDatabaseFile));
    EXPECT_EQ(rows(doc, "SELECT Currency, WizSign FROM tCurrencies"), QStringList({"¦|₪"}));
    EXPECT_EQ(rows(doc, "Select DocType From tDocTypes Where Include Or IncludeDraft"),
              QStringList({"1", "2"}));
    // Every document type has its host file and a scan range starting at 0.
    EXPECT_EQ(
        rows(
            doc,
            "SELECT Count(*) FROM (tDocTypes INNER JOIN tWizFiles ON tWizFiles.WizFileID = tDocTypes.DocType) INNER JOIN tWizFileRanges ON tWizFileRanges.WizFileID = tDocTypes.DocType WHERE tWizFileRanges.FromIndx = 0"),
        rows(doc, "SELECT Count(*) FROM tDocTypes"));
    QStringList docTypes = rows(doc, "qSelectDocTypes");
    EXPECT_EQ(docTypes.first(), "תעודת משלוח|True|False");
    // The scan range window writes through its query.
    jet::Recordset ranges = doc.openRecordset("qWizFileRanges");
    ranges.moveLast();
    ranges.edit();
    ranges.setValue("FromIndx", 17);
    ranges.update();
    EXPECT_EQ(rows(doc, "SELECT FromIndx FROM tWizFileRanges WHERE WizFileID = 12"),
              QStringList({"17"}));
}

// The tables of the item database a test file holds, and its keys: how whole it is.
struct ItemFile {
    QStringList tables;
    QStringList keys;
};

ItemFile readItemFile(const QString& path) {
    ItemFile seen;
    jet::Database db = jet::Database::open(path);
    for (const QString& table : {"tItems", "tAlterKeys", "tAlterPrices"})
        if (db.hasTable(table)) seen.tables << table;
    if (db.hasTable("tItems")) seen.keys = etq::test::jetRows(db, "SELECT ItemKey FROM tItems");
    return seen;
}

// Runs the creation of the item database in a child process and kills it (SIGKILL) after
// `delay`; returns once the child is gone, whether it finished or not.
void createItemsKilledAfter(const QString& path, std::chrono::microseconds delay) {
    const pid_t child = ::fork();
    if (child == 0) {
        CreateItemDatabase(path);
        ::_exit(0);
    }
    std::this_thread::sleep_for(delay);
    ::kill(child, SIGKILL);
    ::waitpid(child, nullptr, 0);
}

// A kill at any moment of a creation that replaces a file leaves the old file or the new one,
// whole: never a file without its tables, never no file. The kills are spread over the time a
// creation takes here, so that they land before, in and after its steps.
TEST_F(LocalDatabasesTest, AKillAtAnyMomentOfACreationLeavesTheOldFileOrTheNewOneWhole) {
    const QString items = path(kItemDatabaseFile);
    const QStringList allTables{"tItems", "tAlterKeys", "tAlterPrices"};
    auto markOld = [&] {
        jet::Database db = jet::Database::open(items);
        db.execute("INSERT INTO tItems (ItemKey) VALUES ('OLD')");
    };
    markOld();
    QElapsedTimer timer;
    timer.start();
    ASSERT_FALSE(CreateItemDatabase(path("scratch.kdb")).isEmpty());
    const qint64 creation = timer.nsecsElapsed() / 1000;

    constexpr int kKills = 24;
    int old = 0;
    int created = 0;
    for (int k = 0; k < kKills; ++k) {
        SCOPED_TRACE(k);
        createItemsKilledAfter(items, std::chrono::microseconds(creation * k / (kKills - 2)));
        ASSERT_TRUE(QFile::exists(items));
        const ItemFile seen = readItemFile(items);
        ASSERT_EQ(seen.tables, allTables);
        if (seen.keys == QStringList{"OLD"}) {
            ++old;
        } else {
            ASSERT_EQ(seen.keys, QStringList());
            ++created;
            markOld();
        }
    }
    RecordProperty("kept_old", old);
    RecordProperty("replaced", created);
}

TEST_F(LocalDatabasesTest, TheUpgradeRefusesAnItemDatabaseWithoutItsItemTables) {
    QFile::remove(path(kItemDatabaseFile));
    jet::Database::create(path(kItemDatabaseFile)).createTable(schema::items());
    const auto failed = failureOf([&] { UpgradeItemDatabase(dir.path()); });
    ASSERT_TRUE(failed);
    EXPECT_TRUE(failed->description.contains("lacks the tables tAlterKeys, tAlterPrices"))
        << failed->description.toStdString();
    EXPECT_FALSE(jet::Database::open(path(kItemDatabaseFile)).hasTable("tAccountDef"));
}

}  // namespace
}  // namespace etq::db::test

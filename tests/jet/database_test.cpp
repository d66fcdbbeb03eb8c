// The engine's files: creation, definitions read back from disk, the errors its callers test
// for, links between files and saved queries.
#include <QDir>
#include <QFile>
#include <QProcess>

#include "jet/connection.h"
#include "jet_fixture.h"

namespace etq::jet::test {
namespace {

TableDef itemsDef() {
    return {"tItems",
            {text("ItemKey", 20), text("ItemName", 100), field("ItemSort", FieldType::Integer),
             field("Copies", FieldType::Byte), field("PrintLabel", FieldType::Boolean),
             field("Price", FieldType::Double), field("LastUpdate", FieldType::Date),
             field("Counter", FieldType::Long)},
            {"ItemKey"}};
}

class DatabaseTest : public JetTest {};

TEST_F(DatabaseTest, DefinitionsAndLocaleAreReadBackFromTheFile) {
    {
        Database db = create("a.kdb");
        db.createTable(itemsDef());
        db.createTable(
            {"tPairs", {text("A", 5), field("B", FieldType::Integer), text("C", 1)}, {"A", "B"}});
    }
    Database db = Database::open(file("a.kdb"));
    EXPECT_EQ(db.locale(), kHebrewLocale);
    EXPECT_EQ(db.tableNames(), QStringList({"tItems", "tPairs"}));
    const TableDef items = db.tableDef("titems");  // names are found without regard to case
    EXPECT_EQ(items.name, "tItems");
    EXPECT_EQ(items.fields, itemsDef().fields);
    EXPECT_EQ(items.primaryKey, QStringList{"ItemKey"});
    EXPECT_EQ(db.tableDef("tPairs").primaryKey, QStringList({"A", "B"}));
}

TEST_F(DatabaseTest, CreatingOverAFileOrOpeningAStrangeFileFails) {
    create("a.kdb");
    EXPECT_JET_ERROR(err::kDatabaseExists, create("a.kdb"));
    EXPECT_JET_ERROR(err::kFileNotFound, Database::open(file("missing.kdb")));
    QFile junk(file("junk.kdb"));
    ASSERT_TRUE(junk.open(QIODevice::WriteOnly));
    junk.write(QByteArray(4096, 'x'));
    junk.close();
    EXPECT_JET_ERROR(err::kUnrecognizedFormat, Database::open(file("junk.kdb")));
    EXPECT_JET_ERROR(err::kBadPath, Database::create(file("no/such/folder/a.kdb")));
}

TEST_F(DatabaseTest, EachFieldRuleIsAnErrorWithItsNumber) {
    Database db = create("a.kdb");
    db.createTable(itemsDef());
    Recordset rs = db.openRecordset("tItems");
    rs.addNew();
    rs.setValue("ItemKey", "1");
    rs.update();

    rs.addNew();
    rs.setValue("ItemKey", "1");
    EXPECT_JET_ERROR(err::kDuplicateKey, rs.update());
    rs.cancelUpdate();

    rs.addNew();
    EXPECT_JET_ERROR(err::kTooLong, rs.setValue("ItemKey", QString(21, u'x')));
    EXPECT_JET_ERROR(err::kZeroLength, rs.setValue("ItemName", ""));
    EXPECT_JET_ERROR(err::kOverflow, rs.setValue("Copies", 256));
    EXPECT_JET_ERROR(err::kOverflow, rs.setValue("Copies", -1));
    EXPECT_JET_ERROR(err::kOverflow, rs.setValue("ItemSort", 32768));
    EXPECT_JET_ERROR(err::kOverflow, rs.setValue("Counter", 2147483648.0));
    EXPECT_JET_ERROR(err::kConversion, rs.setValue("Price", "abc"));
    EXPECT_JET_ERROR(err::kItemNotFound, rs.setValue("NoSuchField", 1));
    rs.setValue("ItemSort", -32768);
    rs.setValue("Copies", 255);
    rs.setValue("Counter", "2147483647");
    rs.setValue("ItemKey", QString(20, u'א'));  // the size counts characters, Hebrew too
    rs.update();
    EXPECT_EQ(rs.recordCount(), 2);

    // The same rules hold for statements, which do not pass through the recordset.
    EXPECT_JET_ERROR(err::kDuplicateKey, db.execute("INSERT INTO tItems (ItemKey) VALUES ('1')",
                                                    Database::FailOnError));
    EXPECT_JET_ERROR(err::kTooLong,
                     db.execute("UPDATE tItems SET ItemName = '" + QString(101, u'n') + "'",
                                Database::FailOnError));
    EXPECT_JET_ERROR(err::kZeroLength,
                     db.execute("UPDATE tItems SET ItemName = ''", Database::FailOnError));
    EXPECT_JET_ERROR(err::kOverflow,
                     db.execute("UPDATE tItems SET Copies = 300", Database::FailOnError));
    EXPECT_JET_ERROR(err::kNullKey, db.execute("INSERT INTO tItems (ItemName) VALUES ('x')",
                                               Database::FailOnError));
    EXPECT_JET_ERROR(err::kTableNotFound, db.execute("DELETE * FROM tNothing"));
    EXPECT_JET_ERROR(err::kUnknownField, db.execute("UPDATE tItems SET Nothing = 1"));
    EXPECT_JET_ERROR(err::kUnknownField, db.openRecordset("SELECT Nothing FROM tItems"));
    EXPECT_JET_ERROR(err::kAlreadyExists, db.createTable(itemsDef()));
    EXPECT_JET_ERROR(err::kTableNotFound, db.openRecordset("tNothing"));
}

// The rules are checked on every row written, so they must stay cheap: none may make the
// statement build a temporary table (SQLite does for a constant IN list of three or more). The
// number rule still refuses a text and takes whole numbers, fractions and Null.
TEST_F(DatabaseTest, FieldRulesNeedNoTemporaryTableAndNumbersRefuseText) {
    Database db = create("a.kdb");
    db.createTable(itemsDef());
    detail::Stmt explain = db.connection().prepare(
        "EXPLAIN INSERT INTO tItems (ItemKey, ItemName, ItemSort, Copies, PrintLabel, Price, "
        "LastUpdate, Counter) VALUES ('1', 'a', 1, 1, -1, 2.5, 45000.5, 1)",
        false);
    QStringList opcodes;
    while (explain.step())
        opcodes << explain.column(1).toString();
    EXPECT_TRUE(opcodes.contains("Insert"));
    EXPECT_FALSE(opcodes.contains("OpenEphemeral"));

    for (const char* value : {"2", "2.5", "Null"})
        EXPECT_EQ(db.execute(QString("INSERT INTO tItems (ItemKey, Price, LastUpdate) VALUES "
                                     "('k%1', %1, %1)")
                                 .arg(value),
                             Database::FailOnError),
                  1)
            << value;
    EXPECT_EQ(db.execute("INSERT INTO tItems (ItemKey, Price) VALUES ('t', 'abc')"), 0);
    EXPECT_EQ(db.execute("INSERT INTO tItems (ItemKey, LastUpdate) VALUES ('d', 'abc')"), 0);
    EXPECT_EQ(rows(db, "SELECT ItemKey, Price FROM tItems ORDER BY ItemKey"),
              QStringList({"k2|2", "k2.5|2.5", "kNull|Null"}));
}

TEST_F(DatabaseTest, ExecuteSkipsFailingRowsUnlessToldToFail) {
    Database db = create("a.kdb");
    db.createTable(
        {"tLog", {field("Id", FieldType::Long), field("Boxes", FieldType::Integer)}, {"Id"}});
    db.createTable(
        {"tNew", {field("Id", FieldType::Long), field("Boxes", FieldType::Long)}, {"Id"}});
    db.execute("INSERT INTO tLog (Id, Boxes) VALUES (1, 1)");
    for (int id : {1, 2, 3})
        db.execute(QString("INSERT INTO tNew (Id, Boxes) VALUES (%1, %2)")
                       .arg(id)
                       .arg(id == 3 ? 40000 : 5));
    // Id 1 is there already and 40000 does not fit an Integer: only Id 2 goes in.
    EXPECT_EQ(db.execute("INSERT INTO tLog (Id, Boxes) SELECT Id, Boxes FROM tNew"), 1);
    EXPECT_EQ(rows(db, "SELECT Id, Boxes FROM tLog ORDER BY Id"), QStringList({"1|1", "2|5"}));
    EXPECT_JET_ERROR(err::kDuplicateKey,
                     db.execute("INSERT INTO tLog SELECT Id, Boxes FROM tNew WHERE Id = 1",
                                Database::FailOnError));
}

TEST_F(DatabaseTest, LinksReadAndWriteThroughAndSurviveReopening) {
    {
        Database items = create("items.kdb");
        items.createTable(itemsDef());
        items.execute("INSERT INTO tItems (ItemKey, ItemName) VALUES ('A1', 'Soap')");
    }
    {
        Database work = create("work.tmp");
        work.linkTable("tItems", file("items.kdb"));
        EXPECT_JET_ERROR(err::kFileNotFound, work.linkTable("tLog", file("nolog.kdb")));
        EXPECT_JET_ERROR(err::kTableNotFound, work.linkTable("tStockLog", file("items.kdb")));
        EXPECT_JET_ERROR(err::kAlreadyExists, work.linkTable("tItems", file("items.kdb")));
    }
    Database work = Database::open(file("work.tmp"));
    ASSERT_EQ(work.links().size(), 1);
    EXPECT_EQ(work.links()[0].connect, ";DATABASE=" + file("items.kdb"));
    EXPECT_EQ(work.links()[0].sourceTable, "tItems");
    EXPECT_EQ(work.tableDef("tItems").primaryKey, QStringList{"ItemKey"});
    EXPECT_EQ(rows(work, "SELECT ItemName FROM tItems"), QStringList{"Soap"});

    Recordset rs = work.openRecordset("tItems");
    rs.addNew();
    rs.setValue("ItemKey", "B2");
    rs.setValue("ItemName", "Brush");
    rs.update();
    work.execute("UPDATE tItems SET Copies = 2 WHERE ItemKey = 'A1'");
    work.close();

    Database items = Database::open(file("items.kdb"));
    EXPECT_EQ(rows(items, "SELECT ItemKey, Copies FROM tItems ORDER BY ItemKey"),
              QStringList({"A1|2", "B2|Null"}));
}

TEST_F(DatabaseTest, ALinkWhoseFileIsGoneNamesTheFileWhenUsed) {
    {
        Database log = create("log.kdb");
        log.createTable({"tStockLog", {field("Number", FieldType::Long)}, {"Number"}});
        Database work = create("work.tmp");
        work.linkTable("tStockLog", file("log.kdb"));
    }
    QFile::remove(file("log.kdb"));
    Database work = Database::open(file("work.tmp"));
    try {
        rows(work, "SELECT * FROM tStockLog");
        ADD_FAILURE() << "no error";
    } catch (const JetError& e) {
        EXPECT_EQ(e.number(), err::kFileNotFound);
        EXPECT_TRUE(e.description().contains("log.kdb"));
    }
}

TEST_F(DatabaseTest, SavedQueriesKeepTheirTextAndRunByName) {
    Database db = create("a.kdb");
    db.createTable(itemsDef());
    const QString select =
        "SELECT ItemKey, ItemName FROM tItems Where PrintLabel = True ORDER BY tItems.Itemkey";
    const QString action = "UPDATE tItems SET PrintLabel = True WHERE ItemKey Like \"A*\"";
    db.createQuery("qMarked", select);
    db.createQuery("qMarkA", action);
    EXPECT_JET_ERROR(err::kObjectExists, db.createQuery("qMarked", select));
    EXPECT_JET_ERROR(err::kSyntax, db.createQuery("qBad", "SELECT FROM WHERE 'x"));
    db.execute(
        "INSERT INTO tItems (ItemKey, ItemName) VALUES ('A1', 'a'), ('A2', 'b'), ('B1', 'c')");
    db.close();

    db = Database::open(file("a.kdb"));
    EXPECT_EQ(db.queryNames(), QStringList({"qMarked", "qMarkA"}));
    EXPECT_EQ(db.querySql("qmarked"), select);
    EXPECT_EQ(db.execute("qMarkA"), 2);
    EXPECT_EQ(rows(db, "qMarked"), QStringList({"A1|a", "A2|b"}));
}

TEST_F(DatabaseTest, TheStockShellReadsTheFiles) {
    if (QProcess::execute("sqlite3", {"-version"}) != 0) GTEST_SKIP() << "no sqlite3 shell";
    {
        Database db = create("a.kdb");
        db.createTable(itemsDef());
        db.createQuery("qSelectItems", "SELECT ItemKey FROM tItems ORDER BY tItems.Itemkey");
        db.execute("INSERT INTO tItems (ItemKey) VALUES ('b'), ('A')");
    }
    QProcess shell;
    shell.start(
        "sqlite3",
        {file("a.kdb"),
         "SELECT ItemKey FROM tItems WHERE ItemKey = 'a' ORDER BY ItemKey; SELECT SQL FROM MSysQueries; SELECT type FROM pragma_table_info('tItems') LIMIT 2;"});
    ASSERT_TRUE(shell.waitForFinished());
    EXPECT_EQ(QString::fromUtf8(shell.readAllStandardOutput()).split('\n', Qt::SkipEmptyParts),
              QStringList({"A", "SELECT ItemKey FROM tItems ORDER BY tItems.Itemkey", "TEXT(20)",
                           "TEXT(100)"}));
}

TEST_F(DatabaseTest, TransactionsCommitAndRollBack) {
    Database db = create("a.kdb");
    db.createTable(itemsDef());
    db.beginTrans();
    db.execute("INSERT INTO tItems (ItemKey) VALUES ('1')");
    db.beginTrans();
    db.execute("INSERT INTO tItems (ItemKey) VALUES ('2')");
    db.rollback();
    db.commitTrans();
    db.beginTrans();
    db.execute("INSERT INTO tItems (ItemKey) VALUES ('3')");
    db.rollback();
    EXPECT_EQ(rows(db, "SELECT ItemKey FROM tItems"), QStringList{"1"});
}

// A link made with a relative path, from a folder whose name holds a ';' (which also ends the
// parts of a connect text), still reaches its table from another working folder.
TEST_F(DatabaseTest, LinksAreStoredWithAbsolutePathsThatMayHoldSemicolons) {
    const QString folder = file("a;b #1");
    ASSERT_TRUE(QDir().mkpath(folder));
    {
        Database items = Database::create(folder + "/items.kdb");
        items.createTable(itemsDef());
        items.execute("INSERT INTO tItems (ItemKey, ItemName) VALUES ('A1', 'Soap')");
    }
    const QString before = QDir::currentPath();
    ASSERT_TRUE(QDir::setCurrent(dir_.path()));
    {
        Database work = Database::create("a;b #1/work.tmp");
        work.linkTable("tItems", "a;b #1/items.kdb");
    }
    ASSERT_TRUE(QDir::setCurrent(QDir::rootPath()));
    Database work = Database::open(folder + "/work.tmp");
    QDir::setCurrent(before);
    ASSERT_EQ(work.links().size(), 1);
    EXPECT_EQ(work.links()[0].connect, ";DATABASE=" + folder + "/items.kdb");
    EXPECT_EQ(work.links()[0].sourcePath(), folder + "/items.kdb");
    EXPECT_EQ(rows(work, "SELECT ItemName FROM tItems"), QStringList{"Soap"});
}

class StagedDatabaseTest : public JetTest {
  protected:
    // The files of the folder, hidden ones too: what a build leaves beside its file.
    QStringList files() const {
        return QDir(dir_.path()).entryList(QDir::Files | QDir::Hidden | QDir::NoDotAndDotDot);
    }
    void writeFile(const QString& name, const QByteArray& bytes) {
        QFile out(file(name));
        ASSERT_TRUE(out.open(QIODevice::WriteOnly));
        out.write(bytes);
    }
};

TEST_F(StagedDatabaseTest, TheNewFileAppearsWholeOnCommitAndNeverBefore) {
    create("a.kdb").createTable(itemsDef());
    Database::open(file("a.kdb")).execute("INSERT INTO tItems (ItemKey) VALUES ('OLD')");
    {
        StagedDatabase abandoned(file("a.kdb"));
        abandoned.database().createTable({"tNew", {text("K", 5)}, {}});
        Database old = Database::open(file("a.kdb"));
        EXPECT_EQ(rows(old, "SELECT ItemKey FROM tItems"), QStringList{"OLD"});
    }
    EXPECT_EQ(files(), QStringList{"a.kdb"});  // destroyed without commit: nothing changed

    writeFile("a.kdb-journal", "left by a writer of the old file that died");
    StagedDatabase staged(file("a.kdb"));
    staged.database().createTable({"tNew", {text("K", 5)}, {}});
    EXPECT_TRUE(Database::open(file("a.kdb")).hasTable("tItems"));
    staged.commit();
    Database now = Database::open(file("a.kdb"));
    EXPECT_EQ(now.tableNames(), QStringList{"tNew"});
    EXPECT_EQ(now.locale(), kHebrewLocale);
    EXPECT_EQ(files(), QStringList{"a.kdb"});
}

TEST_F(StagedDatabaseTest, ACopyPutInPlaceMustBeADatabaseOfOurs) {
    create("source.kdb").createTable(itemsDef());
    writeFile("junk.kdb", QByteArray(4096, 'x'));
    EXPECT_JET_ERROR(err::kUnrecognizedFormat,
                     StagedDatabase::copyOf(file("junk.kdb"), file("a.kdb")));
    EXPECT_JET_ERROR(err::kFileNotFound, StagedDatabase::copyOf(file("none.kdb"), file("a.kdb")));
    EXPECT_JET_ERROR(err::kBadPath, StagedDatabase(file("no/such/folder/a.kdb")));
    EXPECT_EQ(files(), QStringList({"junk.kdb", "source.kdb"}));

    StagedDatabase copy = StagedDatabase::copyOf(file("source.kdb"), file("a.kdb"));
    EXPECT_FALSE(QFile::exists(file("a.kdb")));
    copy.commit();
    EXPECT_EQ(Database::open(file("a.kdb")).tableDef("tItems").fields, itemsDef().fields);
}

}  // namespace
}  // namespace etq::jet::test

#include "import/document_import.h"

#include "document_fixture.h"
#include "print/label_query.h"

namespace etq::test {
namespace {

using demo::StockDocument;

class DocumentImportTest : public DocumentTest {
  protected:
    // Which types the delivered document database marks for scanning.
    void setType(qint16 type, bool include, bool includeDraft) {
        jet::Database db = jet::Database::open(path(db::kDocDatabaseFile));
        db.execute(QStringLiteral("UPDATE tDocTypes SET Include = %1, IncludeDraft = %2 "
                                  "WHERE DocType = %3")
                       .arg(include ? "True" : "False", includeDraft ? "True" : "False")
                       .arg(type),
                   jet::Database::FailOnError);
    }
    // Types 1, 2 and 4 are read (4 with its drafts); type 3 only has its drafts asked for, which
    // does not make it read. Each file holds a document and a draft numbered by its type.
    void prepareTypes() {
        setType(1, true, false);
        setType(2, true, false);
        setType(3, false, true);
        setType(4, true, true);
        for (const auto& [type, file] : {std::pair{1, "dlvnote.dbf"},
                                         {2, "invoice.dbf"},
                                         {3, "return.dbf"},
                                         {4, "orders.dbf"}}) {
            StockDocument draft = document(type * 100 + 2);
            draft.draftMark = "Y";
            writeDocuments(file, {document(type * 100 + 1), draft});
        }
    }
    DocImportOptions runOptions() {
        DocImportOptions o;
        o.dbFolder = folder();
        o.companyFolder = company();
        return o;
    }
    DocImportResult run(const DocImportOptions& o) { return importDocuments(o, context, progress); }
    static QList<qint16> typesRead(const DocImportResult& result) {
        QList<qint16> types;
        for (const DocTypeRead& read : result.types)
            types << read.docType;
        return types;
    }
};

TEST_F(DocumentImportTest, RebuildsTheWorkingDatabaseAndReadsEveryTypeMarkedToInclude) {
    prepareTypes();
    QFile::remove(company() + "/invoice.dbf");  // a type without its file: nothing, no word
    {
        jet::Database work = jet::Database::open(path(db::kWorkDatabaseFile));
        work.execute(
            "INSERT INTO tTempDocHeaders (WizFileID, [Number], RecIndex) VALUES (1, 9, 0)");
    }
    DocImportOptions o = runOptions();
    o.addressSeparator = ",";
    const DocImportResult result = run(o);

    EXPECT_EQ(typesRead(result), (QList<qint16>{1, 2, 4}));
    EXPECT_EQ(result.types[1].scan.recordCount, 0);
    EXPECT_FALSE(result.stopped);
    for (const DocTypeRead& read : result.types)
        EXPECT_FALSE(read.failure);
    EXPECT_EQ(work("SELECT DocType, Number, IsDraft FROM tTempDocHeaders ORDER BY Number"),
              (QStringList{"1|101|False", "4|401|False", "4|402|True"}));
    EXPECT_EQ(result.workDbPath, path(db::kWorkDatabaseFile));
    EXPECT_EQ(context.addressSeparator, ",");
    // Without the delivery log the working database has no link to it, and no log is made.
    EXPECT_FALSE(jet::Database::open(path(db::kWorkDatabaseFile)).hasTable("tStockLog"));
    EXPECT_FALSE(QFile::exists(path(db::kLogDatabaseFile)));
    EXPECT_TRUE(QFile::exists(path(db::kTempItemDatabaseFile)));
    EXPECT_EQ(progress.events.mid(progress.events.size() - 2),
              (QStringList{"fill", "step " + context.caption(38)}));
    EXPECT_TRUE(messages.shown.isEmpty());

    // The next run scans from where this one ended: nothing new, and the old rows are gone.
    run(o);
    EXPECT_TRUE(numbers().isEmpty());
}

// The items step follows every type whose reader gave records. When it fails the user is asked
// whether to go on; No stops the run there, with the later types unread and no final step.
TEST_F(DocumentImportTest, ItemsStepFailingAsksWhetherToContinue) {
    prepareTypes();
    QFile::remove(company() + "/invoice.dbf");
    struct Case {
        MsgAnswer answer;
        QList<qint16> types;
        QStringList numbers;
        int itemSteps;
    };
    const Case cases[] = {
        {MsgAnswer::No, {1}, {"101"}, 1},
        {MsgAnswer::Yes, {1, 2, 4}, {"101", "401", "402"}, 2},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.answer == MsgAnswer::Yes ? "Yes" : "No");
        setRange(0, 0, 1);
        setRange(0, 0, 4);
        RecordingMessages answers(c.answer);
        context.setMessages(&answers);
        progress.events.clear();
        int itemSteps = 0;
        DocImportOptions o = runOptions();
        o.readItems = true;
        o.importItems = [&] { return ++itemSteps > 1; };
        const DocImportResult result = run(o);

        EXPECT_EQ(result.stopped, c.answer == MsgAnswer::No);
        EXPECT_EQ(typesRead(result), c.types);
        EXPECT_EQ(numbers(), c.numbers);
        EXPECT_EQ(itemSteps, c.itemSteps);
        EXPECT_FALSE(result.types[0].itemsImported);
        ASSERT_EQ(answers.shown.size(), 1);
        const Message& question = answers.shown[0];
        EXPECT_EQ(question.text, context.caption(51));
        EXPECT_EQ(question.title, context.caption(30));
        EXPECT_EQ(question.icon, MsgIcon::Question);
        EXPECT_EQ(question.buttons, MsgButtons::YesNo);
        EXPECT_EQ(progress.events.contains("fill"), c.answer == MsgAnswer::Yes);
    }
}

// A reader that fails is that type's failure: told to the caller before the next type is read,
// kept in the result, the items step skipped for it, and the run goes on with the next type.
TEST_F(DocumentImportTest, ReaderFailureIsKeptAndTheRunGoesOn) {
    prepareTypes();
    QFile dlvnote(company() + "/dlvnote.dbf");
    ASSERT_TRUE(dlvnote.resize(dlvnote.size() - 100));
    QList<int> itemSteps;
    QStringList told;
    DocImportOptions o = runOptions();
    o.readItems = true;
    o.importItems = [&] {
        itemSteps << numbers().size();
        return true;
    };
    o.readerFailed = [&](qint16 type, const std::exception_ptr& failure) {
        told << QString("%1 after %2 headers").arg(type).arg(numbers().size());
        EXPECT_THROW(std::rethrow_exception(failure), DbfError);
    };
    const DocImportResult result = run(o);
    EXPECT_EQ(told, QStringList{"1 after 0 headers"});
    EXPECT_EQ(typesRead(result), (QList<qint16>{1, 2, 4}));
    ASSERT_TRUE(result.types[0].failure);
    EXPECT_THROW(std::rethrow_exception(result.types[0].failure), DbfError);
    EXPECT_FALSE(result.types[1].failure);
    EXPECT_EQ(itemSteps, (QList<int>{1, 3}));  // after types 2 and 4
    EXPECT_TRUE(result.types[2].itemsImported);
    EXPECT_EQ(range(1), "0|0");
    EXPECT_EQ(range(2), "2|3");
}

TEST_F(DocumentImportTest, DeliveryLogIsLinkedAndMadeWhenMissing) {
    prepareTypes();
    DocImportOptions o = runOptions();
    o.useDeliveryLog = true;
    run(o);
    EXPECT_TRUE(QFile::exists(path(db::kLogDatabaseFile)));
    jet::Database work = jet::Database::open(path(db::kWorkDatabaseFile));
    ASSERT_TRUE(work.hasTable("tStockLog"));
    EXPECT_TRUE(jetRows(work, "SELECT * FROM tStockLog").isEmpty());
}

TEST_F(DocumentImportTest, MissingItemDatabaseEndsTheRunBeforeAnyType) {
    prepareTypes();
    ASSERT_TRUE(QFile::remove(path(db::kItemDatabaseFile)));
    EXPECT_THROW(run(runOptions()), std::exception);
    EXPECT_EQ(range(1), "0|0");
}

// The document-line label query runs on what the import wrote: one row per included line of an
// included document whose item is known, with the line's copies, in file, document and line
// order. Keys with apostrophes travel through as values and break no statement.
TEST_F(DocumentImportTest, DocumentLineLabelsOfImportedLines) {
    {
        jet::Database items = jet::Database::open(path(db::kItemDatabaseFile));
        items.execute(QStringLiteral("INSERT INTO tItems (ItemKey, Coin) VALUES ('K1', '¦')"));
        items.execute(QStringLiteral("INSERT INTO tItems (ItemKey, Coin) VALUES ('D''OR', '¦')"));
    }
    StockDocument seven = document(7, 0);
    seven.lines = {line("K1", 2), line("D'OR", -3.6), line("K9"), line("K1", 12)};
    StockDocument five = document(5, 0);
    five.accountKey = "O'NEIL";
    five.lines = {line("D'OR", 2500), line("K1", 0)};
    StockDocument nine = document(9, 0);
    nine.lines = {line("K1", 5)};
    writeDocuments("invoice.dbf", {five, seven});
    writeDocuments("dlvnote.dbf", {seven, nine});
    DocImportOptions o = runOptions();
    o.fastWay = true;
    run(o);
    {
        jet::Database work = jet::Database::open(path(db::kWorkDatabaseFile));
        work.execute("UPDATE tTempDocHeaders SET Include = False WHERE [Number] = 9");
        work.execute(
            "UPDATE tTempDocLines SET Include = False WHERE WizFileID = 2 AND "
            "HeadNumber = 7 AND LineNum = 4");
    }

    // WizFileID|Number|ItemKey|Copies|CardCode|Quantity. K9 is no item; the lines of a document
    // come in LineNum order, which their quantities tell apart.
    const QStringList ascending{"1|7|K1|2|20001|2",     "1|7|D'OR|4|20001|-3.6",
                                "1|7|K1|12|20001|12",   "2|5|D'OR|999|O'NEIL|2500",
                                "2|5|K1|0|O'NEIL|0",    "2|7|K1|2|20001|2",
                                "2|7|D'OR|4|20001|-3.6"};
    QStringList descending = ascending;
    std::reverse(descending.begin(), descending.end());
    for (const auto& [order, expected] :
         {std::pair{Ascending, ascending}, std::pair{Descending, descending}}) {
        LabelQueryInput in;
        in.queryType = DocumentLineLabels;
        in.order = order;
        in.fieldChecks[9] = in.fieldChecks[34] = true;  // CardCode, Quantity
        jet::Database work = jet::Database::open(path(db::kWorkDatabaseFile));
        QStringList rows;
        for (jet::Recordset rs = work.openRecordset(BuildLabelQuery(in)); !rs.eof();
             rs.moveNext()) {
            QStringList cells;
            for (const char* column :
                 {"WizFileID", "Number", "ItemKey", "Copies", "CardCode", "Quantity"})
                cells << rs.value(column).toString();
            rows << cells.join(u'|');
        }
        EXPECT_EQ(rows, expected) << int(order);
    }
}

}  // namespace
}  // namespace etq::test

// The print engine driving label software, checked call by call against a recording stand-in
// for the programs, on real working databases.
#include "print/print_engine.h"

#include "jet/row_appender.h"
#include "print/label_software.h"
#include "print_fixture.h"
#include "recording_automation.h"
#include "support/recording_progress.h"

namespace etq::print::test {
namespace {

// One document of the working database: its lines' quantities, one copy each.
struct Doc {
    int number;
    int reference;
    QString account;
    QList<int> quantities;
    QVariant dueDate = {};
};

class PrintEngineTest : public PrintTest {
  protected:
    void SetUp() override {
        PrintTest::SetUp();
        context.automation().add(software);
        addItems({{"A", "סבון", {}, 1.5, 2}, {"B", "מברשת", {}, 2, 3}});
    }

    LabelSoftwareOptions options(qint16 kind, quint8 queryType = ItemLabels) {
        LabelSoftwareOptions o;
        o.workDatabase = workDb();
        o.kind = kind;
        o.labelFile = "/l/item.lab";
        o.headLabelFile = "/l/head.lab";
        o.query.queryType = queryType;
        return o;
    }

    // Runs the engine; the failure's text when it did not reach its end.
    QString run(const LabelSoftwareOptions& o) {
        try {
            printWithLabelSoftware(o, context, progress, pacing);
            return {};
        } catch (const Failure& e) {
            return e.description();
        }
    }

    void addDocuments(const QList<Doc>& docs) {
        jet::Database work = jet::Database::open(workDb());
        jet::Recordset heads = work.openRecordset("tTempDocHeaders");
        jet::Recordset lines = work.openRecordset("tTempDocLines");
        for (const Doc& doc : docs) {
            heads.addNew();
            heads.setValue("WizFileID", 1);
            heads.setValue("Number", doc.number);
            heads.setValue("Reference1", doc.reference);
            heads.setValue("AccountKey", doc.account);
            heads.setValue("DocDueDate", doc.dueDate);
            heads.setValue("Include", true);
            heads.update();
            for (int i = 0; i < doc.quantities.size(); ++i) {
                lines.addNew();
                lines.setValue("WizFileID", 1);
                lines.setValue("HeadNumber", doc.number);
                lines.setValue("LineNum", i + 1);
                lines.setValue("ItemKey", "A");
                lines.setValue("Quantity", doc.quantities[i]);
                lines.setValue("Copies", 1);
                lines.setValue("Include", true);
                lines.update();
            }
        }
    }

    void accountDesign(const QString& account, const QString& design) {
        jet::Database items = jet::Database::open(path(db::kItemDatabaseFile));
        items.execute(QString("INSERT INTO tAccountDef (AccountKey, LabelName) VALUES ('%1', '%2')")
                          .arg(account, design));
    }

    std::shared_ptr<RecordingAutomation> software = std::make_shared<RecordingAutomation>();
    etq::test::RecordingProgress progress;
    RecordingPacing pacing{software->calls};
};

// Two items, A (2 copies, price 1.5) and B (3 copies, price 2), with the item code and the price
// sent: each program gets its own calls for opening the design, filling a record, printing its
// copies and ending the run.
TEST_F(PrintEngineTest, EachKindOpensFillsPrintsAndEndsWithItsOwnCalls) {
    const struct {
        const char* name;
        qint16 kind;
        bool a4;
        QStringList calls;
    } cases[] = {
        {"CodeSoft",
         kCodeSoft,
         true,
         {"new LPPX.Application", "app.Visible = False", R"(doc.Open("/l/item.lab"))",
          R"(var("ItemKey").Value = "A")", "var(\"Price\").Value = 1.5", "yield",
          "doc.PrintLabel(2)", R"(var("ItemKey").Value = "B")", "var(\"Price\").Value = 2", "yield",
          "doc.PrintLabel(3)", "doc.FormFeed()"}},
        {"BarTender",
         kBarTender,
         true,
         {"new BarTender.Application", "app.Visible = False",
          R"(formats.Open("/l/item.lab", False, ""))",
          R"(format.SetNamedSubStringValue("ItemKey", "A"))",
          R"(format.SetNamedSubStringValue("Price", "1.50"))", "yield",
          "format.IdenticalCopiesOfLabel = 2", "format.PrintOut(True, False)",
          R"(format.SetNamedSubStringValue("ItemKey", "B"))",
          R"(format.SetNamedSubStringValue("Price", "2.00"))", "yield",
          "format.IdenticalCopiesOfLabel = 3", "format.PrintOut(True, False)", "app.Quit(1)"}},
        {"NiceLabel A4",
         kNiceLabel,
         true,
         {"new NiceLabel.Application", R"(app.LabelOpen("/l/item.lab"))",
          "app.LabelSessionStart(7)", R"(app.LabelSetVar(7, "ItemKey", "A", -9999, -9999))",
          R"(app.LabelSetVar(7, "Price", "1.50", -9999, -9999))", "yield",
          R"(app.LabelSessionPrint(7, "2,0"))",
          R"(app.LabelSetVar(7, "ItemKey", "B", -9999, -9999))",
          R"(app.LabelSetVar(7, "Price", "2.00", -9999, -9999))", "yield",
          R"(app.LabelSessionPrint(7, "3,0"))", "app.LabelSessionEnd(7)", "app.LabelClose(7)",
          "app.Quit()"}},
        // "Thermal" prints in descending order, and NiceLabel without label sessions.
        {"NiceLabel Thermal",
         kNiceLabel,
         false,
         {"new NiceLabel.Application", R"(app.LabelOpen("/l/item.lab"))",
          R"(app.LabelSetVar(7, "ItemKey", "B", -9999, -9999))",
          R"(app.LabelSetVar(7, "Price", "2.00", -9999, -9999))", "yield",
          R"(app.LabelPrint(7, "3,0"))", R"(app.LabelSetVar(7, "ItemKey", "A", -9999, -9999))",
          R"(app.LabelSetVar(7, "Price", "1.50", -9999, -9999))", "yield",
          R"(app.LabelPrint(7, "2,0"))", "app.LabelClose(7)", "app.Quit()"}},
        {"FastLabel",
         kFastLabel,
         true,
         {"new FastLabel.FastLabelX", R"(app.LabelOpen("/l/item.lab", ""))",
          R"(app.LabelSetVar("ItemKey", "A"))", R"(app.LabelSetVar("Price", "1.50"))", "yield",
          "app.LabelQty = 2", "app.AddRecord()", R"(app.LabelSetVar("ItemKey", "B"))",
          R"(app.LabelSetVar("Price", "2.00"))", "yield", "app.LabelQty = 3", "app.LabelPrint()"}},
        {"gLabels",
         kGLabels,
         true,
         {"new gLabels.Application", R"(app.Printer = "Zebra")", R"(app.Open("/l/item.lab"))",
          R"(app.SetField("ItemKey", "A"))", R"(app.SetField("Price", "1.50"))", "yield",
          "app.PrintRecord(2)", R"(app.SetField("ItemKey", "B"))",
          R"(app.SetField("Price", "2.00"))", "yield", "app.PrintRecord(3)", "app.Close()",
          "app.Quit()"}},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        software->calls.clear();
        LabelSoftwareOptions o = options(c.kind);
        o.a4 = c.a4;
        o.query.order = c.a4 ? Ascending : Descending;
        o.query.fieldChecks[0] = o.query.fieldChecks[6] = true;
        o.printer = "Zebra";
        EXPECT_EQ(run(o), "");
        EXPECT_EQ(software->calls, c.calls);
    }
    EXPECT_EQ(progress.steps.last(), "הכנת המדבקות הסתיימה");
}

// Head labels for two documents of three and two lines: head, line, line, line, head, line,
// line; FastLabel prints each batch when the next head label closes it, and starts a new batch
// after each design it opens and each head label.
TEST_F(PrintEngineTest, HeadLabelBeforeTheLinesOfEachDocument) {
    addDocuments({{10, 5001, "C1", {1, 2, 3}}, {11, 5002, "C2", {4, 5}}});
    LabelSoftwareOptions o = options(kFastLabel, DocumentLineLabels);
    o.headLabels = true;
    o.query.fieldChecks[34] = true;  // Quantity
    EXPECT_EQ(run(o), "");
    EXPECT_EQ(software->calls, (QStringList{"new FastLabel.FastLabelX",
                                            R"(app.LabelOpen("/l/head.lab", ""))",
                                            R"(app.LabelSetVar("Quantity", "1"))",
                                            "app.LabelQty = 1",
                                            "app.LabelPrint()",
                                            R"(app.LabelOpen("/l/item.lab", ""))",
                                            R"(app.LabelSetVar("Quantity", "1"))",
                                            "yield",
                                            "app.LabelQty = 1",
                                            "app.AddRecord()",
                                            R"(app.LabelSetVar("Quantity", "2"))",
                                            "yield",
                                            "app.LabelQty = 1",
                                            "app.AddRecord()",
                                            R"(app.LabelSetVar("Quantity", "3"))",
                                            "yield",
                                            "app.LabelQty = 1",
                                            "app.LabelPrint()",
                                            R"(app.LabelOpen("/l/head.lab", ""))",
                                            R"(app.LabelSetVar("Quantity", "4"))",
                                            "app.LabelQty = 1",
                                            "app.LabelPrint()",
                                            R"(app.LabelOpen("/l/item.lab", ""))",
                                            R"(app.LabelSetVar("Quantity", "4"))",
                                            "yield",
                                            "app.LabelQty = 1",
                                            "app.AddRecord()",
                                            R"(app.LabelSetVar("Quantity", "5"))",
                                            "yield",
                                            "app.LabelQty = 1",
                                            "app.LabelPrint()"}));

    // "Thermal": the documents and their lines come last first; NiceLabel in "A4" keeps one
    // label session per open design.
    software->calls.clear();
    o.kind = kNiceLabel;
    o.a4 = true;
    o.query.order = Descending;
    EXPECT_EQ(run(o), "");
    EXPECT_EQ(software->callsWith({"Open", "Session", "Close", "Quantity"}),
              (QStringList{R"(app.LabelOpen("/l/head.lab"))",
                           "app.LabelSessionStart(7)",
                           R"(app.LabelSetVar(7, "Quantity", "5", -9999, -9999))",
                           R"(app.LabelSessionPrint(7, "1,0"))",
                           "app.LabelSessionEnd(7)",
                           "app.LabelClose(7)",
                           R"(app.LabelOpen("/l/item.lab"))",
                           "app.LabelSessionStart(7)",
                           R"(app.LabelSetVar(7, "Quantity", "5", -9999, -9999))",
                           R"(app.LabelSessionPrint(7, "1,0"))",
                           R"(app.LabelSetVar(7, "Quantity", "4", -9999, -9999))",
                           R"(app.LabelSessionPrint(7, "1,0"))",
                           "app.LabelSessionEnd(7)",
                           "app.LabelClose(7)",
                           R"(app.LabelOpen("/l/head.lab"))",
                           "app.LabelSessionStart(7)",
                           R"(app.LabelSetVar(7, "Quantity", "3", -9999, -9999))",
                           R"(app.LabelSessionPrint(7, "1,0"))",
                           "app.LabelSessionEnd(7)",
                           "app.LabelClose(7)",
                           R"(app.LabelOpen("/l/item.lab"))",
                           "app.LabelSessionStart(7)",
                           R"(app.LabelSetVar(7, "Quantity", "3", -9999, -9999))",
                           R"(app.LabelSessionPrint(7, "1,0"))",
                           R"(app.LabelSetVar(7, "Quantity", "2", -9999, -9999))",
                           R"(app.LabelSessionPrint(7, "1,0"))",
                           R"(app.LabelSetVar(7, "Quantity", "1", -9999, -9999))",
                           R"(app.LabelSessionPrint(7, "1,0"))",
                           "app.LabelSessionEnd(7)",
                           "app.LabelClose(7)"}));
}

// Each record takes its account's design when the account has one, the default otherwise; a
// design is opened once for the records that follow each other with it. FastLabel prints the
// records queued for a design before it opens the next.
TEST_F(PrintEngineTest, RecordsTakeTheirAccountsDesignOpenedOnceForEachRun) {
    accountDesign("C1", "/l/c1.lbl");
    const struct {
        bool useAccount;
        QString account;
        QString design;
    } items[] = {
        {true, "C1", "/l/c1.lbl"}, {true, "C9", "/l/item.lab"}, {false, "C1", "/l/item.lab"}};
    for (const auto& c : items) {
        SCOPED_TRACE(c.account.toStdString());
        software->calls.clear();
        LabelSoftwareOptions o = options(kCodeSoft);
        o.query.useAccountKey = c.useAccount;
        o.query.accountKey = c.account;
        EXPECT_EQ(run(o), "");
        EXPECT_EQ(software->callsWith({".Open("}), QStringList{"doc.Open(\"" + c.design + "\")"});
        EXPECT_EQ(software->callsWith({"PrintLabel"}).size(), 2);
    }

    addDocuments({{10, 5001, "C1", {1, 2}}, {11, 5002, "C9", {3}}});
    software->calls.clear();
    LabelSoftwareOptions o = options(kFastLabel, DocumentLineLabels);
    EXPECT_EQ(run(o), "");
    EXPECT_EQ(software->calls,
              (QStringList{"new FastLabel.FastLabelX", R"(app.LabelOpen("/l/c1.lbl", ""))", "yield",
                           "app.LabelQty = 1", "app.AddRecord()", "yield", "app.LabelQty = 1",
                           "app.LabelPrint()", R"(app.LabelOpen("/l/item.lab", ""))", "yield",
                           "app.LabelQty = 1", "app.LabelPrint()"}));
}

// A failing call ends the run with one message telling where it stood: the step marker, the
// NiceLabel design's handle and the variable last filled. Two documents of three and two lines
// with head labels, the document number sent.
TEST_F(PrintEngineTest, AFailingCallTellsTheStepTheHandleAndTheLastVariable) {
    addDocuments({{10, 5001, "C1", {1, 2, 3}}, {11, 5002, "C2", {4, 5}}});
    const QString lastSet = ", LabelID = 7, Var = Reference1, Value = ";
    const struct {
        qint16 kind;
        const char* member;
        int call;
        QString message;
    } cases[] = {
        {kNiceLabel, "LabelOpen", 1, "LabelOpen failed In Line 15, LabelID = 0, Var = , Value = "},
        {kNiceLabel, "LabelSessionStart", 1,
         "LabelSessionStart failed In Line 16, LabelID = 7, Var = , Value = "},
        {kNiceLabel, "LabelSetVar", 1, "LabelSetVar failed In Line 17" + lastSet + "5001"},
        {kNiceLabel, "LabelSessionPrint", 1,
         "LabelSessionPrint failed In Line 18" + lastSet + "5001"},
        {kNiceLabel, "LabelSessionEnd", 1, "LabelSessionEnd failed In Line 3" + lastSet + "5001"},
        {kNiceLabel, "LabelClose", 1, "LabelClose failed In Line 4" + lastSet + "5001"},
        {kNiceLabel, "LabelOpen", 2, "LabelOpen failed In Line 5" + lastSet + "5001"},
        {kNiceLabel, "LabelSessionStart", 2,
         "LabelSessionStart failed In Line 6" + lastSet + "5001"},
        {kNiceLabel, "LabelSetVar", 2, "LabelSetVar failed In Line 7" + lastSet + "5001"},
        {kNiceLabel, "LabelSessionPrint", 2,
         "LabelSessionPrint failed In Line 8" + lastSet + "5001"},
        {kNiceLabel, "LabelSessionEnd", 2, "LabelSessionEnd failed In Line 13" + lastSet + "5001"},
        {kNiceLabel, "LabelClose", 2, "LabelClose failed In Line 14" + lastSet + "5001"},
        {kNiceLabel, "LabelSessionEnd", 4, "LabelSessionEnd failed In Line 10" + lastSet + "5002"},
        {kNiceLabel, "LabelClose", 4, "LabelClose failed In Line 11" + lastSet + "5002"},
        {kNiceLabel, "Quit", 1, "Quit failed In Line 12" + lastSet + "5002"},
        // CodeSoft and BarTender mark only the filling of variables.
        {kCodeSoft, "Open", 1, "Open failed In Line 2, LabelID = 0, Var = , Value = "},
        {kCodeSoft, "PrintLabel", 2,
         "PrintLabel failed In Line 7, LabelID = 0, Var = Reference1, Value = 5001"},
        {kBarTender, "Close", 1,
         "Close failed In Line 17, LabelID = 0, Var = Reference1, Value = 5001"},
        {kFastLabel, "LabelPrint", 1,
         "LabelPrint failed In Line 18, LabelID = 0, Var = Reference1, Value = 5001"},
        {kFastLabel, "AddRecord", 1,
         "AddRecord failed In Line 7, LabelID = 0, Var = Reference1, Value = 5001"},
        {kFastLabel, "LabelPrint", 2,
         "LabelPrint failed In Line 13, LabelID = 0, Var = Reference1, Value = 5001"},
        {kFastLabel, "LabelPrint", 4,
         "LabelPrint failed In Line 10, LabelID = 0, Var = Reference1, Value = 5002"},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(testing::Message() << c.member << " " << c.call);
        software = std::make_shared<RecordingAutomation>();
        software->failing = c.member;
        software->failingCall = c.call;
        context.automation().add(software);
        LabelSoftwareOptions o = options(c.kind, DocumentLineLabels);
        o.a4 = true;
        o.headLabels = true;
        o.query.fieldChecks[10] = true;
        progress.steps.clear();
        EXPECT_EQ(run(o), c.message);
        EXPECT_TRUE(progress.steps.isEmpty());  // no final message
        EXPECT_FALSE(software->calls.contains("app.Quit()") && QString(c.member) != "Quit");
    }
}

// Nothing to print, or no program to print with: the run stops when it creates the application
// (step 2), before anything is printed.
TEST_F(PrintEngineTest, NoProgramOrNoRecordStopsAtStepTwo) {
    EXPECT_EQ(
        run(options(kNoLabelSoftware)),
        "No label software is chosen to print with (label software kind 0) In Line 2, LabelID = 0, Var = , Value = ");
    Context bare;  // this system's own programs only
    LabelSoftwareOptions o = options(kNiceLabel);
    try {
        printWithLabelSoftware(o, bare, progress, pacing);
        ADD_FAILURE() << "NiceLabel cannot be created here";
    } catch (const Failure& e) {
        EXPECT_EQ(
            e.description(),
            "NiceLabel is not available here: no program on this system provides the automation class \"NiceLabel.Application\" In Line 2, LabelID = 0, Var = , Value = ");
    }
    jet::Database::open(path(db::kItemDatabaseFile))
        .execute("UPDATE tItems SET PrintLabel = False");
    EXPECT_EQ(run(options(kBarTender)),
              "No current record. In Line 2, LabelID = 0, Var = , Value = ");
    EXPECT_EQ(software->calls, QStringList{"new BarTender.Application"});
}

// Null is sent as empty text, also under a price or date format; the price format is the one
// chosen, "0.00" when blank.
TEST_F(PrintEngineTest, NullIsEmptyTextUnderEveryFormat) {
    addDocuments({{10, 5001, "C1", {1}, QDate(2024, 3, 5)}, {11, 5002, "C2", {2}}});
    LabelSoftwareOptions o = options(kBarTender, DocumentLineLabels);
    o.priceFormat = " #,##0.000 ";
    for (int slot : {6, 11, 28})  // price, special price (no row: Null), due date
        o.query.fieldChecks[size_t(slot)] = true;
    jet::Database::open(path(db::kItemDatabaseFile)).execute("UPDATE tItems SET Price = 1234.5");
    EXPECT_EQ(run(o), "");
    EXPECT_EQ(software->callsWith({"SetNamed"}),
              (QStringList{R"(format.SetNamedSubStringValue("Price", "1,234.500"))",
                           R"(format.SetNamedSubStringValue("AltItemPrice", ""))",
                           R"(format.SetNamedSubStringValue("DocDueDate", "05/03/24"))",
                           R"(format.SetNamedSubStringValue("Price", "1,234.500"))",
                           R"(format.SetNamedSubStringValue("AltItemPrice", ""))",
                           R"(format.SetNamedSubStringValue("DocDueDate", ""))"}));
}

// The print delay: a wait of that many seconds on the clock after every record, the last one
// too, and one yield to the window before each record is printed.
TEST_F(PrintEngineTest, PrintDelayWaitsAfterEveryRecord) {
    const struct {
        QString typed;
        int seconds;
        QString failure;
    } cases[] = {
        {"", 0, ""},
        {"2", 4, ""},
        {" 1 ", 2, ""},
        {"soon", 0,
         "The print delay \"soon\" is no whole number of seconds from -32768 to 32767 In Line 0, LabelID = 0, Var = , Value = "},
        {"40000", 0,
         "The print delay \"40000\" is no whole number of seconds from -32768 to 32767 In Line 0, LabelID = 0, Var = , Value = "},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.typed.toStdString());
        software->calls.clear();
        RecordingPacing clock(software->calls);
        LabelSoftwareOptions o = options(kFastLabel);
        o.printDelay = c.typed;
        try {
            printWithLabelSoftware(o, context, progress, clock);
            EXPECT_EQ(c.failure, "");
        } catch (const Failure& e) {
            EXPECT_EQ(e.description(), c.failure);
        }
        EXPECT_EQ(clock.elapsed(), std::chrono::seconds(c.seconds));
        if (c.seconds == 4) {
            EXPECT_EQ(software->callsWith({"yield", "sleep", "LabelQty", "LabelPrint"}),
                      (QStringList{"yield", "app.LabelQty = 2", "sleep 2000 ms", "yield",
                                   "app.LabelQty = 3", "sleep 2000 ms", "app.LabelPrint()"}));
        }
    }
}

// More records than 16 bits can count: every one is printed and the bar reaches its end.
TEST_F(PrintEngineTest, ARunCountsPastThirtyTwoThousandRecords) {
    constexpr int kRecords = 32800;
    {
        jet::Database items = jet::Database::open(path(db::kItemDatabaseFile));
        jet::RowAppender rows(items, "tItems", {"ItemKey", "Coin", "Copies", "PrintLabel"});
        for (int i = 0; i < kRecords; ++i) {
            rows.setText(0, QString("N%1").arg(i, 6, 10, QLatin1Char('0')));
            rows.setText(1, QStringLiteral("¦"));
            rows.setNumber(2, 1);
            rows.setYesNo(3, true);
            rows.addRow();
        }
        rows.write();
    }
    EXPECT_EQ(run(options(kFastLabel)), "");
    EXPECT_EQ(software->callsWith({"LabelQty"}).size(), kRecords + 2);
    EXPECT_EQ(progress.events.mid(progress.events.size() - 2),
              (QStringList{QString("%1/%1").arg(kRecords + 2), "step הכנת המדבקות הסתיימה"}));
    EXPECT_EQ(progress.widths.last(), etq::test::RecordingProgress::kWidth);
}

}  // namespace
}  // namespace etq::print::test

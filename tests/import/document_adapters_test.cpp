// The document road as the control runs it, on the headless surface: the buttons of the tab of
// labels by documents, the controls they read, what they tell the user, and the printed page.
#include "card/document_adapters.h"

#include "card/card_controller.h"
#include "card/component.h"
#include "document_fixture.h"
#include "platform/browser.h"
#include "platform/captions.h"
#include "print/label_definition.h"
#include "support/test_env.h"
#include "surface/control_values.h"
#include "surface/memory_surface.h"

namespace etq::test {
namespace {

using demo::StockDocument;

class RecordingViewer : public PageViewer {
  public:
    void showPage(const QString& path) override { shown.append(path); }
    QStringList shown;
};

class DocumentAdaptersTest : public DocumentTest {
  protected:
    void SetUp() override {
        DocumentTest::SetUp();
        resetSettings();
        GetSetLabelDef(LoadLabelDef, context.applicationName, context.labelDefinition());
        context.connection.server = dir.path();
        context.connection.database = "company";
        context.setPages(&viewer);
        controller.hooks().installedPrinters = [] { return QStringList(); };
        connectParts(controller, surface);
        c("txtDBPath").setText(folder());
        surface.watchWidths([this](const QString& name, int width) {
            if (name == u"ProgressFill") widths << width;
        });
    }
    ControlRef c(const char* name, int index = -1) const { return surface.control(name, index); }
    void includeOnly(std::initializer_list<int> types) {
        jet::Database db = jet::Database::open(path(db::kDocDatabaseFile));
        db.execute("UPDATE tDocTypes SET Include = False, IncludeDraft = False");
        for (int type : types)
            db.execute(QString("UPDATE tDocTypes SET Include = True WHERE DocType = %1").arg(type));
    }
    void addItems(const QStringList& keys) {
        jet::Database items = jet::Database::open(path(db::kItemDatabaseFile));
        for (const QString& key : keys)
            items.execute(
                QString(
                    "INSERT INTO tItems (ItemKey, ItemName, Coin) VALUES ('%1', 'פריט %1', '¦')")
                    .arg(key));
    }
    QStringList critical() const {
        QStringList texts;
        for (const Message& m : messages.shown)
            if (m.icon == MsgIcon::Critical) texts << m.title + ": " + m.text;
        return texts;
    }

    MemorySurface surface;
    CardController controller{surface, context};
    RecordingViewer viewer;
    QList<int> widths;
};

// Both start the run without the fast way; only the button empties the bar and the message
// line first. With no type to scan the working database is made afresh, empty.
TEST_F(DocumentAdaptersTest, ImportButtonAndItsPictureRunTheImportWithoutTheFastWay) {
    includeOnly({});
    for (const auto& [element, expectedWidths] :
         {std::pair{"cmdImportDocs", QList<int>{0, 600}}, {"Image6", QList<int>{600}}}) {
        widths.clear();
        c("chkUseFastWay").setValue(1);
        c("Message1").setCaption("old");
        controller.click(element);
        EXPECT_EQ(c("chkUseFastWay").value().toInt(), 0) << element;
        EXPECT_EQ(widths, expectedWidths) << element;
        EXPECT_EQ(c("Message1").caption(), GetCaption(38, 0)) << element;
    }
    EXPECT_TRUE(messages.shown.isEmpty());
    EXPECT_TRUE(work("SELECT * FROM tTempDocHeaders").isEmpty());
}

// The run reads the tab's date window and reference numbers, the address separator and the
// delivery log choice; headers are included at once the fast way.
TEST_F(DocumentAdaptersTest, ImportReadsTheTabsSettings) {
    includeOnly({1});
    StockDocument early = document(1, 1, kDay.addDays(-1));
    StockDocument drafted = document(3);
    drafted.draftMark = "Y";
    StockDocument addressed = document(4);
    addressed.address = "הרצל 5\rחיפה";
    writeDocuments("dlvnote.dbf", {early, document(2), drafted, addressed, document(5)});
    c("txtFromDate").setText(kDay.toString("dd/MM/yyyy"));
    c("txtToDate").setText("31/12/25");
    c("txtFromDocNum").setText("1002");
    c("txtToDocNum").setText("1004");
    c("cmbAddressSeperator").setListIndex(1);  // ","
    c("chkUseDeliverLog").setValue(1);
    c("chkOnlyLine0").setValue(1);
    c("chkUseFastWay").setValue(1);

    EXPECT_TRUE(ImportDocs(surface, context));
    EXPECT_EQ(work("SELECT [Number], Include, Address FROM tTempDocHeaders ORDER BY [Number]"),
              (QStringList{"2|True|Null", "4|True|הרצל 5,חיפה"}));
    EXPECT_EQ(range(), "0|0");  // a to number keeps the scan position
    EXPECT_TRUE(QFile::exists(path(db::kLogDatabaseFile)));
    EXPECT_TRUE(jet::Database::open(path(db::kWorkDatabaseFile)).hasTable("tStockLog"));

    // No date: the run does not start, and the documents chosen before are kept.
    c("txtToDocNum").setText("");
    c("txtFromDate").setText("32/x/2025");
    EXPECT_FALSE(ImportDocs(surface, context));
    ASSERT_EQ(critical().size(), 1);
    EXPECT_TRUE(critical()[0].contains("32/x/2025"));
    EXPECT_EQ(range(), "0|0");
    EXPECT_EQ(numbers(), (QStringList{"2", "4"}));
}

// A damaged document file is told at once, with the error title; a missing one is not; the run
// goes on with the next type and ends.
TEST_F(DocumentAdaptersTest, ReaderFailuresAreShownAndTheRunGoesOn) {
    includeOnly({1, 2, 4});
    writeDocuments("dlvnote.dbf", documents(3));
    QFile dlvnote(company() + "/dlvnote.dbf");
    ASSERT_TRUE(dlvnote.resize(dlvnote.size() - 100));
    writeDocuments("orders.dbf", documents(2, 400));
    EXPECT_TRUE(ImportDocs(surface, context));
    ASSERT_EQ(messages.shown.size(), 1);
    EXPECT_EQ(messages.shown[0].icon, MsgIcon::Critical);
    EXPECT_EQ(messages.shown[0].title, GetCaption(1, 0));
    EXPECT_EQ(numbers(), (QStringList{"400", "401"}));
    EXPECT_EQ(c("Message1").caption(), GetCaption(38, 0));
}

// The items step reads the items of the reading-items tab's range, their special prices when
// asked, and merges them; when it fails the run asks whether to go on.
TEST_F(DocumentAdaptersTest, ItemsOfTheDocumentsAreImportedOrTheUserIsAsked) {
    includeOnly({1, 2});
    writeDocuments("dlvnote.dbf", documents(1));
    writeDocuments("invoice.dbf", documents(1, 7));
    demo::ItemRecord k1;
    k1.key = "K1";
    k1.name = "מלח";
    k1.prices[0] = {250, {}};
    demo::writeHostFile(company() + "/oitm.dbf", QList<demo::ItemRecord>{k1});
    demo::writeHostFile(company() + "/ospp.dbf", QList<demo::SpecialPriceRecord>{});
    c("chkReadDocItems").setValue(1);
    c("ChkImportAlterPrices").setValue(1);
    c("txtCopies").setText("2");
    c("cmbPriceField").addItem("בסיס", 1);
    c("cmbPriceField").setListIndex(0);

    RecordingProgress steps;
    EXPECT_TRUE(importItemsByDocs(
        SurfaceValues(surface), context, steps,
        {company(),
         db::CreateTempItemDatabase(path(db::kTempItemDatabaseFile), path(db::kItemDatabaseFile)),
         {},
         {},
         0,
         2,
         1}));
    EXPECT_EQ(steps.steps, (QStringList{GetCaption(46, 0), GetCaption(48, 0), GetCaption(50, 0)}));
    EXPECT_EQ(rows(db::kItemDatabaseFile, "SELECT ItemKey, Price, Copies FROM tItems"),
              QStringList{"K1|2.5|2"});

    QFile::remove(company() + "/oitm.dbf");  // quiet in the window, and the step fails
    messages = RecordingMessages(MsgAnswer::No);
    EXPECT_FALSE(ImportDocs(surface, context));
    ASSERT_EQ(messages.shown.size(), 1);
    EXPECT_EQ(messages.shown[0].text, GetCaption(51, 0));
    EXPECT_EQ(numbers(), QStringList{"1"});  // the invoices are not read
}

// The public reader takes its reference number bounds from the tab: a to number keeps the scan
// position; a text that is no number is no bound.
TEST_F(DocumentAdaptersTest, ReaderTakesItsNumberBoundsFromTheTab) {
    writeDocuments("dlvnote.dbf", documents(3));
    const struct {
        const char* from;
        const char* to;
        qint32 result;
        QStringList numbers;
        QString range;
    } cases[] = {
        {"1002", "1002", 3, {"2"}, "0|0"},
        {"abc", "", 3, {"1", "2", "3"}, "3|4"},
        {"", "", 3, {}, "3|4"},  // everything was read before
    };
    for (const auto& k : cases) {
        freshWorkDatabase();
        c("txtFromDocNum").setText(k.from);
        c("txtToDocNum").setText(k.to);
        EXPECT_EQ(ReadStockMnhl(surface, context, company(), path(db::kWorkDatabaseFile), 1, {}, {},
                                false, false, 1),
                  k.result)
            << k.from;
        EXPECT_EQ(numbers(), k.numbers) << k.from;
        EXPECT_EQ(range(), k.range) << k.from;
    }
    EXPECT_EQ(ReadStockMnhl(surface, context, company(), path(db::kWorkDatabaseFile), 2, {}, {},
                            false, false, 1),
              0);  // no invoice file: nothing, and no word
    EXPECT_TRUE(messages.shown.isEmpty());
}

// The document print button prints one label per copy of every included line of an included
// document on the built-in page; the fast way reads the documents first, including them all.
TEST_F(DocumentAdaptersTest, PrintButtonPrintsTheIncludedLinesCopies) {
    includeOnly({1});
    addItems({"K1", "K2", "K3"});
    StockDocument two = document(2, 3);
    two.lines[0].quantity = 2;
    two.lines[2].quantity = 0;
    writeDocuments("dlvnote.dbf", {document(1, 2), two});
    context.labelDefinition().cells[0].UseCell = true;
    context.labelDefinition().cells[0].FldID = 1;
    c("OptOLE", 3).setValue(true);
    const auto labelsOnPage = [this] {
        QFile page(viewer.shown.last());
        return page.open(QIODevice::ReadOnly) ? int(page.readAll().count("<td class='L0'>")) : -1;
    };

    c("chkOnlyLine0").setValue(1);
    c("chkUseFastWay").setValue(1);
    controller.click("Image8");
    ASSERT_EQ(viewer.shown.size(), 1) << critical().join('\n').toStdString();
    EXPECT_EQ(labelsOnPage(), 1 + 1 + 2 + 1 + 0);

    {
        jet::Database w = jet::Database::open(path(db::kWorkDatabaseFile));
        w.execute("UPDATE tTempDocHeaders SET Include = False WHERE [Number] = 1");
    }
    c("chkUseFastWay").setValue(0);  // print what the working database holds
    controller.click("cmdPrintDocButt");
    ASSERT_EQ(viewer.shown.size(), 2);
    EXPECT_EQ(labelsOnPage(), 3);

    c("OptOLE", 1).setValue(true);  // CodeSoft: a Windows program, not on this system
    controller.click("cmdPrintDocButt");
    QFile::remove(path(db::kWorkDatabaseFile));
    c("OptOLE", 3).setValue(true);
    controller.click("cmdPrintDocButt");
    EXPECT_EQ(viewer.shown.size(), 2);
    ASSERT_EQ(critical().size(), 2);
    EXPECT_TRUE(critical()[0].contains("not available here"));
    EXPECT_TRUE(critical()[1].contains("etiqondb.tmp"));
    EXPECT_FALSE(QFile::exists(path(db::kWorkDatabaseFile)));
}

}  // namespace
}  // namespace etq::test

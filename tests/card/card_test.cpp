// The control's behaviour on the headless surface: start-up, copy labels, tab changes, the
// upgrade, opening the label software, file choosers, save buttons and dispatch.
#include <gtest/gtest.h>

#include <QDir>
#include <QFile>
#include <QTemporaryDir>

#include "card/boundary.h"
#include "card/card_controller.h"
#include "card/print_adapters.h"
#include "card_test_support.h"
#include "import/connection.h"
#include "jet/error.h"
#include "platform/captions.h"
#include "platform/context.h"
#include "platform/failure.h"
#include "platform/settings_store.h"
#include "print/label_software.h"
#include "surface/memory_surface.h"
#include "surface/settings_groups.h"

namespace etq {
namespace {

// Answers file dialogs with a prepared name and remembers what it was asked.
class ScriptedChooser : public FileChooser {
  public:
    QString chooseFile(const QString& filter, int filterIndex) override {
        filters.append(filter);
        indexes.append(filterIndex);
        return answer;
    }
    QString answer;
    QStringList filters;
    QList<int> indexes;
};

class CardTest : public ::testing::Test {
  protected:
    void SetUp() override {
        test::resetSettings();
        card.hooks().installedPrinters = [] { return QStringList(); };
        card.hooks().startProgram = [this](const QString& program, const QStringList& args) {
            started.append(QStringList{program} + args);
            return true;
        };
    }
    ControlRef c(const char* name, int index = -1) const { return surface.control(name, index); }
    void touch(const QString& path) {
        QFile file(path);
        ASSERT_TRUE(file.open(QIODevice::WriteOnly));
    }

    MemorySurface surface;
    Context context;
    CardController card{surface, context};
    QList<QStringList> started;
    QTemporaryDir dir;
};

TEST_F(CardTest, StartUpWithTheDefaultCompanyLeavesTheHostListsAlone) {
    QStringList calls;
    card.hooks().fillCmbPrice = [&](const Surface&, Context&) { calls << "price"; };
    card.hooks().labelDefinition = [&](quint8 action) { calls << QString("label%1").arg(action); };
    card.InitProperties();

    EXPECT_EQ(context.applicationName, "Etiquon");
    EXPECT_EQ(calls, QStringList{"label2"});  // the built-in label is the default route
    EXPECT_EQ(c("MainTab").currentTab(), 0);
    EXPECT_EQ(c("cmbPriceField").listIndex(), -1);
    EXPECT_EQ(context.connection.server, "server");
    EXPECT_EQ(context.connection.user, "sa");
}

TEST_F(CardTest, StartUpFillsTheHostListsBeforeLoadingTheSettings) {
    context.applicationName = "Etiquon3";
    SettingsStore store("Etiquon3");
    store.write("Params", "ConnDataBase", "demo");
    store.write("Params", "ConnServer", "/srv/host");
    store.write("ImportItems", "PriceField", "2");
    store.write("ImportItems", "ItmBelong", "1");
    store.write("GeneralParams", "DefPrinter", "Zebra");
    store.write("GeneralParams", "OptOLE1", "True");
    store.write("GeneralParams", "OptOLE3", "False");
    store.write("LabelByDocs", "UseFastWay", "1");
    store.sync();

    QStringList calls;
    auto fill = [&](const char* name, const char* combo, int entries) {
        return [&calls, name, combo, entries](const Surface& s, Context&) {
            calls << name;
            for (int i = 0; i < entries; ++i)
                s.control(combo).addItem(QString::number(i), i + 10);
        };
    };
    card.hooks().fillCmbPrice = fill("price", "cmbPriceField", 3);
    card.hooks().fillCmbItmQGrp = fill("group", "cmbItmQGrp", 2);
    card.hooks().fillCmbItmBelong = fill("belong", "cmbItmBelong", 2);
    card.hooks().labelDefinition = [&](quint8) { calls << "label"; };
    card.hooks().installedPrinters = [] {
        return QStringList{"Rendering Subsystem", "HP", "Zebra"};
    };
    card.InitProperties("3");

    EXPECT_EQ(calls, (QStringList{"price", "group", "belong"}));  // no label: route CodeSoft
    EXPECT_EQ(context.connection.database, "demo");
    EXPECT_EQ(context.connection.server, "/srv/host");
    EXPECT_EQ(companyFolder(context.connection), "/srv/host/demo");
    EXPECT_EQ(c("cmbPriceField").selectedItemData(), 12);
    EXPECT_EQ(c("cmbItmBelong").listIndex(), 1);
    EXPECT_EQ(c("cmbPrinter").listCount(), 2);
    EXPECT_EQ(c("cmbPrinter").text(), "Zebra");
    EXPECT_EQ(GetLabelSoftwareKind(surface), 2);
    EXPECT_EQ(c("MainTab").currentTab(), 1);  // the fast way opens on the documents tab
}

TEST_F(CardTest, StartUpPassesOverAFailingStep) {
    card.hooks().installedPrinters = []() -> QStringList {
        throw SurfaceError("no printers today");
    };
    writeSetting("Etiquon", "LabelByItems", "FromItem", "A100");
    card.InitProperties(" 7 ");
    EXPECT_EQ(context.applicationName, "Etiquon7");
    EXPECT_EQ(c("txtFromItem").text(), "");  // Etiquon7 has its own settings
    EXPECT_EQ(c("txtCopies").text(), "1");
}

TEST_F(CardTest, TheLanguageSettingSelectsEnglish) {
    writeSetting("Etiquon", "Params", "Language", "1");
    card.InitProperties();
    EXPECT_EQ(context.caption(1), "Error");
    // The surface itself keeps its Hebrew design.
    EXPECT_EQ(c("cmdSaveDef1").caption(), "שמור הגדרות");
}

TEST_F(CardTest, FromDocNumCarriesToDocNumUntilToDocNumIsEdited) {
    c("txtFromDocNum").setText("1");
    c("txtFromDocNum").setText("12");
    EXPECT_EQ(c("txtToDocNum").text(), "12");
    c("txtToDocNum").setText("20");
    EXPECT_EQ(c("txtToDocNum").text(), "20");
    c("txtFromDocNum").setText("13");
    EXPECT_EQ(c("txtToDocNum").text(), "13");

    // Loading the group sets FromDocNum first, then the stored ToDocNum.
    writeSetting("Etiquon", "LabelByDocs", "FromDocNum", "100");
    writeSetting("Etiquon", "LabelByDocs", "ToDocNum", "250");
    GetSetParams(surface, context.applicationName, 5, LoadSettings);
    EXPECT_EQ(c("txtFromDocNum").text(), "100");
    EXPECT_EQ(c("txtToDocNum").text(), "250");
}

TEST_F(CardTest, CopyLabelsCopyTheFromBox) {
    c("txtFromItem").setText("A-100");
    c("txtFromDate").setText("01/02/2024");
    c("txtFromDocNum").setText("77");
    c("txtToDocNum").setText("99");
    card.click("LblToKey");
    card.click("LblToDate");
    card.click("LblToRef");
    EXPECT_EQ(c("txtToItem").text(), "A-100");
    EXPECT_EQ(c("txtToDate").text(), "01/02/2024");
    EXPECT_EQ(c("txtToDocNum").text(), "77");
}

TEST_F(CardTest, ChangingTabsClearsTheProgressAndShowsTheLogButton) {
    QString docTypes;
    card.hooks().showDocTypes = [&](const QString& path) { docTypes = path; };
    c("txtDBPath").setText(dir.path());
    c("ProgressFill").setWidth(300);
    c("Message1").setCaption("בעבודה");

    c("MainTab").setCurrentTab(1);
    EXPECT_EQ(c("ProgressFill").width(), 0);
    EXPECT_EQ(c("Message1").caption(), "");
    EXPECT_FALSE(c("cmdDLog").visible());

    c("chkUseDeliverLog").setValue(1);
    c("MainTab").setCurrentTab(0);
    c("MainTab").setCurrentTab(1);
    EXPECT_TRUE(c("cmdDLog").visible());

    c("MainTab").setCurrentTab(6);
    EXPECT_EQ(docTypes, dir.filePath("etiquon.kdb"));
}

TEST_F(CardTest, UpgradeReportsItsResultAndFillsTheProgressBar) {
    int upgrades = 0;
    QString result;
    card.hooks().upgradeItemDatabase = [&](const QString& path) {
        ++upgrades;
        EXPECT_EQ(path, dir.filePath("etqnitm.kdb"));
        return result;
    };
    c("txtDBPath").setText(dir.path());

    card.click("cmdUpgrade");  // no item database: nothing to do
    EXPECT_EQ(upgrades, 0);
    EXPECT_EQ(c("Message1").caption(), "Upgrade successfull");
    EXPECT_EQ(c("ProgressFill").width(), c("ProgressFrame").width());
    EXPECT_GT(c("ProgressFrame").width(), 0);

    touch(dir.filePath("etqnitm.kdb"));
    result = dir.filePath("etqnitm.kdb");
    card.click("cmdUpgrade");
    EXPECT_EQ(upgrades, 1);
    EXPECT_EQ(c("Message1").caption(), "Upgrade successfull");

    result.clear();
    c("ProgressFill").setWidth(0);
    card.click("cmdUpgrade");
    EXPECT_EQ(c("Message1").caption(), "Upgrade failed");
    EXPECT_EQ(c("ProgressFill").width(), c("ProgressFrame").width());

    card.hooks().upgradeItemDatabase = nullptr;
    c("Message1").setCaption("");
    card.click("cmdUpgrade");
    EXPECT_EQ(c("Message1").caption(), "Upgrade failed");
}

TEST_F(CardTest, OpeningTheLabelSoftwareNeedsTheProgram) {
    const QString program = dir.filePath("glabels");
    const QString label = dir.filePath("shelf.lbl");
    const QString head = dir.filePath("head.lbl");
    c("txtLabelSoftware").setText(program);
    c("txtLabelName").setText(label);
    c("txtLabelNameHead").setText(head);

    {
        test::RecordingMessages sink;
        context.setMessages(&sink);
        card.click("ImgEdit", 1);
        ASSERT_EQ(sink.shown.size(), 1u);
        EXPECT_EQ(sink.shown[0].text, context.caption(39));
        EXPECT_EQ(sink.shown[0].title, context.caption(30));
        EXPECT_EQ(sink.shown[0].icon, MsgIcon::Critical);
        EXPECT_TRUE(started.isEmpty());
    }
    touch(program);
    {
        test::RecordingMessages sink(MsgAnswer::No);
        context.setMessages(&sink);
        card.click("ImgEdit", 1);
        ASSERT_EQ(sink.shown.size(), 1u);
        EXPECT_EQ(sink.shown[0].text, context.caption(40));
        EXPECT_EQ(sink.shown[0].buttons, MsgButtons::YesNo);
        EXPECT_TRUE(started.isEmpty());
    }
    {
        test::RecordingMessages sink(MsgAnswer::Yes);
        context.setMessages(&sink);
        card.click("ImgEdit", 1);
        ASSERT_EQ(started.size(), 1);
        EXPECT_EQ(started[0], QStringList{program});
    }
    touch(label);
    touch(head);
    {
        test::RecordingMessages sink;
        context.setMessages(&sink);
        card.click("ImgEdit", 1);
        card.click("ImgEdit", 0);
        EXPECT_TRUE(sink.shown.empty());
        ASSERT_EQ(started.size(), 3);
        EXPECT_EQ(started[1], (QStringList{program, label}));
        EXPECT_EQ(started[2], (QStringList{program, head}));
    }
}

TEST_F(CardTest, TheSelectedOptionGivesTheLabelSoftwareKind) {
    const qint16 kinds[] = {5, 2, 4, 6, 7, 8};
    for (int i = 0; i < 6; ++i) {
        c("OptOLE", i).setValue(true);
        EXPECT_EQ(GetLabelSoftwareKind(surface), kinds[i]) << "OptOLE(" << i << ")";
    }
    c("OptOLE", 5).setValue(false);
    EXPECT_EQ(GetLabelSoftwareKind(surface), 0);
}

TEST_F(CardTest, FileChoosersOfferTheKindsFiles) {
    ScriptedChooser chooser;
    card.setFileChooser(&chooser);
    c("OptOLE", 1).setValue(true);  // CodeSoft
    c("txtLabelNameHead").setText("/labels/old.lab");

    chooser.answer = "/labels/shelf.lab";
    card.click("CmdDir", 1);
    EXPECT_EQ(c("txtLabelName").text(), "/labels/shelf.lab");
    chooser.answer = "/opt/codesoft/Lppa.exe";
    card.click("CmdDir", 2);
    EXPECT_EQ(c("txtLabelSoftware").text(), "/opt/codesoft/Lppa.exe");
    chooser.answer.clear();  // cancelled
    card.click("CmdDir", 0);
    EXPECT_EQ(c("txtLabelNameHead").text(), "/labels/old.lab");

    EXPECT_EQ(chooser.filters, (QStringList{"All Files (*);;CodeSoft Files (*.lab)",
                                            "All Software (*.exe);;CodeSoft Software (Lppa.exe)",
                                            "All Files (*);;CodeSoft Files (*.lab)"}));
    EXPECT_EQ(chooser.indexes, (QList<int>{2, 2, 2}));

    c("OptOLE", 3).setValue(true);  // the built-in page has no files of its own
    card.click("CmdDir", 1);
    EXPECT_EQ(chooser.filters.last(), "");
    EXPECT_EQ(toQtFilter(labelFileFilter(7)), "All Files (*);;FastLabel Files (*.lbl)");
    EXPECT_EQ(toQtFilter(labelFileFilter(8)), "All Files (*);;gLabels Files (*.glabels)");
    EXPECT_EQ(toQtFilter(labelSoftwareFilter(4)),
              "All Software (*.exe);;BarTender Software (Bartend.exe)");
}

TEST_F(CardTest, EachSaveButtonWritesItsGroup) {
    const struct {
        const char* button;
        const char* section;
        const char* key;
    } buttons[] = {
        {"cmdSaveDef1", "GeneralParams", "DBPath"},  {"cmdSaveDef2", "ImportItems", "Copies"},
        {"CmdSaveFields", "LabelVars", "FldSend40"}, {"cmdSaveDef4", "LabelByItems", "FromItem"},
        {"cmdSaveDef5", "LabelByDocs", "ToDate"},    {"cmdSaveDef6", "ByDocsDef", "UseDeliverLog"},
    };
    for (const auto& b : buttons) {
        card.click(b.button);
        const SettingsStore store("Etiquon");
        EXPECT_TRUE(store.contains(b.section, b.key)) << b.button;
    }
    EXPECT_EQ(SettingsStore("Etiquon").sections().size(), 6);
}

TEST_F(CardTest, SavingTheGeneralSettingsSavesTheBuiltInLabelOnlyWhenItIsChosen) {
    QList<quint8> actions;
    card.hooks().labelDefinition = [&](quint8 action) { actions << action; };
    c("OptOLE", 3).setValue(true);
    card.click("cmdSaveDef1");
    EXPECT_EQ(actions, QList<quint8>{1});
    c("OptOLE", 2).setValue(true);
    card.click("cmdSaveDef1");
    EXPECT_EQ(actions, QList<quint8>{1});
    EXPECT_EQ(readSetting("Etiquon", "GeneralParams", "OptOLE2", ""), "True");
}

TEST_F(CardTest, OtherElementsGoToTheirWork) {
    QStringList runs;
    QString folderSeen;
    card.setWork("cmdSelectItems", [&](int) {
        runs << "select";
        folderSeen = card.databaseFolder();
    });
    card.setWork("cmdPrintItmes", [&](int) { runs << "print"; });
    card.setWork("cmdSelectDocItems", [&](int) { runs << "select lines"; });
    card.setWork("cmdPrintDocButt", [&](int) { runs << "print lines"; });
    c("txtDBPath").setText("/data/etiquon");

    card.click("Image3");
    card.click("Image5");
    card.click("Image7");
    card.click("Image8");
    EXPECT_EQ(runs, (QStringList{"select", "print", "select lines", "print lines"}));
    EXPECT_EQ(folderSeen, "/data/etiquon");

    EXPECT_TRUE(CardController::isClickable("LblToRef"));
    EXPECT_TRUE(CardController::isClickable("cmdDLog"));
    EXPECT_FALSE(CardController::isClickable("LblFromDate"));
}

TEST_F(CardTest, CheckAllAndClearAllGoToTheDocumentTypeGrid) {
    QList<bool> marks;
    card.click("cmdAllDocTypes");  // no grid yet: nothing happens
    card.hooks().markAllDocTypes = [&](bool scan) { marks << scan; };
    card.click("cmdAllDocTypes");
    card.click("cmdNoDocTypes");
    EXPECT_EQ(marks, (QList<bool>{true, false}));
}

}  // namespace
}  // namespace etq

namespace etq {
namespace {

// The window tells a failure of the logic in a critical box with the boundary's title (or the
// failure's own), and passes over those it has always kept to itself; either way the work
// counts as not done.
TEST(BoundaryTest, FailuresAreShownAsTheWindowHasAlwaysShownThem) {
    struct Case {
        std::function<void()> work;
        bool done;
        QString title;  // of the message shown; empty: none shown
        QString text;
    };
    const Case cases[] = {
        {[] { throw jet::JetError(3022, "Duplicate key"); }, false, "Title", "Duplicate key"},
        {[] { throw HostFileDamaged("oitm.dbf is cut short"); }, false, "Title",
         "oitm.dbf is cut short"},
        {[] { throw Failure("Database not found", "Error"); }, false, "Error",
         "Database not found"},
        {[] { throw HostFileMissing("no oitm.dbf"); }, false, {}, {}},
        {[] { throw QuietFailure("tCurrencies is read-only"); }, false, {}, {}},
        {[] {}, true, {}, {}},
    };
    for (const Case& c : cases) {
        test::RecordingMessages sink;
        Context context;
        context.setMessages(&sink);
        EXPECT_EQ(reportFailures(context, "Title", c.work), c.done) << c.text.toStdString();
        ASSERT_EQ(sink.shown.size(), c.title.isEmpty() ? 0 : 1) << c.text.toStdString();
        if (c.title.isEmpty()) continue;
        EXPECT_EQ(sink.shown[0].title, c.title);
        EXPECT_EQ(sink.shown[0].text, c.text);
        EXPECT_EQ(sink.shown[0].icon, MsgIcon::Critical);
    }
}

}  // namespace
}  // namespace etq

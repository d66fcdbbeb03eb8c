// The item print button and the built-in label definition as the control runs them: wired by
// connectParts, on the headless surface, with the settings store and a stand-in CUPS.
#include "card/print_adapters.h"

#include <QFileInfo>

#include "card/card_controller.h"
#include "card/component.h"
#include "print_fixture.h"
#include "recording_automation.h"

namespace etq::print::test {
namespace {

class PrintButtonTest : public PrintTest {
  protected:
    void SetUp() override {
        PrintTest::SetUp();
        controller.hooks().installedPrinters = [] { return QStringList{"Zebra_GK420"}; };
        connectParts(controller, surface);
        labelDefinition().cells[0].UseCell = true;
        labelDefinition().cells[0].FldID = 1;
    }
    LabelDefinition& labelDefinition() { return context.labelDefinition(); }

    // Puts a stand-in lpoptions first on PATH that logs its arguments, or fails.
    void fakeLpoptions(bool fail) {
        QFile script(cups.path() + "/lpoptions");
        ASSERT_TRUE(script.open(QIODevice::WriteOnly));
        script.write(fail ? "#!/bin/sh\necho 'lpoptions: Unknown printer' >&2\nexit 1\n"
                          : "#!/bin/sh\necho \"$@\" > \"$(dirname \"$0\")/log\"\n");
        script.close();
        script.setPermissions(script.permissions() | QFile::ExeOwner);
        qputenv("PATH", (cups.path() + ":").toLocal8Bit() + path);
    }
    CardController controller{surface, context};
    QTemporaryDir cups;
    QByteArray path = qgetenv("PATH");
};

TEST_F(PrintButtonTest, SaveGeneralSettingsKeepsTheDefinitionOnlyForTheBuiltInPage) {
    labelDefinition().page.PageRows = 9;
    controller.click("cmdSaveDef1");
    labelDefinition() = LabelDefinition{};
    controller.InitProperties();  // OptOLE(3) is stored as selected: the definition loads
    EXPECT_EQ(labelDefinition().page.PageRows, 9);
    EXPECT_TRUE(labelDefinition().cells[0].UseCell);

    surface.control("OptOLE", 1).setValue(true);
    labelDefinition().page.PageRows = 3;
    controller.click("cmdSaveDef1");
    EXPECT_EQ(SettingsStore("Etiquon").read("DirectLabel", "PageRows", ""), "9");
}

// A run that chose another route at start-up loads the stored definition when the built-in
// label is chosen, and before it prints; what the designer changed since stays.
TEST_F(PrintButtonTest, TheDefinitionIsLoadedWhenTheRouteIsChosenAndBeforeAPrint) {
    GetSetLabelDef(SaveLabelDef, context.applicationName, labelDefinition());  // cell 0: name
    addItems({{"A", "סבון", {}}});
    const auto printedCells = [&] {
        QFile file(viewer.shown.value(viewer.shown.size() - 1));
        return file.open(QIODevice::ReadOnly) ? file.readAll().count("<td class='L0'>") : -1;
    };

    labelDefinition() = LabelDefinition{};  // never loaded
    controller.click("cmdPrintItmes");
    EXPECT_EQ(printedCells(), 1);

    labelDefinition() = LabelDefinition{};
    surface.control("OptOLE", 3).setValue(true);
    controller.click("OptOLE", 3);
    EXPECT_TRUE(labelDefinition().cells[0].UseCell);
    labelDefinition().cells[0].UseCell = false;  // the designer's change
    controller.click("OptOLE", 3);
    controller.click("cmdPrintItmes");
    EXPECT_FALSE(labelDefinition().cells[0].UseCell);
    EXPECT_EQ(printedCells(), 0);
}

TEST_F(PrintButtonTest, PrintButtonMakesTheWorkingDatabaseAndShowsThePage) {
    addItems({{"A", "סבון", {}}});
    ASSERT_TRUE(QFile::remove(workDb()));
    controller.click("Image5");
    ASSERT_EQ(viewer.shown.size(), 1)
        << (messages.shown.isEmpty() ? std::string() : messages.shown[0].text.toStdString());
    EXPECT_TRUE(QFileInfo::exists(workDb()));
    QFile file(viewer.shown[0]);
    ASSERT_TRUE(file.open(QIODevice::ReadOnly));
    EXPECT_EQ(file.readAll().count("<td class='L0'>"), 1);
}

TEST_F(PrintButtonTest, ChosenPrinterBecomesTheDefaultBeforePrinting) {
    addItems({{"A", "סבון", {}}});
    fakeLpoptions(false);
    surface.control("cmbPrinter").addItem("Zebra_GK420");
    surface.control("cmbPrinter").setListIndex(0);
    controller.click("cmdPrintItmes");
    QFile log(cups.path() + "/log");
    ASSERT_TRUE(log.open(QIODevice::ReadOnly));
    EXPECT_EQ(log.readAll(), "-d Zebra_GK420\n");
    EXPECT_EQ(viewer.shown.size(), 1);

    fakeLpoptions(true);  // a printer CUPS refuses: reported, nothing printed
    controller.click("cmdPrintItmes");
    qputenv("PATH", path);
    EXPECT_EQ(viewer.shown.size(), 1);
    ASSERT_EQ(messages.shown.size(), 1);
    EXPECT_TRUE(messages.shown[0].text.contains("Unknown printer"));
}

// With label software chosen the button runs the print engine on the label tab's settings; a
// program this system does not have is reported with the engine's message, titled "Error".
TEST_F(PrintButtonTest, LabelSoftwareChosenPrintsThroughTheEngine) {
    addItems({{"A", "סבון", {}, 1.25, 2}});
    surface.control("OptOLE", 2).setValue(true);
    controller.click("cmdPrintItmes");
    EXPECT_TRUE(viewer.shown.isEmpty());
    ASSERT_EQ(messages.shown.size(), 1);
    EXPECT_EQ(messages.shown[0].icon, MsgIcon::Critical);
    EXPECT_EQ(messages.shown[0].title, context.caption(1));
    EXPECT_EQ(
        messages.shown[0].text,
        "BarTender is not available here: no program on this system provides the automation class \"BarTender.Application\" In Line 2, LabelID = 0, Var = , Value = ");

    auto software = std::make_shared<RecordingAutomation>();
    context.automation().add(software);
    surface.control("OptOLE", 0).setValue(true);  // NiceLabel
    surface.control("txtLabelName").setText("/l/item.lbl");
    surface.control("txtPriceFormat").setText("0.0");
    surface.control("ChkFldSend", 6).setValue(1);
    controller.click("cmdPrintItmes");
    EXPECT_EQ(messages.shown.size(), 1);
    EXPECT_EQ(software->calls,
              (QStringList{"new NiceLabel.Application", R"(app.LabelOpen("/l/item.lbl"))",
                           "app.LabelSessionStart(7)",
                           R"(app.LabelSetVar(7, "Price", "1.3", -9999, -9999))",
                           R"(app.LabelSessionPrint(7, "2,0"))", "app.LabelSessionEnd(7)",
                           "app.LabelClose(7)", "app.Quit()"}));
    EXPECT_EQ(surface.control("Message1").caption(), context.caption(44));
    EXPECT_EQ(surface.control("ProgressFill").width(), surface.control("ProgressFrame").width());

    // The document print's route: head labels from txtLabelNameHead, "Thermal" order.
    jet::Database work = jet::Database::open(workDb());
    work.execute("INSERT INTO tTempDocHeaders (WizFileID, Number, Include) VALUES (1, 10, True)");
    work.execute(
        "INSERT INTO tTempDocLines (WizFileID, HeadNumber, LineNum, ItemKey, Copies, Include) VALUES (1, 10, 1, 'A', 1, True), (1, 10, 2, 'A', 4, True)");
    software->calls.clear();
    surface.control("txtLabelNameHead").setText("/l/head.lbl");
    surface.control("OptPrinter", 1).setValue(true);
    surface.control("ChkFldSend", 6).setValue(0);
    EXPECT_TRUE(PrintWithLabelSoftware(surface, context, "/l/line.lbl", DocumentLineLabels,
                                       kNiceLabel, workDb(), true));
    EXPECT_EQ(software->callsWith({"Open", "Print("}),
              (QStringList{R"(app.LabelOpen("/l/head.lbl"))", R"(app.LabelPrint(7, "1,0"))",
                           R"(app.LabelOpen("/l/line.lbl"))", R"(app.LabelPrint(7, "4,0"))",
                           R"(app.LabelPrint(7, "1,0"))"}));
}

}  // namespace
}  // namespace etq::print::test

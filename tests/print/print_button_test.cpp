// The item print button and the built-in label definition as the control runs them: wired by
// connectParts, on the headless surface, with the settings store and a stand-in CUPS.
#include "card/print_adapters.h"

#include <QFileInfo>

#include "card/card_controller.h"
#include "card/component.h"
#include "print_fixture.h"

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

TEST_F(PrintButtonTest, LabelSoftwareChosenIsReportedWithoutPrinting) {
    surface.control("OptOLE", 2).setValue(true);
    controller.click("cmdPrintItmes");
    EXPECT_TRUE(viewer.shown.isEmpty());
    ASSERT_EQ(messages.shown.size(), 1);
    EXPECT_EQ(messages.shown[0].icon, MsgIcon::Critical);
}

}  // namespace
}  // namespace etq::print::test

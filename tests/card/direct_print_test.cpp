// Direct print from the control: with "הדפסה ישירה" chosen beside the printer list, the print
// button draws the labels' PDF and sends it with lp to the printer chosen, on that printer's
// paper, instead of showing the page in a browser. CUPS is a stand-in that logs its calls.
#include <QFile>
#include <QTemporaryDir>

#include "card/card_controller.h"
#include "card/component.h"
#include "print/print_fixture.h"

namespace etq::print::test {
namespace {

class DirectPrintTest : public PrintTest {
  protected:
    void SetUp() override {
        PrintTest::SetUp();
        connectParts(controller, surface);
        def.cells[0].UseCell = true;
        def.cells[0].FldID = 1;
        script("lpoptions",
               "echo \"lpoptions $*\" >> \"$(dirname \"$0\")/log\"\n"
               "[ \"$3\" = \"-l\" ] && echo 'PageSize/Media Size: Letter *A5 A4'\nexit 0\n");
        script("lp",
               "echo \"lp $*\" >> \"$(dirname \"$0\")/log\"\n"
               "for last; do :; done\ncp \"$last\" \"$(dirname \"$0\")/sent.pdf\"\n");
        qputenv("PATH", (cups.path() + ":").toLocal8Bit() + path);
    }
    void TearDown() override { qputenv("PATH", path); }

    void script(const QString& name, const QByteArray& body) {
        QFile file(cups.path() + "/" + name);
        ASSERT_TRUE(file.open(QIODevice::WriteOnly));
        file.write("#!/bin/sh\n" + body);
        file.close();
        file.setPermissions(file.permissions() | QFile::ExeOwner);
    }
    QByteArray read(const QString& name) const {
        QFile file(cups.path() + "/" + name);
        return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
    }

    CardController controller{surface, context};
    QTemporaryDir cups;
    QByteArray path = qgetenv("PATH");
};

TEST_F(DirectPrintTest, TheLabelsPdfGoesToTheChosenPrinterOnItsPaper) {
    addItems({{"A", "סבון", {}}, {"B", "מברשת", {}}});
    surface.control("cmbPrinter").addItem("Zebra_GK420");
    surface.control("cmbPrinter").setListIndex(0);
    surface.control("cmbPrintMode").setListIndex(1);
    controller.click("cmdPrintItmes");

    EXPECT_TRUE(messages.shown.isEmpty()) << messages.shown.value(0).text.toStdString();
    EXPECT_TRUE(viewer.shown.isEmpty());
    const QList<QByteArray> calls = read("log").trimmed().split('\n');
    ASSERT_EQ(calls.size(), 2) << read("log").data();
    EXPECT_EQ(calls[0], "lpoptions -p Zebra_GK420 -l");  // the default printer stays
    EXPECT_TRUE(calls[1].startsWith("lp -d Zebra_GK420 -- /")) << calls[1].data();
    EXPECT_TRUE(calls[1].endsWith("/etiqon1.pdf")) << calls[1].data();
    // A5, the printer's paper, to the hundred-thousandth of a point.
    const QByteArray pdf = read("sent.pdf");
    EXPECT_TRUE(pdf.startsWith("%PDF-"));
    EXPECT_TRUE(pdf.contains("/MediaBox [0 0 419.527559 595.275591]"));

    // A sheet product this machine's catalogue lacks prints nothing rather than misplace the
    // labels on the sheet.
    def.page.SheetBrand = "Nobody";
    def.page.SheetPart = "0";
    controller.click("cmdPrintItmes");
    ASSERT_EQ(messages.shown.size(), 1);
    EXPECT_EQ(messages.shown[0].title, "תקלה");
    EXPECT_TRUE(messages.shown[0].text.contains("Nobody 0 is not in the catalogue"));
    EXPECT_EQ(read("log").count("lp -d"), 1);  // the first print's only

    surface.control("cmbPrintMode").setListIndex(0);  // the browser page again
    controller.click("cmdPrintItmes");
    EXPECT_EQ(viewer.shown.size(), 1);
}

}  // namespace
}  // namespace etq::print::test

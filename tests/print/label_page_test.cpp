// The built-in label page written from a real working database, read back as the bytes a
// browser gets.
#include "print/label_page.h"

#include <QFileInfo>

#include "card/print_adapters.h"
#include "platform/codepage1255.h"
#include "platform/failure.h"
#include "print/label_query.h"
#include "print_fixture.h"

namespace etq::print::test {
namespace {

class LabelPageTest : public PrintTest {
  protected:
    void useCell(int i, int fldId, quint8 viewType = 0) {
        LabelCell& cell = def.cells[size_t(i)];
        cell.UseCell = true;
        cell.FldID = qint16(fldId);
        cell.ViewType = viewType;
    }

    // Writes the page of the item labels and returns its lines.
    QStringList writePage() {
        const QString file = dir.path() + "/page.htm";
        CreateLabFile(surface, context, file, workDb(), ItemLabels, Ascending);
        QFile f(file);
        EXPECT_TRUE(f.open(QIODevice::ReadOnly));
        bytes = f.readAll();
        QStringList lines = decode1255(bytes).split("\r\n");
        EXPECT_EQ(lines.takeLast(), "");  // the last line ends too
        return lines;
    }

    // What each label position holds: the lines between its cell's opening and closing.
    static QList<QStringList> positions(const QStringList& lines) {
        QList<QStringList> out;
        for (qsizetype i = 0; i < lines.size(); ++i) {
            if (!lines[i].startsWith("    <td ")) continue;
            QStringList content;
            for (++i; lines[i] != "    </td>"; ++i)
                if (!lines[i].contains("table")) content << lines[i];
            out << content;
        }
        return out;
    }

    static int sheets(const QStringList& lines) {
        return int(lines.count("<table height='100%' width='100%' border='0'>"));
    }

    static QString textRow(int cell, const QString& text) {
        return QString("    <tr align='center'><td class='L%1'>%2</td></tr>").arg(cell).arg(text);
    }
    static QString imageRow(int cell, const QString& bitmap) {
        return QString(
                   "    <tr align='center'><td class='L%1'><img src='%2'  width=100 height=50></img></td></tr>")
            .arg(cell)
            .arg(bitmap);
    }
    const QString kEmpty = "    <tr><td nowrap>&nbsp;</td></tr>";
    QByteArray bytes;
};

TEST_F(LabelPageTest, TenRecordsFillOneSheetOfFourBySix) {
    addNumberedItems(10);
    useCell(0, 1);
    const QStringList lines = writePage();
    EXPECT_EQ(sheets(lines), 1);
    const QList<QStringList> labels = positions(lines);
    ASSERT_EQ(labels.size(), 24);
    for (int p = 1; p <= 10; ++p)
        EXPECT_EQ(labels[p - 1], QStringList{textRow(0, QString("פריט %1").arg(p))}) << p;
    for (int p = 11; p <= 24; ++p)
        EXPECT_EQ(labels[p - 1], QStringList{kEmpty}) << p;
    EXPECT_EQ(lines.count("  <tr>"), 6);
    EXPECT_TRUE(lines.contains("    <td width='25.0%' height='16.7%' align='center'>"));
    EXPECT_EQ(lines.mid(lines.size() - 3), QStringList({"</table>", "</BODY>", "</HTML>"}));
    // Every line ends with CR LF, and the page is in the code page it declares.
    EXPECT_EQ(bytes.count("\n"), bytes.count("\r\n"));
    EXPECT_TRUE(bytes.contains(encode1255(u"פריט 1", Unmappable::QuestionMark)));
    EXPECT_EQ(surface.control("ProgressFill").width(), 0);
}

TEST_F(LabelPageTest, CopiesRepeatARecordWithItsRecordNumber) {
    addItems({{"A", "ראשון", "7290000000015", 1, 3}, {"B", "שני", "7290000000022", 1, 1}});
    useCell(0, 1);
    useCell(1, 4, 1);
    const QList<QStringList> labels = positions(writePage());
    for (int p = 0; p < 3; ++p)
        EXPECT_EQ(labels[p], QStringList({textRow(0, "ראשון"), imageRow(1, "B0400001.BMP")}));
    EXPECT_EQ(labels[3], QStringList({textRow(0, "שני"), imageRow(1, "B0400002.BMP")}));
    EXPECT_EQ(labels[4], QStringList{kEmpty});
}

TEST_F(LabelPageTest, TwentyFourLabelsTakeOneSheetAndTwentyFiveTwo) {
    addNumberedItems(2, 12);
    useCell(0, 0);
    QStringList lines = writePage();
    EXPECT_EQ(sheets(lines), 1);
    EXPECT_FALSE(lines.contains(kEmpty));
    addItems({{"Z", "אחרון", {}}});
    lines = writePage();
    EXPECT_EQ(sheets(lines), 2);
    const QList<QStringList> labels = positions(lines);
    ASSERT_EQ(labels.size(), 48);
    EXPECT_EQ(labels[24], QStringList{textRow(0, "Z")});
    EXPECT_EQ(labels[25], QStringList{kEmpty});
}

TEST_F(LabelPageTest, RecordWithoutCopiesTakesNoPositionButKeepsItsNumber) {
    addItems({{"A", "אפס", "7290000000015", 1, 0}, {"B", "אחד", "7290000000022", 1, 1}});
    useCell(0, 4, 1);
    const QList<QStringList> labels = positions(writePage());
    EXPECT_EQ(labels[0], QStringList{imageRow(0, "B0400002.BMP")});
    EXPECT_EQ(labels[1], QStringList{kEmpty});
}

TEST_F(LabelPageTest, AutoPrintOpensTheBodyOnTwoLines) {
    addNumberedItems(1);
    useCell(0, 0);
    QStringList lines = writePage();
    EXPECT_TRUE(lines.contains("<BODY BGCOLOR='#FFFFFF'>"));
    def.page.PageAutoPrint = true;
    lines = writePage();
    const qsizetype body = lines.indexOf("<BODY onload='window.print()'");
    ASSERT_GE(body, 0);
    EXPECT_EQ(lines[body + 1], " BGCOLOR='#FFFFFF'>");
}

TEST_F(LabelPageTest, PriceTakesTheFormatAndTheRecordsSign) {
    addItems({{"A", "סבון", {}, 12.5}});
    useCell(0, 6);
    EXPECT_EQ(positions(writePage())[0], QStringList{textRow(0, "12.50 ₪")});
    surface.control("txtPriceFormat").setText(" 0.0 ");
    def.cells[0].Prefix = "מחיר";
    EXPECT_EQ(positions(writePage())[0], QStringList{textRow(0, "מחיר 12.5 ₪")});
    def.page.MaxTextLen = 6;  // the prefix counts
    EXPECT_EQ(positions(writePage())[0], QStringList{textRow(0, "מחיר 1")});
}

TEST_F(LabelPageTest, CellsKeepTheirIndexInClassesAndStyles) {
    addNumberedItems(1);
    useCell(0, 0);
    useCell(2, 1);
    useCell(5, 6);
    def.cells[2] = {true, 1, {}, 0, 1, 12, 2, true, true, 2, 0, {}, false, 14, true};
    const QStringList lines = writePage();
    EXPECT_EQ(positions(lines)[0],
              QStringList({textRow(0, "K01"), textRow(2, "פריט 1"), textRow(5, "11.00 ₪")}));
    const qsizetype style = lines.indexOf("<style>");
    EXPECT_EQ(
        lines.mid(0, style + 1),
        QStringList({"<HTML>", "<HEAD>", "<TITLE>מדבקות פריטים</TITLE>",
                     "<meta http-equiv='Content-Type' content='text/html; charset=windows-1255'>",
                     "<style>"}));
    EXPECT_EQ(
        lines.mid(style + 1, 8),
        QStringList(
            {"       .L0 {font-family:Arial (Hebrew); font-weight:Normal; font-size:9pt; font-style:Normal; text-align:Center; direction:rtl; color:black;}",
             "       .L2 {font-family:David; font-weight:Bold; font-size:12pt; font-style:Italic; text-decoration: underline; text-align:Left; direction:ltr; height: 14pt; border: thin solid black; color:black;}",
             "       .L5 {font-family:Arial (Hebrew); font-weight:Normal; font-size:9pt; font-style:Normal; text-align:Center; direction:rtl; color:black;}",
             "       TR {vertical-align: middle; }", "       TD {vertical-align: middle; }",
             "       TABLE {border: none; direction: rtl; padding: 0; word-spacing: 0; letter-spacing: 0}",
             "       .Lab {border: none; direction: rtl; padding: 1; word-spacing: 0; letter-spacing: 0; margin-top: 0; margin-bottom: 0}",
             "</style>"}));
    // The page ticked the cells' fields on the label tab.
    EXPECT_EQ(surface.control("ChkFldSend", 6).value().toInt(), 1);
}

TEST_F(LabelPageTest, DatabaseValuesAreEscapedAndOtherCharactersReferenced) {
    addItems({{"A", "<b>Tom & Jerry's</b> 😀", {}}});
    useCell(0, 1);
    const QStringList lines = writePage();
    EXPECT_EQ(positions(lines)[0],
              QStringList{textRow(0, "&lt;b&gt;Tom &amp; Jerry&#39;s&lt;/b&gt; &#128512;")});
}

TEST_F(LabelPageTest, EmptyQueryLeavesTheHeadAndTheBodyOpening) {
    useCell(0, 1);
    const QStringList lines = writePage();
    EXPECT_EQ(lines.last(), "<BODY BGCOLOR='#FFFFFF'>");
    EXPECT_EQ(sheets(lines), 0);
}

TEST_F(LabelPageTest, GridSizesGiveTheirShares) {
    addNumberedItems(1);
    useCell(0, 0);
    def.page.PageRows = 1;
    def.page.PageCols = 12;
    EXPECT_TRUE(writePage().contains("    <td width='08.3%' height='100.0%' align='center'>"));
    // No labels, or more than a sheet can hold, is a setting to mend.
    for (const auto [rows, columns] : {std::pair{0, 12}, {101, 4}, {1, 41}, {3000, 3000}}) {
        def.page.PageRows = qint16(rows);
        def.page.PageCols = qint16(columns);
        EXPECT_THROW(writePage(), BadSetting) << rows << "x" << columns;
    }
}

using PrintRunTest = LabelPageTest;

TEST_F(PrintRunTest, WritesPageAndBitmapsIntoAFolderOfItsOwnAndShowsThePage) {
    addItems({{"A", "סבון", "7290000000015"}, {"B", "מברשת", "7290000000022"}});
    useCell(0, 1);
    useCell(1, 4, 1);
    def.bar.BarType = 6;
    QString page = PrintBuiltInLabels(surface, context, workDb(), ItemLabels);
    ASSERT_FALSE(page.isEmpty());
    const QString folder = QFileInfo(page).path();
    EXPECT_TRUE(QFileInfo(folder).path().endsWith("/etiquon/etiqon")) << folder.toStdString();
    EXPECT_EQ(QFileInfo(folder).permissions() & (QFile::ReadOther | QFile::ReadGroup), 0);
    EXPECT_EQ(viewer.shown, QStringList{page});
    EXPECT_EQ(QDir(folder).entryList(QDir::Files),
              QStringList({"B0400001.BMP", "B0400002.BMP", "etiqon1.htm"}));
    EXPECT_TRUE(messages.shown.isEmpty());

    // The next run writes into a new folder and leaves the first run's page whole; a negative
    // bar type makes no bitmaps.
    def.bar.BarType = -1;
    page = PrintBuiltInLabels(surface, context, workDb(), ItemLabels);
    EXPECT_NE(QFileInfo(page).path(), folder);
    EXPECT_EQ(QDir(QFileInfo(page).path()).entryList(QDir::Files), QStringList{"etiqon1.htm"});
    EXPECT_EQ(QDir(folder).entryList(QDir::Files).size(), 3);
}

TEST_F(PrintRunTest, RefusedBarcodesAreReportedAndThePageStillShown) {
    addItems({{"A", "סבון", "ABC"}, {"B", "מברשת", "7290000000022"}});
    useCell(0, 4, 1);
    def.bar.BarType = 6;
    EXPECT_FALSE(PrintBuiltInLabels(surface, context, workDb(), ItemLabels).isEmpty());
    ASSERT_EQ(messages.shown.size(), 1);
    EXPECT_EQ(messages.shown[0].title, "תקלה");
    EXPECT_TRUE(messages.shown[0].text.startsWith("1 labels have no barcode:\nB0400001.BMP"));
    EXPECT_EQ(viewer.shown.size(), 1);
}

// A cell may show a field whose box on the label data tab is not ticked: the run's barcode query
// has the column from the first run on, and the box is ticked after it.
TEST_F(PrintRunTest, BarcodeOnAnUntickedFieldPrintsFromTheFirstRun) {
    addItems({{"A", "סבון", "7290000000015"}});
    useCell(0, 8, 1);  // serial number: a column only when its box is ticked
    def.bar.BarType = 2;
    const QString page = PrintBuiltInLabels(surface, context, workDb(), ItemLabels);
    ASSERT_FALSE(page.isEmpty()) << messages.shown.value(0).text.toStdString();
    EXPECT_TRUE(messages.shown.isEmpty());
    EXPECT_TRUE(QFileInfo::exists(QFileInfo(page).path() + "/B0800001.BMP"));
    EXPECT_EQ(surface.control("ChkFldSend", 8).value().toInt(), 1);
}

// The unit slot shows the item's unit, the column the item import fills.
TEST_F(LabelPageTest, UnitCellShowsTheItemsUnit) {
    addItems({{"A", "סבון", {}}});
    jet::Database::open(path(db::kItemDatabaseFile))
        .execute("UPDATE tItems SET Unit = 'ליטר', Local = 'x' WHERE ItemKey = 'A'");
    useCell(0, 5);
    EXPECT_EQ(positions(writePage())[0], QStringList{textRow(0, "ליטר")});
}

TEST_F(PrintRunTest, MissingDatabaseIsReported) {
    useCell(0, 1);
    EXPECT_TRUE(
        PrintBuiltInLabels(surface, context, dir.path() + "/none.tmp", ItemLabels).isEmpty());
    ASSERT_EQ(messages.shown.size(), 1);
    EXPECT_EQ(messages.shown[0].title, "תקלה");
}

}  // namespace
}  // namespace etq::print::test

// The document line selection's query text and its grids on a real working database, the
// choice of the document types a document import scans, and the two document windows offscreen.
#include <QPushButton>
#include <QTableView>

#include "db/db_fixture.h"
#include "dialogs/bound_grid_model.h"
#include "dialogs/doc_line_selection.h"
#include "dialogs/doc_lines_query.h"
#include "dialogs/doc_types.h"
#include "dialogs/edit_ranges_window.h"
#include "dialogs/select_doc_item_window.h"
#include "jet/error.h"
#include "platform/captions.h"

namespace etq::dialogs::test {
namespace {

// Values are numbers when they are whole numbers, quoted texts otherwise: nothing a grid cell
// holds can end the statement or add a condition to it.
TEST(DocLinesQueryText, NumbersGoInAsNumbersAndAnythingElseAsAText) {
    const QString head =
        "SELECT tTempDocLines.LineNum, tTempDocLines.ItemKey, tItems.ItemName, tTempDocLines.Quantity, tTempDocLines.Warehouse, tTempDocLines.Copies, tTempDocLines.Include FROM (tTempDocLines Inner Join tItems On tItems.ItemKey = tTempDocLines.ItemKey) Where WizFileID=";
    const QString tail = " ORDER BY tTempDocLines.HeadNumber, tTempDocLines.LineNum";
    EXPECT_EQ(BuildDocLinesQuery("1", "101"), head + "1 And HeadNumber=101" + tail);
    EXPECT_EQ(BuildDocLinesQuery("", ""), head + "'' And HeadNumber=''" + tail);
    EXPECT_EQ(BuildDocLinesQuery("1 Or 1=1", "7') Or ('1'='1"),
              head + "'1 Or 1=1' And HeadNumber='7'') Or (''1''=''1'" + tail);
}

// Two imported documents: delivery note 101 (lines 1 and 2; line 3 names an item tItems lacks)
// and invoice 7 (lines 1 and 2).
class DocLineSelectionTest : public db::test::DbFolderTest {
  protected:
    void SetUp() override {
        DbFolderTest::SetUp();
        ASSERT_FALSE(createWork(false).isEmpty());
        jet::Database items = jet::Database::open(path(db::kItemDatabaseFile));
        items.execute(
            "INSERT INTO tItems (ItemKey, ItemName, Coin) VALUES ('A', 'סבון', '¦'), ('B', 'מברשת', '¦')");
        jet::Database w = work();
        w.execute(
            "INSERT INTO tTempDocHeaders (WizFileID, [Number], RecIndex, DocType, Reference1, Include) VALUES (2, 7, 0, 2, 20507, False), (1, 101, 0, 1, 10501, False)");
        w.execute(
            "INSERT INTO tTempDocLines (WizFileID, HeadNumber, LineNum, ItemKey, Quantity, Copies, Include) VALUES (1, 101, 1, 'A', 2, 2, True), (1, 101, 2, 'B', 3, 3, True), (1, 101, 3, 'GONE', 1, 1, True), (2, 7, 1, 'A', 5, 5, True), (2, 7, 2, 'B', 1, 1, True)");
    }
    jet::Database work() { return jet::Database::open(path(db::kWorkDatabaseFile)); }
    QStringList stored(const QString& sql) {
        jet::Database w = work();
        return rows(w, sql);
    }
    QStringList lineKeys() {
        QStringList keys;
        for (int row = 0; row < selection.lineCount(); ++row)
            keys << selection.lineCell(row, DocLineSelection::kItemKeyColumn).toString();
        return keys;
    }

    BoundGridModel documents, lines;
    DocLineSelection selection{documents, lines};
};

TEST_F(DocLineSelectionTest, ChecksAndCopiesGoStraightToTheWorkingDatabase) {
    selection.openDocuments(dir.path());
    ASSERT_EQ(selection.documentCount(), 2);
    EXPECT_EQ(selection.documentAt(0), (DocumentKey{1, 101}));  // by type first
    selection.showLines(0);
    EXPECT_EQ(lineKeys(), (QStringList{"A", "B"}));  // GONE is no item: not listed

    selection.includeAllDocuments(true);
    selection.includeAllLines(false);  // the lines of the document shown, only
    selection.setCopies(selection.findLine(2), 9);
    EXPECT_THROW(selection.setCopies(0, 70000), jet::JetError);
    selection.showLines(selection.findDocument({2, 7}));
    EXPECT_EQ(lineKeys(), (QStringList{"A", "B"}));
    selection.includeLine(selection.findLine(1), false);
    selection.includeDocument(1, false);  // its lines keep their own flags

    EXPECT_EQ(stored("SELECT WizFileID, [Number], Include FROM tTempDocHeaders ORDER BY WizFileID"),
              (QStringList{"1|101|True", "2|7|False"}));
    EXPECT_EQ(
        stored("SELECT WizFileID, LineNum, Copies, Include FROM tTempDocLines ORDER BY "
               "WizFileID, LineNum"),
        (QStringList{"1|1|2|False", "1|2|9|False", "1|3|1|True", "2|1|5|False", "2|2|1|True"}));
    EXPECT_EQ(selection.findDocument({3, 1}), -1);
    EXPECT_EQ(selection.findLine(9), -1);
    // A hostile value matches nothing and breaks nothing.
    EXPECT_TRUE(stored(BuildDocLinesQuery("1 Or 1=1", "101")).isEmpty());
    EXPECT_EQ(stored(BuildDocLinesQuery("1", "101")).size(), 2);
}

TEST_F(DocLineSelectionTest, NoDocumentImportedListsNoLines) {
    work().execute("DELETE * FROM tTempDocHeaders");
    selection.openDocuments(dir.path());
    EXPECT_EQ(selection.documentCount(), 0);
    selection.showLines(0);
    EXPECT_EQ(selection.lineCount(), 0);
    EXPECT_EQ(selection.currentDocument(), -1);
}

TEST_F(DocLineSelectionTest, DocumentTypesToScanAreKeptInTheDocumentDatabase) {
    const QString docDb = path(db::kDocDatabaseFile);
    setDocTypeFlags(docDb, 4, true, std::nullopt);
    setDocTypeFlags(docDb, 1, false, true);
    const QList<DocTypeRow> types = readDocTypes(docDb);
    ASSERT_EQ(types.size(), 7);
    EXPECT_EQ(types[0], (DocTypeRow{1, "תעודת משלוח", false, true}));
    EXPECT_EQ(types[3], (DocTypeRow{4, "הזמנת לקוח", true, false}));
    EXPECT_EQ(types[6].type, 12);
    EXPECT_THROW(setDocTypeFlags(docDb, 9, true, true), jet::JetError);
}

QString header(const QAbstractItemModel& model, int column) {
    return model.headerData(column, Qt::Horizontal, Qt::DisplayRole).toString();
}

int alignment(const QAbstractItemModel& model, int column) {
    return model.data(model.index(0, column), Qt::TextAlignmentRole).toInt();
}

void click(QWidget& window, const char* name) {
    window.findChild<QPushButton*>(name)->click();
}

// Documents and lines in two grids: a change of document shows its lines, the buttons and the
// grids' own edits write straight through.
TEST_F(DocLineSelectionTest, WindowShowsTheLinesOfTheCurrentDocument) {
    SelectDocItemWindow window(dir.path(), 0);
    EXPECT_EQ(window.windowTitle(), "בחירת שורות מסמכים להדפסה");
    auto* documentView = window.findChild<QTableView*>("VSDocHeaders");
    ASSERT_EQ(window.documents().rowCount(), 2);
    EXPECT_TRUE(documentView->isColumnHidden(6));
    EXPECT_TRUE(documentView->isColumnHidden(7));
    EXPECT_FALSE(documentView->isColumnHidden(5));
    EXPECT_EQ(header(window.documents(), 0), GetCaption(7, 0));
    EXPECT_EQ(header(window.documents(), 5), GetCaption(12, 0));
    EXPECT_EQ(header(window.lines(), 6), GetCaption(19, 0));
    EXPECT_EQ(alignment(window.lines(), 0),
              int(Qt::AlignRight | Qt::AlignAbsolute | Qt::AlignVCenter));
    ASSERT_EQ(window.lines().rowCount(), 2);

    documentView->setCurrentIndex(window.documents().index(1, 0));
    EXPECT_EQ(window.selection().currentDocument(), 1);
    click(window, "cmdNoneLines");
    click(window, "CmdAllHeaders");
    QAbstractItemModel& lines = window.lines();
    EXPECT_TRUE(lines.setData(lines.index(0, 5), "4", Qt::EditRole));
    EXPECT_EQ(
        stored("SELECT WizFileID, LineNum, Copies, Include FROM tTempDocLines ORDER BY "
               "WizFileID, LineNum"),
        (QStringList{"1|1|2|True", "1|2|3|True", "1|3|1|True", "2|1|4|False", "2|2|1|False"}));
    EXPECT_EQ(stored("SELECT Include FROM tTempDocHeaders"), (QStringList{"True", "True"}));

    SelectDocItemWindow english(dir.path(), 1);
    EXPECT_EQ(english.windowTitle(), "Selecting document items for print");
    EXPECT_EQ(english.layoutDirection(), Qt::LeftToRight);
    EXPECT_EQ(english.findChild<QPushButton*>("cmdNoneHeaders")->text(), "Unselect all");
    EXPECT_EQ(header(english.lines(), 5), "Copies");
    EXPECT_EQ(alignment(english.documents(), 0),
              int(Qt::AlignLeft | Qt::AlignAbsolute | Qt::AlignVCenter));
}

TEST_F(DocLineSelectionTest, RangesWindowEditsAndResetsTheNextScanStart) {
    {
        jet::Database docs = jet::Database::open(path(db::kDocDatabaseFile));
        docs.execute("UPDATE tWizFileRanges SET LastIndx = 7, FromIndx = 8");
    }
    EditRangesWindow window(dir.path(), 0);
    QAbstractItemModel& grid = window.grid();
    ASSERT_EQ(grid.rowCount(), 7);
    EXPECT_EQ(header(grid, 0), GetCaption(4, 0));
    EXPECT_EQ(header(grid, 2), GetCaption(6, 0));
    EXPECT_EQ(alignment(grid, 2), int(Qt::AlignRight | Qt::AlignAbsolute | Qt::AlignVCenter));
    EXPECT_TRUE(grid.setData(grid.index(1, 2), "3", Qt::EditRole));
    jet::Database docs = jet::Database::open(path(db::kDocDatabaseFile));
    EXPECT_EQ(rows(docs, "SELECT FromIndx FROM tWizFileRanges WHERE WizFileID = 2"),
              QStringList{"3"});
    click(window, "cmdNoneItems");
    EXPECT_EQ(grid.data(grid.index(1, 2), Qt::DisplayRole).toString(), "0");
    EXPECT_EQ(rows(docs, "SELECT DISTINCT LastIndx, FromIndx FROM tWizFileRanges"),
              QStringList{"7|0"});

    EditRangesWindow english(dir.path(), 1);
    EXPECT_EQ(english.windowTitle(), "Documents special numerators");
    EXPECT_EQ(english.layoutDirection(), Qt::LeftToRight);
    EXPECT_EQ(header(english.grid(), 2), "Next scan start");
    EXPECT_EQ(english.findChild<QPushButton*>("cmdNoneItems")->text(), "Reset all");

    EditRangesWindow nowhere(dir.path() + "/missing", 0);  // nothing to show, and no failure
    EXPECT_EQ(nowhere.grid().rowCount(), 0);
}

}  // namespace
}  // namespace etq::dialogs::test

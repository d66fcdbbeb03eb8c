// The item selection window on a real item database.
#include "dialogs/select_item_window.h"

#include <QApplication>
#include <QComboBox>
#include <QLineEdit>
#include <QPushButton>
#include <QTableView>
#include <QTimer>

#include "db/db_fixture.h"
#include "dialogs/bound_grid_model.h"
#include "platform/captions.h"

namespace etq::dialogs::test {
namespace {

class SelectItemWindowTest : public db::test::DbFolderTest {
  protected:
    void SetUp() override {
        DbFolderTest::SetUp();
        jet::Database items = jet::Database::open(path(db::kItemDatabaseFile));
        items.execute(
            "INSERT INTO tItems (ItemKey, ItemName, Coin, Price, Copies, PrintLabel) VALUES ('100', 'סבון', '¦', 1, 1, False), ('200', 'מברשת', '¦', 1, 1, False), ('300', 'ספוג', '¦', 1, 1, False)");
    }
    static void click(QWidget& window, const char* name) {
        window.findChild<QPushButton*>(name)->click();
    }
    static void type(QWidget& window, const char* name, const QString& text) {
        window.findChild<QLineEdit*>(name)->setText(text);
    }
    QStringList stored() {
        jet::Database items = jet::Database::open(path(db::kItemDatabaseFile));
        return rows(items, "SELECT ItemKey, PrintLabel, Copies FROM tItems ORDER BY ItemKey");
    }
};

TEST_F(SelectItemWindowTest, ButtonsWriteStraightToTheItemTable) {
    SelectItemWindow window(dir.path(), "", 0);
    EXPECT_EQ(window.windowTitle(), "בחירת פריטים להדפסה");
    EXPECT_EQ(window.grid().rowCount(), 3);
    EXPECT_EQ(window.grid().headerData(1, Qt::Horizontal, Qt::DisplayRole).toString(),
              GetCaption(19, 0));
    type(window, "txtToItemKey", "2");
    click(window, "cmdFindKey");
    EXPECT_EQ(window.findChild<QTableView*>("VSSelectItems")->currentIndex().row(), 1);
    type(window, "txtAllCopis", "4");
    click(window, "CmdAllCopies");
    EXPECT_EQ(stored(), QStringList({"100|False|1", "200|True|4", "300|False|1"}));
    click(window, "cmdShowMarked");
    EXPECT_EQ(window.grid().rowCount(), 1);
    click(window, "cmdShowAll");
    click(window, "CmdAllItems");
    EXPECT_EQ(stored(), QStringList({"100|True|1", "200|True|4", "300|True|1"}));
    click(window, "cmdNoneItems");
    EXPECT_EQ(stored(), QStringList({"100|False|1", "200|False|4", "300|False|1"}));
    // A tick in the grid is a write too.
    QAbstractItemModel& model = window.grid();
    model.setData(model.index(2, 1), Qt::Checked, Qt::CheckStateRole);
    EXPECT_EQ(stored()[2], "300|True|1");
}

TEST_F(SelectItemWindowTest, EnglishWindowTakesItsEnglishTexts) {
    SelectItemWindow window(dir.path(), "", 1);
    EXPECT_EQ(window.windowTitle(), "Selecting items for print");
    EXPECT_EQ(window.layoutDirection(), Qt::LeftToRight);
    EXPECT_EQ(window.findChild<QPushButton*>("CmdAllItems")->text(), "Select all");
    EXPECT_EQ(window.findChild<QComboBox*>("cmbItmSortBy")->itemText(1), "Item Name");
    EXPECT_EQ(window.findChild<QComboBox*>("cmbItmSortOrder")->currentIndex(), 0);
    EXPECT_EQ(window.grid().headerData(3, Qt::Horizontal, Qt::DisplayRole).toString(), "Item Name");
}

}  // namespace
}  // namespace etq::dialogs::test

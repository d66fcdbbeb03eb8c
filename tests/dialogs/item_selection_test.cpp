// The item selection's query texts, and its buttons on a real item database.
#include "dialogs/item_selection.h"

#include "db/db_fixture.h"
#include "dialogs/bound_grid_model.h"
#include "dialogs/items_query.h"
#include "print/label_query.h"

namespace etq::dialogs::test {
namespace {

TEST(ItemsQueryText, SortAndDirectionApplyToTheLastColumn) {
    const QString base = "SELECT ItemKey, PrintLabel, Copies, ItemName FROM tItems WHERE (1 > 0)";
    EXPECT_EQ(BuildItemsQuery("", false, 0, 0),
              base + " ORDER BY tItems.PrintLabel, tItems.Itemkey ASC");
    EXPECT_EQ(BuildItemsQuery(" And ItemKey >= '1'", true, 1, 1),
              base + " And PrintLabel = True And ItemKey >= '1' ORDER BY tItems.ItemName DESC");
    EXPECT_EQ(BuildItemsQuery("", false, 5, 7), base + " ORDER BY ");
}

// Items 100 to 600; 300 is marked with 2 copies.
class ItemSelectionTest : public db::test::DbFolderTest {
  protected:
    void SetUp() override {
        DbFolderTest::SetUp();
        jet::Database items = jet::Database::open(path(db::kItemDatabaseFile));
        items.execute(
            "INSERT INTO tItems (ItemKey, ItemName, Coin, Price, Copies, PrintLabel) VALUES ('100', 'Soap', '¦', 1, 1, False), ('200', 'brush', '¦', 1, 1, False), ('300', 'Sponge', '¦', 1, 2, True), ('400', 'Bread', '¦', 1, 1, False), ('500', 'Salt', '¦', 1, 1, False), ('600', 'Sugar', '¦', 1, 1, False)");
    }
    void open(const QString& filter = {}) {
        selection = std::make_unique<ItemSelection>(grid, filter);
        selection->open(dir.path(), 0, 0);
    }
    // Key, tick and copies of every item in the item database, in key order.
    QStringList stored() {
        jet::Database items = jet::Database::open(path(db::kItemDatabaseFile));
        return rows(items, "SELECT ItemKey, PrintLabel, Copies FROM tItems ORDER BY ItemKey");
    }
    QString key(int row) const { return grid.cell(row, 0).toString(); }

    BoundGridModel grid;
    std::unique_ptr<ItemSelection> selection;
};

TEST_F(ItemSelectionTest, ListsMarkedFirstThenByKey) {
    open();
    ASSERT_EQ(selection->rowCount(), 6);
    EXPECT_EQ(key(0), "300");
    EXPECT_EQ(key(1), "100");
    open(ItemKeyRangeCondition("200", "400"));
    EXPECT_EQ(selection->rowCount(), 3);
    selection->show(true, 0, 0);
    EXPECT_EQ(selection->rowCount(), 1);
}

TEST_F(ItemSelectionTest, MarkAllAndClearAllWriteThrough) {
    open(ItemKeyRangeCondition("", "200"));
    selection->markAll(true);
    EXPECT_EQ(stored(), QStringList({"100|True|1", "200|True|1", "300|True|2", "400|False|1",
                                     "500|False|1", "600|False|1"}));
    open();
    selection->markAll(false);
    for (const QString& row : stored())
        EXPECT_TRUE(row.contains("|False|")) << row.toStdString();
}

TEST_F(ItemSelectionTest, CopiesGoToTickedRowsOnly) {
    open();
    selection->setCopies("");
    selection->setCopies("many");
    EXPECT_EQ(stored()[2], "300|True|2");
    selection->setCopies("3");
    EXPECT_EQ(stored(), QStringList({"100|False|1", "200|False|1", "300|True|3", "400|False|1",
                                     "500|False|1", "600|False|1"}));
    EXPECT_TRUE(selection->lastError().isEmpty());
    selection->setCopies("300");  // beyond what Copies holds: the row is left, the reason kept
    EXPECT_EQ(stored()[2], "300|True|3");
    EXPECT_FALSE(selection->lastError().isEmpty());
}

TEST_F(ItemSelectionTest, FindByKeyTicksTheFirstBeginningWithIt) {
    open();
    EXPECT_EQ(selection->findByKey(""), -1);
    EXPECT_EQ(selection->findByKey("9"), -1);
    const int row = selection->findByKey("5");
    ASSERT_GE(row, 0);
    EXPECT_EQ(key(row), "500");
    EXPECT_EQ(stored()[4], "500|True|1");
}

TEST_F(ItemSelectionTest, FindByNameWrapsAndDoesNotTick) {
    open();  // 300 Sponge, 100 Soap, 200 brush, 400 Bread, 500 Salt, 600 Sugar
    EXPECT_EQ(selection->findByName("", -1), -1);
    int row = selection->findByName("s", -1);
    EXPECT_EQ(key(row), "300");
    row = selection->findByName("s", row);
    EXPECT_EQ(key(row), "100");
    row = selection->findByName("S", 4);
    EXPECT_EQ(key(row), "600");
    row = selection->findByName("s", row);  // from the last match back to the top
    EXPECT_EQ(key(row), "300");
    EXPECT_EQ(selection->findByName("BR", 1), 2);  // case is ignored
    EXPECT_EQ(stored()[0], "100|False|1");
}

}  // namespace
}  // namespace etq::dialogs::test

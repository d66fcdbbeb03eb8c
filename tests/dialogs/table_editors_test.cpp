// The editors' record sources and row work on a real item database.
#include "dialogs/table_editors.h"

#include "db/db_fixture.h"
#include "dialogs/bound_grid_model.h"
#include "platform/user_paths.h"
#include "support/log_capture.h"
#include "support/sql_source_file.h"

namespace etq::dialogs::test {
namespace {

class TableEditorsTest : public db::test::DbFolderTest {
  protected:
    void SetUp() override {
        DbFolderTest::SetUp();
        jet::Database items = jet::Database::open(path(db::kItemDatabaseFile));
        items.execute(
            "INSERT INTO tItems (ItemKey, ItemName, BarCode, Price) VALUES ('1', 'סבון 12 יח', '729001', 5), ('2', 'A*B', '729002', 4), ('3', 'A?B', '629003', 3), ('4', 'A1B', '729004', 2), ('5', 'x[y', Null, 1), ('6', 'O''Neil', '729006', 1), ('7', '1#2', '729007', 0), ('8', 'אחר 112', '729008', 9)");
        items.execute(
            "INSERT INTO tAlterKeys (AccountKey, ItemKey, AlterNum, AlterBar) VALUES ('C1', '1', 'Z9', Null), ('C1', '2', 'A1', Null), ('C2', '1', 'M5', Null), ('O''K', '2', 'Q', Null)");
    }
    // The first column of every row the editor shows.
    static QStringList keys(EditorGrid& editor, int column = 1) {
        QStringList out;
        for (int row = 0; row < editor.rowCount(); ++row)
            out << vb::toText(editor.value(row, column));
        return out;
    }
    QStringList stored(const QString& sql) {
        jet::Database items = jet::Database::open(path(db::kItemDatabaseFile));
        return rows(items, sql);
    }
    BoundGridModel grid;
};

TEST_F(TableEditorsTest, ItemSearchIsAValueAndSortsFollowTheLists) {
    EXPECT_EQ(
        BuildEditItemsQuery({1, "12", 1, 1, ""}),
        "SELECT ItemKey, ItemName, Unit, BarCode, Price FROM tItems Where (1>0) And ItemName Like '*12*' Order By ItemName DESC");
    ItemEditor editor(grid);
    editor.setDatabaseFolder(dir.path());
    struct Case {
        ItemsFilter filter;
        QStringList keys;
    };
    const Case cases[] = {
        {{-1, "", -1, 0, ""}, {"1", "2", "3", "4", "5", "6", "7", "8"}},
        {{1, "12", -1, 0, ""}, {"1", "8"}},  // anywhere in the name
        {{1, "*", -1, 0, ""}, {"2"}},
        {{1, "A?B", -1, 0, ""}, {"3"}},
        {{1, "#", -1, 0, ""}, {"7"}},
        {{1, "[", -1, 0, ""}, {"5"}},
        {{1, "O'Neil", -1, 0, ""}, {"6"}},
        {{1, "'; DROP TABLE tItems", -1, 0, ""}, {}},
        {{2, "629", -1, 0, ""}, {"3"}},
        {{0, "2", -1, 0, ""}, {"2"}},
        {{-1, "12", -1, 0, ""}, {"1", "2", "3", "4", "5", "6", "7", "8"}},  // no column: all
        {{-1, "", 2, 1, ""}, {"8", "7", "6", "4", "2", "1", "3", "5"}},  // barcode down, Null last
        {{-1, "", 0, 1, ""}, {"8", "7", "6", "5", "4", "3", "2", "1"}},
        {{-1, "", -1, 0, "6"}, {"6"}},
    };
    for (const Case& c : cases) {
        editor.show(c.filter);
        EXPECT_EQ(keys(editor), c.keys) << BuildEditItemsQuery(c.filter).toStdString();
    }
    EXPECT_EQ(stored("SELECT Count(*) FROM tItems"), QStringList{"8"});
}

TEST_F(TableEditorsTest, AlterKeyFiltersAreEqualitiesAndNarrowTogether) {
    EXPECT_EQ(
        BuildAlterKeysQuery({{{0, "C1"}, {1, ""}}, 2, 1}),
        "Select AccountKey, ItemKey, AlterNum, AlterBar From tAlterKeys Where (1>0) And AccountKey = 'C1' Order By AlterNum DESC, ItemKey");
    AlterKeyEditor editor(grid);
    editor.setDatabaseFolder(dir.path());
    struct Case {
        AlterKeysFilter filter;
        QStringList alterNums;
    };
    const Case cases[] = {
        {{}, {"Z9", "A1", "M5", "Q"}},
        {{{{0, "C1"}}}, {"Z9", "A1"}},
        {{{{0, "C1"}, {1, "2"}}}, {"A1"}},
        {{{{1, "1"}}}, {"Z9", "M5"}},
        {{{{0, "C"}}}, {}},  // no part of a value
        {{{{0, "O'K"}}}, {"Q"}},
        {{{}, 2, 0}, {"A1", "M5", "Q", "Z9"}},
        {{{{0, "C1"}}, 2, 1}, {"Z9", "A1"}},
    };
    for (const Case& c : cases) {
        editor.show(c.filter);
        EXPECT_EQ(keys(editor, 3), c.alterNums) << BuildAlterKeysQuery(c.filter).toStdString();
    }
}

TEST_F(TableEditorsTest, AlterKeyRowsAreAddedAloneAndGetTheirBarcode) {
    AlterKeyEditor editor(grid);
    editor.setDatabaseFolder(dir.path());
    editor.addRow();
    EXPECT_EQ(grid.recordSource(),
              "Select AccountKey, ItemKey, AlterNum, AlterBar From tAlterKeys Where (1<0)");
    EXPECT_EQ(keys(editor), QStringList{"?"});
    editor.write(0, 1, "C3");
    editor.addRow();  // the first row was overtyped, so a new one fits
    EXPECT_EQ(keys(editor), QStringList{"?"});
    EXPECT_THROW(editor.addRow(), jet::JetError);  // two "?" rows break the table's key

    editor.show(AlterKeysFilter{});
    editor.setAltBar({0, 1}, "");
    editor.setAltBar({0, 2}, "7290001");
    EXPECT_EQ(
        stored("SELECT AccountKey, ItemKey, AlterBar FROM tAlterKeys ORDER BY AccountKey, ItemKey"),
        QStringList(
            {"?|?|7290001", "C1|1|Null", "C1|2|7290001", "C2|1|Null", "C3|?|Null", "O'K|2|Null"}));
    editor.deleteRow(0);
    EXPECT_EQ(keys(editor), QStringList({"C1", "C1", "C2", "C3", "O'K"}));
    EXPECT_EQ(stored("SELECT Count(*) FROM tAlterKeys"), QStringList{"5"});
}

TEST_F(TableEditorsTest, AccountRowsAndTheirPriceListsAndLabelFiles) {
    AccountDefEditor editor(grid);
    editor.setDatabaseFolder(dir.path());
    editor.show();
    editor.addRow();
    EXPECT_THROW(editor.addRow(), jet::JetError);
    EXPECT_EQ(editor.rowCount(), 1);
    EXPECT_EQ(editor.value(0, 3).toString(), defaultLabelFile());
    editor.write(0, 3, "/labels/shelf.lbl");
    editor.write(0, 2, 4);
    EXPECT_EQ(stored("SELECT AccountKey, PriceList, LabelName FROM tAccountDef"),
              QStringList{"00000000|4|/labels/shelf.lbl"});

    // The drop-down keeps its entries when the source has no lists or fails, which is logged.
    const QString source = dir.filePath("host.db");
    etq::test::writeSqlSourceFile(source);
    ConnParams params = etq::test::sqlSourceParams(source);
    editor.FillPriceListColumn(params);
    const EntryList lists{{"מחירון בסיס", 1}, {"סיטונאי", 4}};
    EXPECT_EQ(editor.priceLists(), lists);
    params.driver = "No Such Driver";
    etq::test::LogCapture log;
    editor.FillPriceListColumn(params);
    EXPECT_EQ(editor.priceLists(), lists);
    EXPECT_TRUE(log.contains("etiquon.import: price lists from the SQL Server source:"));
    EXPECT_TRUE(log.contains("No Such Driver"));
}

}  // namespace
}  // namespace etq::dialogs::test

// The label query's text for the shapes the label tab can ask for, and the rows it gives on a
// real working database.
#include "print/label_query.h"

#include "card/print_adapters.h"
#include "print_fixture.h"
#include "surface/control_values.h"

namespace etq::print::test {
namespace {

const QString kHead =
    "SELECT tItems.ItemKey, tItems.ItemName, tItems.ItemSort, tItems.FName, tItems.BarCode, tItems.Local, tItems.Unit, tItems.Price, tItems.Coin, tCurrencies.WizSign AS CoinSign";
const QString kFrom = " FROM (tCurrencies INNER JOIN tItems ON tCurrencies.Currency = tItems.Coin)";

LabelQueryInput withSlots(std::initializer_list<int> slots, quint8 queryType = ItemLabels) {
    LabelQueryInput in;
    in.queryType = queryType;
    for (int s : slots)
        in.fieldChecks[size_t(s)] = true;
    return in;
}

LabelQueryInput allSlots(quint8 queryType) {
    LabelQueryInput in;
    in.queryType = queryType;
    in.fieldChecks.fill(true);
    return in;
}

TEST(LabelQueryText, PlainItemQueryIsHeadCopiesFromAndOrder) {
    LabelQueryInput in;
    EXPECT_EQ(BuildLabelQuery(in),
              kHead + ", tItems.Copies, '' As AccountLabel" + kFrom +
                  " WHERE (1 > 0) And tItems.PrintLabel = True ORDER BY tItems.Itemkey ASC");
    in.order = Descending;
    EXPECT_TRUE(BuildLabelQuery(in).endsWith(" ORDER BY tItems.Itemkey DESC"));
    in.order = 0;  // no direction word, the blank stays
    EXPECT_TRUE(BuildLabelQuery(in).endsWith(" ORDER BY tItems.Itemkey "));
}

TEST(LabelQueryText, AccountModeNeedsTheFlagAndAKey) {
    LabelQueryInput in = withSlots({9, 14, 15});
    in.useAccountKey = true;  // but no key: the forms without an account
    EXPECT_EQ(
        BuildLabelQuery(in),
        kHead +
            ", tItems.Copies, '' As AccountLabel, 'NoCode' AS CardCode, tItems.Price AS ListPrice, 'NoName' AS CardName" +
            kFrom + " WHERE (1 > 0) And tItems.PrintLabel = True ORDER BY tItems.Itemkey ASC");
    in.accountKey = "C1";
    const QString sql = BuildLabelQuery(in);
    EXPECT_TRUE(sql.contains(
        ", tItems.Copies, (Select LabelName From tAccountDef Where tAccountDef.AccountKey = 'C1') As AccountLabel, 'C1' As CardCode, (Select Price From tAccountDef, tPriceList Where tAccountDef.AccountKey = 'C1' And tPriceList.ItemKey = tItems.ItemKey And tPriceList.PriceList = tAccountDef.PriceList) As ListPrice, 'C1' As CardName FROM"));
    in.useAccountKey = false;  // a key without the flag: no account either
    EXPECT_TRUE(BuildLabelQuery(in).contains("'NoCode' AS CardCode"));
}

TEST(LabelQueryText, ItemRangeTakesEachBoundAlone) {
    EXPECT_EQ(ItemKeyRangeCondition("", ""), "");
    EXPECT_EQ(ItemKeyRangeCondition("100", ""), " And ItemKey >= '100'");
    EXPECT_EQ(ItemKeyRangeCondition("", "300"), " And ItemKey <= '300'");
    EXPECT_EQ(ItemKeyRangeCondition("100", "300"), " And ItemKey >= '100' And ItemKey <= '300'");
    EXPECT_EQ(ItemKeyRangeCondition("O'Neil", ""), " And ItemKey >= 'O''Neil'");
    LabelQueryInput in;
    in.fromItem = "100";
    EXPECT_TRUE(BuildLabelQuery(in).endsWith(
        " And tItems.PrintLabel = True And ItemKey >= '100' ORDER BY tItems.Itemkey ASC"));
}

TEST(LabelQueryText, SlotsFollowTheirFixedOrderWithTwelveBeforeEleven) {
    const QString sql = BuildLabelQuery(withSlots({11, 12, 40, 8, 0, 27, 31}));
    EXPECT_EQ(
        sql.mid(kHead.size(), sql.indexOf(" FROM") - kHead.size()),
        ", tItems.Copies, '' As AccountLabel, 'NoSerial' AS SerialNum, tItems.ItemKey As AlterKey, tItems.Price AS SpecialPrice, '' As CompName");
    EXPECT_LT(sql.indexOf("AS AlterKey", 0, Qt::CaseInsensitive), sql.indexOf("SpecialPrice"));
}

TEST(LabelQueryText, CompanyNameLosesQuotesAndCommas) {
    LabelQueryInput in = withSlots({40});
    in.companyName = "Cohen, \"Levi\" & Sons' Ltd";
    EXPECT_TRUE(BuildLabelQuery(in).contains(", 'Cohen Levi & Sons Ltd' As CompName FROM"));
}

TEST(LabelQueryText, DocumentLinesIgnoreAccountAndRange) {
    LabelQueryInput in = withSlots({9, 12}, DocumentLineLabels);
    in.useAccountKey = true;
    in.accountKey = "C1";
    in.fromItem = "100";
    in.toItem = "300";
    in.order = Descending;
    EXPECT_EQ(
        BuildLabelQuery(in),
        kHead +
            ", tTempDocHeaders.WizFileID, tTempDocHeaders.Number, tTempDocLines.Copies, (Select LabelName From tAccountDef Where tAccountDef.AccountKey = tTempDocHeaders.AccountKey) As AccountLabel, tTempDocHeaders.AccountKey As CardCode, (Select AlterNum From tAlterKeys Where AccountKey = tTempDocHeaders.AccountKey And ItemKey = tItems.ItemKey) AS AlterKey" +
            kFrom +
            " , tTempDocHeaders, tTempDocLines WHERE (1 > 0) And tTempDocLines.WizFileID = tTempDocHeaders.WizFileID And tTempDocLines.HeadNumber = tTempDocHeaders.Number And tItems.Itemkey = tTempDocLines.Itemkey And (tTempDocHeaders.Include = True) And (tTempDocLines.Include = True) ORDER BY tTempDocLines.WizFileID DESC, tTempDocLines.HeadNumber DESC, tTempDocLines.LineNum DESC");
}

TEST(LabelQueryText, SurfaceGivesTheLabelTabsValues) {
    MemorySurface surface;
    surface.control("ChkUseAccountKey").setValue(1);
    surface.control("txtAccountKey").setText("C1");
    surface.control("txtFromItem").setText("A");
    surface.control("ChkFldSend", 12).setValue(1);
    surface.control("ChkFldSend", 13).setValue(2);  // grey is not checked
    surface.control("OptPrinter", 1).setValue(true);
    const SurfaceValues values(surface);
    const LabelQueryInput in = readLabelQueryInput(values, ItemLabels, labelOrder(values));
    EXPECT_EQ(in.order, Descending);
    EXPECT_TRUE(in.useAccountKey);
    EXPECT_EQ(in.accountKey, "C1");
    EXPECT_EQ(in.fromItem, "A");
    EXPECT_TRUE(in.fieldChecks[12]);
    EXPECT_FALSE(in.fieldChecks[13]);
    surface.control("OptPrinter", 0).setValue(true);
    EXPECT_EQ(labelOrder(values), Ascending);
}

// The statements run on the working database of a real folder.
class LabelQueryRun : public PrintTest {
  protected:
    void SetUp() override {
        PrintTest::SetUp();
        addItems({{"100", "סבון", "7290000000015", 12.5, 2},
                  {"200", "מברשת", {}, 3, 1, false},
                  {"300", "משחה", {}, 4, 1, true, "XX"},  // no such currency
                  {"O'K", "גרש", {}, 5, 1}});
        work = jet::Database::open(workDb());
        work.execute("INSERT INTO tAlterKeys VALUES ('C''1', '100', 'A-100', 'ALT-BAR')");
        work.execute("INSERT INTO tAccountDef VALUES ('C''1', 2, 'c1.lbl', True)");
    }
    QStringList keys(const LabelQueryInput& in) {
        QStringList out;
        jet::Recordset rs = work.openRecordset(BuildLabelQuery(in));
        for (; !rs.eof(); rs.moveNext())
            out << rs.value("ItemKey").toString();
        return out;
    }
    jet::Database work;
};

TEST_F(LabelQueryRun, MarkedItemsWithAKnownCurrencyInOrder) {
    LabelQueryInput in;
    EXPECT_EQ(keys(in), QStringList({"100", "O'K"}));
    in.order = Descending;
    EXPECT_EQ(keys(in), QStringList({"O'K", "100"}));
    in.fromItem = "O'K";  // a quoted key narrows the range instead of breaking the statement
    EXPECT_EQ(keys(in), QStringList({"O'K"}));
}

TEST_F(LabelQueryRun, EverySlotRunsForBothQueryTypes) {
    LabelQueryInput items = allSlots(ItemLabels);
    items.useAccountKey = true;
    items.accountKey = "C'1";
    items.companyName = "Corvan";
    jet::Recordset rs = work.openRecordset(BuildLabelQuery(items));
    ASSERT_EQ(rs.recordCount(), 2);
    EXPECT_EQ(rs.value("AccountLabel").toString(), "c1.lbl");
    EXPECT_EQ(rs.value("AlterKey").toString(), "A-100");
    EXPECT_EQ(rs.value("CardCode").toString(), "C'1");
    EXPECT_EQ(rs.value("CoinSign").toString(), "₪");
    EXPECT_EQ(rs.value("CompName").toString(), "Corvan");
    // Item labels have no document line: these columns are there, and empty.
    for (const char* column : {"LineBar", "LineVNum", "LineLen1"})
        EXPECT_TRUE(rs.value(column).isNull()) << column;
    // Every slot's result column is in the row.
    for (const LabelFieldSlot& slot : labelFieldSlots())
        EXPECT_GE(rs.fieldIndex(slot.column.toString()), 0) << slot.slot;

    jet::Recordset lines = work.openRecordset(BuildLabelQuery(allSlots(DocumentLineLabels)));
    EXPECT_TRUE(lines.eof());  // no documents imported
    for (const LabelFieldSlot& slot : labelFieldSlots())
        EXPECT_GE(lines.fieldIndex(slot.column.toString()), 0) << slot.slot;
}

TEST_F(LabelQueryRun, DocumentLinesOfIncludedDocumentsWithTheirAccount) {
    work.execute(
        "INSERT INTO tTempDocHeaders (WizFileID, [Number], RecIndex, DocType, Reference1, AccountKey, Include, CardName, City) VALUES (1, 500, 0, 1, 7001, 'C''1', True, 'לקוח', 'חיפה'), (1, 501, 1, 1, 7002, 'C2', False, 'אחר', 'עכו')");
    work.execute(
        "INSERT INTO tTempDocLines (WizFileID, HeadNumber, LineNum, [Number], ItemKey, Copies, Include, SerialNum) VALUES (1, 500, 1, 0, '100', 3, True, 'SN1'), (1, 500, 2, 0, '999', 1, True, Null), (1, 500, 3, 0, 'O''K', 1, False, Null), (1, 501, 1, 1, '100', 1, True, Null)");
    LabelQueryInput in = allSlots(DocumentLineLabels);
    jet::Recordset rs = work.openRecordset(BuildLabelQuery(in));
    // Line 2's item is unknown, line 3 and document 501 are left out.
    ASSERT_EQ(rs.recordCount(), 1);
    EXPECT_EQ(rs.value("ItemKey").toString(), "100");
    EXPECT_EQ(rs.value("Copies").toInt(), 3);
    EXPECT_EQ(rs.value("CardCode").toString(), "C'1");
    EXPECT_EQ(rs.value("AccountLabel").toString(), "c1.lbl");
    EXPECT_EQ(rs.value("AlterKey").toString(), "A-100");
    EXPECT_EQ(rs.value("SerialNum").toString(), "SN1");
    EXPECT_EQ(rs.value("City").toString(), "חיפה");
    EXPECT_EQ(rs.value("SymbolHeb").toString(), "ת.מ");
}

}  // namespace
}  // namespace etq::print::test

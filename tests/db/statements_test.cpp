// Every statement the component runs, in its own dialect, against the real databases of a
// folder filled with a small set of items and documents: the rows each one returns.
#include "db_fixture.h"

namespace etq::db::test {
namespace {

class StatementsTest : public DbFolderTest {
  protected:
    void SetUp() override {
        DbFolderTest::SetUp();
        ASSERT_FALSE(createWork(true).isEmpty());
        work = jet::Database::open(path(kWorkDatabaseFile));
        // Items: 100 and 300 are marked, 300's currency has no row.
        work.execute(
            "INSERT INTO tCurrencies (Currency, [Desc], Sign, WizSign) VALUES ('$', 'Dollar', '$', 'USD')");
        work.execute(
            "INSERT INTO tItems (ItemKey, ItemName, Unit, BarCode, Coin, Price, Copies, PrintLabel, SuppCatNum, SalPackUN, PurPackUN) VALUES ('100', 'סבון', 'יח', '7290000000015', '¦', 12.5, 2, True, 'S-1', 1, 6), ('200', 'מברשת 12', 'יח', Null, '$', 3, 1, False, Null, 1, 1), ('300', 'משחה', Null, Null, 'XX', 4, 1, True, Null, 1, 1)");
        work.execute("INSERT INTO tAlterKeys VALUES ('C1', '100', 'A-100', 'ALT-BAR')");
        work.execute("INSERT INTO tAlterPrices VALUES ('C1', '100', 9.9, '¦')");
        work.execute("INSERT INTO tAccountDef VALUES ('C1', 2, 'c1.lbl', True)");
        work.execute("INSERT INTO tPriceList VALUES ('100', 2, 11, '¦')");
        work.execute("INSERT INTO tTransports VALUES (1, 'משלוחים'), (2, 'דואר')");
        work.execute(
            "INSERT INTO tTempDocHeaders (WizFileID, [Number], RecIndex, DocType, Reference1, DocDate, DocDueDate, AccountKey, Include, CardName, Address, City, StampNum, TrnspCode, TrnspName, Phone1) VALUES (1, 500, 0, 1, 7001, 45658, 45688, 'C1', True, 'לקוח א', 'הרצל 1', 'חיפה', '3', 1, 'משלוחים', '04-1'), (2, 600, 1, 2, 8001, 45660, Null, 'C2', False, 'לקוח ב', Null, 'יפו', '0', 1, 'משלוחים', Null), (1, 501, 2, 1, 7002, 45659, Null, 'C2', True, 'לקוח ב', 'יפו 2', 'עכו', '2 boxes', 2, 'דואר', Null)");
        work.execute(
            "INSERT INTO tTempDocLines (WizFileID, HeadNumber, LineNum, [Number], ItemKey, Quantity, Warehouse, Copies, Include, SerialNum) VALUES (1, 500, 1, 0, '100', 2, 1, 2, True, 'SN1'), (1, 500, 2, 0, '200', 1, 1, 1, True, Null), (1, 500, 3, 0, '999', 1, 1, 1, True, Null), (2, 600, 1, 1, '100', 5, 2, 5, True, Null), (1, 501, 1, 2, '100', 1, 1, 1, False, Null)");
    }
    QStringList q(const QString& sql) { return rows(work, sql); }
    jet::Database work;
};

TEST_F(StatementsTest, SavedQueriesOfTheWorkingDatabase) {
    EXPECT_EQ(q("qSelectDocHeaders"),
              QStringList({"תעודת משלוח|7001|01/01/25|C1|True|לקוח א|1|500",
                           "תעודת משלוח|7002|02/01/25|C2|True|לקוח ב|1|501",
                           "חשבונית מס|8001|03/01/25|C2|False|לקוח ב|2|600"}));
    // A line whose item is missing does not show.
    EXPECT_EQ(q("qSelectDocLines"),
              QStringList({"1|100|סבון|2|1|2|True", "2|200|מברשת 12|1|1|1|True",
                           "1|100|סבון|1|1|1|False", "1|100|סבון|5|2|5|True"}));
    EXPECT_EQ(q("Select * From tDocTypes Where Include Or IncludeDraft").size(), 2);
}

TEST_F(StatementsTest, FindCriteriaOfTheReaders) {
    jet::Recordset items = work.openRecordset("tItems");
    items.findFirst("ItemKey=\"200\"");
    EXPECT_EQ(items.value("Price").toDouble(), 3);
    jet::Recordset currencies = work.openRecordset("tCurrencies");
    currencies.findFirst("CURRENCY='$'");
    EXPECT_EQ(currencies.value("WizSign").toString(), "USD");
    currencies.findFirst("CURRENCY='EU'");
    EXPECT_TRUE(currencies.noMatch());
}

TEST_F(StatementsTest, ItemLabelQueries) {
    const QString head =
        "SELECT tItems.ItemKey, tItems.ItemName, tItems.ItemSort, tItems.FName, tItems.BarCode, tItems.Local, tItems.Unit, tItems.Price, tItems.Coin, tCurrencies.WizSign AS CoinSign";
    const QString from =
        " FROM (tCurrencies INNER JOIN tItems ON tCurrencies.Currency = tItems.Coin)";
    // No slot, no account, no range: the marked items whose currency is known.
    EXPECT_EQ(q(head + ", tItems.Copies, '' As AccountLabel" + from +
                " WHERE (1 > 0) And tItems.PrintLabel = True ORDER BY tItems.Itemkey ASC"),
              QStringList({"100|סבון|Null|Null|7290000000015|Null|יח|12.5|¦|₪|2|"}));
    // Account mode with the account's slots, a range, descending.
    const QString account =
        head +
        ", tItems.Copies, (Select LabelName From tAccountDef Where tAccountDef.AccountKey = 'C1') As AccountLabel, 'C1' As CardCode, (Select AlterNum From tAlterKeys Where AccountKey = 'C1' And ItemKey = tItems.ItemKey) AS AlterKey, (Select Price From tAlterPrices Where AccountKey = 'C1' And ItemKey = tItems.ItemKey) AS SpecialPrice, (Select AlterBar From tAlterKeys Where AccountKey = 'C1' And ItemKey = tItems.ItemKey) AS AlterBar, (Select Price From tAccountDef, tPriceList Where tAccountDef.AccountKey = 'C1' And tPriceList.ItemKey = tItems.ItemKey And tPriceList.PriceList = tAccountDef.PriceList) As ListPrice, 'C1' As CardName, 1 AS PackStart, tItems.SuppCatNum, tItems.PurPackUn AS PPackUn, 'Corvan Information Systems' As CompName" +
        from +
        " WHERE (1 > 0) And tItems.PrintLabel = True And ItemKey >= '100' And ItemKey <= '300' ORDER BY tItems.Itemkey DESC";
    jet::Recordset rs = work.openRecordset(account);
    ASSERT_EQ(rs.recordCount(), 1);
    EXPECT_EQ(rs.value("AccountLabel").toString(), "c1.lbl");
    EXPECT_EQ(rs.value("AlterKey").toString(), "A-100");
    EXPECT_EQ(rs.value("SpecialPrice").toDouble(), 9.9);
    EXPECT_EQ(rs.value("AlterBar").toString(), "ALT-BAR");
    EXPECT_EQ(rs.value("ListPrice").toDouble(), 11);
    EXPECT_EQ(rs.value("CardName").toString(), "C1");
    EXPECT_EQ(rs.value("PPackUn").toDouble(), 6);
    EXPECT_EQ(rs.value("CompName").toString(), "Corvan Information Systems");
}

TEST_F(StatementsTest, DocumentLineLabelQuery) {
    const QString sql =
        "SELECT tItems.ItemKey, tItems.ItemName, tItems.ItemSort, tItems.FName, tItems.BarCode, tItems.Local, tItems.Unit, tItems.Price, tItems.Coin, tCurrencies.WizSign AS CoinSign, tTempDocHeaders.WizFileID, tTempDocHeaders.Number, tTempDocLines.Copies, (Select LabelName From tAccountDef Where tAccountDef.AccountKey = tTempDocHeaders.AccountKey) As AccountLabel, tTempDocLines.SerialNum, tTempDocHeaders.Reference1, (Select AlterNum From tAlterKeys Where AccountKey = tTempDocHeaders.AccountKey And ItemKey = tItems.ItemKey) AS AlterKey, (Select Price From tAlterPrices Where AccountKey = tTempDocHeaders.AccountKey And ItemKey = tItems.ItemKey) AS SpecialPrice, (Select Price From tAccountDef, tPriceList Where tAccountDef.AccountKey = tTempDocHeaders.AccountKey And tPriceList.ItemKey = tTempDocLines.ItemKey And tPriceList.PriceList = tAccountDef.PriceList) As ListPrice, (Select SymbolHeb From tWizFiles Where WizFileID = tTempDocHeaders.WizFileID) AS SymbolHeb, tTempDocHeaders.DocDueDate, tTempDocLines.CodeBars AS LineBar FROM (tCurrencies INNER JOIN tItems ON tCurrencies.Currency = tItems.Coin) , tTempDocHeaders, tTempDocLines WHERE (1 > 0) And tTempDocLines.WizFileID = tTempDocHeaders.WizFileID And tTempDocLines.HeadNumber = tTempDocHeaders.Number And tItems.Itemkey = tTempDocLines.Itemkey And (tTempDocHeaders.Include = True) And (tTempDocLines.Include = True) ORDER BY tTempDocLines.WizFileID DESC, tTempDocLines.HeadNumber DESC, tTempDocLines.LineNum DESC";
    jet::Recordset rs = work.openRecordset(sql);
    // Document 600 is not included, line 3's item is missing, 501's line is left out.
    ASSERT_EQ(rs.recordCount(), 2);
    EXPECT_EQ(rs.value("ItemKey").toString(), "200");
    rs.moveNext();
    EXPECT_EQ(rs.value("SerialNum").toString(), "SN1");
    EXPECT_EQ(rs.value("AccountLabel").toString(), "c1.lbl");
    EXPECT_EQ(rs.value("SpecialPrice").toDouble(), 9.9);
    EXPECT_EQ(rs.value("ListPrice").toDouble(), 11);
    EXPECT_EQ(rs.value("SymbolHeb").toString(), "ת.מ");
    EXPECT_EQ(vb::format(rs.value("DocDueDate"), "dd/mm/yy"), "31/01/25");
    EXPECT_TRUE(rs.value("LineBar").isNull());
}

TEST_F(StatementsTest, SelectionAndEditorQueries) {
    jet::Database items = jet::Database::open(path(kItemDatabaseFile));
    EXPECT_EQ(
        rows(
            items,
            "SELECT ItemKey, PrintLabel, Copies, ItemName FROM tItems WHERE (1 > 0) And PrintLabel = True And ItemKey >= '100' ORDER BY tItems.PrintLabel, tItems.Itemkey DESC"),
        QStringList({"300|True|1|משחה", "100|True|2|סבון"}));
    EXPECT_EQ(
        rows(
            items,
            "SELECT ItemKey, PrintLabel, Copies, ItemName FROM tItems WHERE (1 > 0) ORDER BY tItems.ItemName ASC")
            .first(),
        "200|False|1|מברשת 12");
    EXPECT_EQ(
        rows(
            items,
            "SELECT ItemKey, ItemName, Unit, BarCode, Price FROM tItems Where (1>0) And ItemName Like '*12*' Order By ItemName DESC"),
        QStringList({"200|מברשת 12|יח|Null|3"}));
    EXPECT_EQ(
        rows(
            items,
            "Select AccountKey, ItemKey, AlterNum, AlterBar From tAlterKeys Where (1>0) And AccountKey = 'C1' And ItemKey = '100' Order By ItemKey DESC, ItemKey"),
        QStringList({"C1|100|A-100|ALT-BAR"}));
    EXPECT_TRUE(
        rows(items, "Select AccountKey, ItemKey, AlterNum, AlterBar From tAlterKeys Where (1<0)")
            .isEmpty());
    EXPECT_EQ(rows(items, "Select AccountKey,PriceList,LabelName From tAccountDef"),
              QStringList({"C1|2|c1.lbl"}));
    EXPECT_EQ(
        q("SELECT tTempDocLines.LineNum, tTempDocLines.ItemKey, tItems.ItemName, tTempDocLines.Quantity, tTempDocLines.Warehouse, tTempDocLines.Copies, tTempDocLines.Include FROM (tTempDocLines Inner Join tItems On tItems.ItemKey = tTempDocLines.ItemKey) Where WizFileID=1 And HeadNumber=500 ORDER BY tTempDocLines.HeadNumber, tTempDocLines.LineNum"),
        QStringList({"1|100|סבון|2|1|2|True", "2|200|מברשת 12|1|1|1|True"}));
}

TEST_F(StatementsTest, DeliveryLogStatements) {
    const QString addToLog =
        "INSERT INTO tStockLog ( WizFileID, [Number], DocType, Reference1, DocDate, LogDate, TrnspCode, Boxes, ShipOrder ) SELECT tTempDocHeaders.WizFileID, tTempDocHeaders.Number, tTempDocHeaders.DocType, tTempDocHeaders.Reference1, tTempDocHeaders.DocDate, Date() AS Expr1, tTempDocHeaders.TrnspCode, Val([StampNum]) AS Expr2, 0 AS Expr3 FROM tTempDocHeaders WHERE tTempDocHeaders.Include And tTempDocHeaders.TrnspCode > -1 And Val(tTempDocHeaders.StampNum) > 0";
    const QString route =
        "SELECT tTempDocHeaders.TrnspCode, tTempDocHeaders.TrnspName, tTempDocHeaders.AccountKey, tTempDocHeaders.CardName, tTempDocHeaders.Address, tTempDocHeaders.Phone1, tTempDocHeaders.City, Sum(Val(tTempDocHeaders.StampNum)) As TotalPacks FROM (tTempDocHeaders INNER JOIN tDocTypes ON tTempDocHeaders.DocType = tDocTypes.DocType) LEFT JOIN tStockLog ON (tTempDocHeaders.Number = tStockLog.Number) AND (tTempDocHeaders.WizFileID = tStockLog.WizFileID) Where (tTempDocHeaders.Include) And (tTempDocHeaders.TrnspCode > -1) And (tStockLog.Number Is Null) And Val(tTempDocHeaders.StampNum) > 0 GROUP BY tTempDocHeaders.TrnspCode, tTempDocHeaders.TrnspName, tTempDocHeaders.AccountKey, tTempDocHeaders.CardName, tTempDocHeaders.Address, tTempDocHeaders.Phone1, tTempDocHeaders.City ORDER BY tTempDocHeaders.TrnspCode, tTempDocHeaders.City, tTempDocHeaders.Address, tTempDocHeaders.CardName";
    EXPECT_EQ(q(route), QStringList({"1|משלוחים|C1|לקוח א|הרצל 1|04-1|חיפה|3",
                                     "2|דואר|C2|לקוח ב|יפו 2|Null|עכו|2"}));
    EXPECT_EQ(work.execute(addToLog), 2);
    EXPECT_EQ(work.execute(addToLog), 0);  // logged documents are skipped
    EXPECT_TRUE(q(route).isEmpty());
    const QString today = vb::toText(vb::dateFromSerial(vb::today()));
    EXPECT_EQ(
        q("SELECT tStockLog.DocDate, tStockLog.TrnspCode, tTransports.TrnspName, tDocTypes.DocDesc, tStockLog.Reference1, tStockLog.Boxes FROM tStockLog, tDocTypes, tTransports Where tDocTypes.DocType = tStockLog.DocType And tTransports.TrnspCode = tStockLog.TrnspCode And tStockLog.DocDate >= 45659 ORDER BY tStockLog.TrnspCode, tStockLog.DocDate"),
        QStringList({"02/01/2025|2|דואר|תעודת משלוח|7002|2"}));
    const QString logEditor =
        "SELECT tDocTypes.DocDesc, tStockLog.LogDate, tStockLog.DocDate, tStockLog.Reference1, tTransports.TrnspName FROM (tStockLog INNER JOIN tDocTypes ON tStockLog.DocType = tDocTypes.DocType) INNER JOIN tTransports ON tTransports.TrnspCode = tStockLog.TrnspCode ORDER BY tStockLog.LogDate";
    EXPECT_EQ(q(logEditor), QStringList({"תעודת משלוח|" + today + "|01/01/2025|7001|משלוחים",
                                         "תעודת משלוח|" + today + "|02/01/2025|7002|דואר"}));
    // Deleting a row of the editor's join removes the log entry: the document is back on the route.
    jet::Recordset rs = work.openRecordset(logEditor);
    rs.deleteRecord();
    EXPECT_EQ(q(route).size(), 1);
}

}  // namespace
}  // namespace etq::db::test

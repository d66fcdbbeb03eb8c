// The SQL dialect of the component, run against real tables: what each construct returns.
#include "jet/sql_translator.h"
#include "jet/vb.h"
#include "jet_fixture.h"

namespace etq::jet::test {
namespace {

class DialectTest : public JetTest {
  protected:
    void SetUp() override {
        db = create("a.kdb");
        db.createTable(
            {"tItems",
             {text("ItemKey", 20), text("ItemName", 100), field("PrintLabel", FieldType::Boolean),
              field("Price", FieldType::Double), text("Coin", 3)},
             {"ItemKey"}});
        db.execute(
            "INSERT INTO tItems VALUES ('1', 'Soap', True, 12.5, '¦'), ('2', 'Brush', False, 3, Null), ('3', Null, False, Null, '$')");
    }
    QStringList q(const QString& sql) { return rows(db, sql); }
    Database db;
};

TEST_F(DialectTest, PlusJoinsTextsAndNullSpreads) {
    EXPECT_EQ(
        q("SELECT (ItemName + '') AS N, ItemName + ' ' + Coin AS C, Price + 1 AS P FROM tItems ORDER BY ItemKey"),
        QStringList({"Soap|Soap ¦|13.5", "Brush|Null|4", "Null|Null|Null"}));
    EXPECT_EQ(q("SELECT '1' + 2, 'a' & Null & 1"), QStringList({"3|a1"}));
}

TEST_F(DialectTest, ValReadsALeadingNumber) {
    EXPECT_EQ(
        q("SELECT Val('12abc'), Val(' 1 2 '), Val(Null), Val('&H1F'), Val('abc'), Val('-3.5e1x'), Val([ItemName]) FROM tItems WHERE ItemKey = '3'"),
        QStringList({"12|12|0|31|0|-35|0"}));
}

TEST_F(DialectTest, FormatDateAndLike) {
    const qint64 today = qint64(vb::today());
    EXPECT_EQ(
        q("SELECT Format$(45658,'dd/mm/yy'), Format$(12.5,'0.00'), Format(100/6,'00.0'), Format$(100/12,'00.0'), Format$(100/1,'00.0'), Date()"),
        QStringList({QString("01/01/25|12.50|16.7|08.3|100.0|%1").arg(today)}));
    EXPECT_EQ(
        q("SELECT ItemKey FROM tItems WHERE ItemName Like 's*' OR ItemName Like '?RUSH' ORDER BY ItemKey"),
        QStringList({"1", "2"}));
    EXPECT_EQ(q("SELECT ItemKey FROM tItems WHERE ItemName Not Like '*o*'"), QStringList({"2"}));
    EXPECT_EQ(q("SELECT ItemKey FROM tItems WHERE ItemName Like '*[bc]*'"), QStringList({"2"}));
}

TEST_F(DialectTest, LiteralsNamesAndTrueFalse) {
    EXPECT_EQ(q("SELECT [ItemKey], \"it's\" AS [A Name] FROM tItems WHERE PrintLabel = True"),
              QStringList({"1|it's"}));
    EXPECT_EQ(q("SELECT Count(*) FROM tItems WHERE PrintLabel = False AND ItemKey <> \"2\""),
              QStringList({"1"}));
    EXPECT_EQ(
        q("SELECT ItemKey FROM tItems WHERE ItemName Is Null Or Price Between 3 And 4 ORDER BY ItemKey"),
        QStringList({"2", "3"}));
    EXPECT_EQ(
        q("SELECT IIf(PrintLabel, 'yes', 'no'), Nz(ItemName, '-') FROM tItems ORDER BY ItemKey DESC"),
        QStringList({"no|-", "no|Brush", "yes|Soap"}));
    // An unnamed expression is named as the engine names it.
    Recordset rs = db.openRecordset("SELECT ItemKey, Price * 2 FROM tItems");
    EXPECT_EQ(rs.fieldName(1), "Expr1001");
    EXPECT_JET_ERROR(err::kSyntax, q("SELECT FROM tItems"));
    EXPECT_JET_ERROR(err::kSyntax, q("SELECT 'open"));
}

TEST_F(DialectTest, DeleteStarEmptiesATable) {
    EXPECT_EQ(db.execute("DELETE * FROM tItems WHERE Coin = '$'"), 1);
    EXPECT_EQ(db.execute("Delete * From tItems"), 2);
    EXPECT_TRUE(q("SELECT * FROM tItems").isEmpty());
}

TEST_F(DialectTest, OuterJoinUpdateUpdatesMatchesAndAddsTheMissing) {
    db.createTable({"tPrices",
                    {text("ItemKey", 20), field("PriceList", FieldType::Integer),
                     field("Price", FieldType::Double), text("Currency", 3)},
                    {"ItemKey", "PriceList"}});
    db.createTable({"tStage",
                    {text("ItemKey", 20), field("PriceList", FieldType::Integer),
                     field("Price", FieldType::Double), text("Currency", 3)},
                    {"ItemKey", "PriceList"}});
    db.execute("INSERT INTO tPrices VALUES ('1', 1, 10, '$'), ('1', 2, 20, '$')");
    db.execute("INSERT INTO tStage VALUES ('1', 1, 11, 'EU'), ('2', 1, 5, '¦'), ('2', 11, 7, '¦')");
    const QString merge =
        "UPDATE tStage LEFT JOIN tPrices ON (tStage.ItemKey = tPrices.ItemKey) AND (tStage.PriceList = tPrices.PriceList) SET tPrices.ItemKey = tStage.ItemKey, tPrices.PriceList = tStage.PriceList, tPrices.Price = tStage.Price, tPrices.Currency = tStage.Currency";
    EXPECT_EQ(db.execute(merge + " Where tStage.PriceList = 1"), 2);
    EXPECT_EQ(
        q("SELECT ItemKey, PriceList, Price, Currency FROM tPrices ORDER BY ItemKey, PriceList"),
        QStringList({"1|1|11|EU", "1|2|20|$", "2|1|5|¦"}));
    EXPECT_EQ(db.execute(merge + " Where tStage.PriceList = 3"), 0);
}

TEST_F(DialectTest, InnerJoinUpdateWritesTheNamedTable) {
    db.createTable({"tMarks", {text("ItemKey", 20)}, {"ItemKey"}});
    db.execute("INSERT INTO tMarks VALUES ('2')");
    db.execute(
        "UPDATE tItems INNER JOIN tMarks ON tItems.ItemKey = tMarks.ItemKey SET tItems.PrintLabel = True");
    EXPECT_EQ(q("SELECT ItemKey FROM tItems WHERE PrintLabel ORDER BY ItemKey"),
              QStringList({"1", "2"}));
}

TEST(DialectTranslation, LiteralsBecomeParametersForCriteria) {
    sql::Options options;
    options.parameterizeLiterals = true;
    const sql::Translation t = sql::translateCriterion("ItemKey=\"a\"\"b\"", options);
    EXPECT_EQ(t.sql, "(\"ItemKey\" = ?1)");
    ASSERT_EQ(t.parameters.size(), 1);
    EXPECT_EQ(t.parameters[0].literal.toString(), "a\"b");
}

}  // namespace
}  // namespace etq::jet::test

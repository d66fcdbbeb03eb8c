#include "import/host_lists.h"

#include "import_fixture.h"

namespace etq::test {
namespace {

using demo::CurrencyRecord;
using demo::ItemGroupRecord;
using demo::SpecialPriceRecord;

class HostListsTest : public ImportTest {
  protected:
    QStringList entries(const char* combo) const {
        const ControlRef c = surface.control(combo);
        QStringList out;
        for (int i = 0; i < c.listCount(); ++i)
            out << c.listItem(i) + u'=' + QString::number(c.itemData(i));
        return out;
    }
    QStringList currencies() const {
        return rows(db::kDocDatabaseFile,
                    "SELECT Currency, [Desc], Sign, WizSign FROM tCurrencies ORDER BY Currency");
    }
};

TEST_F(HostListsTest, CombosTakeNamedRecordsWithTheirNumbers) {
    surface.control("cmbItmBelong").addItem("old", 99);
    FillCmbItmBelong(surface, context);  // no oitb.dbf: the combo keeps its entries
    EXPECT_EQ(entries("cmbItmBelong"), QStringList{"old=99"});

    ItemGroupRecord deleted{3, "gone"};
    deleted.deleted = true;
    write("oitb.dbf",
          QList<ItemGroupRecord>{{1, QStringLiteral("מוצרי חלב")}, {2, "  "}, deleted, {14, "x"}});
    write("oitg.dbf", QList<demo::PropertyGroupRecord>{{8, "kosher"}});
    write("opln.dbf", QList<demo::PriceListRecord>{{1, "base"}, {10, "vip"}});
    FillCmbItmBelong(surface, context);
    FillCmbItmQGrp(surface, context);
    FillCmbPrice(surface, context);
    EXPECT_EQ(entries("cmbItmBelong"), (QStringList{QStringLiteral("מוצרי חלב=1"), "x=14"}));
    EXPECT_EQ(entries("cmbItmQGrp"), QStringList{"kosher=8"});
    EXPECT_EQ(entries("cmbPriceField"), (QStringList{"base=1", "vip=10"}));
    EXPECT_TRUE(messages.shown.isEmpty());

    // A damaged file is told, and the combo keeps what it had.
    QFile::resize(company() + "/opln.dbf", 40);
    FillCmbPrice(surface, context);
    EXPECT_EQ(entries("cmbPriceField"), (QStringList{"base=1", "vip=10"}));
    ASSERT_EQ(messages.shown.size(), 1);
    EXPECT_TRUE(messages.shown[0].text.contains("opln.dbf"));
}

TEST_F(HostListsTest, CurrenciesAreAddedOrEditedAndTheLocalOneShowsTheShekelSign) {
    EXPECT_FALSE(
        ReadCoinsMNHL(surface, context, company(), path(db::kDocDatabaseFile)));  // no ocrn.dbf
    // The delivered file holds the local currency; its blank description is kept.
    write("ocrn.dbf",
          QList<CurrencyRecord>{
              {QStringLiteral("¦"), "", "x", ""}, {"$", "dollar", "USD", "$"}, {"A'", "", "", ""}});
    ASSERT_TRUE(ReadCoinsMNHL(surface, context, company(), path(db::kDocDatabaseFile)));
    const QStringList expected{"$|dollar|$|USD", "A'|Null|Null|Null",
                               QStringLiteral("¦|שקל חדש|₪|₪")};
    EXPECT_EQ(currencies(), expected);
    ASSERT_TRUE(ReadCoinsMNHL(surface, context, company(), path(db::kDocDatabaseFile)));
    EXPECT_EQ(currencies(), expected);
    EXPECT_TRUE(messages.shown.isEmpty());
}

TEST_F(HostListsTest, SpecialPricesAreStagedOncePerAccountAndItem) {
    const QString temp = prepareTempDatabase();
    SpecialPriceRecord deleted{"D", "20001", {100, {}}};
    deleted.deleted = true;
    write("ospp.dbf", QList<SpecialPriceRecord>{{"AB\"C", "20001", {1250, {}}},
                                                {"X", " ", {100, {}}},
                                                {" ", "20001", {100, {}}},
                                                deleted,
                                                {"AB\"C", "20002", {-99, "$"}},
                                                {"AB\"C", "20001", {7, {}}}});
    ASSERT_TRUE(ReadSpecialPriceMNHL(surface, context, company(), temp, {}, {}));
    EXPECT_EQ(
        rows(db::kTempItemDatabaseFile,
             "SELECT AccountKey, ItemKey, Price, Coin FROM tTempAlterPrices ORDER BY AccountKey"),
        (QStringList{"20001|AB'C|12.5|Null", "20002|AB'C|-0.99|$"}));
    EXPECT_TRUE(messages.shown.isEmpty());
    // Six records, the bar moving at the fifth.
    EXPECT_EQ(widths, (QList<int>{0, 500, 0}));
}

}  // namespace
}  // namespace etq::test

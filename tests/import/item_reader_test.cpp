#include "import/item_reader.h"

#include <QtEndian>

#include "import_fixture.h"

namespace etq::test {
namespace {

using demo::ItemRecord;

class ItemReaderTest : public ImportTest {
  protected:
    bool read(qint16 foreign = 0, qint16 copies = 1, qint16 priceField = 1,
              bool priceLists = false) {
        return ReadItemMNHL(surface, context, company(), temp, {}, {}, foreign, copies, priceField,
                            true, false, priceLists);
    }
    QStringList items(const QString& fields = "ItemKey") const {
        return rows(db::kItemDatabaseFile, "SELECT " + fields + " FROM tItems ORDER BY ItemKey");
    }
    // Chooses the query group rule: bit `bit` (from oitg), cmbItmQGrpBy at `by`.
    void chooseQueryGroup(int bit, int by) {
        surface.control("chkItmQGrp").setValue(1);
        surface.control("cmbItmQGrp").addItem("group", bit);
        surface.control("cmbItmQGrp").setListIndex(0);
        surface.control("cmbItmQGrpBy").setListIndex(by);
    }

    void SetUp() override {
        ImportTest::SetUp();
        temp = prepareTempDatabase();
    }
    QString temp;
};

TEST_F(ItemReaderTest, WritesEveryFieldAndUpdatesOnTheNextRead) {
    ItemRecord milk = item("10023", QStringLiteral("חלב 3%"), 1999);
    milk.foreignName = "Milk";
    milk.group = "12";
    milk.barcode = "7290000066318";
    milk.supplierCatalogNumber = "S-77";
    milk.unit = QStringLiteral("ליטר");
    milk.prices[1] = {-250, "$"};
    ItemRecord bare = item("20", "");  // no names, no group: those fields stay null
    write("oitm.dbf", QList{milk, bare});
    ASSERT_TRUE(read(0, 3));
    EXPECT_EQ(
        items(
            "ItemKey, ItemName, Fname, ItemSort, Unit, BarCode, SuppCatNum, Copies, Price, Coin, SalPackUN, PurPackUN, IgnoreInDoc"),
        (QStringList{
            QStringLiteral("10023|חלב 3%|Milk|12|ליטר|7290000066318|S-77|3|19.99|¦|1|1|Null"),
            "20|Null|Null|Null|Null|Null|Null|3|0|¦|1|1|Null"}));

    // Price 2 in dollars; a blank barcode keeps the stored one; foreign names replace names,
    // a blank foreign name leaves the stored name.
    milk.barcode.clear();
    milk.name = "changed";
    write("oitm.dbf", QList{milk, bare, item("30", "new")});
    ASSERT_TRUE(read(-1, 1, 2));
    EXPECT_EQ(
        items("ItemKey, ItemName, BarCode, Price, Coin"),
        (QStringList{"10023|Milk|7290000066318|-2.5|$", "20|Null|Null|0|¦", "30|Null|Null|0|¦"}));
    EXPECT_TRUE(messages.shown.isEmpty());
}

TEST_F(ItemReaderTest, KeyRangeComparesByCharacterCodesAndQuotesBecomeApostrophes) {
    ItemRecord blank = item("   ");
    ItemRecord deleted = item("150");
    deleted.deleted = true;
    write("oitm.dbf", QList{item("099"), item("100"), item("2"), blank, deleted, item("A\"B"),
                            item("O'Neil"), item("1000")});
    surface.control("txtFromItemKey").setText(" 100 ");
    ASSERT_TRUE(read());
    EXPECT_EQ(items(), (QStringList{"100", "1000", "2", "A'B", "O'Neil"}));
    surface.control("txtFromItemKey").setText("");
    surface.control("txtToItemKey").setText("1000");
    ASSERT_TRUE(read());
    const QStringList all{"099", "100", "1000", "2", "A'B", "O'Neil"};
    EXPECT_EQ(items(), all);
    // The keys are found again: no duplicates, no broken criteria.
    surface.control("txtToItemKey").setText("");
    ASSERT_TRUE(read());
    EXPECT_EQ(items(), all);
    EXPECT_TRUE(messages.shown.isEmpty());
    // Eight records, the bar moving at the fifth, then emptied; the deleted record counts.
    EXPECT_EQ(widths.mid(0, 3), (QList<int>{0, 375, 0}));
}

TEST_F(ItemReaderTest, GroupFilterAndQueryGroupRule) {
    ItemRecord a = item("A"), b = item("B"), c = item("C"), d = item("D");
    a.group = "4";
    b.group = "5";
    a.queryGroups = "4";  // bit 3 set
    c.queryGroups = "3";  // bit 3 clear
    write("oitm.dbf", QList{a, b, c, d});
    surface.control("chkItmBelong").setValue(1);
    surface.control("cmbItmBelong").addItem("group 4", 4);
    surface.control("cmbItmBelong").setListIndex(0);
    chooseQueryGroup(3, 1);
    ASSERT_TRUE(read());
    // B is of another group; D has no group and passes, and has no query groups to judge.
    EXPECT_EQ(items("ItemKey, IgnoreInDoc"), (QStringList{"A|True", "C|False", "D|Null"}));
    surface.control("cmbItmQGrpBy").setListIndex(0);
    ASSERT_TRUE(read());
    EXPECT_EQ(items("ItemKey, IgnoreInDoc"), (QStringList{"A|False", "C|True", "D|Null"}));
}

TEST_F(ItemReaderTest, StagesNonZeroPricesOfAllListsOnlyWhenAsked) {
    ItemRecord a = item("A", "a", 1000);
    a.prices[3] = {360, "$"};
    a.prices[9] = {50, {}};
    write("oitm.dbf", QList{a, item("B", "b", 0), a});  // A twice: its rows are staged once
    ASSERT_TRUE(read());
    const QString staged = "SELECT ItemKey, PriceList, Price, Currency FROM tTempPriceList";
    EXPECT_TRUE(rows(db::kTempItemDatabaseFile, staged).isEmpty());
    ASSERT_TRUE(read(0, 1, 1, true));
    EXPECT_EQ(rows(db::kTempItemDatabaseFile, staged + " ORDER BY PriceList"),
              (QStringList{"A|1|10|¦", "A|4|3.6|$", "A|10|0.5|¦"}));
    EXPECT_TRUE(messages.shown.isEmpty());
}

TEST_F(ItemReaderTest, FailuresAreReportedAndKeepWhatWasWritten) {
    // No file: false, nothing said.
    EXPECT_FALSE(read());
    EXPECT_TRUE(messages.shown.isEmpty());

    ItemRecord bad = item("B");
    bad.group = "x7";
    write("oitm.dbf", QList{item("A"), bad, item("C")});
    EXPECT_FALSE(read());
    ASSERT_EQ(messages.shown.size(), 1);
    EXPECT_TRUE(messages.shown[0].text.contains("oitm.dbf, record 2"))
        << messages.shown[0].text.toStdString();
    EXPECT_EQ(messages.shown[0].icon, MsgIcon::Critical);
    EXPECT_EQ(items(), QStringList{"A"});

    for (qint16 copies : {256, -1})
        EXPECT_FALSE(read(0, copies));  // Copies is a Byte
    EXPECT_FALSE(read(0, 1, 11));       // there are ten prices
    EXPECT_TRUE(messages.shown.last().text.contains("Price field 11"));
    EXPECT_EQ(messages.shown.size(), 4);
    EXPECT_EQ(items("ItemKey, Copies"), QStringList{"A|1"});
}

// Damaged files: every one is a clear message naming the file, never a crash.
TEST_F(ItemReaderTest, DamagedItemFilesFailCleanly) {
    const QString file = company() + "/oitm.dbf";
    auto damage = [&](const std::function<void(QByteArray&)>& how) {
        write("oitm.dbf", QList{item("A"), item("B")});
        QFile f(file);
        ASSERT_TRUE(f.open(QIODevice::ReadOnly));
        QByteArray bytes = f.readAll();
        f.close();
        how(bytes);
        ASSERT_TRUE(f.open(QIODevice::WriteOnly | QIODevice::Truncate));
        f.write(bytes);
    };
    const std::function<void(QByteArray&)> damages[] = {
        [](QByteArray& b) { b.chop(500); },                                    // truncated
        [](QByteArray& b) { qToLittleEndian<quint32>(9, b.data() + 4); },      // more records
        [](QByteArray& b) { qToLittleEndian<quint16>(60000, b.data() + 8); },  // header
        [](QByteArray& b) { qToLittleEndian<quint16>(200, b.data() + 10); },   // short records
        [](QByteArray& b) { b.truncate(20); },
        [](QByteArray& b) {  // header a byte long: every field would shift by one
            qToLittleEndian<quint16>(qFromLittleEndian<quint16>(b.data() + 8) + 1, b.data() + 8);
        },
    };
    for (const auto& how : damages) {
        damage(how);
        messages.shown.clear();
        EXPECT_FALSE(read());
        ASSERT_EQ(messages.shown.size(), 1);
        EXPECT_TRUE(messages.shown[0].text.contains(file)) << messages.shown[0].text.toStdString();
    }
    EXPECT_TRUE(items().isEmpty());
}

}  // namespace
}  // namespace etq::test

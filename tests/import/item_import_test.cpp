#include "import/item_import.h"

#include <QProcess>

#include "card/card_controller.h"
#include "card/component.h"
#include "import_fixture.h"
#include "platform/captions.h"
#include "samples/demo_company.h"

namespace etq::test {
namespace {

using demo::ItemRecord;
using demo::SpecialPriceRecord;

class ItemImportTest : public ImportTest {
  protected:
    void SetUp() override {
        ImportTest::SetUp();
        surface.control("cmbPriceField").addItem("base", 1);
        surface.control("cmbPriceField").setListIndex(0);
        surface.control("txtCopies").setText("2");
        ItemRecord a = item("A", "a", 1000);
        a.prices[1] = {900, "$"};
        write("oitm.dbf", QList{a, item("B", "b", 250)});
        write("ocrn.dbf", QList<demo::CurrencyRecord>{{"$", "dollar", "USD", "$"}});
        write("ospp.dbf", QList<SpecialPriceRecord>{{"A", "20001", {800, {}}}});
    }
    void check(const char* box) { surface.control(box).setValue(1); }
    QStringList table(const QString& sql) const { return rows(db::kItemDatabaseFile, sql); }
    const QString kItems = "SELECT ItemKey, Price, Copies FROM tItems ORDER BY ItemKey";
    const QString kPriceLists = "SELECT ItemKey, PriceList, Price FROM tPriceList";
    const QString kSpecialPrices = "SELECT AccountKey, ItemKey, Price FROM tAlterPrices";
};

TEST_F(ItemImportTest, FirstRunPreparesEveryDatabaseAndReadsItemsAndCurrencies) {
    ASSERT_TRUE(CmdImportItems(surface, context));
    for (const QString& file :
         {db::kItemDatabaseFile, db::kTempItemDatabaseFile, db::kWorkDatabaseFile})
        EXPECT_TRUE(QFile::exists(path(file))) << file.toStdString();
    EXPECT_EQ(table(kItems), (QStringList{"A|10|2", "B|2.5|2"}));
    EXPECT_EQ(rows(db::kDocDatabaseFile, "SELECT WizSign FROM tCurrencies WHERE Currency='$'"),
              QStringList{"USD"});
    EXPECT_EQ(surface.control("Message1").caption(), GetCaption(38, 0));
    EXPECT_EQ(surface.control("ProgressFill").width(), surface.control("ProgressFrame").width());
    // Neither price lists nor special prices were asked for.
    EXPECT_TRUE(table(kPriceLists).isEmpty());
    EXPECT_TRUE(table(kSpecialPrices).isEmpty());
    EXPECT_FALSE(steps.contains(GetCaption(34, 0)));
    EXPECT_TRUE(messages.shown.isEmpty());
}

TEST_F(ItemImportTest, LaterRunsUpdateAddMergeAndCleanWhenAsked) {
    ASSERT_TRUE(CmdImportItems(surface, context));
    write("oitm.dbf", QList{item("B", "b", 300), item("C", "c", 100)});
    check("chkReadPriceList");
    check("ChkImportAlterPrices");
    ASSERT_TRUE(CmdImportItems(surface, context));
    EXPECT_EQ(table(kItems), (QStringList{"A|10|2", "B|3|2", "C|1|2"}));  // A stays
    EXPECT_EQ(table(kPriceLists + " ORDER BY ItemKey"), (QStringList{"B|1|3", "C|1|1"}));
    EXPECT_EQ(table(kSpecialPrices), QStringList{"20001|A|8"});
    EXPECT_EQ(steps.filter(GetCaption(34, 0)).size(), 2);  // cleared at the start and the end

    check("ChkClean");
    surface.control("txtCopies").setText("4");
    ASSERT_TRUE(CmdImportItems(surface, context));
    EXPECT_EQ(table(kItems), (QStringList{"B|3|4", "C|1|4"}));
    EXPECT_TRUE(messages.shown.isEmpty());
}

TEST_F(ItemImportTest, StopsWhereAReaderStops) {
    QFile::remove(company() + "/oitm.dbf");
    EXPECT_FALSE(CmdImportItems(surface, context));  // silently, still showing caption 31
    EXPECT_EQ(surface.control("Message1").caption(), GetCaption(31, 0));
    EXPECT_TRUE(messages.shown.isEmpty());
    EXPECT_FALSE(QFile::exists(path(db::kWorkDatabaseFile)));

    write("oitm.dbf", QList{item("A")});
    surface.control("cmbPriceField").addItem("eleventh", 11);
    surface.control("cmbPriceField").setListIndex(1);
    EXPECT_FALSE(CmdImportItems(surface, context));
    ASSERT_EQ(messages.shown.size(), 1);
    EXPECT_TRUE(messages.shown[0].text.contains("Price field 11"));
    EXPECT_EQ(rows(db::kDocDatabaseFile, "SELECT Currency FROM tCurrencies"),
              QStringList{QStringLiteral("¦")});

    surface.control("cmbPriceField").setListIndex(0);
    surface.control("txtCopies").setText("many");
    EXPECT_FALSE(CmdImportItems(surface, context));
    ASSERT_EQ(messages.shown.size(), 2);
    EXPECT_TRUE(messages.shown[1].text.contains("\"many\""));
    EXPECT_EQ(messages.shown[1].title, GetCaption(1, 0));
}

// The control runs the import from its button, and fills the host lists at start-up.
TEST_F(ItemImportTest, TheControlIsWiredToTheImport) {
    write("opln.dbf", QList<demo::PriceListRecord>{{1, "base"}, {2, "dollars"}});
    MemorySurface card;
    Context cardContext;
    CardController controller(card, cardContext);
    connectParts(controller, card);
    controller.hooks().installedPrinters = [] { return QStringList(); };
    controller.InitProperties();
    cardContext.connection.server = dir.path();
    cardContext.connection.database = "company";
    controller.FillCmbPrice();
    ASSERT_EQ(card.control("cmbPriceField").listCount(), 2);
    card.control("cmbPriceField").setListIndex(1);
    card.control("txtCopies").setText("1");
    card.control("txtDBPath").setText(folder());
    controller.click("CmdImportItems");
    EXPECT_EQ(card.control("Message1").caption(), GetCaption(38, 0));
    EXPECT_EQ(table(kItems), (QStringList{"A|9|1", "B|0|1"}));
}

}  // namespace
}  // namespace etq::test

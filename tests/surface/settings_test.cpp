// The settings store and the settings groups, on the headless surface and real INI files.
#include <gtest/gtest.h>

#include <QDir>
#include <QFile>
#include <QRegularExpression>
#include <QSettings>

#include "platform/label_fields.h"
#include "platform/settings_store.h"
#include "platform/user_paths.h"
#include "support/test_env.h"
#include "surface/memory_surface.h"
#include "surface/settings_groups.h"

namespace etq {
namespace {

class SettingsTest : public ::testing::Test {
  protected:
    void SetUp() override { test::resetSettings(); }

    void loadAll(const Surface& surface) const {
        for (quint8 group = 1; group <= 6; ++group)
            GetSetParams(surface, app, group, LoadSettings);
    }
    QString text(const char* name) const { return surface.control(name).text(); }

    MemorySurface surface;
    QString app = "Etiquon";  // the application name the groups are kept under
};

TEST_F(SettingsTest, ApplicationNameTakesOnlyANumericSettingId) {
    EXPECT_EQ(applicationNameFor(" 7 "), "Etiquon7");
    EXPECT_EQ(applicationNameFor("3"), "Etiquon3");
    EXPECT_EQ(applicationNameFor(""), "Etiquon");
    EXPECT_EQ(applicationNameFor("   "), "Etiquon");
    EXPECT_EQ(applicationNameFor("abc"), "Etiquon");
    EXPECT_EQ(applicationNameFor("7a"), "Etiquon");
    EXPECT_EQ(applicationNameFor("../7"), "Etiquon");
}

TEST_F(SettingsTest, EachApplicationNameHasItsOwnIniFile) {
    {
        SettingsStore store("Etiquon7");
        store.write("GeneralParams", "CompanyName", "חברת בדיקה, בע\"מ");
        store.write("0LabelDef", "UseCell", "-1");
        ASSERT_TRUE(store.sync());
    }
    EXPECT_TRUE(QFile::exists(test::settingsFile("Etiquon7")));
    EXPECT_FALSE(QFile::exists(test::settingsFile("Etiquon")));

    EXPECT_EQ(readSetting("Etiquon7", "GeneralParams", "CompanyName", "x"), "חברת בדיקה, בע\"מ");
    EXPECT_EQ(readSetting("Etiquon7", "0LabelDef", "UseCell", "0"), "-1");
    EXPECT_EQ(readSetting("Etiquon", "GeneralParams", "CompanyName", "none"), "none");

    // A value typed into the file by hand with a comma reads back as the same text.
    QFile file(test::settingsFile("Etiquon7"));
    ASSERT_TRUE(file.open(QIODevice::Append));
    file.write("[Params]\nConnServer=/srv/a,b\n");
    file.close();
    EXPECT_EQ(readSetting("Etiquon7", "Params", "ConnServer", ""), "/srv/a,b");
}

TEST_F(SettingsTest, AnEmptyStoreGivesTheDefaults) {
    loadAll(surface);

    EXPECT_EQ(text("txtCompanyName"), "Corvan Information Systems");
    for (int i = 0; i < 6; ++i)
        EXPECT_EQ(surface.control("OptOLE", i).value().toBool(), i == 3) << "OptOLE(" << i << ")";
    EXPECT_FALSE(surface.control("OptPrinter", 0).value().toBool());
    EXPECT_TRUE(surface.control("OptPrinter", 1).value().toBool());  // "Thermal"
    EXPECT_EQ(surface.control("OptPrinter", 1).caption(), "Thermal");

    EXPECT_EQ(text("txtDBPath"), userDataFolder());
    EXPECT_TRUE(text("txtDBPath").endsWith("/Etiquon"));
    EXPECT_EQ(text("txtLabelName"), QDir::homePath() + "/mylabel.lbl");
    EXPECT_EQ(text("txtLabelNameHead"), QDir::homePath() + "/mylabel.lbl");
    EXPECT_EQ(text("txtCopies"), "1");
    EXPECT_EQ(text("txtFromDate"), "01/01/1980");
    EXPECT_EQ(text("txtToDate"), "01/01/2025");
    EXPECT_EQ(text("txtPriceFormat"), "0.00");
    EXPECT_EQ(text("txtPrintDelay"), "0");
    EXPECT_EQ(text("txtLine0Copies"), "1");
    for (int i = 0; i < kLabelFieldCount; ++i)
        EXPECT_EQ(surface.control("ChkFldSend", i).value().toInt(), 0) << "slot " << i;

    // Position 0 of a fixed list is selected; the host lists are empty, so theirs is skipped,
    // and "-1" names no printer.
    EXPECT_EQ(surface.control("CmbItemNameType").listIndex(), 0);
    EXPECT_EQ(surface.control("cmbAddressSeperator").text(), "0");
    EXPECT_EQ(surface.control("cmbPriceField").listIndex(), -1);
    EXPECT_EQ(surface.control("cmbPrinter").listIndex(), -1);
}

TEST_F(SettingsTest, SavingTheLabelFieldsWritesOneKeyPerSlot) {
    surface.control("ChkFldSend", 0).setValue(1);
    surface.control("ChkFldSend", 6).setValue(1);
    surface.control("ChkFldSend", 40).setValue("2");
    surface.control("txtPriceFormat").setText("#,##0.00");
    GetSetParams(surface, app, 3, SaveSettings);

    QSettings file(test::settingsFile("Etiquon"), QSettings::IniFormat);
    file.beginGroup("LabelVars");
    QStringList slotKeys = file.childKeys().filter(QRegularExpression("^FldSend"));
    slotKeys.sort();
    ASSERT_EQ(slotKeys.size(), kLabelFieldCount);
    EXPECT_EQ(slotKeys.first(), "FldSend00");
    EXPECT_EQ(slotKeys.last(), "FldSend40");
    EXPECT_EQ(file.value("FldSend00").toString(), "1");
    EXPECT_EQ(file.value("FldSend05").toString(), "0");
    EXPECT_EQ(file.value("FldSend06").toString(), "1");
    EXPECT_EQ(file.value("FldSend40").toString(), "2");
    EXPECT_EQ(file.value("PriceFormat").toString(), "#,##0.00");
    EXPECT_EQ(file.value("PrintDelay").toString(), "");

    MemorySurface reloaded;
    GetSetParams(reloaded, app, 3, LoadSettings);
    EXPECT_EQ(reloaded.control("ChkFldSend", 6).value().toInt(), 1);
    EXPECT_EQ(reloaded.control("ChkFldSend", 40).value().toInt(), 2);
    EXPECT_EQ(reloaded.control("ChkFldSend", 7).value().toInt(), 0);
    EXPECT_EQ(reloaded.control("txtPriceFormat").text(), "#,##0.00");
}

TEST_F(SettingsTest, OptionsAreStoredAsTrueAndFalse) {
    surface.control("OptOLE", 1).setValue(true);
    EXPECT_FALSE(surface.control("OptOLE", 3).value().toBool());
    GetSetParams(surface, app, 1, SaveSettings);
    EXPECT_EQ(readSetting("Etiquon", "GeneralParams", "OptOLE1", ""), "True");
    EXPECT_EQ(readSetting("Etiquon", "GeneralParams", "OptOLE3", ""), "False");

    MemorySurface reloaded;
    GetSetParams(reloaded, app, 1, LoadSettings);
    EXPECT_TRUE(reloaded.control("OptOLE", 1).value().toBool());
    EXPECT_FALSE(reloaded.control("OptOLE", 3).value().toBool());
}

TEST_F(SettingsTest, AListPositionBeyondTheListIsSkippedAndTheGroupGoesOn) {
    writeSetting("Etiquon", "ImportItems", "ItemNameType", "1");
    writeSetting("Etiquon", "ImportItems", "PriceField", "5");
    writeSetting("Etiquon", "ImportItems", "Copies", "4");
    writeSetting("Etiquon", "ImportItems", "CleanItems", "1");
    writeSetting("Etiquon", "ImportItems", "ToItemKey", "Z99");
    const ControlRef prices = surface.control("cmbPriceField");
    for (const char* list : {"מחיר 1", "מחיר 2", "מחירון סיטונאי"})
        prices.addItem(list);

    GetSetParams(surface, app, 2, LoadSettings);

    EXPECT_EQ(prices.listIndex(), -1);
    EXPECT_EQ(surface.control("CmbItemNameType").listIndex(), 1);
    EXPECT_EQ(text("txtCopies"), "4");
    EXPECT_EQ(surface.control("ChkClean").value().toInt(), 1);
    EXPECT_EQ(text("txtToItemKey"), "Z99");

    writeSetting("Etiquon", "ImportItems", "PriceField", "2");
    GetSetParams(surface, app, 2, LoadSettings);
    EXPECT_EQ(prices.listIndex(), 2);
    EXPECT_EQ(prices.text(), "מחירון סיטונאי");
}

TEST_F(SettingsTest, ValuesAControlCannotTakeAreSkipped) {
    writeSetting("Etiquon", "GeneralParams", "OptPrinter0", "maybe");
    writeSetting("Etiquon", "LabelVars", "FldSend03", "7");
    writeSetting("Etiquon", "LabelVars", "FldSend04", "True");
    writeSetting("Etiquon", "LabelVars", "PriceFormat", "0.0");
    writeSetting("Etiquon", "GeneralParams", "DefPrinter", "Canon");
    const ControlRef printers = surface.control("cmbPrinter");
    printers.addItem("HP_LaserJet");
    printers.addItem("Zebra_GK420");

    loadAll(surface);
    EXPECT_FALSE(surface.control("OptPrinter", 0).value().toBool());
    EXPECT_TRUE(surface.control("OptPrinter", 1).value().toBool());
    EXPECT_EQ(surface.control("ChkFldSend", 3).value().toInt(), 0);
    EXPECT_EQ(surface.control("ChkFldSend", 4).value().toInt(), 0);
    EXPECT_EQ(text("txtPriceFormat"), "0.0");
    EXPECT_EQ(printers.listIndex(), -1);

    writeSetting("Etiquon", "GeneralParams", "DefPrinter", "Zebra_GK420");
    GetSetParams(surface, app, 1, LoadSettings);
    EXPECT_EQ(printers.text(), "Zebra_GK420");

    // The dialogs' groups name controls this surface lacks: nothing happens.
    writeSetting("Etiquon", "EditItems", "ItmSortBy", "1");
    EXPECT_NO_THROW(GetSetParams(surface, app, 11, LoadSettings));
    EXPECT_NO_THROW(GetSetParams(surface, app, 12, SaveSettings));
    EXPECT_NO_THROW(GetSetParams(surface, app, 7, SaveSettings));
    EXPECT_FALSE(SettingsStore("Etiquon").contains("AlterItems", "AltSortBy"));
}

TEST_F(SettingsTest, ASettingIdKeepsItsOwnValues) {
    app = (applicationNameFor(" 7 "));
    surface.control("txtFromDate").setText("15/03/2024");
    surface.control("chkUseFastWay").setValue(1);
    GetSetParams(surface, app, 5, SaveSettings);
    EXPECT_TRUE(QFile::exists(test::settingsFile("Etiquon7")));
    EXPECT_FALSE(QFile::exists(test::settingsFile("Etiquon")));

    app = ("Etiquon");
    MemorySurface plain;
    GetSetParams(plain, app, 5, LoadSettings);
    EXPECT_EQ(plain.control("txtFromDate").text(), "01/01/1980");
    EXPECT_EQ(plain.control("chkUseFastWay").value().toInt(), 0);

    app = ("Etiquon7");
    MemorySurface seven;
    GetSetParams(seven, app, 5, LoadSettings);
    EXPECT_EQ(seven.control("txtFromDate").text(), "15/03/2024");
    EXPECT_EQ(seven.control("chkUseFastWay").value().toInt(), 1);
}

TEST_F(SettingsTest, StoredKeysOfControlArraysAreFoundInTheTable) {
    int element = -1;
    const SettingKey* slot = findSettingKey(u"LabelVars", u"FldSend07", &element);
    ASSERT_NE(slot, nullptr);
    EXPECT_EQ(element, 7);
    EXPECT_EQ(findSettingKey(u"LabelVars", u"FldSend41"), nullptr);
    EXPECT_EQ(findSettingKey(u"LabelVars", u"FldSend7"), nullptr);
    EXPECT_EQ(settingDefault(u"GeneralParams", u"OptOLE3"), "True");
    EXPECT_EQ(settingDefault(u"AlterItems", u"AltSearchBy1"), "1");
    EXPECT_EQ(settingDefault(u"Params", u"ConnDataBase"), "corvan02");
}

}  // namespace
}  // namespace etq

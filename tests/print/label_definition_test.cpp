// The built-in label definition through the real settings file.
#include "print/label_definition.h"

#include <gtest/gtest.h>

#include <QDir>
#include <QFile>
#include <QStandardPaths>

#include "platform/settings_store.h"
#include "support/qt_print.h"

namespace etq::print::test {
namespace {

class LabelDefinitionTest : public ::testing::Test {
  protected:
    void SetUp() override {
        QDir(QStandardPaths::writableLocation(QStandardPaths::GenericConfigLocation) + "/Etiquon")
            .removeRecursively();
    }
    static void store(const QString& section, const QString& key, const QString& value) {
        SettingsStore s("Etiquon");
        s.write(section, key, value);
        s.sync();
    }
    static QString stored(const QString& section, const QString& key) {
        return SettingsStore("Etiquon").read(section, key, "<none>");
    }
    LabelDefinition def;
};

TEST_F(LabelDefinitionTest, EmptyStoreGivesTheDefaults) {
    EXPECT_EQ(def.page.PageRows, 0);  // nothing before the first load
    EXPECT_EQ(def.cells[0].FontSize, 0);
    GetSetLabelDef(LoadLabelDef, "Etiquon", def);
    for (const LabelCell& cell : def.cells) {
        EXPECT_FALSE(cell.UseCell);
        EXPECT_EQ(cell.FldID, -1);
        EXPECT_EQ(cell.FontSize, 9);
        EXPECT_EQ(cell.Align, 1);
        EXPECT_EQ(cell.Direction, 1);
        EXPECT_EQ(cell.ViewType, 0);
        EXPECT_EQ(cell.Prefix, "");
    }
    EXPECT_EQ(def.bar.BarType, 0);
    EXPECT_TRUE(def.bar.CheckDigit);
    EXPECT_FLOAT_EQ(def.bar.BarHeight, 0.4f);
    EXPECT_FLOAT_EQ(def.bar.DimX, 0.01f);
    EXPECT_FLOAT_EQ(def.bar.WideBarRatio, 2.2f);
    EXPECT_EQ(def.bar.UserResoX, 100);
    EXPECT_EQ(def.bar.UserResoY, 50);
    EXPECT_EQ(def.page.PageCols, 4);
    EXPECT_EQ(def.page.PageRows, 6);
    EXPECT_FALSE(def.page.PageAutoPrint);
}

TEST_F(LabelDefinitionTest, TrueReadsAsMinusOneAndSavesAsMinusOne) {
    store("2LabelDef", "UseCell", "True");
    store("2LabelDef", "Border", "-1");
    store("2LabelDef", "FldID", "True");  // a number field takes it as -1 too
    store("DirectLabel", "PageAutoPrint", "False");
    store("LabelBar", "ShowDesc", "True");
    GetSetLabelDef(LoadLabelDef, "Etiquon", def);
    EXPECT_TRUE(def.cells[2].UseCell);
    EXPECT_TRUE(def.cells[2].Border);
    EXPECT_EQ(def.cells[2].FldID, -1);
    EXPECT_TRUE(def.bar.ShowDesc);
    GetSetLabelDef(SaveLabelDef, "Etiquon", def);
    EXPECT_EQ(stored("2LabelDef", "UseCell"), "-1");
    EXPECT_EQ(stored("2LabelDef", "FontUL"), "0");
    EXPECT_EQ(stored("LabelBar", "ShowDesc"), "-1");
    EXPECT_EQ(stored("LabelBar", "DimX"), "0.01");
    EXPECT_EQ(stored("LabelBar", "WideBarRatio"), "2.2");
    EXPECT_EQ(stored("DirectLabel", "PageRows"), "6");
    // Cells are 0LabelDef to 6LabelDef: nothing for a cell 7.
    EXPECT_EQ(stored("7LabelDef", "UseCell"), "<none>");
    EXPECT_EQ(stored("6LabelDef", "UseCell"), "0");
}

TEST_F(LabelDefinitionTest, SavedDefinitionLoadsBackUnchanged) {
    GetSetLabelDef(LoadLabelDef, "Etiquon", def);
    def.cells[5] = {true, 4, {}, 1, 2, 14, 2, true, true, 0, 0, "מחיר:", false, 12, true};
    def.bar.BarType = 6;
    def.bar.LeftPrefix = "X";
    def.bar.LeftLen = 3;
    def.bar.DimX = 0.015f;
    def.page = {8, 3, true, 20, 2, 1, "Avery", "L7160"};
    GetSetLabelDef(SaveLabelDef, "Etiquon", def);
    LabelDefinition loaded;
    GetSetLabelDef(LoadLabelDef, "Etiquon", loaded);
    const LabelCell& c = loaded.cells[5];
    EXPECT_TRUE(c.UseCell && c.FontUL && c.FontItalic && c.Border);
    EXPECT_EQ(c.FldID, 4);
    EXPECT_EQ(c.ViewType, 1);
    EXPECT_EQ(c.Font, 2);
    EXPECT_EQ(c.FontSize, 14);
    EXPECT_EQ(c.FontWeight, 2);
    EXPECT_EQ(c.Align, 0);
    EXPECT_EQ(c.Prefix, "מחיר:");
    EXPECT_EQ(c.Height, 12);
    EXPECT_EQ(loaded.bar.BarType, 6);
    EXPECT_EQ(loaded.bar.LeftPrefix, "X");
    EXPECT_EQ(loaded.bar.LeftLen, 3);
    EXPECT_FLOAT_EQ(loaded.bar.DimX, 0.015f);
    EXPECT_EQ(loaded.page.PageRows, 8);
    EXPECT_EQ(loaded.page.PageCols, 3);
    EXPECT_TRUE(loaded.page.PageAutoPrint);
    EXPECT_EQ(loaded.page.MaxTextLen, 20);
    EXPECT_EQ(loaded.page.SheetBrand + " " + loaded.page.SheetPart, "Avery L7160");
}

TEST_F(LabelDefinitionTest, NegativeBarTypeSkipsTheBarSectionFromThenOn) {
    store("LabelBar", "BarType", "-1");
    store("LabelBar", "UserResoX", "300");
    GetSetLabelDef(LoadLabelDef, "Etiquon", def);  // read while the bar type was still 0
    EXPECT_EQ(def.bar.BarType, -1);
    EXPECT_EQ(def.bar.UserResoX, 300);
    store("LabelBar", "UserResoX", "400");
    GetSetLabelDef(LoadLabelDef, "Etiquon", def);
    EXPECT_EQ(def.bar.UserResoX, 300);  // not read again
    def.bar.UserResoX = 500;
    GetSetLabelDef(SaveLabelDef, "Etiquon", def);
    EXPECT_EQ(stored("LabelBar", "UserResoX"), "400");  // nor written
}

TEST_F(LabelDefinitionTest, UnreadableValueLeavesTheFieldAndTheRestLoads) {
    GetSetLabelDef(LoadLabelDef, "Etiquon", def);
    store("0LabelDef", "FontSize", "big");
    store("0LabelDef", "Align", "300");  // beyond a byte
    store("0LabelDef", "Height", "7");
    store("LabelBar", "BarHeight", "0.5");
    GetSetLabelDef(LoadLabelDef, "Etiquon", def);
    EXPECT_EQ(def.cells[0].FontSize, 9);
    EXPECT_EQ(def.cells[0].Align, 1);
    EXPECT_EQ(def.cells[0].Height, 7);
    EXPECT_FLOAT_EQ(def.bar.BarHeight, 0.5f);
}

}  // namespace
}  // namespace etq::print::test

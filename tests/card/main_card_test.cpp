// The window: its controls by name on their tabs (compared with the headless surface), and the
// behaviour that depends on real widgets.
#include <gtest/gtest.h>

#include <QCheckBox>
#include <QComboBox>
#include <QDir>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>
#include <QTabWidget>
#include <QTableView>
#include <QTest>

#include "card/card_controller.h"
#include "card/main_card.h"
#include "card/print_adapters.h"
#include "card_test_support.h"
#include "dialogs/language_switch.h"
#include "platform/context.h"
#include "surface/memory_surface.h"

namespace etq {
namespace {

// The working controls of each tab, as the other parts of the component address them.
const struct {
    int tab;
    const char* names;
} kTabControls[] = {
    {0,
     "txtFromItem txtToItem LblToKey ChkUseAccountKey txtAccountKey cmdSelectItems Image3 cmdPrintItmes Image5 cmdSaveDef4"},
    {1,
     "txtFromDate txtToDate LblFromDate LblToDate txtFromDocNum txtToDocNum LblToRef chkReadDocItems chkPrintHeadLabel chkOnlyLine0 chkUseFastWay cmdImportDocs Image6 cmdSelectDocItems Image7 cmdPrintDocButt Image8 cmdRanges cmdDLog cmdSaveDef5"},
    {2,
     "txtFromItemKey txtToItemKey chkItmQGrp cmbItmQGrp cmbItmQGrpBy chkItmBelong cmbItmBelong chkReadPriceList ChkClean ChkImportAlterPrices txtCopies cmbPriceField CmbItemNameType CmdImportItems cmdSaveDef2"},
    {3, "cmbPrinter cmbPrintMode cmdAlterKeys cmdAccDef cmdEditItems"},
    {4,
     "txtCompanyName txtDBPath DDEorOLE OptOLE(0) OptOLE(1) OptOLE(2) OptOLE(3) OptOLE(4) OptOLE(5) PrinterType OptPrinter(0) OptPrinter(1) txtLabelSoftware CmdDir(2) txtLabelName CmdDir(1) ImgEdit(1) txtLabelNameHead CmdDir(0) ImgEdit(0) cmdLabDesign CmdConnect cmdSaveDef1"},
    {5, "txtPrintDelay txtPriceFormat CmdSaveFields"},
    {6,
     "VSDocTypes cmdAllDocTypes cmdNoDocTypes cmbAddressFrom cmbAddressSeperator cmbCopiesAt cmbLine0From txtLine0Copies chkUseDeliverLog cmdSaveDef6"},
    {7, "cmdUpgrade"},
    {-1, "MainTab Message1 ProgressFrame ProgressFill"},
};

// Tab 5 holds the 41 label field slots besides.
QStringList tabControls(int tab) {
    QStringList names;
    for (const auto& t : kTabControls)
        if (t.tab == tab) names = QString(t.names).split(' ');
    if (tab != 5) return names;
    for (int i = 0; i < 41; ++i)
        names << QString("ChkFldSend(%1)").arg(i) << QString("LblFldName(%1)").arg(i)
              << QString("LblFldDesc(%1)").arg(i);
    return names;
}

class MainCardTest : public ::testing::Test {
  protected:
    void SetUp() override { test::resetSettings(); }
    template <typename W>
    W* widget(const char* name) {
        W* w = card.findChild<W*>(name);
        EXPECT_NE(w, nullptr) << name;
        return w;
    }

    Context context;
    MainCard card{context};
};

TEST_F(MainCardTest, EveryControlIsOnItsTabInBothSurfaces) {
    MemorySurface memory;
    const Surface* surfaces[] = {&card, &memory};
    for (int tab = -1; tab <= 7; ++tab) {
        for (const QString& full : tabControls(tab)) {
            const auto [name, index] = splitElementName(full);
            for (const Surface* surface : surfaces) {
                ASSERT_TRUE(surface->hasControl(name, index)) << full.toStdString();
                EXPECT_EQ(surface->control(name, index).tab(), tab) << full.toStdString();
            }
            QWidget* w = card.findChild<QWidget*>(full);
            ASSERT_NE(w, nullptr) << full.toStdString();
            if (tab >= 0) {
                EXPECT_TRUE(card.mainTab()->widget(tab)->isAncestorOf(w)) << full.toStdString();
            }
        }
    }
    EXPECT_EQ(card.mainTab()->count(), 8);
    EXPECT_EQ(card.elementCount("ChkFldSend"), 41);
    EXPECT_EQ(memory.elementCount("ChkFldSend"), 41);
    EXPECT_EQ(card.elementCount("OptOLE"), 6);
    EXPECT_EQ(card.elementCount("txtDBPath"), 0);
}

TEST_F(MainCardTest, ControlsCarryTheirDesignCaptionsTagsAndTooltips) {
    EXPECT_EQ(card.mainTab()->tabText(0), "מדבקות ע\"פ פריטים");
    EXPECT_EQ(card.mainTab()->tabText(6), "הגדרות לקריאת מסמכים");
    EXPECT_EQ(widget<QCheckBox>("ChkUseAccountKey")->text(),
              "להשתמש במק\"טים חליפיים/מחירים מיוחדים?");
    EXPECT_EQ(widget<QPushButton>("cmdPrintItmes")->property("Tag").toString(), "Print labels");
    EXPECT_EQ(widget<QPushButton>("cmdPrintDocButt")->toolTip(), "Print labels for selected lines");
    EXPECT_EQ(widget<QPushButton>("cmdLabDesign")->text(), "הדפסה ישירה");
    EXPECT_EQ(widget<QRadioButton>("OptOLE(3)")->text(), "Direct");
    EXPECT_EQ(widget<QRadioButton>("OptPrinter(0)")->text(), "A4");

    // The label field slots: variable name and format on LblFldName, description and result
    // column on LblFldDesc, the field's name as the box's tooltip.
    EXPECT_EQ(widget<QLabel>("LblFldName(6)")->text(), "Price");
    EXPECT_EQ(widget<QLabel>("LblFldName(6)")->property("Tag").toString(), "2");
    EXPECT_EQ(widget<QLabel>("LblFldName(28)")->property("Tag").toString(), "3");
    EXPECT_EQ(widget<QLabel>("LblFldName(2)")->property("Tag").toString(), "");
    EXPECT_EQ(widget<QLabel>("LblFldName(16)")->text(), "-");
    EXPECT_EQ(widget<QLabel>("LblFldDesc(6)")->text(), "מחיר");
    EXPECT_EQ(widget<QLabel>("LblFldDesc(5)")->property("Tag").toString(), "Unit");
    EXPECT_EQ(widget<QLabel>("LblFldDesc(11)")->property("Tag").toString(), "SpecialPrice");
    EXPECT_EQ(widget<QCheckBox>("ChkFldSend(0)")->toolTip(), "Item code");
    EXPECT_EQ(widget<QCheckBox>("ChkFldSend(40)")->toolTip(), "");
    EXPECT_EQ(card.layoutDirection(), Qt::RightToLeft);
}

TEST_F(MainCardTest, ListsAndOptionsBehaveAsOnTheHeadlessSurface) {
    const ControlRef prices = card.control("cmbPriceField");
    prices.addItem("מחיר 1", 1);
    prices.addItem("מחיר 2", 2);
    EXPECT_EQ(prices.listIndex(), -1);  // filling selects nothing
    EXPECT_THROW(prices.setListIndex(2), SurfaceError);
    prices.setText("מחיר 2");
    EXPECT_EQ(prices.selectedItemData(), 2);
    EXPECT_THROW(prices.setText("מחיר 3"), SurfaceError);
    prices.setListIndex(-1);
    EXPECT_EQ(prices.text(), "");
    EXPECT_THROW(card.control("txtDBPath").listIndex(), SurfaceError);
    EXPECT_THROW(card.control("cmdUpgrade").value(), SurfaceError);
    EXPECT_THROW(card.control("NoSuchControl"), SurfaceError);

    card.control("OptOLE", 2).setValue("True");
    EXPECT_FALSE(card.control("OptOLE", 3).value().toBool());
    EXPECT_EQ(GetLabelSoftwareKind(card), 4);
    card.control("OptOLE", 2).setValue("False");  // a routine may leave no option selected
    EXPECT_EQ(GetLabelSoftwareKind(card), 0);

    card.control("ChkFldSend", 3).setValue(2);
    EXPECT_EQ(widget<QCheckBox>("ChkFldSend(3)")->checkState(), Qt::PartiallyChecked);
    EXPECT_EQ(card.control("ChkFldSend", 3).valueText(), "2");
}

TEST_F(MainCardTest, StartUpOnTheWindow) {
    card.controller().hooks().installedPrinters = [] { return QStringList{"Zebra"}; };
    card.InitProperties();
    EXPECT_EQ(card.mainTab()->currentIndex(), 0);
    EXPECT_TRUE(widget<QRadioButton>("OptOLE(3)")->isChecked());
    EXPECT_TRUE(widget<QRadioButton>("OptPrinter(1)")->isChecked());
    EXPECT_EQ(widget<QLineEdit>("txtFromDate")->text(), "01/01/1980");
    EXPECT_EQ(widget<QComboBox>("cmbPrinter")->count(), 1);
    EXPECT_EQ(widget<QComboBox>("cmbPrinter")->currentIndex(), -1);
}

TEST_F(MainCardTest, TypingAndClickingOnTheWindow) {
    auto* from = widget<QLineEdit>("txtFromDocNum");
    auto* to = widget<QLineEdit>("txtToDocNum");
    QTest::keyClicks(from, "120");
    EXPECT_EQ(to->text(), "120");
    to->selectAll();
    QTest::keyClicks(to, "180");
    EXPECT_EQ(to->text(), "180");
    QTest::keyClicks(from, "5");
    EXPECT_EQ(to->text(), "1205");

    QTest::keyClicks(widget<QLineEdit>("txtFromItem"), "A-7");
    QTest::mouseClick(widget<QLabel>("LblToKey"), Qt::LeftButton);
    EXPECT_EQ(widget<QLineEdit>("txtToItem")->text(), "A-7");

    card.resize(900, 600);
    card.show();
    widget<QLineEdit>("txtDBPath")->setText(QDir::tempPath() + "/no-such-etiquon-folder");
    widget<QPushButton>("cmdUpgrade")->click();
    EXPECT_EQ(widget<QLabel>("Message1")->text(), "Upgrade successfull");
    const QWidget* frame = widget<QWidget>("ProgressFrame");
    const QWidget* fill = widget<QWidget>("ProgressFill");
    EXPECT_EQ(fill->width(), frame->width());
    card.mainTab()->setCurrentIndex(2);
    EXPECT_EQ(fill->width(), 0);
    EXPECT_EQ(widget<QLabel>("Message1")->text(), "");

    card.mainTab()->setCurrentIndex(1);
    EXPECT_TRUE(widget<QPushButton>("cmdDLog")->isHidden());
}

TEST_F(MainCardTest, TheLanguageSwitchTurnsAWindowToEnglish) {
    QWidget window;
    window.setLayoutDirection(Qt::RightToLeft);
    auto* label = new QLabel("תאור:", &window);
    label->setAlignment(Qt::AlignRight | Qt::AlignAbsolute | Qt::AlignVCenter);
    label->setProperty("Tag", "Description:");
    auto* untagged = new QLabel("מחסן", &window);
    auto* button = new QPushButton("שמור", &window);
    button->setProperty("Tag", "Save");
    auto* combo = new QComboBox(&window);
    auto* grid = new QTableView(&window);
    grid->setLayoutDirection(Qt::RightToLeft);

    MirrorControls(&window);
    ApplyTagCaptions(&window);
    FillComboFromList(combo, "Item code;Item Name");

    EXPECT_EQ(window.layoutDirection(), Qt::LeftToRight);
    EXPECT_EQ(label->layoutDirection(), Qt::LeftToRight);
    EXPECT_EQ(label->alignment() & Qt::AlignHorizontal_Mask, Qt::AlignLeft | Qt::AlignAbsolute);
    EXPECT_EQ(grid->layoutDirection(), Qt::RightToLeft);
    EXPECT_EQ(label->text(), "Description:");
    EXPECT_EQ(untagged->text(), "מחסן");
    EXPECT_EQ(button->text(), "Save");
    EXPECT_EQ(combo->count(), 2);
    EXPECT_EQ(combo->itemText(1), "Item Name");
    EXPECT_EQ(combo->currentIndex(), -1);
}

}  // namespace
}  // namespace etq

// The label designer frmLabDef on the offscreen platform: its rows, its accept and cancel, its
// preview and the label sheet products, driven through its widgets as a user drives them.
#include "dialogs/label_designer_window.h"

#include <gtest/gtest.h>

#include <QCheckBox>
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QTabWidget>
#include <QTest>

#include "dialogs/label_preview.h"
#include "platform/context.h"
#include "support/qt_print.h"
#include "support/recording_messages.h"
#include "support/test_env.h"
#include "surface/memory_surface.h"

namespace etq {
namespace {

class LabelDesignerWindowTest : public ::testing::Test {
  protected:
    void SetUp() override {
        test::resetSettings();
        context.setMessages(&messages);
        GetSetLabelDef(LoadLabelDef, context.applicationName, def());
    }
    LabelDefinition& def() { return context.labelDefinition(); }

    // Cells 0 to 6 all in use, each telling itself apart: field i, size 8 + i, prefix "pi",
    // barcode for the odd ones.
    void useAllCells() {
        for (int i = 0; i < kLabelCellCount; ++i) {
            LabelCell& cell = def().cells[size_t(i)];
            cell.UseCell = true;
            cell.FldID = qint16(i);
            cell.ViewType = quint8(i % 2);
            cell.FontSize = quint8(8 + i);
            cell.Prefix = QStringLiteral("p%1").arg(i);
        }
    }

    std::unique_ptr<LabelDesignerWindow> open() {
        auto window = std::make_unique<LabelDesignerWindow>(context, card, LabelPreviewSource{});
        window->show();
        return window;
    }
    template <typename W>
    static W* widget(const LabelDesignerWindow& window, const QString& name) {
        W* w = window.findChild<W*>(name);
        EXPECT_NE(w, nullptr) << name.toStdString();
        return w;
    }
    static void click(const LabelDesignerWindow& window, const QString& name) {
        QTest::mouseClick(widget<QWidget>(window, name), Qt::LeftButton);
    }
    static int darkPixels(const QImage& image) {
        int dark = 0;
        for (int y = 0; y < image.height(); ++y)
            for (int x = 0; x < image.width(); ++x)
                if (qGray(image.pixel(x, y)) < 128) ++dark;
        return dark;
    }

    Context context;
    test::RecordingMessages messages;
    MemorySurface card;
};

// Insert on row 2 moves cells 2 to 5 down and loses cell 6; remove on row 0 moves cells 1 to 6
// up. The row left behind is not in use, has no field and shows text; the rest of its look is
// the old row's, and its field, with nothing selected, stays as it was on accept.
TEST_F(LabelDesignerWindowTest, InsertAndRemoveMoveTheRowsAndClearTheOneLeft) {
    const struct {
        const char* label;
        int cleared;
        int sourceOf[kLabelCellCount];  // the old cell each row shows afterwards
    } cases[] = {
        {"lblAdd(2)", 2, {0, 1, 2, 2, 3, 4, 5}},
        {"lblDel(0)", 6, {1, 2, 3, 4, 5, 6, 6}},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.label);
        useAllCells();
        const LabelDefinition before = def();
        const auto window = open();
        click(*window, c.label);
        EXPECT_EQ(widget<QComboBox>(*window, QStringLiteral("cmbXFld(%1)").arg(c.cleared))
                      ->currentIndex(),
                  -1);
        click(*window, "cmdClose");
        EXPECT_EQ(window->result(), QDialog::Accepted);
        for (int row = 0; row < kLabelCellCount; ++row) {
            LabelCell expected = before.cells[size_t(c.sourceOf[row])];
            if (row == c.cleared) {
                expected.UseCell = false;
                expected.ViewType = 0;
                expected.FldID = before.cells[size_t(row)].FldID;
            }
            EXPECT_EQ(def().cells[size_t(row)], expected) << "row " << row;
        }
    }
}

TEST_F(LabelDesignerWindowTest, CancelLeavesTheDefinitionAsItWas) {
    useAllCells();
    const LabelDefinition before = def();
    const auto window = open();
    click(*window, "lblDel(1)");
    widget<QLineEdit>(*window, "txtRows")->setText("9");
    widget<QComboBox>(*window, "cmbXBarType")->setCurrentIndex(6);
    click(*window, "cmdCancel");
    EXPECT_EQ(window->result(), QDialog::Rejected);
    EXPECT_EQ(def(), before);
}

// Accept checks every control before it changes anything: a font size that is no number is
// named with its row and field, and the controls before and after it change nothing.
TEST_F(LabelDesignerWindowTest, ABadFontSizeChangesNothing) {
    useAllCells();
    const LabelDefinition before = def();
    const auto window = open();
    widget<QLineEdit>(*window, "txtPrefix(0)")->setText("חדש");
    widget<QLineEdit>(*window, "txtFontSize(3)")->setText("abc");
    widget<QLineEdit>(*window, "txtRows")->setText("9");
    click(*window, "cmdClose");
    EXPECT_TRUE(window->isVisible());
    EXPECT_EQ(def(), before);
    ASSERT_EQ(messages.shown.size(), 1);
    EXPECT_EQ(messages.shown[0].title, "תקלה");
    EXPECT_EQ(messages.shown[0].icon, MsgIcon::Critical);
    EXPECT_EQ(messages.shown[0].text,
              "שורה 4, גודל (txtFontSize(3)): \"abc\" אינו מספר שלם מ-0 עד 255");

    widget<QLineEdit>(*window, "txtFontSize(3)")->setText("300");  // beyond a byte
    click(*window, "cmdClose");
    EXPECT_EQ(def(), before);
    widget<QLineEdit>(*window, "txtFontSize(3)")->setText("12");
    click(*window, "cmdClose");
    EXPECT_EQ(window->result(), QDialog::Accepted);
    EXPECT_EQ(def().cells[0].Prefix, "חדש");
    EXPECT_EQ(def().cells[3].FontSize, 12);
    EXPECT_EQ(def().page.PageRows, 9);
}

// The preview draws one label of the sample item (no database folder) as the controls stand,
// again after every change.
TEST_F(LabelDesignerWindowTest, ThePreviewIsDrawnAgainAfterAChange) {
    def().cells[0].UseCell = true;
    def().cells[0].FldID = 1;  // the item's name
    const auto window = open();
    EXPECT_EQ(window->previewRecord().value("ItemName").toString(), "חלב 3%");
    const LabelPreview& preview = window->preview();
    const int named = darkPixels(preview.image());
    const int drawn = preview.redraws();

    widget<QLineEdit>(*window, "txtFontSize(0)")->setText("20");
    EXPECT_GT(preview.redraws(), drawn);
    EXPECT_GT(darkPixels(preview.image()), named);

    widget<QCheckBox>(*window, "chkXCell(0)")->setChecked(false);
    EXPECT_LT(darkPixels(preview.image()), named);  // only the outline is left

    widget<QCheckBox>(*window, "chkXCell(0)")->setChecked(true);
    widget<QComboBox>(*window, "cmbVType(0)")->setCurrentIndex(1);  // the name as a barcode
    widget<QComboBox>(*window, "cmbXFld(0)")->setCurrentIndex(4);   // of the item's barcode
    EXPECT_GT(darkPixels(preview.image()), named);
}

// Choosing a label sheet product fills the grid with its labels across and down, and accept
// keeps the product for the PDF.
TEST_F(LabelDesignerWindowTest, AProductFillsTheGridAndIsKept) {
    const auto window = open();
    widget<QLineEdit>(*window, "txtSheetFind")->setText("avery l7160");
    auto* sheets = widget<QComboBox>(*window, "cmbSheet");
    ASSERT_GE(sheets->count(), 2);
    EXPECT_EQ(sheets->itemText(0), "ללא - הגריד מחלק את הדף");
    sheets->setCurrentIndex(1);
    EXPECT_TRUE(sheets->currentText().startsWith("Avery L7160 - 64.0 x 38.1"))
        << sheets->currentText().toStdString();
    EXPECT_EQ(widget<QLineEdit>(*window, "txtCols")->text(), "3");
    EXPECT_EQ(widget<QLineEdit>(*window, "txtRows")->text(), "7");
    const QImage& label = window->preview().image();
    EXPECT_NEAR(double(label.width()) / label.height(), 64.0 / 38.1, 0.02);

    click(*window, "cmdClose");
    EXPECT_EQ(def().page.PageCols, 3);
    EXPECT_EQ(def().page.PageRows, 7);
    EXPECT_EQ(def().page.SheetBrand + " " + def().page.SheetPart, "Avery L7160");

    // Opened again, the product is chosen; a grid typed by hand gives it up.
    const auto again = open();
    EXPECT_TRUE(widget<QComboBox>(*again, "cmbSheet")->currentText().startsWith("Avery L7160"));
    QTest::keyClicks(widget<QLineEdit>(*again, "txtCols"), "0");
    EXPECT_EQ(widget<QComboBox>(*again, "cmbSheet")->currentIndex(), 0);
    click(*again, "cmdClose");
    EXPECT_EQ(def().page.PageCols, 30);
    EXPECT_EQ(def().page.SheetBrand, "");
}

// The third tab captions its rows with the cells' fields; the captions of the two bar measures
// put back their defaults. In English the window reads left to right.
TEST_F(LabelDesignerWindowTest, CaptionsDefaultsAndEnglish) {
    def().cells[1].FldID = 6;
    auto window = open();
    EXPECT_EQ(window->windowTitle(), "הגדרות מדבקה ישירה");
    widget<QTabWidget>(*window, "SSTab1")->setCurrentIndex(2);
    EXPECT_EQ(widget<QLabel>(*window, "lblFCap(1)")->text(), "מחיר");
    widget<QLineEdit>(*window, "txtDimX")->setText("0.3");
    click(*window, "lblDimX");
    click(*window, "lblWideBarRatio");
    EXPECT_EQ(widget<QLineEdit>(*window, "txtDimX")->text(), "0.01");
    EXPECT_EQ(widget<QLineEdit>(*window, "txtWideBarRatio")->text(), "2.2");

    context.language = 1;
    window = open();
    EXPECT_EQ(window->windowTitle(), "Direct label settings");
    EXPECT_EQ(window->layoutDirection(), Qt::LeftToRight);
    EXPECT_EQ(widget<QPushButton>(*window, "cmdClose")->text(), "OK");
    EXPECT_EQ(widget<QComboBox>(*window, "CmbAlign(0)")->itemText(1), "Centre");
}

}  // namespace
}  // namespace etq

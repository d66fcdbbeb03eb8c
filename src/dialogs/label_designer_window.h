#pragma once

#include <QDialog>
#include <QSizeF>
#include <QVariantHash>
#include <optional>

#include "dialogs/label_designer.h"
#include "print/label_page.h"

class QComboBox;
class QLineEdit;
class QTabWidget;

namespace etq {

class Context;
class LabelPreview;
struct LabelSheet;

// What the preview draws its label from: the database folder whose first marked item it shows
// (a sample item when there is none), the label tab's query settings and price format, and the
// paper the page's grid divides when no label sheet product is chosen.
struct LabelPreviewSource {
    QString databaseFolder;
    LabelPageInput page;
    QSizeF paper{210, 297};
};

// The label designer frmLabDef: the built-in label definition of the run's context in three
// tabs (the cells' content and look, the barcode and the page, more of the cells' look), with
// a preview of one label beside them, redrawn at every change. The control's surface (`card`,
// the surface reference) gives the field list. Accept checks every control before it changes
// anything; cancel leaves the definition as it was. Right to left and Hebrew; English when the
// run's language is.
class LabelDesignerWindow : public QDialog {
    Q_OBJECT

  public:
    LabelDesignerWindow(Context& context, const Surface& card, LabelPreviewSource source,
                        QWidget* parent = nullptr);
    ~LabelDesignerWindow() override;

    // Every cmbXFld(i) lists the captions of the control's LblFldDesc array, by slot.
    void FillXFld(const Surface& card);
    // The fixed lists of every cell: cmbVType, CmbFont, CmbWeight, CmbAlign, CmbDirection.
    void FillCombos();
    // Moves one value between a control and its field: 1 field to control, 2 control to field.
    // False when a text box's text does not convert (the field keeps its value).
    bool GetSetFormLabDef(quint8 action, QWidget* control, const DesignerControl& binding,
                          LabelDefinition& def, int cell);
    // Moves the whole definition (1 to the window, 2 from it), every control in turn; returns
    // the problem of the first text that does not convert, empty when all did.
    QString GetSetFormLabDefs(quint8 action, LabelDefinition& def);
    // Row ToCell takes the thirteen controls of row FromCell; WithClean then clears FromCell's
    // use, field and display mode.
    void MoveCell(int fromCell, int toCell, bool withClean);
    // lblAdd(n) and lblDel(n): a row inserted before row n, row n removed.
    void insertRow(int n);
    void removeRow(int n);

    LabelPreview& preview() const { return *preview_; }
    // The record the preview shows.
    const QVariantHash& previewRecord() const { return record_; }

  private:
    void buildControls();
    QWidget* buildCellTab(bool firstTab);
    QWidget* buildSharedTab();
    void switchToEnglish();
    QWidget* control(QStringView name, int index = -1) const;
    void connectChanges(QWidget* widget);
    void onTabChanged(int tab);
    void acceptChanges();
    void redrawPreview();
    void findSheets(const QString& text);
    void listSheets(const QString& text, const LabelSheet* chosen);
    void chooseSheet(int item);
    void gridEdited();
    const LabelSheet* chosenSheet() const;

    Context& context_;
    const Surface& card_;
    LabelPreviewSource source_;
    QVariantHash record_;
    LabelDefinition& definition_;
    QTabWidget* tabs_ = nullptr;
    LabelPreview* preview_ = nullptr;
    QComboBox* sheets_ = nullptr;
    int quiet_ = 0;  // changes made by the routines redraw the preview once, at their end
};

}  // namespace etq

#pragma once

#include "dialogs/editor_window.h"
#include "dialogs/table_editors.h"

class QComboBox;
class QLineEdit;
class QPrinter;

namespace etq {

// The alternate key window frmAlterItems: AccountKey, ItemKey, AlterNum and AlterBar of tAlterKeys
// in the grid VSAlterKeys, each edit written at once. Two filter rows, each an exact value of the
// column chosen, narrow the rows shown (CmdShowAlterKeys); cmdAddAccount adds a row to overtype,
// DelAccountDef deletes the current row after a question, cmdSetAltBar puts one alternate barcode
// into the selected rows, cmdPrintAltKeys prints the grid. The filter and sort choices come from
// the settings group AlterItems when the window opens.
class AlterItemsWindow : public EditorWindow {
    Q_OBJECT

  public:
    AlterItemsWindow(Context& context, const QString& databaseFolder, QWidget* parent = nullptr);

    AlterKeyEditor& editor() { return editor_; }
    AlterKeysFilter filter() const;

    // Prints the grid as shown to the printer (a printer or a PDF file), as the document
    // "Alternate items".
    void printTo(QPrinter& printer);

  private:
    void showAlterKeys();
    void addRow();
    void setAltBar();
    void print();
    void arrange();

    AlterKeyEditor editor_;
    QComboBox* searchBy_[2];
    QLineEdit* searchValue_[2];
    QComboBox* sortBy_;
    QComboBox* sortOrder_;
    QLineEdit* altBarCode_;
};

}  // namespace etq

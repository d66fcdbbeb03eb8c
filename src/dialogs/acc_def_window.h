#pragma once

#include "dialogs/editor_window.h"
#include "dialogs/table_editors.h"

namespace etq {

class FileChooser;

// The account definition window frmAccDef: AccountKey, PriceList and LabelName of tAccountDef in
// the grid VSAccountDef, each edit written at once. The price list column offers the host's price
// lists from the SQL Server source (it shows the list's name and keeps its number); the label
// column's "..." button chooses a label design file of the label software kind the control was
// set to. cmdAddAccount adds the account "00000000" to overtype; DelAccountDef deletes the current
// row after a question.
class AccDefWindow : public EditorWindow {
    Q_OBJECT

  public:
    // `chooser` is the window's file dialog (ComDlg1), not owned.
    AccDefWindow(Context& context, const QString& databaseFolder, qint16 labelSoftwareKind,
                 FileChooser& chooser, QWidget* parent = nullptr);

    AccountDefEditor& editor() { return editor_; }
    // The "..." button of a label cell: the label design file chosen with the window's file
    // dialog and the kind's filters; empty when cancelled. The cell takes a chosen file.
    QString chooseLabelFile();

  private:
    void addRow();
    void ReArrangeAccGrid();

    AccountDefEditor editor_;
    qint16 kind_;
    FileChooser& chooser_;
};

}  // namespace etq

#pragma once

#include "dialogs/editor_window.h"
#include "dialogs/table_editors.h"

class QComboBox;
class QLineEdit;

namespace etq {

// The item editor frmEditItems: ItemKey, ItemName, Unit, BarCode and Price of every item in the
// grid VSEditItems, each edit written to tItems at once. cmdShowItems shows the items whose
// searched column holds the search text anywhere, in the order chosen; the search and sort
// choices come from the settings group EditItems when the window opens.
class EditItemsWindow : public EditorWindow {
    Q_OBJECT

  public:
    EditItemsWindow(Context& context, const QString& databaseFolder, QWidget* parent = nullptr);

    ItemEditor& editor() { return editor_; }
    // The choices of the window's search and sort controls.
    ItemsFilter filter() const;

  private:
    void showItems();
    void arrange();

    ItemEditor editor_;
    QComboBox* searchBy_;
    QLineEdit* searchValue_;
    QComboBox* sortBy_;
    QComboBox* sortOrder_;
};

}  // namespace etq

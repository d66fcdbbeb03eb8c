#pragma once

#include <QDialog>

#include "dialogs/item_selection.h"

class QComboBox;
class QLineEdit;
class QTableView;

namespace etq {

class BoundGridModel;
class CardController;
class Surface;

// The item selection window frmSelectItem: the items of the item database in the grid
// VSSelectItems, bound to tItems, so that every tick and copies value is written at once.
// Buttons mark or clear all, set the copies of the ticked items, find by key (and tick) or by
// name (wrapping), and show the marked items only or all.
class SelectItemWindow : public QDialog {
    Q_OBJECT

  public:
    SelectItemWindow(const QString& databaseFolder, const QString& rangeFilter,
                     QWidget* parent = nullptr);
    ~SelectItemWindow() override;

    BoundGridModel& grid() { return *grid_; }
    ItemSelection& selection() { return selection_; }

  private:
    void buildControls();
    void switchToEnglish();
    void showItems(bool markedOnly);
    void applyColumnLayout();
    void goToRow(int row);

    BoundGridModel* grid_;
    ItemSelection selection_;
    QTableView* view_ = nullptr;
    QComboBox* sortBy_ = nullptr;
    QComboBox* sortOrder_ = nullptr;
    QLineEdit* allCopies_ = nullptr;
    QLineEdit* findKey_ = nullptr;
    QLineEdit* findName_ = nullptr;
};

// Wires cmdSelectItems of the control to this window: the label tab's item range narrows the
// list, the database folder is the one the control took for its dialogs.
void connectItemSelection(CardController& controller, const Surface& surface, QWidget* parent);

}  // namespace etq

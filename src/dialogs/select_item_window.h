#pragma once

#include <QDialog>

#include "dialogs/item_selection.h"

class QComboBox;
class QLineEdit;
class QTableView;

namespace etq {

class BoundGridModel;

// The item selection window frmSelectItem: the items of the item database in the grid
// VSSelectItems, bound to tItems, so that every tick and copies value is written at once.
// Buttons mark or clear all, set the copies of the ticked items, find by key (and tick) or by
// name (wrapping), and show the marked items only or all.
class SelectItemWindow : public QDialog {
    Q_OBJECT

  public:
    // `language` is the selector of the run: 1 English, else Hebrew.
    SelectItemWindow(const QString& databaseFolder, const QString& rangeFilter, qint16 language,
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

    qint16 language_;
    BoundGridModel* grid_;
    ItemSelection selection_;
    QTableView* view_ = nullptr;
    QComboBox* sortBy_ = nullptr;
    QComboBox* sortOrder_ = nullptr;
    QLineEdit* allCopies_ = nullptr;
    QLineEdit* findKey_ = nullptr;
    QLineEdit* findName_ = nullptr;
};

}  // namespace etq

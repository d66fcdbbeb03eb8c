#pragma once

#include <QDialog>
#include <functional>
#include <span>

class QTableView;

namespace etq {

class BoundGridModel;
class Context;
class EditorGrid;

// What the three editor windows (items, alternate keys, account definitions) share: a grid
// bound to the item database that writes every edit through, the run's context (language,
// settings store, message boxes), the question before a row is deleted, and the switch to
// English. The buttons' failures are passed over and logged, as the windows always have.
class EditorWindow : public QDialog {
    Q_OBJECT

  public:
    ~EditorWindow() override;

    BoundGridModel& grid() { return *grid_; }
    QTableView* view() const { return view_; }

  protected:
    // The window `name` with its grid `gridName`, right to left; its controls are made by the
    // window itself.
    EditorWindow(Context& context, const QString& name, const QString& title,
                 const QString& gridName, QWidget* parent);

    Context& context() const { return context_; }
    bool english() const;
    // English mode: the title, the controls left to right, the English captions (the lists are
    // the window's to refill).
    void switchToEnglish(const QString& title);
    // Loads the window's settings group into its combo boxes and text boxes.
    void loadSettings(quint8 group);
    // Headers from the caption table for grid columns 1, 2, ...; text columns aligned for the
    // language, the `numberColumns` right-centred. The first row becomes the current one.
    void arrangeGrid(std::span<const int> captions, std::span<const int> numberColumns = {});
    // Asks caption 41 under the title of caption 30; on Yes the current row's record goes.
    void deleteCurrentRow(EditorGrid& editor);
    // The rows selected in the grid, top to bottom.
    QList<int> selectedRows() const;
    // Runs a button's work; a failure is logged with `what` and passed over.
    void passOver(const char* what, const std::function<void()>& work);

  private:
    Context& context_;
    BoundGridModel* grid_;
    QTableView* view_;
};

}  // namespace etq

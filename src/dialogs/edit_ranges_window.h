#pragma once

#include <QDialog>

class QTableView;

namespace etq {

class BoundGridModel;

// The scan range window frmEditRanges: per document file, where the last scan of the document
// import ended and where the next one starts (qWizFileRanges of the document database), in the
// grid VSEditRange, edits written straight to tWizFileRanges. cmdNoneItems makes every next
// scan start from the first record; cmdClose closes the window. Loading and the reset pass over
// failures (they are logged).
class EditRangesWindow : public QDialog {
    Q_OBJECT

  public:
    // `language` is the selector of the run: 1 English, else Hebrew.
    EditRangesWindow(const QString& databaseFolder, qint16 language, QWidget* parent = nullptr);
    ~EditRangesWindow() override;

    BoundGridModel& grid() { return *grid_; }

  private:
    void load();
    void resetAll();
    void applyColumnLayout();

    QString docDbPath_;
    qint16 language_;
    BoundGridModel* grid_;
    QTableView* view_ = nullptr;
};

}  // namespace etq

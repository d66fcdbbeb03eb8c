#pragma once

#include <QDialog>

#include "dialogs/doc_line_selection.h"

class QTableView;

namespace etq {

class BoundGridModel;

// The document line selection window frmSelectDocItem: the documents of the last document
// import in the grid VSDocHeaders, the lines of the current one in VSDocLines, both bound to the
// working database, so that every print flag and every copies value typed is written at once.
// The four buttons include or leave out every document, or every line of the current document.
// Loading, a change of document and the buttons pass over failures (they are logged).
class SelectDocItemWindow : public QDialog {
    Q_OBJECT

  public:
    // `language` is the selector of the run: 1 English, else Hebrew.
    SelectDocItemWindow(const QString& databaseFolder, qint16 language, QWidget* parent = nullptr);
    ~SelectDocItemWindow() override;

    BoundGridModel& documents() { return *documents_; }
    BoundGridModel& lines() { return *lines_; }
    DocLineSelection& selection() { return selection_; }

  private:
    QTableView* makeGrid(const QString& name, BoundGridModel* model);
    void buildControls();
    void loadDocuments(const QString& databaseFolder);
    void showDocument(int row);
    void RearrangeDocLines();

    qint16 language_;
    BoundGridModel* documents_;
    BoundGridModel* lines_;
    DocLineSelection selection_;
    QTableView* documentView_ = nullptr;
    QTableView* lineView_ = nullptr;
};

}  // namespace etq

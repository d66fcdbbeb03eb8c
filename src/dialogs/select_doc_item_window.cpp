#include "dialogs/select_doc_item_window.h"

#include <QGridLayout>
#include <QItemSelectionModel>
#include <QPushButton>
#include <QTableView>

#include "dialogs/bound_grid_model.h"
#include "dialogs/language_switch.h"
#include "dialogs/window_controls.h"
#include "platform/captions.h"
#include "platform/failure.h"
#include "platform/log.h"

namespace etq {

namespace {

using S = DocLineSelection;

// The headers of the document grid's columns 1 to 6 are captions 7 to 12, those of the line
// grid's columns 1 to 7 captions 13 to 19.
constexpr int kFirstDocumentCaption = 7;
constexpr int kFirstLineCaption = 13;
constexpr int kRightCentred = 7;

// Runs a step that passes over its failure, as the window always has.
template <class Step>
void passOver(const char* what, Step&& step) {
    try {
        step();
    } catch (const std::exception& e) {
        qCInfo(log::card) << what << describe(e);
    }
}

}  // namespace

SelectDocItemWindow::SelectDocItemWindow(const QString& databaseFolder, qint16 language,
                                         QWidget* parent)
    : QDialog(parent),
      language_(language),
      documents_(new BoundGridModel(this)),
      lines_(new BoundGridModel(this)),
      selection_(*documents_, *lines_) {
    setObjectName(QStringLiteral("frmSelectDocItem"));
    setWindowTitle(QStringLiteral("בחירת שורות מסמכים להדפסה"));
    setLayoutDirection(Qt::RightToLeft);
    buildControls();
    if (language_ > 0) {
        setWindowTitle(QStringLiteral("Selecting document items for print"));
        MirrorControls(this);
        ApplyTagCaptions(this);
    }
    loadDocuments(databaseFolder);
    resize(820, 620);
}

SelectDocItemWindow::~SelectDocItemWindow() = default;

QTableView* SelectDocItemWindow::makeGrid(const QString& name, BoundGridModel* model) {
    auto* view = new QTableView(this);
    view->setObjectName(name);
    view->setModel(model);
    view->setSelectionBehavior(QAbstractItemView::SelectRows);
    view->setSelectionMode(QAbstractItemView::SingleSelection);
    return view;
}

void SelectDocItemWindow::buildControls() {
    documentView_ = makeGrid(QStringLiteral("VSDocHeaders"), documents_);
    lineView_ = makeGrid(QStringLiteral("VSDocLines"), lines_);
    QPushButton* allDocuments =
        makeButton(QStringLiteral("CmdAllHeaders"), QStringLiteral("סמן את כולם"),
                   QStringLiteral("Select all"), this);
    QPushButton* noDocuments =
        makeButton(QStringLiteral("cmdNoneHeaders"), QStringLiteral("בטל את כולם"),
                   QStringLiteral("Unselect all"), this);
    QPushButton* allLines = makeButton(QStringLiteral("CmdAllLines"), QStringLiteral("סמן את כולם"),
                                       QStringLiteral("Select all"), this);
    QPushButton* noLines = makeButton(QStringLiteral("cmdNoneLines"), QStringLiteral("בטל את כולם"),
                                      QStringLiteral("Unselect all"), this);
    QPushButton* close = makeButton(QStringLiteral("cmdClose"), QStringLiteral("סגור"),
                                    QStringLiteral("Close"), this);

    auto* layout = new QGridLayout(this);
    layout->addWidget(documentView_, 0, 0, 1, 3);
    layout->addWidget(allDocuments, 1, 0);
    layout->addWidget(noDocuments, 1, 1);
    layout->addWidget(lineView_, 2, 0, 1, 3);
    layout->addWidget(allLines, 3, 0);
    layout->addWidget(noLines, 3, 1);
    layout->addWidget(close, 3, 2);
    layout->setRowStretch(0, 1);
    layout->setRowStretch(2, 1);

    connect(allDocuments, &QPushButton::clicked, this,
            [this] { selection_.includeAllDocuments(true); });
    connect(noDocuments, &QPushButton::clicked, this,
            [this] { selection_.includeAllDocuments(false); });
    connect(allLines, &QPushButton::clicked, this, [this] { selection_.includeAllLines(true); });
    connect(noLines, &QPushButton::clicked, this, [this] { selection_.includeAllLines(false); });
    connect(close, &QPushButton::clicked, this, &QDialog::accept);
    connect(documentView_->selectionModel(), &QItemSelectionModel::currentRowChanged, this,
            [this](const QModelIndex& current) {
                if (current.row() != selection_.currentDocument()) showDocument(current.row());
            });
}

void SelectDocItemWindow::loadDocuments(const QString& databaseFolder) {
    passOver("documents to print:", [&] { selection_.openDocuments(databaseFolder); });
    // Which file and which number a document is: the keys of its lines, not for the user.
    documentView_->setColumnHidden(S::kWizFileColumn - 1, true);
    documentView_->setColumnHidden(S::kNumberColumn - 1, true);
    const Qt::Alignment text = BoundGridModel::alignmentOfCode(GetColumnAlignment(language_));
    for (int column = S::kDocTypeColumn; column <= S::kCardNameColumn; ++column) {
        documents_->setAlignment(column - 1, text);
        documents_->setHeader(
            column - 1, GetCaption(kFirstDocumentCaption + column - S::kDocTypeColumn, language_));
    }
    documentView_->resizeColumnsToContents();
    showDocument(0);
}

void SelectDocItemWindow::showDocument(int row) {
    passOver("lines of the document:", [&] { selection_.showLines(row); });
    RearrangeDocLines();
}

// Lays out the line grid anew after its rows were read again.
void SelectDocItemWindow::RearrangeDocLines() {
    const Qt::Alignment text = BoundGridModel::alignmentOfCode(GetColumnAlignment(language_));
    const Qt::Alignment number = BoundGridModel::alignmentOfCode(kRightCentred);
    for (int column = S::kLineNumColumn; column <= S::kLineIncludeColumn; ++column) {
        lines_->setAlignment(column - 1, column <= S::kItemNameColumn ? text : number);
        lines_->setHeader(column - 1,
                          GetCaption(kFirstLineCaption + column - S::kLineNumColumn, language_));
    }
    lineView_->resizeColumnsToContents();
}

}  // namespace etq

#include "dialogs/alter_items_window.h"

#include <QComboBox>
#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPrintDialog>
#include <QPrinter>
#include <QPushButton>
#include <QTableView>

#include "dialogs/bound_grid_model.h"
#include "dialogs/grid_printing.h"
#include "dialogs/language_switch.h"
#include "dialogs/window_controls.h"

namespace etq {

namespace {
const QString kColumns = QStringLiteral("קוד כרטיס;מפתח פריט;מפתח חליפי;בר-קוד חליפי");
const QString kEnglishColumns = QStringLiteral("Card code;Item code;Alt.Code;Alt.Barcode");
constexpr quint8 kSettingsGroup = 12;
}  // namespace

AlterItemsWindow::AlterItemsWindow(Context& context, const QString& databaseFolder, QWidget* parent)
    : EditorWindow(context, QStringLiteral("frmAlterItems"), QStringLiteral("פריטים חלופיים"),
                   QStringLiteral("VSAlterKeys"), parent),
      editor_(grid()),
      sortBy_(makeList(QStringLiteral("cmbAltSortBy"), kColumns, this)),
      sortOrder_(makeList(QStringLiteral("cmbAltSortOrder"), kSortOrderList, this)),
      altBarCode_(makeBox(QStringLiteral("txtAltBarCode"), this)) {
    for (int k = 0; k < 2; ++k) {
        searchBy_[k] = makeList(QStringLiteral("cmbAltSearchBy(%1)").arg(k), kColumns, this);
        searchValue_[k] = makeBox(QStringLiteral("txtAltSearchValue(%1)").arg(k), this);
    }
    QLabel* searchLabel = makeLabel(QStringLiteral("lblAltSearchBy"), QStringLiteral("סינון:"),
                                    QStringLiteral("Filter:"), this);
    QLabel* sortLabel = makeLabel(QStringLiteral("lblAltSortBy"), QStringLiteral("מיון לפי:"),
                                  QStringLiteral("Sort by:"), this);
    QPushButton* show =
        makeButton(QStringLiteral("CmdShowAlterKeys"), QStringLiteral("הצגה / מיון שורות "),
                   QStringLiteral("Show / Sort rows"), this);
    QPushButton* add = makeButton(QStringLiteral("cmdAddAccount"), QStringLiteral("הוסף שורה"),
                                  QStringLiteral("Add row"), this);
    QPushButton* remove = makeButton(QStringLiteral("DelAccountDef"), QStringLiteral("מחק שורה"),
                                     QStringLiteral("Delete row"), this);
    QPushButton* setBar =
        makeButton(QStringLiteral("cmdSetAltBar"), QStringLiteral("הצב ברקוד חליפי"),
                   QStringLiteral("Set alternate barcode"), this);
    QPushButton* print = makeButton(QStringLiteral("cmdPrintAltKeys"), QStringLiteral("הדפס"),
                                    QStringLiteral("Print"), this);
    QPushButton* close = makeButton(QStringLiteral("cmdClose"), QStringLiteral("סגור"),
                                    QStringLiteral("Close"), this);

    auto* layout = new QGridLayout(this);
    layout->addWidget(view(), 0, 0, 1, 5);
    layout->addWidget(searchLabel, 1, 0);
    for (int k = 0; k < 2; ++k) {
        layout->addWidget(searchBy_[k], 1 + k, 1);
        layout->addWidget(searchValue_[k], 1 + k, 2);
    }
    layout->addWidget(show, 1, 3, 3, 1);
    layout->addWidget(sortLabel, 3, 0);
    layout->addWidget(sortBy_, 3, 1);
    layout->addWidget(sortOrder_, 3, 2, Qt::AlignLeading);
    layout->addWidget(setBar, 4, 0);
    layout->addWidget(altBarCode_, 4, 1, 1, 2);
    layout->addWidget(add, 5, 0);
    layout->addWidget(remove, 5, 1);
    layout->addWidget(print, 5, 2);
    layout->addWidget(close, 5, 4);
    layout->setRowStretch(0, 1);
    layout->setColumnStretch(2, 1);

    connect(show, &QPushButton::clicked, this, &AlterItemsWindow::showAlterKeys);
    connect(add, &QPushButton::clicked, this, &AlterItemsWindow::addRow);
    connect(remove, &QPushButton::clicked, this, [this] { deleteCurrentRow(editor_); });
    connect(setBar, &QPushButton::clicked, this, &AlterItemsWindow::setAltBar);
    connect(print, &QPushButton::clicked, this, &AlterItemsWindow::print);
    connect(close, &QPushButton::clicked, this, &QDialog::accept);

    if (english()) {
        switchToEnglish(QStringLiteral("Alternate items"));
        for (QComboBox* list : {searchBy_[0], searchBy_[1], sortBy_})
            FillComboFromList(list, kEnglishColumns);
        FillComboFromList(sortOrder_, kEnglishSortOrderList);
    }
    loadSettings(kSettingsGroup);
    editor_.setDatabaseFolder(databaseFolder);
    showAlterKeys();
    resize(760, 600);
}

AlterKeysFilter AlterItemsWindow::filter() const {
    AlterKeysFilter f;
    for (int k = 0; k < 2; ++k)
        f.searches.append({searchBy_[k]->currentIndex(), searchValue_[k]->text()});
    f.sortBy = sortBy_->currentIndex();
    f.sortOrder = sortOrder_->currentIndex();
    return f;
}

void AlterItemsWindow::showAlterKeys() {
    passOver("show", [this] { editor_.show(filter()); });
    arrange();
}

void AlterItemsWindow::addRow() {
    passOver("add", [this] { editor_.addRow(); });
    arrange();
}

void AlterItemsWindow::setAltBar() {
    passOver("set alternate barcode",
             [this] { editor_.setAltBar(selectedRows(), altBarCode_->text()); });
}

void AlterItemsWindow::printTo(QPrinter& printer) {
    printer.setDocName(QStringLiteral("Alternate items"));
    PrintGrid(grid(), printer, english() ? Qt::LeftToRight : Qt::RightToLeft);
}

void AlterItemsWindow::print() {
    QPrinter printer(QPrinter::HighResolution);
    QPrintDialog dialog(&printer, this);
    if (dialog.exec() == QDialog::Accepted) printTo(printer);
}

// ArrangeAlterKeysGrid: the headers and the texts aligned for the language.
void AlterItemsWindow::arrange() {
    arrangeGrid(AlterKeyEditor::kHeaderCaptions);
}

}  // namespace etq

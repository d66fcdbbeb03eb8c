#include "dialogs/edit_items_window.h"

#include <QComboBox>
#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QTableView>

#include "dialogs/language_switch.h"
#include "dialogs/window_controls.h"

namespace etq {

namespace {
const QString kColumns = QStringLiteral("מפתח פריט;שם פריט;בר-קוד");
const QString kEnglishColumns = QStringLiteral("Item code;Item name;Bar-code");
constexpr int kPriceColumn = 5;
constexpr quint8 kSettingsGroup = 11;
}  // namespace

EditItemsWindow::EditItemsWindow(Context& context, const QString& databaseFolder, QWidget* parent)
    : EditorWindow(context, QStringLiteral("frmEditItems"), QStringLiteral("עריכת פריטים"),
                   QStringLiteral("VSEditItems"), parent),
      editor_(grid()),
      searchBy_(makeList(QStringLiteral("cmbItmSearchBy"), kColumns, this)),
      searchValue_(makeBox(QStringLiteral("txtItmSearchValue"), this)),
      sortBy_(makeList(QStringLiteral("cmbItmSortBy"), kColumns, this)),
      sortOrder_(makeList(QStringLiteral("cmbItmSortOrder"), kSortOrderList, this)) {
    QLabel* searchLabel = makeLabel(QStringLiteral("lblItmSearchBy"), QStringLiteral("חיפוש לפי:"),
                                    QStringLiteral("Search by:"), this);
    QLabel* sortLabel = makeLabel(QStringLiteral("lblItmSortBy"), QStringLiteral("מיון לפי:"),
                                  QStringLiteral("Sort by:"), this);
    QPushButton* show =
        makeButton(QStringLiteral("cmdShowItems"), QStringLiteral("חיפוש / מיון שורות "),
                   QStringLiteral("Search / Sort rows"), this);
    QPushButton* close = makeButton(QStringLiteral("cmdClose"), QStringLiteral("סגור"),
                                    QStringLiteral("Close"), this);

    auto* layout = new QGridLayout(this);
    layout->addWidget(view(), 0, 0, 1, 5);
    layout->addWidget(searchLabel, 1, 0);
    layout->addWidget(searchBy_, 1, 1);
    layout->addWidget(searchValue_, 1, 2);
    layout->addWidget(show, 1, 3, 2, 1);
    layout->addWidget(sortLabel, 2, 0);
    layout->addWidget(sortBy_, 2, 1);
    layout->addWidget(sortOrder_, 2, 2, Qt::AlignLeading);
    layout->addWidget(close, 3, 4);
    layout->setRowStretch(0, 1);
    layout->setColumnStretch(2, 1);

    connect(show, &QPushButton::clicked, this, &EditItemsWindow::showItems);
    connect(close, &QPushButton::clicked, this, &QDialog::accept);

    if (english()) {
        switchToEnglish(QStringLiteral("Edit items"));
        FillComboFromList(searchBy_, kEnglishColumns);
        FillComboFromList(sortBy_, kEnglishColumns);
        FillComboFromList(sortOrder_, kEnglishSortOrderList);
    }
    loadSettings(kSettingsGroup);
    editor_.setDatabaseFolder(databaseFolder);
    passOver("open", [this] { editor_.show(QStringLiteral("qEditItems")); });
    arrange();
    resize(760, 560);
}

ItemsFilter EditItemsWindow::filter() const {
    ItemsFilter f;
    f.searchBy = searchBy_->currentIndex();
    f.search = searchValue_->text();
    f.sortBy = sortBy_->currentIndex();
    f.sortOrder = sortOrder_->currentIndex();
    return f;
}

void EditItemsWindow::showItems() {
    passOver("show", [this] { editor_.show(filter()); });
    arrange();
}

// ArrangeEditItemsGrid: the headers, the texts aligned for the language, the price as a number.
void EditItemsWindow::arrange() {
    const int numbers[] = {kPriceColumn};
    arrangeGrid(ItemEditor::kHeaderCaptions, numbers);
}

}  // namespace etq

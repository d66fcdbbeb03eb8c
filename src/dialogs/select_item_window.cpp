#include "dialogs/select_item_window.h"

#include <QComboBox>
#include <QGridLayout>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
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

// A button or label of the window: its name, Hebrew caption and English caption (its tag).
struct Caption {
    QStringView name;
    QStringView hebrew;
    QStringView english;
};

constexpr Caption kCaptions[] = {
    {u"CmdAllItems", u"סמן את כולם", u"Select all"},
    {u"cmdNoneItems", u"בטל את כולם", u"Unselect all"},
    {u"CmdAllCopies", u"הצב כמות לנבחרים:", u"Set copies for selected:"},
    {u"cmdFindKey", u"איתור פריט לפי מפתח:", u"Find item by key:"},
    {u"cmdFindByDesc", u"איתור פריט לפי תאור:", u"Find item by name:"},
    {u"cmdShowMarked", u"הצג רק מסומנים", u"Show selected only"},
    {u"cmdShowAll", u"הצג את כולם", u"Show all"},
    {u"cmdClose", u"סגור", u"Close"},
    {u"lblSortBy", u"מיון לפי:", u"Sort by:"},
};

const Caption& captionOf(QStringView name) {
    for (const Caption& c : kCaptions)
        if (c.name == name) return c;
    Q_UNREACHABLE();
}

// The grid's headers are captions 14, 19, 18 and 15 for its columns 1 to 4.
constexpr int kHeaderCaptions[] = {14, 19, 18, 15};
constexpr int kRightCentred = 7;

QPushButton* makeButton(QStringView name, QWidget* parent) {
    const Caption& c = captionOf(name);
    return etq::makeButton(name.toString(), c.hebrew.toString(), c.english.toString(), parent);
}

}  // namespace

SelectItemWindow::SelectItemWindow(const QString& databaseFolder, const QString& rangeFilter,
                                   qint16 language, QWidget* parent)
    : QDialog(parent),
      language_(language),
      grid_(new BoundGridModel(this)),
      selection_(*grid_, rangeFilter) {
    setObjectName(QStringLiteral("frmSelectItem"));
    setWindowTitle(QStringLiteral("בחירת פריטים להדפסה"));
    setLayoutDirection(Qt::RightToLeft);
    buildControls();
    if (language_ > 0) switchToEnglish();
    sortBy_->setCurrentIndex(0);
    sortOrder_->setCurrentIndex(0);
    try {
        selection_.open(databaseFolder, qint16(sortBy_->currentIndex()),
                        qint16(sortOrder_->currentIndex()));
    } catch (const std::exception& e) {
        // An item database that cannot be opened leaves the grid empty, as its data control does.
        qCInfo(log::card) << "item selection:" << describe(e);
    }
    applyColumnLayout();
    resize(720, 560);
}

SelectItemWindow::~SelectItemWindow() = default;

void SelectItemWindow::buildControls() {
    view_ = new QTableView(this);
    view_->setObjectName(QStringLiteral("VSSelectItems"));
    view_->setModel(grid_);
    view_->setSelectionBehavior(QAbstractItemView::SelectRows);
    view_->setSelectionMode(QAbstractItemView::SingleSelection);

    sortBy_ = makeList(QStringLiteral("cmbItmSortBy"), QStringLiteral("מפתח פריט;שם פריט"), this);
    sortOrder_ = makeList(QStringLiteral("cmbItmSortOrder"), kSortOrderList, this);
    const Caption& sortCaption = captionOf(u"lblSortBy");
    QLabel* sortLabel = makeLabel(QStringLiteral("lblSortBy"), sortCaption.hebrew.toString(),
                                  sortCaption.english.toString(), this);
    allCopies_ = makeBox(QStringLiteral("txtAllCopis"), this);
    findKey_ = makeBox(QStringLiteral("txtToItemKey"), this);
    findName_ = makeBox(QStringLiteral("txtToItemName"), this);

    QPushButton* markAll = makeButton(u"CmdAllItems", this);
    QPushButton* clearAll = makeButton(u"cmdNoneItems", this);
    QPushButton* setCopies = makeButton(u"CmdAllCopies", this);
    QPushButton* findKey = makeButton(u"cmdFindKey", this);
    QPushButton* findName = makeButton(u"cmdFindByDesc", this);
    QPushButton* showMarked = makeButton(u"cmdShowMarked", this);
    QPushButton* showAll = makeButton(u"cmdShowAll", this);
    QPushButton* close = makeButton(u"cmdClose", this);

    auto* layout = new QGridLayout(this);
    layout->addWidget(view_, 0, 0, 1, 4);
    layout->addWidget(markAll, 1, 0);
    layout->addWidget(clearAll, 1, 1);
    layout->addWidget(showMarked, 1, 2);
    layout->addWidget(showAll, 1, 3);
    layout->addWidget(setCopies, 2, 0);
    layout->addWidget(allCopies_, 2, 1);
    layout->addWidget(sortLabel, 2, 2);
    auto* sorts = new QHBoxLayout;
    sorts->addWidget(sortBy_);
    sorts->addWidget(sortOrder_);
    layout->addLayout(sorts, 2, 3);
    layout->addWidget(findKey, 3, 0);
    layout->addWidget(findKey_, 3, 1);
    layout->addWidget(findName, 3, 2);
    layout->addWidget(findName_, 3, 3);
    layout->addWidget(close, 4, 3);
    layout->setRowStretch(0, 1);

    connect(markAll, &QPushButton::clicked, this, [this] { selection_.markAll(true); });
    connect(clearAll, &QPushButton::clicked, this, [this] { selection_.markAll(false); });
    connect(setCopies, &QPushButton::clicked, this,
            [this] { selection_.setCopies(allCopies_->text()); });
    connect(findKey, &QPushButton::clicked, this,
            [this] { goToRow(selection_.findByKey(findKey_->text())); });
    connect(findName, &QPushButton::clicked, this, [this] {
        goToRow(selection_.findByName(findName_->text(), view_->currentIndex().row()));
    });
    connect(showMarked, &QPushButton::clicked, this, [this] { showItems(true); });
    connect(showAll, &QPushButton::clicked, this, [this] { showItems(false); });
    connect(close, &QPushButton::clicked, this, &QDialog::accept);
}

void SelectItemWindow::switchToEnglish() {
    setWindowTitle(QStringLiteral("Selecting items for print"));
    MirrorControls(this);
    ApplyTagCaptions(this);
    FillComboFromList(sortBy_, QStringLiteral("Item code;Item Name"));
    FillComboFromList(sortOrder_, kEnglishSortOrderList);
    findName_->setAlignment(Qt::AlignLeft | Qt::AlignAbsolute);
}

void SelectItemWindow::showItems(bool markedOnly) {
    try {
        selection_.show(markedOnly, qint16(sortBy_->currentIndex()),
                        qint16(sortOrder_->currentIndex()));
    } catch (const std::exception& e) {
        // The buttons pass over failures; the grid stays empty.
        qCInfo(log::card) << "item selection:" << describe(e);
    }
    applyColumnLayout();
}

void SelectItemWindow::applyColumnLayout() {
    for (int column = 0; column < 4 && column < grid_->columnCount(); ++column)
        grid_->setHeader(column, GetCaption(kHeaderCaptions[column], language_));
    const Qt::Alignment text = BoundGridModel::alignmentOfCode(GetColumnAlignment(language_));
    const Qt::Alignment number = BoundGridModel::alignmentOfCode(kRightCentred);
    grid_->setAlignment(ItemSelection::kKeyColumn - 1, text);
    grid_->setAlignment(ItemSelection::kMarkColumn - 1, number);
    grid_->setAlignment(ItemSelection::kCopiesColumn - 1, number);
    grid_->setAlignment(ItemSelection::kNameColumn - 1, text);
    view_->resizeColumnsToContents();
}

void SelectItemWindow::goToRow(int row) {
    if (row < 0) return;
    const QModelIndex index = grid_->index(row, ItemSelection::kKeyColumn - 1);
    view_->setCurrentIndex(index);
    view_->scrollTo(index);
}

}  // namespace etq

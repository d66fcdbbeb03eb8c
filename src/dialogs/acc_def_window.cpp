#include "dialogs/acc_def_window.h"

#include <QComboBox>
#include <QGridLayout>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QLineEdit>
#include <QPushButton>
#include <QStyledItemDelegate>
#include <QTableView>
#include <QToolButton>

#include "dialogs/bound_grid_model.h"
#include "dialogs/window_controls.h"
#include "platform/context.h"
#include "print/label_software.h"

namespace etq {

namespace {

// Grid widths are laid out in twips; 15 twips make a pixel on a 96 dots per inch screen.
constexpr int kTwipsPerPixel = 15;

// The price list column: a drop-down of the host's price lists, led by an empty entry; the cell
// keeps the list's number and shows its name. Without lists it is a plain cell.
class PriceListDelegate : public QStyledItemDelegate {
  public:
    PriceListDelegate(const AccountDefEditor& editor, QObject* parent)
        : QStyledItemDelegate(parent), editor_(editor) {}

    QString displayText(const QVariant& value, const QLocale& locale) const override {
        bool number = false;
        const int list = value.toInt(&number);
        if (number)
            for (const ListEntry& entry : editor_.priceLists())
                if (entry.data == list) return entry.text;
        return QStyledItemDelegate::displayText(value, locale);
    }
    QWidget* createEditor(QWidget* parent, const QStyleOptionViewItem& option,
                          const QModelIndex& index) const override {
        if (editor_.priceLists().isEmpty())
            return QStyledItemDelegate::createEditor(parent, option, index);
        auto* combo = new QComboBox(parent);
        combo->setObjectName(QStringLiteral("PriceListCombo"));
        combo->addItem(QString(), QVariant());
        for (const ListEntry& entry : editor_.priceLists())
            combo->addItem(entry.text, entry.data);
        return combo;
    }
    void setEditorData(QWidget* widget, const QModelIndex& index) const override {
        auto* combo = qobject_cast<QComboBox*>(widget);
        if (!combo) return QStyledItemDelegate::setEditorData(widget, index);
        const QVariant value = index.data(Qt::EditRole);
        const int at = value.isNull() ? 0 : combo->findData(value.toInt());
        combo->setCurrentIndex(std::max(at, 0));
    }
    void setModelData(QWidget* widget, QAbstractItemModel* model,
                      const QModelIndex& index) const override {
        auto* combo = qobject_cast<QComboBox*>(widget);
        if (!combo) return QStyledItemDelegate::setModelData(widget, model, index);
        model->setData(index, combo->currentData(), Qt::EditRole);
    }

  private:
    const AccountDefEditor& editor_;
};

// The label column: the cell's text with an ellipsis button ("...") that chooses a file. A path
// reads left to right also in the right-to-left grid.
class LabelFileDelegate : public QStyledItemDelegate {
  public:
    LabelFileDelegate(AccDefWindow& window, QObject* parent)
        : QStyledItemDelegate(parent), window_(window) {}

    void initStyleOption(QStyleOptionViewItem* option, const QModelIndex& index) const override {
        QStyledItemDelegate::initStyleOption(option, index);
        option->direction = Qt::LeftToRight;
    }

    QWidget* createEditor(QWidget* parent, const QStyleOptionViewItem&,
                          const QModelIndex& index) const override {
        auto* editor = new QWidget(parent);
        editor->setAutoFillBackground(true);
        auto* text = new QLineEdit(editor);
        text->setObjectName(QStringLiteral("LabelNameText"));
        text->setLayoutDirection(Qt::LeftToRight);
        auto* ellipsis = new QToolButton(editor);
        ellipsis->setObjectName(QStringLiteral("LabelNameEllipsis"));
        ellipsis->setText(QStringLiteral("..."));
        auto* layout = new QHBoxLayout(editor);
        layout->setContentsMargins(0, 0, 0, 0);
        layout->setSpacing(0);
        layout->addWidget(text);
        layout->addWidget(ellipsis);
        QObject::connect(ellipsis, &QToolButton::clicked, editor, [this, editor, text] {
            const QString file = window_.chooseLabelFile();
            if (file.isEmpty()) return;
            text->setText(file);
            auto* self = const_cast<LabelFileDelegate*>(this);
            Q_EMIT self->commitData(editor);
            Q_EMIT self->closeEditor(editor);
        });
        return editor;
    }
    void setEditorData(QWidget* editor, const QModelIndex& index) const override {
        textOf(editor)->setText(index.data(Qt::DisplayRole).toString());
    }
    void setModelData(QWidget* editor, QAbstractItemModel* model,
                      const QModelIndex& index) const override {
        model->setData(index, textOf(editor)->text(), Qt::EditRole);
    }

  private:
    static QLineEdit* textOf(QWidget* editor) {
        return editor->findChild<QLineEdit*>(QStringLiteral("LabelNameText"));
    }
    AccDefWindow& window_;
};

}  // namespace

AccDefWindow::AccDefWindow(Context& context, const QString& databaseFolder,
                           qint16 labelSoftwareKind, FileChooser& chooser, QWidget* parent)
    : EditorWindow(context, QStringLiteral("frmAccDef"), QStringLiteral("הגדרות לקוח/ספק"),
                   QStringLiteral("VSAccountDef"), parent),
      editor_(grid()),
      kind_(labelSoftwareKind),
      chooser_(chooser) {
    QPushButton* add =
        makeButton(QStringLiteral("cmdAddAccount"), QStringLiteral("הוסף הגדרת כרטיס"),
                   QStringLiteral("Add card definition"), this);
    QPushButton* remove =
        makeButton(QStringLiteral("DelAccountDef"), QStringLiteral("מחק הגדרת כרטיס"),
                   QStringLiteral("Delete card definition"), this);
    QPushButton* close = makeButton(QStringLiteral("cmdClose"), QStringLiteral("סגור"),
                                    QStringLiteral("Close"), this);

    auto* layout = new QGridLayout(this);
    layout->addWidget(view(), 0, 0, 1, 4);
    layout->addWidget(add, 1, 0);
    layout->addWidget(remove, 1, 1);
    layout->addWidget(close, 1, 3);
    layout->setRowStretch(0, 1);
    layout->setColumnStretch(2, 1);

    view()->setItemDelegateForColumn(AccountDefEditor::kPriceListColumn - 1,
                                     new PriceListDelegate(editor_, this));
    view()->setItemDelegateForColumn(AccountDefEditor::kLabelColumn - 1,
                                     new LabelFileDelegate(*this, this));

    connect(add, &QPushButton::clicked, this, &AccDefWindow::addRow);
    connect(remove, &QPushButton::clicked, this, [this] { deleteCurrentRow(editor_); });
    connect(close, &QPushButton::clicked, this, &QDialog::accept);

    if (english()) switchToEnglish(QStringLiteral("Customer/Supplier definitions"));
    editor_.setDatabaseFolder(databaseFolder);
    passOver("open", [this] { editor_.show(); });
    ReArrangeAccGrid();
    resize(560, 480);
}

void AccDefWindow::addRow() {
    passOver("add", [this] { editor_.addRow(); });
    if (grid().rowCount() > 0) view()->setCurrentIndex(grid().index(grid().rowCount() - 1, 0));
}

QString AccDefWindow::chooseLabelFile() {
    return SelectLabelFile(kind_, chooser_);
}

// The headers, the widths, the price lists of the drop-down and the label column's button.
void AccDefWindow::ReArrangeAccGrid() {
    arrangeGrid(AccountDefEditor::kHeaderCaptions);
    for (int column = 1; column <= int(std::size(AccountDefEditor::kColumnWidths)); ++column)
        view()->setColumnWidth(column - 1,
                               AccountDefEditor::kColumnWidths[column - 1] / kTwipsPerPixel);
    editor_.FillPriceListColumn(context().connection);
    view()->viewport()->update();
}

}  // namespace etq

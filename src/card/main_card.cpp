#include "card/main_card.h"

#include <QCheckBox>
#include <QComboBox>
#include <QGridLayout>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QMouseEvent>
#include <QPushButton>
#include <QRadioButton>
#include <QStyle>
#include <QTabWidget>
#include <QTableView>
#include <QToolButton>
#include <set>

#include "card/card_controller.h"
#include "card/component.h"
#include "card/editor_commands.h"
#include "card/print_adapters.h"
#include "dialogs/bound_grid_model.h"
#include "dialogs/edit_ranges_window.h"
#include "dialogs/label_designer_window.h"
#include "dialogs/logon_dialog.h"
#include "dialogs/select_doc_item_window.h"
#include "dialogs/select_item_window.h"
#include "platform/captions.h"
#include "platform/context.h"
#include "platform/qt_file_chooser.h"
#include "print/label_pdf.h"
#include "print/label_query.h"
#include "surface/control_values.h"
#include "surface/surface_controls.h"

namespace etq {

namespace {

// A label that reports clicks: the copy labels of the surface act like buttons.
class ClickLabel : public QLabel {
    Q_OBJECT

  public:
    using QLabel::QLabel;

  Q_SIGNALS:
    void clicked();

  protected:
    void mouseReleaseEvent(QMouseEvent* event) override {
        if (event->button() == Qt::LeftButton && rect().contains(event->position().toPoint()))
            Q_EMIT clicked();
        QLabel::mouseReleaseEvent(event);
    }
};

// The progress bar's frame; its fill grows from the leading (right-hand) edge.
class ProgressShape : public QFrame {
  public:
    using QFrame::QFrame;
    void setFill(QWidget* fill) {
        fill_ = fill;
        placeFill();
    }
    void placeFill() {
        if (!fill_) return;
        const int w = fill_->width();
        const int x = layoutDirection() == Qt::RightToLeft ? width() - w : 0;
        fill_->setGeometry(x, 0, w, height());
    }

  protected:
    void resizeEvent(QResizeEvent* event) override {
        QFrame::resizeEvent(event);
        placeFill();
    }

  private:
    QWidget* fill_ = nullptr;
};

constexpr int kBoxWidth = 150;
constexpr int kPathBoxWidth = 380;
constexpr int kButtonWidth = 200;
constexpr int kSpacerColumnWidth = 24;
constexpr int kProgressHeight = 12;

// Text boxes that hold paths and names get the room they need.
bool isWideBox(QStringView name) {
    return name == u"txtCompanyName" || name == u"txtDBPath" || name == u"txtLabelSoftware" ||
           name == u"txtLabelName" || name == u"txtLabelNameHead";
}

QIcon pictureIcon(QStringView name, QStyle* style) {
    if (name == u"Image3" || name == u"Image7")
        return style->standardIcon(QStyle::SP_FileDialogDetailedView);
    if (name == u"Image5" || name == u"Image8")
        return style->standardIcon(QStyle::SP_DialogApplyButton);
    if (name == u"Image6") return style->standardIcon(QStyle::SP_BrowserReload);
    if (name == u"CmdDir") return style->standardIcon(QStyle::SP_DirOpenIcon);
    return style->standardIcon(QStyle::SP_FileDialogContentsView);  // ImgEdit
}

}  // namespace

// A widget of the card seen as a control of the surface.
class MainCard::WidgetControl : public Control {
  public:
    WidgetControl(MainCard& card, QWidget* widget, ControlKind kind)
        : card_(card), widget_(widget), kind_(kind) {}

    ControlKind kind() const override { return kind_; }
    int tab() const override {
        for (QWidget* w = widget_; w; w = w->parentWidget()) {
            const int i = card_.mainTab_->indexOf(w);
            if (i >= 0) return i;
        }
        return -1;
    }

    QString text() const override {
        if (auto* edit = qobject_cast<QLineEdit*>(widget_)) return edit->text();
        return {};
    }
    void setText(const QString& text) override {
        if (auto* edit = qobject_cast<QLineEdit*>(widget_)) edit->setText(text);
    }
    QString caption() const override {
        if (auto* label = qobject_cast<QLabel*>(widget_)) return label->text();
        if (auto* button = qobject_cast<QAbstractButton*>(widget_)) return button->text();
        if (auto* frame = qobject_cast<QGroupBox*>(widget_)) return frame->title();
        return {};
    }
    void setCaption(const QString& caption) override {
        if (auto* label = qobject_cast<QLabel*>(widget_)) label->setText(caption);
        if (auto* button = qobject_cast<QAbstractButton*>(widget_)) button->setText(caption);
        if (auto* frame = qobject_cast<QGroupBox*>(widget_)) frame->setTitle(caption);
    }
    int state() const override {
        if (auto* box = qobject_cast<QCheckBox*>(widget_)) return checkValue(box->checkState());
        if (auto* option = qobject_cast<QRadioButton*>(widget_)) return option->isChecked();
        return 0;
    }
    void setState(int state) override {
        if (auto* box = qobject_cast<QCheckBox*>(widget_)) {
            box->setTristate(state == 2);
            box->setCheckState(checkState(state));
        } else if (auto* option = qobject_cast<QRadioButton*>(widget_)) {
            setOption(option, state != 0);
        }
    }
    int listIndex() const override { return combo() ? combo()->currentIndex() : -1; }
    void setListIndex(int index) override {
        if (combo()) combo()->setCurrentIndex(index);
    }
    int listCount() const override { return combo() ? combo()->count() : 0; }
    QString itemText(int i) const override { return combo() ? combo()->itemText(i) : QString(); }
    int itemData(int i) const override { return combo() ? combo()->itemData(i).toInt() : 0; }
    void addItem(const QString& text, int data) override {
        if (!combo()) return;
        // A list gets a selection only when one is made; Qt would select its first entry.
        const bool noSelection = combo()->currentIndex() < 0;
        combo()->addItem(text, data);
        if (noSelection) combo()->setCurrentIndex(-1);
    }
    void clearList() override {
        if (combo()) combo()->clear();
    }
    int currentTab() const override { return tabs() ? tabs()->currentIndex() : -1; }
    void setCurrentTab(int tab) override {
        if (tabs()) tabs()->setCurrentIndex(tab);
    }
    int tabCount() const override { return tabs() ? tabs()->count() : 0; }

    bool visible() const override { return !widget_->isHidden(); }
    void setVisible(bool visible) override { widget_->setVisible(visible); }
    QString tag() const override { return widget_->property("Tag").toString(); }
    void setTag(const QString& tag) override { widget_->setProperty("Tag", tag); }
    QString toolTip() const override { return widget_->toolTip(); }
    void setToolTip(const QString& toolTip) override { widget_->setToolTip(toolTip); }
    int width() const override { return widget_->width(); }
    void setWidth(int width) override {
        if (auto* frame = dynamic_cast<ProgressShape*>(widget_->parentWidget())) {
            widget_->resize(width, frame->height());
            frame->placeFill();
        } else {
            widget_->setFixedWidth(width);
        }
    }
    void setFocus() override { widget_->setFocus(); }

  private:
    QComboBox* combo() const { return qobject_cast<QComboBox*>(widget_); }
    QTabWidget* tabs() const { return qobject_cast<QTabWidget*>(widget_); }

    // A check box's value: 0 clear, 1 checked, 2 grey; Qt numbers its states otherwise.
    static int checkValue(Qt::CheckState state) {
        return state == Qt::Checked ? 1 : state == Qt::PartiallyChecked ? 2 : 0;
    }
    static Qt::CheckState checkState(int value) {
        return value == 1 ? Qt::Checked : value == 2 ? Qt::PartiallyChecked : Qt::Unchecked;
    }

    // Qt keeps one option of a frame selected; a routine may clear them all.
    static void setOption(QRadioButton* option, bool selected) {
        if (selected || !option->isChecked()) {
            option->setChecked(selected);
            return;
        }
        option->setAutoExclusive(false);
        option->setChecked(false);
        option->setAutoExclusive(true);
    }

    MainCard& card_;
    QWidget* widget_;
    ControlKind kind_;
};

MainCard::MainCard(Context& context, QWidget* parent)
    : QWidget(parent), chooser_(std::make_unique<QtFileChooser>(this)) {
    setObjectName(QStringLiteral("MainCard"));
    setLayoutDirection(Qt::RightToLeft);
    buildControls();
    controller_ = std::make_unique<CardController>(*this, context);
    controller_->setFileChooser(chooser_.get());
    controller_->setWork(QStringLiteral("CmdConnect"), [this, &context](int) {
        LogonDialog dialog(context, this);
        dialog.exec();
    });
    connectDocTypeGrid();
    connectItemSelection();
    connectDocumentWindows();
    connectLabelDesigner();
    connectEditors(*controller_, *this, this);
    connectParts(*controller_, *this);
}

// cmdSelectDocItems opens the document line selection window, cmdRanges the scan range window,
// each on the database folder the control took for its dialogs.
void MainCard::connectDocumentWindows() {
    controller_->setWork(QStringLiteral("cmdSelectDocItems"), [this](int) {
        SelectDocItemWindow window(controller_->databaseFolder(), controller_->context().language,
                                   this);
        window.exec();
    });
    controller_->setWork(QStringLiteral("cmdRanges"), [this](int) {
        EditRangesWindow window(controller_->databaseFolder(), controller_->context().language,
                                this);
        window.exec();
    });
}

// cmdLabDesign opens the label designer on the run's definition; the card is its surface
// reference, the database folder the one the control took for its dialogs.
void MainCard::connectLabelDesigner() {
    controller_->setWork(QStringLiteral("cmdLabDesign"), [this](int) {
        const std::unique_ptr<LabelDesignerWindow> window =
            makeLabelDesigner(controller_->databaseFolder());
        window->exec();
    });
}

std::unique_ptr<LabelDesignerWindow> MainCard::makeLabelDesigner(const QString& databaseFolder) {
    const ItemPrintOptions options = readItemPrintOptions(SurfaceValues(*this));
    LabelPreviewSource source{databaseFolder, options.page};
    if (options.printer) source.paper = printerPaperSize(*options.printer);
    return std::make_unique<LabelDesignerWindow>(controller_->context(), *this, source, this);
}

// cmdSelectItems opens the item selection window: the label tab's item range narrows the list,
// the database folder is the one the control took for its dialogs.
void MainCard::connectItemSelection() {
    controller_->setWork(QStringLiteral("cmdSelectItems"), [this](int) {
        const QString filter = ItemKeyRangeCondition(control(QStringLiteral("txtFromItem")).text(),
                                                     control(QStringLiteral("txtToItem")).text());
        SelectItemWindow window(controller_->databaseFolder(), filter,
                                controller_->context().language, this);
        window.exec();
    });
}

// The document type grid of tab 6 is bound to qSelectDocTypes of the document database: its
// scan and draft boxes write straight through to tDocTypes.
void MainCard::connectDocTypeGrid() {
    auto* view = findChild<QTableView*>(QStringLiteral("VSDocTypes"));
    if (!view) return;
    docTypes_ = new BoundGridModel(this);
    view->setModel(docTypes_);
    CardHooks& hooks = controller_->hooks();
    hooks.showDocTypes = [this, view](const QString& documentDatabase) {
        docTypes_->setDatabaseName(documentDatabase);
        docTypes_->setRecordSource(QStringLiteral("qSelectDocTypes"));
        docTypes_->refresh();
        // Column 1 left-centred; the headers are captions 7, 27 and 28.
        docTypes_->setAlignment(0, BoundGridModel::alignmentOfCode(1));
        const int captions[] = {7, 27, 28};
        for (int column = 0; column < 3 && column < docTypes_->columnCount(); ++column)
            docTypes_->setHeader(column,
                                 GetCaption(captions[column], controller_->context().language));
        view->resizeColumnsToContents();
    };
    hooks.markAllDocTypes = [this](bool scan) {
        for (int row = 0; row < docTypes_->rowCount(); ++row)
            docTypes_->setData(docTypes_->index(row, 1), scan ? Qt::Checked : Qt::Unchecked,
                               Qt::CheckStateRole);
    };
}

MainCard::~MainCard() = default;

void MainCard::InitProperties(const QString& settingId) {
    controller_->InitProperties(settingId);
}

int MainCard::elementCount(const QString& name) const {
    const QString prefix = name + u'(';
    int count = 0;
    for (auto it = byName_.cbegin(); it != byName_.cend(); ++it)
        if (it.key().startsWith(prefix)) ++count;
    return count;
}

Control* MainCard::find(const QString& name, int index) const {
    return byName_.value(elementName(name, index));
}

void MainCard::buildControls() {
    auto* outer = new QGridLayout(this);
    mainTab_ = new QTabWidget(this);
    QHash<QString, QGridLayout*> grids;  // by container: "tab0".."tab7", frame names, ""
    grids.insert(QString(), outer);
    const QStringList captions = tabCaptions();
    for (int i = 0; i < kTabCount; ++i) {
        auto* page = new QWidget;
        page->setObjectName(QStringLiteral("MainTabPage%1").arg(i));
        mainTab_->addTab(page, captions[i]);
        grids.insert(QStringLiteral("tab%1").arg(i), new QGridLayout(page));
    }

    // Which grid columns hold something, to give the empty ones some room.
    QHash<QGridLayout*, std::set<int>> usedColumns;
    std::set<QGridLayout*> gridsWithView;
    for (const ControlSpec& spec : surfaceControls()) {
        const QString name = spec.name.toString();
        const QString key = !spec.container.isEmpty() ? spec.container.toString()
                            : spec.tab >= 0           ? QStringLiteral("tab%1").arg(spec.tab)
                                                      : QString();
        QWidget* widget = nullptr;
        if (spec.kind == ControlKind::TabStrip) {
            widget = mainTab_;
        } else if (spec.container == u"ProgressFrame") {
            widget = makeWidget(spec, findChild<QWidget*>(key));
        } else {
            widget = makeWidget(spec, nullptr);
        }
        widget->setObjectName(elementName(name, spec.index));
        widget->setProperty("Tag", spec.tag.toString());
        if (!spec.toolTip.isEmpty()) widget->setToolTip(spec.toolTip.toString());
        if (auto* frame = qobject_cast<QGroupBox*>(widget))
            grids.insert(name, new QGridLayout(frame));

        if (spec.container == u"ProgressFrame") {
            static_cast<ProgressShape*>(widget->parentWidget())->setFill(widget);
        } else {
            QGridLayout* grid = grids.value(key);
            Qt::Alignment alignment;
            if (spec.kind == ControlKind::CommandButton)
                alignment = Qt::AlignLeading | Qt::AlignTop;
            if (spec.kind == ControlKind::Picture) alignment = Qt::AlignCenter;
            grid->addWidget(widget, spec.row, spec.column, spec.rowSpan, spec.columnSpan,
                            alignment);
            for (int c = spec.column; c < spec.column + spec.columnSpan; ++c)
                usedColumns[grid].insert(c);
            if (spec.kind == ControlKind::Grid) {
                gridsWithView.insert(grid);
                grid->setRowStretch(spec.row + spec.rowSpan - 1, 1);
                for (int c = spec.column; c < spec.column + spec.columnSpan; ++c)
                    grid->setColumnStretch(c, 1);
            }
        }
        connectEvents(widget, name, spec.index);
        controls_.push_back(std::make_unique<WidgetControl>(*this, widget, spec.kind));
        byName_.insert(elementName(name, spec.index), controls_.back().get());
    }

    for (const DesignList& list : designLists()) {
        Control* combo = byName_.value(list.control.toString());
        for (const QString& item : list.items.toString().split(u';'))
            combo->addItem(item, 0);
    }

    // Each tab packs its controls against the top right corner.
    for (int i = 0; i < kTabCount; ++i) {
        QGridLayout* grid = grids.value(QStringLiteral("tab%1").arg(i));
        for (int c = 0; c < grid->columnCount(); ++c)
            if (!usedColumns[grid].count(c)) grid->setColumnMinimumWidth(c, kSpacerColumnWidth);
        if (gridsWithView.count(grid)) continue;
        grid->setRowStretch(grid->rowCount(), 1);
        grid->setColumnStretch(grid->columnCount(), 1);
    }
    outer->setRowStretch(0, 1);
}

QWidget* MainCard::makeWidget(const ControlSpec& spec, QWidget* parent) {
    const QString caption = spec.caption.toString();
    switch (spec.kind) {
        case ControlKind::TextBox: {
            auto* edit = new QLineEdit(parent);
            edit->setMinimumWidth(isWideBox(spec.name) ? kPathBoxWidth : kBoxWidth);
            return edit;
        }
        case ControlKind::Label: {
            auto* label = new ClickLabel(caption, parent);
            // Captions are right-justified, also those in Latin letters; the slots' variable
            // names read as the identifiers they are.
            if (spec.name != u"LblFldName")
                label->setAlignment(Qt::AlignRight | Qt::AlignAbsolute | Qt::AlignVCenter);
            if (CardController::isClickable(spec.name.toString())) {
                label->setCursor(Qt::PointingHandCursor);
                QFont font = label->font();
                font.setUnderline(true);
                label->setFont(font);
            }
            return label;
        }
        case ControlKind::CommandButton: {
            auto* button = new QPushButton(caption, parent);
            button->setMinimumWidth(kButtonWidth);
            return button;
        }
        case ControlKind::CheckBox:
            return new QCheckBox(caption, parent);
        case ControlKind::OptionButton:
            return new QRadioButton(caption, parent);
        case ControlKind::ComboBox: {
            auto* combo = new QComboBox(parent);
            combo->setMinimumWidth(kBoxWidth);
            combo->setSizeAdjustPolicy(QComboBox::AdjustToContents);
            return combo;
        }
        case ControlKind::Frame:
            return new QGroupBox(caption, parent);
        case ControlKind::Picture: {
            auto* picture = new QToolButton(parent);
            picture->setIcon(pictureIcon(spec.name, style()));
            picture->setIconSize(QSize(22, 22));
            picture->setAutoRaise(true);
            return picture;
        }
        case ControlKind::Shape: {
            if (spec.container.isEmpty()) {
                auto* frame = new ProgressShape(parent);
                frame->setFrameShape(QFrame::Box);
                frame->setFixedHeight(kProgressHeight);
                return frame;
            }
            auto* fill = new QFrame(parent);
            fill->setAutoFillBackground(true);
            QPalette palette = fill->palette();
            palette.setColor(QPalette::Window, palette.color(QPalette::Highlight));
            fill->setPalette(palette);
            fill->resize(0, kProgressHeight);
            return fill;
        }
        case ControlKind::Grid:
            return new QTableView(parent);
        case ControlKind::TabStrip:
            break;
    }
    return new QWidget(parent);
}

void MainCard::connectEvents(QWidget* widget, const QString& name, int index) {
    if (qobject_cast<QPushButton*>(widget) || qobject_cast<QToolButton*>(widget)) {
        connect(static_cast<QAbstractButton*>(widget), &QAbstractButton::clicked, this,
                [this, name, index] { controller_->click(name, index); });
    } else if (auto* label = qobject_cast<ClickLabel*>(widget)) {
        connect(label, &ClickLabel::clicked, this,
                [this, name, index] { controller_->click(name, index); });
    } else if (auto* option = qobject_cast<QRadioButton*>(widget)) {
        connect(option, &QRadioButton::clicked, this,
                [this, name, index] { controller_->click(name, index); });
    } else if (auto* edit = qobject_cast<QLineEdit*>(widget)) {
        connect(edit, &QLineEdit::textChanged, this,
                [this, name, index] { notifyChanged(name, index); });
    } else if (auto* tabs = qobject_cast<QTabWidget*>(widget)) {
        connect(tabs, &QTabWidget::currentChanged, this,
                [this, name, index] { notifyChanged(name, index); });
    }
}

}  // namespace etq

#include "main_card.moc"

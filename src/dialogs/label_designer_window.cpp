#include "dialogs/label_designer_window.h"

#include <QCheckBox>
#include <QComboBox>
#include <QGridLayout>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QMouseEvent>
#include <QPushButton>
#include <QTabWidget>
#include <algorithm>
#include <functional>
#include <span>

#include "dialogs/label_preview.h"
#include "dialogs/language_switch.h"
#include "platform/context.h"
#include "platform/log.h"
#include "platform/messages.h"
#include "print/label_faces.h"
#include "print/label_sheets.h"

namespace etq {

namespace {

// The designer's failures have always been titled in Hebrew, whatever the language.
const QString kFailureTitle = QStringLiteral("תקלה");
constexpr int kLookTab = 2;
constexpr int kMostSheetsListed = 400;
constexpr int kNumberBoxWidth = 56;
constexpr int kFieldListWidth = 150;

// A label that acts when clicked: the row actions and the captions of the two bar measures.
class ClickLabel : public QLabel {
  public:
    ClickLabel(const QString& text, std::function<void()> onClick, QWidget* parent)
        : QLabel(text, parent), onClick_(std::move(onClick)) {
        setCursor(Qt::PointingHandCursor);
        QFont underlined = font();
        underlined.setUnderline(true);
        setFont(underlined);
    }

  protected:
    void mouseReleaseEvent(QMouseEvent* event) override {
        if (event->button() == Qt::LeftButton && rect().contains(event->position().toPoint()))
            onClick_();
        QLabel::mouseReleaseEvent(event);
    }

  private:
    std::function<void()> onClick_;
};

QLabel* captionLabel(QStringView hebrew, QStringView english, QWidget* parent,
                     const QString& name = {}) {
    auto* label = new QLabel(hebrew.toString(), parent);
    label->setProperty("Tag", english.toString());
    if (!name.isEmpty()) label->setObjectName(name);
    return label;
}

// Changes made by the routines themselves, counted so that the preview is drawn once after them.
class Quiet {
  public:
    explicit Quiet(int& depth) : depth_(depth) { ++depth_; }
    ~Quiet() { --depth_; }

  private:
    int& depth_;
};

// The columns of the two cell tabs, in the order of the cell controls' table.
constexpr QStringView kFirstTabControls[] = {u"chkXCell",    u"cmbXFld",   u"cmbVType", u"CmbFont",
                                             u"txtFontSize", u"CmbWeight", u"CmbAlign"};
constexpr QStringView kLookTabControls[] = {u"ChkUL",     u"ChkItalic", u"CmbDirection",
                                            u"txtPrefix", u"txtHeight", u"ChkBorder"};

QString sheetEntry(const LabelSheet& sheet, qint16 language) {
    return QStringLiteral("%1 - %2 x %3 %4, %5 x %6")
        .arg(sheet.name())
        .arg(sheet.label.width(), 0, 'f', 1)
        .arg(sheet.label.height(), 0, 'f', 1)
        .arg(language > 0 ? QStringLiteral("mm") : QStringLiteral("מ\"מ"))
        .arg(sheet.columns)
        .arg(sheet.rows);
}

}  // namespace

LabelDesignerWindow::LabelDesignerWindow(Context& context, const Surface& card,
                                         LabelPreviewSource source, QWidget* parent)
    : QDialog(parent),
      context_(context),
      card_(card),
      source_(std::move(source)),
      record_(labelPreviewRecord(source_.databaseFolder, source_.page.query)),
      definition_(loadedLabelDefinition(context)) {
    setObjectName(QStringLiteral("frmLabDef"));
    setWindowTitle(QStringLiteral("הגדרות מדבקה ישירה"));
    setLayoutDirection(Qt::RightToLeft);
    const Quiet quiet(quiet_);
    buildControls();
    if (context_.language > 0) switchToEnglish();
    tabs_->setCurrentIndex(0);
    FillXFld(card_);
    FillCombos();
    GetSetFormLabDefs(1, definition_);
    const LabelSheet* sheet =
        definition_.page.SheetBrand.isEmpty() && definition_.page.SheetPart.isEmpty()
            ? nullptr
            : SheetCatalogue::installed().find(definition_.page.SheetBrand,
                                               definition_.page.SheetPart);
    if (sheet) {
        auto* find = static_cast<QLineEdit*>(control(u"txtSheetFind"));
        const QSignalBlocker blocker(find);
        find->setText(sheet->name());
    }
    listSheets(sheet ? sheet->name() : QString(), sheet);
    redrawPreview();
}

LabelDesignerWindow::~LabelDesignerWindow() = default;

QWidget* LabelDesignerWindow::control(QStringView name, int index) const {
    return findChild<QWidget*>(elementName(name.toString(), index));
}

void LabelDesignerWindow::buildControls() {
    tabs_ = new QTabWidget(this);
    tabs_->setObjectName(QStringLiteral("SSTab1"));
    tabs_->addTab(buildCellTab(true), QStringLiteral("תוכן ועיצוב התאים"));
    tabs_->addTab(buildSharedTab(), QStringLiteral("הגדרות נוספות"));
    tabs_->addTab(buildCellTab(false), QStringLiteral("עיצוב התאים - עוד"));
    connect(tabs_, &QTabWidget::currentChanged, this, &LabelDesignerWindow::onTabChanged);

    auto* previewBox = new QGroupBox(QStringLiteral("תצוגה מקדימה"), this);
    previewBox->setObjectName(QStringLiteral("fraPreview"));
    previewBox->setProperty("Tag", QStringLiteral("Preview"));
    auto* previewLayout = new QVBoxLayout(previewBox);
    preview_ = new LabelPreview(previewBox);
    const bool sample = record_ == sampleLabelRecord();
    auto* recordLabel = captionLabel(sample ? u"פריט לדוגמה" : u"הפריט המסומן הראשון",
                                     sample ? u"A sample item" : u"The first marked item",
                                     previewBox, QStringLiteral("lblPreviewItem"));
    previewLayout->addWidget(recordLabel);
    previewLayout->addWidget(preview_, 1);

    auto* close = new QPushButton(QStringLiteral("אישור"), this);
    close->setObjectName(QStringLiteral("cmdClose"));
    close->setProperty("Tag", QStringLiteral("OK"));
    close->setDefault(true);
    auto* cancel = new QPushButton(QStringLiteral("ביטול"), this);
    cancel->setObjectName(QStringLiteral("cmdCancel"));
    cancel->setProperty("Tag", QStringLiteral("Cancel"));
    connect(close, &QPushButton::clicked, this, &LabelDesignerWindow::acceptChanges);
    connect(cancel, &QPushButton::clicked, this, &QDialog::reject);

    auto* layout = new QGridLayout(this);
    layout->addWidget(tabs_, 0, 0, 1, 3);
    layout->addWidget(previewBox, 0, 3);
    layout->addWidget(close, 1, 1);
    layout->addWidget(cancel, 1, 2);
    layout->setColumnStretch(0, 1);
}

// The first tab: each cell's use, field, display, font, size, weight and alignment, and its row
// actions. The third: the rest of each cell's look, captioned with the cell's field.
QWidget* LabelDesignerWindow::buildCellTab(bool firstTab) {
    auto* page = new QWidget(this);  // the window finds its controls by name from the start
    page->setObjectName(firstTab ? QStringLiteral("SSTab1Page0") : QStringLiteral("SSTab1Page2"));
    auto* grid = new QGridLayout(page);
    const std::span<const QStringView> columns =
        firstTab ? std::span<const QStringView>(kFirstTabControls)
                 : std::span<const QStringView>(kLookTabControls);
    grid->addWidget(
        firstTab ? captionLabel(u"שורה", u"Row", page) : captionLabel(u"שדה", u"Field", page), 0,
        0);
    for (size_t c = 0; c < columns.size(); ++c) {
        const DesignerControl& binding = *findDesignerControl(columns[c]);
        grid->addWidget(captionLabel(binding.hebrew, binding.english, page), 0, int(c) + 1);
    }
    if (firstTab)
        grid->addWidget(captionLabel(u"פעולות שורה", u"Row actions", page), 0,
                        int(columns.size()) + 1, 1, 2);

    for (int cell = 0; cell < kLabelCellCount; ++cell) {
        const int row = cell + 1;
        if (firstTab) {
            grid->addWidget(new QLabel(QString::number(cell + 1), page), row, 0);
        } else {
            auto* caption = new QLabel(page);
            caption->setObjectName(elementName(QStringLiteral("lblFCap"), cell));
            caption->setMinimumWidth(120);
            grid->addWidget(caption, row, 0);
        }
        for (size_t c = 0; c < columns.size(); ++c) {
            const DesignerControl& binding = *findDesignerControl(columns[c]);
            QWidget* widget = nullptr;
            if (binding.kind == ControlKind::CheckBox) {
                widget = new QCheckBox(page);
            } else if (binding.kind == ControlKind::ComboBox) {
                auto* combo = new QComboBox(page);
                if (binding.name == u"cmbXFld") combo->setMinimumWidth(kFieldListWidth);
                widget = combo;
            } else {
                auto* box = new QLineEdit(page);
                box->setMaximumWidth(binding.name == u"txtPrefix" ? 3 * kNumberBoxWidth
                                                                  : kNumberBoxWidth);
                widget = box;
            }
            widget->setObjectName(elementName(binding.name.toString(), cell));
            connectChanges(widget);
            grid->addWidget(widget, row, int(c) + 1);
        }
        if (firstTab) {
            auto* add = new ClickLabel(
                QStringLiteral("הכנס"), [this, cell] { insertRow(cell); }, page);
            add->setObjectName(elementName(QStringLiteral("lblAdd"), cell));
            add->setProperty("Tag", QStringLiteral("Insert"));
            auto* remove = new ClickLabel(
                QStringLiteral("הוצא"), [this, cell] { removeRow(cell); }, page);
            remove->setObjectName(elementName(QStringLiteral("lblDel"), cell));
            remove->setProperty("Tag", QStringLiteral("Remove"));
            grid->addWidget(add, row, int(columns.size()) + 1);
            grid->addWidget(remove, row, int(columns.size()) + 2);
        }
    }
    grid->setRowStretch(kLabelCellCount + 1, 1);
    grid->setColumnStretch(grid->columnCount(), 1);
    return page;
}

// The second tab: the barcode setting, the page grid and the label sheet product.
QWidget* LabelDesignerWindow::buildSharedTab() {
    auto* page = new QWidget(this);  // the window finds its controls by name from the start
    page->setObjectName(QStringLiteral("SSTab1Page1"));
    auto* outer = new QGridLayout(page);
    auto addBox = [&](QStringView hebrew, QStringView english, const QString& name, int row,
                      int column) {
        auto* box = new QGroupBox(hebrew.toString(), page);
        box->setObjectName(name);
        box->setProperty("Tag", english.toString());
        outer->addWidget(box, row, column);
        return new QGridLayout(box);
    };
    QGridLayout* barcode = addBox(u"ברקוד", u"Barcode", QStringLiteral("fraBarcode"), 0, 0);
    QGridLayout* grid = addBox(u"דף", u"Page", QStringLiteral("fraPage"), 0, 1);
    QGridLayout* sheet = addBox(u"גיליון מדבקות", u"Label sheet", QStringLiteral("fraSheet"), 1, 0);
    outer->setRowStretch(2, 1);

    // A control with its caption on its right (the caption a clickable label for the two bar
    // measures), or a check box that is its own caption.
    auto place = [&](QGridLayout* layout, QStringView name, int row, int column = 0) {
        const DesignerControl& binding = *findDesignerControl(name);
        QWidget* widget = nullptr;
        if (binding.kind == ControlKind::CheckBox) {
            auto* box = new QCheckBox(binding.hebrew.toString(), page);
            box->setProperty("Tag", binding.english.toString());
            widget = box;
            layout->addWidget(widget, row, column, 1, 3);
        } else {
            QLabel* caption = nullptr;
            if (name == u"txtDimX" || name == u"txtWideBarRatio") {
                const bool dimX = name == u"txtDimX";
                caption = new ClickLabel(
                    binding.hebrew.toString(),
                    [this, dimX] {
                        static_cast<QLineEdit*>(control(dimX ? u"txtDimX" : u"txtWideBarRatio"))
                            ->setText(dimX ? QStringLiteral("0.01") : QStringLiteral("2.2"));
                    },
                    page);
                caption->setObjectName(dimX ? QStringLiteral("lblDimX")
                                            : QStringLiteral("lblWideBarRatio"));
                caption->setProperty("Tag", binding.english.toString());
            } else {
                caption = captionLabel(binding.hebrew, binding.english, page);
            }
            layout->addWidget(caption, row, column);
            if (binding.kind == ControlKind::ComboBox) {
                widget = new QComboBox(page);
            } else {
                auto* box = new QLineEdit(page);
                box->setMaximumWidth(name == u"txtXLeftPrefix" ? 2 * kNumberBoxWidth
                                                               : kNumberBoxWidth);
                widget = box;
            }
            layout->addWidget(widget, row, column + 1);
        }
        widget->setObjectName(name.toString());
        connectChanges(widget);
        return widget;
    };

    place(barcode, u"cmbXBarType", 0);
    place(barcode, u"txtXBarH", 1);
    place(barcode, u"txtXBarLeftLen", 2);
    place(barcode, u"txtXLeftPrefix", 3);
    place(barcode, u"txtUserResoX", 4);
    place(barcode, u"txtUserResoY", 5);
    place(barcode, u"chkCDigit", 6);
    place(barcode, u"ChkShowDesc", 7);
    place(barcode, u"txtDimX", 8);
    barcode->addWidget(new QLabel(QStringLiteral("0.005 - 0.5"), page), 8, 2);
    place(barcode, u"txtWideBarRatio", 9);
    barcode->addWidget(new QLabel(QStringLiteral("2.0 - 3.0"), page), 9, 2);

    place(grid, u"txtCols", 0);
    place(grid, u"txtRows", 1);
    place(grid, u"txtMaxTextLen", 2);
    grid->addWidget(captionLabel(u"שוליים למדבקה:", u"Label margins:", page), 3, 0);
    place(grid, u"txtLabTop", 4);
    place(grid, u"txtLabBottom", 5);
    place(grid, u"chkOpenPrintDlg", 6);
    grid->setRowStretch(7, 1);
    for (QStringView name : {u"txtCols", u"txtRows"})
        connect(static_cast<QLineEdit*>(control(name)), &QLineEdit::textEdited, this,
                &LabelDesignerWindow::gridEdited);

    sheet->addWidget(captionLabel(u"חיפוש לפי יצרן ומק\"ט:", u"Find by maker and part:", page), 0,
                     0);
    auto* find = new QLineEdit(page);
    find->setObjectName(QStringLiteral("txtSheetFind"));
    find->setPlaceholderText(QStringLiteral("Avery L7160"));
    sheet->addWidget(find, 0, 1);
    sheets_ = new QComboBox(page);
    sheets_->setObjectName(QStringLiteral("cmbSheet"));
    sheets_->setMinimumWidth(320);
    sheet->addWidget(sheets_, 1, 0, 1, 2);
    connect(find, &QLineEdit::textChanged, this, &LabelDesignerWindow::findSheets);
    connect(sheets_, &QComboBox::currentIndexChanged, this, &LabelDesignerWindow::chooseSheet);
    return page;
}

void LabelDesignerWindow::connectChanges(QWidget* widget) {
    const auto changed = [this] {
        if (!quiet_) redrawPreview();
    };
    if (auto* box = qobject_cast<QCheckBox*>(widget))
        connect(box, &QCheckBox::toggled, this, changed);
    else if (auto* combo = qobject_cast<QComboBox*>(widget))
        connect(combo, &QComboBox::currentIndexChanged, this, changed);
    else if (auto* edit = qobject_cast<QLineEdit*>(widget))
        connect(edit, &QLineEdit::textChanged, this, changed);
}

void LabelDesignerWindow::switchToEnglish() {
    setWindowTitle(QStringLiteral("Direct label settings"));
    tabs_->setTabText(0, QStringLiteral("Cell content and look"));
    tabs_->setTabText(1, QStringLiteral("More settings"));
    tabs_->setTabText(2, QStringLiteral("More cell look"));
    MirrorControls(this);
    ApplyTagCaptions(this);
    for (QGroupBox* box : findChildren<QGroupBox*>())
        box->setTitle(box->property("Tag").toString());
}

void LabelDesignerWindow::FillXFld(const Surface& card) {
    const QStringList captions = labelFieldCaptions(card);
    for (int cell = 0; cell < kLabelCellCount; ++cell) {
        auto* combo = static_cast<QComboBox*>(control(u"cmbXFld", cell));
        combo->clear();
        combo->addItems(captions);
        combo->setCurrentIndex(-1);
    }
}

void LabelDesignerWindow::FillCombos() {
    for (int cell = 0; cell < kLabelCellCount; ++cell)
        for (QStringView name :
             {u"cmbVType", u"CmbFont", u"CmbWeight", u"CmbAlign", u"CmbDirection"})
            FillComboFromList(
                static_cast<QComboBox*>(control(name, cell)),
                designerItems(*findDesignerControl(name), context_.language).join(u';'));
    const DesignerControl& barTypes = *findDesignerControl(u"cmbXBarType");
    FillComboFromList(static_cast<QComboBox*>(control(barTypes.name)),
                      designerItems(barTypes, context_.language).join(u';'));
}

bool LabelDesignerWindow::GetSetFormLabDef(quint8 action, QWidget* widget,
                                           const DesignerControl& binding, LabelDefinition& def,
                                           int cell) {
    if (auto* combo = qobject_cast<QComboBox*>(widget)) {
        if (action == 1) {
            const int value = designerValue(binding, def, cell);
            if (value >= 0 && value < combo->count()) combo->setCurrentIndex(value);
        } else if (action == 2 && combo->currentIndex() >= 0) {
            setDesignerValue(binding, def, cell, combo->currentIndex());
        }
    } else if (auto* box = qobject_cast<QCheckBox*>(widget)) {
        if (action == 1) {
            const int value = designerValue(binding, def, cell);
            box->setChecked(value == -1 || value == 1);
        } else if (action == 2) {
            setDesignerValue(binding, def, cell, box->isChecked() ? 1 : 0);
        }
    } else if (auto* edit = qobject_cast<QLineEdit*>(widget)) {
        if (action == 1) edit->setText(designerText(binding, def, cell));
        if (action == 2) return setDesignerText(binding, def, cell, edit->text());
    }
    return true;
}

QString LabelDesignerWindow::GetSetFormLabDefs(quint8 action, LabelDefinition& def) {
    const Quiet quiet(quiet_);
    QString problem;
    auto move = [&](const DesignerControl& binding, int cell) {
        QWidget* widget = control(binding.name, cell);
        if (!GetSetFormLabDef(action, widget, binding, def, std::max(cell, 0)) && problem.isEmpty())
            problem = designerValueProblem(binding, cell, static_cast<QLineEdit*>(widget)->text(),
                                           context_.language);
    };
    for (int cell = 0; cell < kLabelCellCount; ++cell)
        for (const DesignerControl& binding : designerCellControls())
            move(binding, cell);
    for (const DesignerControl& binding : designerSharedControls())
        move(binding, -1);
    return problem;
}

void LabelDesignerWindow::MoveCell(int fromCell, int toCell, bool withClean) {
    const Quiet quiet(quiet_);
    for (const DesignerControl& binding : designerCellControls()) {
        QWidget* from = control(binding.name, fromCell);
        QWidget* to = control(binding.name, toCell);
        if (auto* box = qobject_cast<QCheckBox*>(from))
            static_cast<QCheckBox*>(to)->setChecked(box->isChecked());
        else if (auto* combo = qobject_cast<QComboBox*>(from))
            static_cast<QComboBox*>(to)->setCurrentIndex(combo->currentIndex());
        else if (auto* edit = qobject_cast<QLineEdit*>(from))
            static_cast<QLineEdit*>(to)->setText(edit->text());
        if (!withClean) continue;
        if (binding.name == u"chkXCell") static_cast<QCheckBox*>(from)->setChecked(false);
        if (binding.name == u"cmbXFld") static_cast<QComboBox*>(from)->setCurrentIndex(-1);
        if (binding.name == u"cmbVType") static_cast<QComboBox*>(from)->setCurrentIndex(0);
    }
}

void LabelDesignerWindow::insertRow(int n) {
    {
        const Quiet quiet(quiet_);
        for (int k = kLabelCellCount - 2; k >= n; --k)
            MoveCell(k, k + 1, true);
    }
    redrawPreview();
}

void LabelDesignerWindow::removeRow(int n) {
    {
        const Quiet quiet(quiet_);
        for (int k = n; k <= kLabelCellCount - 2; ++k)
            MoveCell(k + 1, k, true);
    }
    redrawPreview();
}

void LabelDesignerWindow::onTabChanged(int tab) {
    if (tab != kLookTab) return;
    for (int cell = 0; cell < kLabelCellCount; ++cell) {
        auto* field = qobject_cast<QComboBox*>(control(u"cmbXFld", cell));
        auto* caption = qobject_cast<QLabel*>(control(u"lblFCap", cell));
        if (!field || !caption) {
            qCInfo(log::card) << "label designer: no field caption for cell" << cell;
            continue;
        }
        caption->setText(field->currentText());
    }
}

// Nothing changes unless every control holds a value its field takes.
void LabelDesignerWindow::acceptChanges() {
    LabelDefinition edited = definition_;
    const QString problem = GetSetFormLabDefs(2, edited);
    if (!problem.isEmpty()) {
        showCritical(context_.messages(), problem, kFailureTitle);
        return;
    }
    const LabelSheet* sheet = chosenSheet();
    edited.page.SheetBrand = sheet ? sheet->brand : QString();
    edited.page.SheetPart = sheet ? sheet->part : QString();
    definition_ = edited;
    accept();
}

void LabelDesignerWindow::redrawPreview() {
    if (!preview_) return;
    LabelDefinition shown = definition_;
    GetSetFormLabDefs(2, shown);
    QSizeF label;
    LabelSheet::Shape shape = LabelSheet::Shape::Rectangle;
    double corner = 0;
    if (const LabelSheet* sheet = chosenSheet()) {
        label = sheet->label;
        shape = sheet->shape;
        corner = sheet->corner;
    } else {
        const qint16 columns = shown.page.PageCols > 0 ? shown.page.PageCols : 1;
        const qint16 rows = shown.page.PageRows > 0 ? shown.page.PageRows : 1;
        label = QSizeF(source_.paper.width() / columns, source_.paper.height() / rows);
    }
    preview_->showLabel(shown, faceOf(shown, record_, source_.page.priceFormat), label, shape,
                        corner);
}

// The products whose maker and part hold the words typed; the first entry chooses none (the
// grid divides the page). Nothing is listed for an empty search but the product chosen.
void LabelDesignerWindow::findSheets(const QString& text) {
    listSheets(text, chosenSheet());
}

void LabelDesignerWindow::listSheets(const QString& text, const LabelSheet* chosen) {
    std::vector<const LabelSheet*> found;
    if (!text.trimmed().isEmpty()) found = SheetCatalogue::installed().search(text);
    if (found.size() > size_t(kMostSheetsListed)) found.resize(size_t(kMostSheetsListed));
    if (chosen && std::find(found.begin(), found.end(), chosen) == found.end())
        found.insert(found.begin(), chosen);
    {
        const QSignalBlocker blocker(sheets_);
        sheets_->clear();
        sheets_->addItem(context_.language > 0 ? QStringLiteral("None: the grid divides the page")
                                               : QStringLiteral("ללא - הגריד מחלק את הדף"));
        for (const LabelSheet* sheet : found) {
            sheets_->addItem(sheetEntry(*sheet, context_.language),
                             QVariant::fromValue(quintptr(sheet)));
            if (sheet == chosen) sheets_->setCurrentIndex(sheets_->count() - 1);
        }
    }
}

const LabelSheet* LabelDesignerWindow::chosenSheet() const {
    if (!sheets_ || sheets_->currentIndex() <= 0) return nullptr;
    return reinterpret_cast<const LabelSheet*>(sheets_->currentData().value<quintptr>());
}

// A product fills the grid with its labels across and down.
void LabelDesignerWindow::chooseSheet(int) {
    if (const LabelSheet* sheet = chosenSheet()) {
        const Quiet quiet(quiet_);
        static_cast<QLineEdit*>(control(u"txtCols"))->setText(QString::number(sheet->columns));
        static_cast<QLineEdit*>(control(u"txtRows"))->setText(QString::number(sheet->rows));
    }
    redrawPreview();
}

// A grid typed by hand that differs from the product's gives up the product.
void LabelDesignerWindow::gridEdited() {
    const LabelSheet* sheet = chosenSheet();
    if (!sheet) return;
    const QString columns = static_cast<QLineEdit*>(control(u"txtCols"))->text().trimmed();
    const QString rows = static_cast<QLineEdit*>(control(u"txtRows"))->text().trimmed();
    if (columns != QString::number(sheet->columns) || rows != QString::number(sheet->rows))
        sheets_->setCurrentIndex(0);
}

}  // namespace etq

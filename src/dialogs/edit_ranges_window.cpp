#include "dialogs/edit_ranges_window.h"

#include <QGridLayout>
#include <QPushButton>
#include <QTableView>

#include "db/file_names.h"
#include "dialogs/bound_grid_model.h"
#include "dialogs/language_switch.h"
#include "dialogs/window_controls.h"
#include "import/scan_ranges.h"
#include "platform/captions.h"
#include "platform/failure.h"
#include "platform/log.h"

namespace etq {

namespace {

// The headers of columns 1 to 3 are captions 4, 5 and 6.
constexpr int kHeaderCaptions[] = {4, 5, 6};
constexpr int kRightCentred = 7;

}  // namespace

EditRangesWindow::EditRangesWindow(const QString& databaseFolder, qint16 language, QWidget* parent)
    : QDialog(parent),
      docDbPath_(db::inFolder(databaseFolder, db::kDocDatabaseFile)),
      language_(language),
      grid_(new BoundGridModel(this)) {
    setObjectName(QStringLiteral("frmEditRanges"));
    setWindowTitle(QStringLiteral("מונים מיוחדים למסמכים"));
    setLayoutDirection(Qt::RightToLeft);

    view_ = new QTableView(this);
    view_->setObjectName(QStringLiteral("VSEditRange"));
    view_->setModel(grid_);
    QPushButton* reset = makeButton(QStringLiteral("cmdNoneItems"), QStringLiteral("אפס את כולם"),
                                    QStringLiteral("Reset all"), this);
    QPushButton* close = makeButton(QStringLiteral("cmdClose"), QStringLiteral("סגור"),
                                    QStringLiteral("Close"), this);
    auto* layout = new QGridLayout(this);
    layout->addWidget(view_, 0, 0, 1, 2);
    layout->addWidget(reset, 1, 0);
    layout->addWidget(close, 1, 1);
    connect(reset, &QPushButton::clicked, this, &EditRangesWindow::resetAll);
    connect(close, &QPushButton::clicked, this, &QDialog::accept);

    if (language_ > 0) {
        setWindowTitle(QStringLiteral("Documents special numerators"));
        MirrorControls(this);
        ApplyTagCaptions(this);
    }
    load();
    resize(520, 360);
}

EditRangesWindow::~EditRangesWindow() = default;

void EditRangesWindow::load() {
    grid_->setDatabaseName(docDbPath_);
    grid_->setRecordSource(QStringLiteral("qWizFileRanges"));
    try {
        grid_->refresh();
    } catch (const std::exception& e) {
        qCInfo(log::card) << "scan ranges:" << describe(e);
    }
    applyColumnLayout();
}

void EditRangesWindow::resetAll() {
    try {
        resetScanRanges(docDbPath_);
    } catch (const std::exception& e) {
        qCInfo(log::card) << "scan ranges not reset:" << describe(e);
    }
    load();
}

void EditRangesWindow::applyColumnLayout() {
    for (int column = 0; column < 3 && column < grid_->columnCount(); ++column)
        grid_->setHeader(column, GetCaption(kHeaderCaptions[column], language_));
    grid_->setAlignment(DescriptionColumn - 1,
                        BoundGridModel::alignmentOfCode(GetColumnAlignment(language_)));
    grid_->setAlignment(LastRecordColumn - 1, BoundGridModel::alignmentOfCode(kRightCentred));
    grid_->setAlignment(NextStartColumn - 1, BoundGridModel::alignmentOfCode(kRightCentred));
    view_->resizeColumnsToContents();
}

}  // namespace etq

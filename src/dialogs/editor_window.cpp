#include "dialogs/editor_window.h"

#include <QHeaderView>
#include <QItemSelectionModel>
#include <QTableView>
#include <algorithm>

#include "dialogs/bound_grid_model.h"
#include "dialogs/dialog_surface.h"
#include "dialogs/language_switch.h"
#include "dialogs/table_editors.h"
#include "platform/captions.h"
#include "platform/context.h"
#include "platform/failure.h"
#include "platform/log.h"
#include "platform/messages.h"
#include "surface/settings_groups.h"

namespace etq {

namespace {
constexpr int kRightCentred = 7;
}

EditorWindow::EditorWindow(Context& context, const QString& name, const QString& title,
                           const QString& gridName, QWidget* parent)
    : QDialog(parent),
      context_(context),
      grid_(new BoundGridModel(this)),
      view_(new QTableView(this)) {
    setObjectName(name);
    setWindowTitle(title);
    setLayoutDirection(Qt::RightToLeft);
    view_->setObjectName(gridName);
    view_->setModel(grid_);
    view_->setSelectionBehavior(QAbstractItemView::SelectRows);
    view_->setSelectionMode(QAbstractItemView::ExtendedSelection);
    view_->setEditTriggers(QAbstractItemView::DoubleClicked | QAbstractItemView::EditKeyPressed |
                           QAbstractItemView::AnyKeyPressed);
}

EditorWindow::~EditorWindow() = default;

bool EditorWindow::english() const {
    return context_.isEnglish();
}

void EditorWindow::switchToEnglish(const QString& title) {
    setWindowTitle(title);
    MirrorControls(this);
    ApplyTagCaptions(this);
}

void EditorWindow::loadSettings(quint8 group) {
    GetSetParams(DialogSurface(*this), context_.applicationName, group, LoadSettings);
}

void EditorWindow::arrangeGrid(std::span<const int> captions, std::span<const int> numberColumns) {
    const Qt::Alignment text =
        BoundGridModel::alignmentOfCode(GetColumnAlignment(context_.language));
    const Qt::Alignment number = BoundGridModel::alignmentOfCode(kRightCentred);
    for (int column = 1; column <= int(captions.size()) && column <= grid_->columnCount();
         ++column) {
        grid_->setHeader(column - 1, GetCaption(captions[size_t(column - 1)], context_.language));
        const bool isNumber =
            std::find(numberColumns.begin(), numberColumns.end(), column) != numberColumns.end();
        grid_->setAlignment(column - 1, isNumber ? number : text);
    }
    view_->resizeColumnsToContents();
    if (grid_->rowCount() > 0) view_->setCurrentIndex(grid_->index(0, 0));
}

void EditorWindow::deleteCurrentRow(EditorGrid& editor) {
    const int row = view_->currentIndex().row();
    if (row < 0) return;  // an empty grid has no current record
    if (askYesNo(context_.messages(), context_.caption(41), context_.caption(30)) != MsgAnswer::Yes)
        return;
    passOver("delete", [&] { editor.deleteRow(row); });
    if (grid_->rowCount() > 0)
        view_->setCurrentIndex(grid_->index(std::min(row, grid_->rowCount() - 1), 0));
}

QList<int> EditorWindow::selectedRows() const {
    QList<int> rows;
    for (int row = 0; row < grid_->rowCount(); ++row)
        if (view_->selectionModel()->isRowSelected(row, {})) rows.append(row);
    return rows;
}

void EditorWindow::passOver(const char* what, const std::function<void()>& work) {
    try {
        work();
    } catch (const std::exception& e) {
        qCInfo(log::card) << objectName() << what << "passed over:" << describe(e);
    }
}

}  // namespace etq

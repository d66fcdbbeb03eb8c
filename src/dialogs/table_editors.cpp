#include "dialogs/table_editors.h"

#include "db/file_names.h"
#include "dialogs/bound_grid_model.h"
#include "import/sql_source.h"
#include "platform/failure.h"
#include "platform/log.h"
#include "platform/user_paths.h"

namespace etq {

namespace {
int modelColumn(int column) {
    return column - 1;
}
}  // namespace

void EditorGrid::setDatabaseFolder(const QString& folder) {
    grid_.setDatabaseName(db::inFolder(folder, db::kItemDatabaseFile));
}

void EditorGrid::show(const QString& recordSource) {
    grid_.setRecordSource(recordSource);
    grid_.refresh();
}

int EditorGrid::rowCount() const {
    return grid_.rowCount();
}

QVariant EditorGrid::value(int row, int column) const {
    return grid_.cell(row, modelColumn(column));
}

void EditorGrid::write(int row, int column, const QVariant& value) {
    grid_.writeCell(row, modelColumn(column), value);
}

void EditorGrid::addRecord(const QList<std::pair<int, QVariant>>& values) {
    jet::Recordset& rs = grid_.recordset();
    rs.addNew();
    try {
        for (const auto& [column, value] : values)
            rs.setValue(modelColumn(column), value);
        rs.update();
    } catch (...) {
        rs.cancelUpdate();
        grid_.showRows();
        throw;
    }
    grid_.showRows();
}

void EditorGrid::deleteRow(int row) {
    jet::Recordset& rs = grid_.recordset();
    rs.setAbsolutePosition(row);
    rs.deleteRecord();
    grid_.showRows();
}

void AlterKeyEditor::addRow() {
    show(NoAlterKeysQuery());
    const QString unknown = QStringLiteral("?");
    addRecord({{1, unknown}, {2, unknown}, {3, unknown}});
}

void AlterKeyEditor::setAltBar(const QList<int>& rows, const QString& barcode) {
    if (barcode.isEmpty()) return;
    for (int row : rows)
        write(row, kAlterBarColumn, barcode);
}

void AccountDefEditor::addRow() {
    addRecord({{1, QStringLiteral("00000000")}, {kLabelColumn, defaultLabelFile()}});
}

void AccountDefEditor::FillPriceListColumn(const ConnParams& params) {
    try {
        if (std::optional<EntryList> lists = ReadPriceLists(params)) priceLists_ = *lists;
    } catch (const std::exception& e) {
        qCInfo(log::import) << "price lists from the SQL Server source:" << describe(e);
    }
}

}  // namespace etq

#include "dialogs/item_selection.h"

#include "db/file_names.h"
#include "dialogs/bound_grid_model.h"
#include "dialogs/items_query.h"
#include "jet/error.h"
#include "jet/vb.h"

namespace etq {

ItemSelection::ItemSelection(BoundGridModel& grid, QString rangeFilter)
    : grid_(grid), rangeFilter_(std::move(rangeFilter)) {}

void ItemSelection::open(const QString& databaseFolder, qint16 sortBy, qint16 sortOrder) {
    grid_.setDatabaseName(db::inFolder(databaseFolder, db::kItemDatabaseFile));
    show(false, sortBy, sortOrder);
}

void ItemSelection::show(bool markedOnly, qint16 sortBy, qint16 sortOrder) {
    grid_.setRecordSource(BuildItemsQuery(rangeFilter_, markedOnly, sortBy, sortOrder));
    grid_.refresh();
}

int ItemSelection::rowCount() const {
    return grid_.rowCount();
}

QString ItemSelection::text(int row, int gridColumn) const {
    return vb::toText(grid_.cell(row, modelColumn(gridColumn)));
}

void ItemSelection::write(int row, int gridColumn, const QVariant& value) {
    try {
        grid_.writeCell(row, modelColumn(gridColumn), value);
    } catch (const jet::JetError& e) {
        lastError_ = e.description();
    }
}

void ItemSelection::markAll(bool mark) {
    for (int row = 0; row < rowCount(); ++row)
        write(row, kMarkColumn, mark);
}

void ItemSelection::setCopies(const QString& copies) {
    if (copies.isEmpty()) return;
    const std::optional<qint32> whole = vb::toLong(copies);
    if (!whole) return;
    for (int row = 0; row < rowCount(); ++row)
        if (grid_.cell(row, modelColumn(kMarkColumn)).toBool()) write(row, kCopiesColumn, *whole);
}

int ItemSelection::findFrom(int gridColumn, const QString& start, int fromRow) const {
    for (int row = std::max(0, fromRow); row < rowCount(); ++row)
        if (text(row, gridColumn).startsWith(start, Qt::CaseInsensitive)) return row;
    return -1;
}

int ItemSelection::findByKey(const QString& key) {
    if (key.isEmpty()) return -1;
    const int row = findFrom(kKeyColumn, key, 0);
    if (row >= 0) write(row, kMarkColumn, true);
    return row;
}

int ItemSelection::findByName(const QString& name, int currentRow) const {
    if (name.isEmpty()) return -1;
    const int row = findFrom(kNameColumn, name, currentRow + 1);
    return row >= 0 ? row : findFrom(kNameColumn, name, 0);
}

}  // namespace etq

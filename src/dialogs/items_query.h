#pragma once

#include <QString>

namespace etq {

// The record source of the item selection grid: item key, print flag, copies and name of the
// items of tItems, only the marked ones when `markedOnly`, narrowed by `filter` (pieces that
// begin with " And "). SortBy 0 orders by print flag then item key, 1 by name; SortOrder 0
// ascending, 1 descending, applied to the last sort column. Other values add nothing.
QString BuildItemsQuery(const QString& filter, bool markedOnly, qint16 sortBy, qint16 sortOrder);

}  // namespace etq

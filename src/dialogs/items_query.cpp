#include "dialogs/items_query.h"

namespace etq {

QString BuildItemsQuery(const QString& filter, bool markedOnly, qint16 sortBy, qint16 sortOrder) {
    QString sql =
        QStringLiteral("SELECT ItemKey, PrintLabel, Copies, ItemName FROM tItems WHERE (1 > 0)");
    if (markedOnly) sql += QStringLiteral(" And PrintLabel = True");
    sql += filter;
    sql += QStringLiteral(" ORDER BY ");
    if (sortBy == 0) sql += QStringLiteral("tItems.PrintLabel, tItems.Itemkey");
    if (sortBy == 1) sql += QStringLiteral("tItems.ItemName");
    if (sortOrder == 0) sql += QStringLiteral(" ASC");
    if (sortOrder == 1) sql += QStringLiteral(" DESC");
    return sql;
}

}  // namespace etq

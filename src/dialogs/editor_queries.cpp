#include "dialogs/editor_queries.h"

#include <span>

#include "print/label_query.h"

namespace etq {

namespace {

// The list's column at a position; empty for none.
QStringView columnAt(std::span<const QStringView> columns, int position) {
    return position >= 0 && position < int(columns.size()) ? columns[size_t(position)]
                                                           : QStringView();
}

QString descending(int sortOrder) {
    return sortOrder == 1 ? QStringLiteral(" DESC") : QString();
}

}  // namespace

QString EqualsCondition(QStringView column, const QString& value) {
    return QStringLiteral(" And %1 = %2").arg(column, quotedText(value));
}

QString LikePatternOf(const QString& value) {
    QString pattern;
    pattern.reserve(value.size());
    for (const QChar c : value) {
        if (c == u'*' || c == u'?' || c == u'#' || c == u'[')
            pattern += u'[' + QString(c) + u']';
        else
            pattern += c;
    }
    return pattern;
}

QString ContainsCondition(QStringView column, const QString& value) {
    return QStringLiteral(" And %1 Like %2")
        .arg(column, quotedText(u'*' + LikePatternOf(value) + u'*'));
}

QString BuildEditItemsQuery(const ItemsFilter& filter) {
    QString sql = QStringLiteral("SELECT ItemKey, ItemName, Unit, BarCode, Price") +
                  QStringLiteral(" FROM tItems") + QStringLiteral(" Where (1>0)");
    const QStringView searched = columnAt(kItemListColumns, filter.searchBy);
    if (!searched.isEmpty() && !filter.search.isEmpty())
        sql += ContainsCondition(searched, filter.search);
    if (!filter.key.isEmpty()) sql += EqualsCondition(u"ItemKey", filter.key);
    const QStringView sorted = columnAt(kItemListColumns, filter.sortBy);
    if (!sorted.isEmpty())
        sql += QStringLiteral(" Order By %1%2").arg(sorted, descending(filter.sortOrder));
    else
        sql += QStringLiteral(" Order By ItemKey");
    return sql;
}

namespace {
const QString kAlterKeysHead = QStringLiteral("Select AccountKey, ItemKey, AlterNum, AlterBar") +
                               QStringLiteral(" From tAlterKeys");
}  // namespace

QString BuildAlterKeysQuery(const AlterKeysFilter& filter) {
    QString sql = kAlterKeysHead + QStringLiteral(" Where (1>0)");
    for (const AlterKeySearch& search : filter.searches) {
        const QStringView column = columnAt(kAlterKeyListColumns, search.searchBy);
        if (!column.isEmpty() && !search.value.isEmpty())
            sql += EqualsCondition(column, search.value);
    }
    const QStringView sorted = columnAt(kAlterKeyListColumns, filter.sortBy);
    if (!sorted.isEmpty())
        sql += QStringLiteral(" Order By %1%2, ItemKey").arg(sorted, descending(filter.sortOrder));
    else
        sql += QStringLiteral(" Order By AccountKey, ItemKey");
    return sql;
}

QString NoAlterKeysQuery() {
    return kAlterKeysHead + QStringLiteral(" Where (1<0)");
}

QString BuildAccountDefQuery(const QString& account) {
    QString sql = QStringLiteral("Select AccountKey,PriceList,LabelName From tAccountDef");
    if (!account.isEmpty())
        sql += QStringLiteral(" Where (1>0)") + EqualsCondition(u"AccountKey", account);
    return sql;
}

}  // namespace etq

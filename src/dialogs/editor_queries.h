#pragma once

#include <QList>
#include <QString>
#include <QStringView>

// The record sources of the item, alternate key and account editors, composed in one place for
// the windows and the command line. Each is a base that ends in "Where (1>0)" followed by
// conditions that begin with " And ", then its order.
//
// A value the user gives is a value, never SQL: it goes into a text literal with its apostrophes
// doubled, and a search text is matched as written, so that "*", "?", "#" and "[" in it are
// those characters and "'" cannot end the literal.
namespace etq {

// The columns of the search and sort lists, by list position.
inline constexpr QStringView kItemListColumns[] = {u"ItemKey", u"ItemName", u"BarCode"};
inline constexpr QStringView kAlterKeyListColumns[] = {u"AccountKey", u"ItemKey", u"AlterNum",
                                                       u"AlterBar"};

// The item editor's choices. List positions outside their list count as no selection.
struct ItemsFilter {
    int searchBy = -1;  // column searched
    QString search;     // a part of the column's value; empty shows every item
    int sortBy = -1;    // no selection orders by item key
    int sortOrder = 0;  // 1 descending
    QString key;        // not empty: the item with exactly this key only
};

// "SELECT ItemKey, ItemName, Unit, BarCode, Price FROM tItems Where (1>0)", the search as a match
// anywhere in the column, then the order.
QString BuildEditItemsQuery(const ItemsFilter& filter);

// One filter row of the alternate key editor: the column and its exact value.
struct AlterKeySearch {
    int searchBy = -1;
    QString value;  // empty: the row adds nothing
};

struct AlterKeysFilter {
    QList<AlterKeySearch> searches;  // all of them narrow the rows; the window has two
    int sortBy = -1;                 // no selection orders by account, then item
    int sortOrder = 0;               // 1 descending (the sort column only)
};

// "Select AccountKey, ItemKey, AlterNum, AlterBar From tAlterKeys Where (1>0)", each search as an
// equality, then the order.
QString BuildAlterKeysQuery(const AlterKeysFilter& filter);

// The alternate key source that shows no row: a row added to it is the only one shown.
QString NoAlterKeysQuery();

// "Select AccountKey,PriceList,LabelName From tAccountDef", narrowed to one account when
// `account` is not empty.
QString BuildAccountDefQuery(const QString& account = {});

// " And column = 'value'".
QString EqualsCondition(QStringView column, const QString& value);
// " And column Like '*value*'", the value matched as written.
QString ContainsCondition(QStringView column, const QString& value);
// A Like pattern that matches exactly `value`: each of * ? # [ inside brackets.
QString LikePatternOf(const QString& value);

}  // namespace etq

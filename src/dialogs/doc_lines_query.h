#pragma once

#include <QString>

namespace etq {

// The record source of the document line grid: line number, item key, the item's name from
// tItems, quantity, warehouse, copies and print flag of the lines of one imported document (the
// header's WizFileID and Number), in line order. Lines whose item is not in tItems are not
// listed. A value that is a whole number goes in as that number; anything else (an empty value
// when no document is listed, or a text that is no number) as a quoted text, which matches no
// line: no value can break or add to the statement.
QString BuildDocLinesQuery(const QString& wizFileId, const QString& headNumber);

}  // namespace etq

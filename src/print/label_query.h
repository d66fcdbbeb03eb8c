#pragma once

#include <QString>
#include <array>

#include "platform/label_fields.h"

namespace etq {

// What the label query selects: the marked items, or the included lines of the included
// documents.
enum LabelQueryType : quint8 { ItemLabels = 1, DocumentLineLabels = 2 };
// Sort direction of the label query; any other value adds no direction word.
enum LabelOrder : quint8 { Ascending = 1, Descending = 2 };

// The settings of the label tab that shape the label query.
struct LabelQueryInput {
    quint8 queryType = ItemLabels;
    quint8 order = Ascending;
    bool useAccountKey = false;
    QString accountKey;
    QString fromItem;  // item labels only
    QString toItem;
    std::array<bool, kLabelFieldCount> fieldChecks{};  // the field slots that are sent
    QString companyName;
};

// The SELECT statement, in the engine's dialect, whose rows are the label positions: one per
// marked item or included document line, with its copies, its account's label design and the
// columns of the checked field slots. Builds text only; the caller opens it on the working
// database.
QString BuildLabelQuery(const LabelQueryInput& input);

// " And ItemKey >= '<from>'" and " And ItemKey <= '<to>'", each only when its key is given.
QString ItemKeyRangeCondition(const QString& fromItem, const QString& toItem);

// The key as a text literal between apostrophes, an apostrophe inside doubled.
QString quotedText(const QString& text);

}  // namespace etq

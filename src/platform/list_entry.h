#pragma once

#include <QList>
#include <QString>

namespace etq {

// An entry of a list the user chooses from: the text shown and the number behind it (a combo
// box's item data).
struct ListEntry {
    QString text;
    int data = 0;
    friend bool operator==(const ListEntry&, const ListEntry&) = default;
};

using EntryList = QList<ListEntry>;

}  // namespace etq

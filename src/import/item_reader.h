#pragma once

#include <QString>
#include <optional>

namespace etq {

class Progress;

// The query group rule of the item import: one bit of the host item's query group mask decides
// whether the item is left out of document labels (IgnoreInDoc).
struct QueryGroupRule {
    int bit = 1;  // 1 is the lowest bit
    // True: items with the bit set are left out; false: the items without it are.
    bool ignoreWhenSet = false;

    bool ignoreInDoc(qint32 mask) const;
};

// What one reading of the host's item file does.
struct ItemReadOptions {
    QString companyFolder;  // holds oitm.dbf
    // The temporary items database, whose links lead to tItems of the item database (and which
    // holds tTempPriceList).
    QString databasePath;
    // Key range, compared by character codes ("2" is after "100"); empty: no bound.
    QString fromKey;
    QString toKey;
    std::optional<qint16> group;  // only items of this item group (a blank group passes)
    std::optional<QueryGroupRule> queryGroup;
    bool foreignNames = false;     // ItemName from the foreign name
    qint16 copies = 0;             // Copies of every item read
    int priceField = 1;            // the price entry (1..10) that gives Price and Coin
    bool stagePriceLists = false;  // also stage all ten prices in tTempPriceList
};

// Reads the host's items (oitm.dbf) into tItems: a key found is edited, a new key added; with
// stagePriceLists every price entry with a price becomes a staged price list row. A field the
// host leaves blank keeps its stored value; Price, Coin, Copies and the pack units are always
// written. Records marked deleted are not read but count for the progress, shown every fifth
// record between an emptied bar at the start and at the end.
//
// Throws HostFileMissing when the company folder has no item file, HostFileDamaged or
// HostValueError for a file or field that cannot be read, and the engine's JetError. The items
// written before a failure stay written. A duplicate key is passed over.
void readHostItems(const ItemReadOptions& options, Progress& progress);

}  // namespace etq

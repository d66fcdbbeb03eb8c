#pragma once

#include <QString>

#include "platform/list_entry.h"

// The host's small reference files: the lists the reading-items tab offers, its currencies and
// its special prices per account.
namespace etq {

class Progress;

// The lists of the company folder the item import chooses from.
enum class HostList {
    PropertyGroups,  // item property groups (oitg.dbf): the query group rule's bit
    ItemGroups,      // item groups (oitb.dbf)
    PriceLists,      // price lists (opln.dbf): the price field
};

// The entries of a list: the name as text, the number as data. Records with a blank name add
// nothing. Throws HostFileMissing when the file is not there, HostFileDamaged or HostValueError
// when it cannot be read.
EntryList readHostList(const QString& companyFolder, HostList list);

// Brings the host's currencies (ocrn.dbf) into tCurrencies of the database at databasePath: a
// code found is edited, a new one added; blank host texts leave the stored ones. The local
// currency gets the shekel sign. Throws HostFileMissing for a missing file, HostFileDamaged or
// HostValueError for a file that cannot be read, and QuietFailure when the database refuses
// (the window has always passed over that); what was written before stays.
void readHostCurrencies(const QString& companyFolder, const QString& databasePath,
                        Progress& progress);

// Stages the host's special prices (ospp.dbf) in tTempAlterPrices of the temporary items
// database at databasePath; the merge moves them on. Records without an item or an account key
// are passed over, and so is a second price for the same account and item. Failures as
// readHostCurrencies.
void readHostSpecialPrices(const QString& companyFolder, const QString& databasePath,
                           Progress& progress);

}  // namespace etq

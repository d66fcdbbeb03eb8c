#pragma once

#include <QString>

#include "import/item_reader.h"

namespace etq {

class Context;
class Progress;

// What an item import run does: where, from where, and what it reads.
struct ItemImportOptions {
    QString databaseFolder;  // the local databases
    QString companyFolder;   // the host's company folder
    bool clean = false;      // empty tItems first (and tAlterPrices with specialPrices)
    bool specialPrices = false;
    // The item reading: key range, groups, names, copies, price field and price lists. Its
    // company folder and database are the run's own.
    ItemReadOptions items;
};

// The item import run: prepares the item and temporary items databases, reads items,
// currencies and (when asked) special prices from the company folder, merges the staged rows
// into the item database and makes sure the working database exists. Each step is shown as
// the progress's step (captions 31 to 38 in the context's language) and the bar moves.
//
// Returns when the run reached its end (the step then shows caption 38, "Scan is finished").
// The run holds the database folder's lock: while another run works there it throws FolderBusy
// before touching anything. A failure throws and ends the run at that step: the engine's
// JetError or a Failure, among
// them those the window has always passed over without a word (a missing oitm.dbf, a currency
// database that cannot be written). What was written before the stop is kept.
void importItems(const ItemImportOptions& options, const Context& context, Progress& progress);

}  // namespace etq

#pragma once

#include <QString>

namespace etq {

class Surface;

// Empties the item tables before an import, as the surface's boxes say: tItems when ChkClean
// is checked, and tAlterPrices too when ChkImportAlterPrices is checked as well. itemDbPath is
// the item database. A failure throws to the caller.
void CleanTables(const Surface& surface, const QString& itemDbPath);

// The item import run of CmdImportItems, with the values of the reading-items tab and the
// database folder txtDBPath: prepares the item and temporary items databases, reads items,
// currencies and (when asked) special prices from the company folder of the connection
// parameters, merges the staged rows into the item database and makes sure the working
// database exists. Message1 tells each step and the progress bar moves.
//
// True when the run reached its end (Message1 shows caption 38, "Scan is finished"). False
// when it stopped early: the step that stopped it has reported why, or stopped without a word
// where the readers always have (a missing oitm.dbf, a currency database that cannot be
// written). What was written before the stop is kept.
bool ImportItems(const Surface& surface);

}  // namespace etq

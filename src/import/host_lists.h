#pragma once

#include <QString>
#include <QVariant>

// The host's small reference files: the lists the reading-items tab offers, its currencies and
// its special prices per account.
namespace etq {

class Surface;

// Fill a combo box of the reading-items tab from the company folder of the current connection
// parameters: the entry's text is the name, its item data the number. A missing file leaves
// the combo as it was; records with a blank name add nothing. A damaged file is reported.
void FillCmbItmQGrp(const Surface& surface);    // cmbItmQGrp, item property groups (oitg.dbf)
void FillCmbItmBelong(const Surface& surface);  // cmbItmBelong, item groups (oitb.dbf)
void FillCmbPrice(const Surface& surface);      // cmbPriceField, price lists (opln.dbf)

// Brings the host's currencies (ocrn.dbf in compPath) into tCurrencies of the database at
// dbPath: a code found is edited, a new one added; blank host texts leave the stored ones.
// True when the file was read to its end; false when it is missing or the reading failed
// (a damaged file is reported, a database failure ends the reader without a message).
bool ReadCoinsMNHL(const Surface& surface, const QString& compPath, const QString& dbPath);

// Stages the host's special prices (ospp.dbf in compPath) in tTempAlterPrices of the temporary
// items database at dbPath; the merge moves them on. Records without an item or an account
// key are passed over, and so is a second price for the same account and item. fromItemKey
// and toItemKey are accepted and filter nothing. Results and failures as ReadCoinsMNHL.
bool ReadSpecialPriceMNHL(const Surface& surface, const QString& compPath, const QString& dbPath,
                          const QVariant& fromItemKey, const QVariant& toItemKey);

}  // namespace etq

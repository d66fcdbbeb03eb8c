#pragma once

#include <QString>
#include <QVariant>

namespace etq {

class Surface;

// Reads the host's items (oitm.dbf in the company folder compPath) into tItems through the
// temporary items database at dbPath, whose links lead to the item database: a key found is
// edited, a new key added. With importPriceLists the prices of all ten price entries are
// staged in tTempPriceList as well.
//
// Which items are read comes from the surface's boxes on the reading-items tab: the key range
// txtFromItemKey..txtToItemKey (binary comparison), the item group of cmbItmBelong when
// chkItmBelong is checked, and the query group rule of cmbItmQGrp/cmbItmQGrpBy when chkItmQGrp
// is checked. fromItemKey and toItemKey are accepted from callers and not used;
// importPackUnits and byDocs likewise. getForeign non-zero takes the foreign name as
// ItemName; every item gets `copies` copies and the price of entry priceField (1..10).
//
// Returns true when the file was read to its end. A missing oitm.dbf returns false without a
// word; any other failure is shown (critical, caption 1) and returns false, keeping the items
// written before it.
bool ReadItemMNHL(const Surface& surface, const QString& compPath, const QString& dbPath,
                  const QVariant& fromItemKey, const QVariant& toItemKey, qint16 getForeign,
                  qint16 copies, qint16 priceField, bool importPackUnits, bool byDocs,
                  bool importPriceLists);

}  // namespace etq

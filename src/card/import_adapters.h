#pragma once

// The item import as the control runs it: the routines that read the controls of the
// reading-items tab into the options of the import logic, and the control's own routines of
// that name, which report their failures as the window always has.

#include <QString>
#include <QVariant>
#include <optional>

#include "import/item_import.h"

namespace etq {

class Context;
class ControlValues;
class Progress;
class StoredValues;
class Surface;

// The item data of the combo's selected entry as a 16-bit number; nothing when none is chosen.
// Throws JetError (overflow) for item data beyond 16 bits.
std::optional<qint16> selectedNumber(const ControlValues& values, const QString& combo);

// The copies every imported item gets: txtCopies as a 16-bit whole number. Throws JetError
// (type mismatch) when it is none.
qint16 copiesOf(const ControlValues& values);

// The price entry that gives the items their price: the number behind the price list chosen in
// cmbPriceField. Throws JetError when none is chosen.
qint16 priceFieldOf(const ControlValues& values);

// Which host items a reading takes: the key range txtFromItemKey..txtToItemKey, the item group
// of cmbItmBelong when chkItmBelong is checked, and the query group rule of cmbItmQGrp and
// cmbItmQGrpBy when chkItmQGrp is checked.
ItemReadOptions readItemSelection(const ControlValues& values);

// The whole run's options from the reading-items tab, the database folder txtDBPath and the
// context's company folder. Throws when no price list is chosen or the copies are no number.
ItemImportOptions readItemImportOptions(const ControlValues& values, const Context& context);

// CmdImportItems: the item import run with the controls' values, its steps on Message1 and the
// progress bar. True when it reached its end; false when it stopped, after telling why where the
// window tells it.
bool CmdImportItems(Surface& surface, Context& context);

// Empties the item tables before an import as ChkClean and ChkImportAlterPrices say. A failure
// throws to the caller.
void CleanTables(const Surface& surface, Context& context, const QString& itemDbPath);

// The readers as the control offers them: true when the host file was read to its end. A
// missing file gives false without a word; other failures are shown (critical, caption 1)
// where the window has always shown them, and give false. fromItemKey and toItemKey are
// accepted and not used (ReadItemMNHL takes its range from the tab's boxes), and so are
// importPackUnits and byDocs.
bool ReadItemMNHL(const Surface& surface, Context& context, const QString& compPath,
                  const QString& dbPath, const QVariant& fromItemKey, const QVariant& toItemKey,
                  qint16 getForeign, qint16 copies, qint16 priceField, bool importPackUnits,
                  bool byDocs, bool importPriceLists);
// The same reading on any control values (the command line's stored settings), its progress
// shown on `progress`.
bool ReadItemMNHL(const ControlValues& values, Progress& progress, Context& context,
                  const QString& compPath, const QString& dbPath, const QVariant& fromItemKey,
                  const QVariant& toItemKey, qint16 getForeign, qint16 copies, qint16 priceField,
                  bool importPackUnits, bool byDocs, bool importPriceLists);
bool ReadCoinsMNHL(const Surface& surface, Context& context, const QString& compPath,
                   const QString& dbPath);
bool ReadSpecialPriceMNHL(const Surface& surface, Context& context, const QString& compPath,
                          const QString& dbPath, const QVariant& fromItemKey,
                          const QVariant& toItemKey);

// Fill a combo box of the reading-items tab from the company folder of the context's connection
// parameters: the entry's text is the name, its item data the number. A missing file leaves
// the combo as it was; a damaged one is reported.
void FillCmbItmQGrp(const Surface& surface, Context& context);    // item property groups
void FillCmbItmBelong(const Surface& surface, Context& context);  // item groups
void FillCmbPrice(const Surface& surface, Context& context);      // price lists

// The same three lists for settings read from the store (the command line), reported alike.
void FillHostLists(StoredValues& values, Context& context);

}  // namespace etq

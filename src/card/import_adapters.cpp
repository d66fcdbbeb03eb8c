#include "card/import_adapters.h"

#include "card/boundary.h"
#include "db/local_databases.h"
#include "import/connection.h"
#include "import/host_lists.h"
#include "jet/error.h"
#include "jet/vb.h"
#include "platform/context.h"
#include "surface/control_values.h"
#include "surface/surface.h"
#include "surface/surface_progress.h"

namespace etq {

namespace {

// The three host lists of the reading-items tab, by combo box.
struct ComboList {
    QStringView combo;
    HostList list;
};
constexpr ComboList kHostLists[] = {
    {u"cmbPriceField", HostList::PriceLists},
    {u"cmbItmQGrp", HostList::PropertyGroups},
    {u"cmbItmBelong", HostList::ItemGroups},
};

HostList listOf(QStringView combo) {
    for (const ComboList& c : kHostLists)
        if (c.combo == combo) return c.list;
    return HostList::PriceLists;
}

void fillCombo(const Surface& surface, Context& context, const QString& combo) {
    reportFailures(context, context.caption(1), [&] {
        const EntryList entries = readHostList(companyFolder(context.connection), listOf(combo));
        const ControlRef box = surface.control(combo);
        box.clearList();
        for (const ListEntry& entry : entries)
            box.addItem(entry.text, entry.data);
    });
}

}  // namespace

qint16 copiesOf(const ControlValues& values) {
    const QString copies = values.text(QStringLiteral("txtCopies"));
    if (const auto number = vb::toInteger(copies)) return *number;
    jet::fail(jet::err::kTypeMismatch,
              QStringLiteral("The copies \"%1\" are not a whole number from -32768 to 32767.")
                  .arg(copies));
}

qint16 priceFieldOf(const ControlValues& values) {
    if (const auto number = selectedNumber(values, QStringLiteral("cmbPriceField"))) return *number;
    jet::fail(jet::err::kInvalidArgument,
              QStringLiteral("No price list is chosen in cmbPriceField."));
}

std::optional<qint16> selectedNumber(const ControlValues& values, const QString& combo) {
    const std::optional<int> data = values.selectedItemData(combo);
    if (!data) return std::nullopt;
    if (const auto number = vb::toInteger(*data)) return number;
    jet::fail(jet::err::kOverflow,
              QStringLiteral("The entry chosen in %1 stands for %2, beyond a 16-bit number.")
                  .arg(combo)
                  .arg(*data));
}

ItemReadOptions readItemSelection(const ControlValues& values) {
    ItemReadOptions options;
    options.fromKey = values.text(QStringLiteral("txtFromItemKey")).trimmed();
    options.toKey = values.text(QStringLiteral("txtToItemKey")).trimmed();
    if (values.isChecked(QStringLiteral("chkItmBelong")))
        options.group = selectedNumber(values, QStringLiteral("cmbItmBelong"));
    if (values.isChecked(QStringLiteral("chkItmQGrp"))) {
        const std::optional<qint16> bit = selectedNumber(values, QStringLiteral("cmbItmQGrp"));
        const int by = values.listIndex(QStringLiteral("cmbItmQGrpBy"));
        if (bit && by >= 0) options.queryGroup = QueryGroupRule{*bit, by == 1};
    }
    return options;
}

ItemImportOptions readItemImportOptions(const ControlValues& values, const Context& context) {
    ItemImportOptions options;
    options.companyFolder = companyFolder(context.connection);
    options.items = readItemSelection(values);
    options.items.priceField = priceFieldOf(values);
    options.databaseFolder = values.text(QStringLiteral("txtDBPath"));
    options.clean = values.isChecked(QStringLiteral("ChkClean"));
    options.specialPrices = values.isChecked(QStringLiteral("ChkImportAlterPrices"));
    options.items.foreignNames = values.listIndex(QStringLiteral("CmbItemNameType")) == 1;
    options.items.copies = copiesOf(values);
    options.items.stagePriceLists = values.isChecked(QStringLiteral("chkReadPriceList"));
    return options;
}

bool CmdImportItems(Surface& surface, Context& context) {
    SurfaceProgress progress(surface);
    return reportFailures(context, context.caption(1), [&] {
        importItems(readItemImportOptions(SurfaceValues(surface), context), context, progress);
    });
}

void CleanTables(const Surface& surface, Context& context, const QString& itemDbPath) {
    const SurfaceValues values(surface);
    SurfaceProgress progress(surface);
    db::CleanItemTables(itemDbPath, values.isChecked(QStringLiteral("ChkClean")),
                        values.isChecked(QStringLiteral("ChkImportAlterPrices")), context,
                        progress);
}

bool ReadItemMNHL(const Surface& surface, Context& context, const QString& compPath,
                  const QString& dbPath, const QVariant& fromItemKey, const QVariant& toItemKey,
                  qint16 getForeign, qint16 copies, qint16 priceField, bool importPackUnits,
                  bool byDocs, bool importPriceLists) {
    SurfaceProgress progress(surface);
    return ReadItemMNHL(SurfaceValues(surface), progress, context, compPath, dbPath, fromItemKey,
                        toItemKey, getForeign, copies, priceField, importPackUnits, byDocs,
                        importPriceLists);
}

bool ReadItemMNHL(const ControlValues& values, Progress& progress, Context& context,
                  const QString& compPath, const QString& dbPath, const QVariant& /*fromItemKey*/,
                  const QVariant& /*toItemKey*/, qint16 getForeign, qint16 copies,
                  qint16 priceField, bool /*importPackUnits*/, bool /*byDocs*/,
                  bool importPriceLists) {
    return reportFailures(context, context.caption(1), [&] {
        ItemReadOptions options = readItemSelection(values);
        options.companyFolder = compPath;
        options.databasePath = dbPath;
        options.foreignNames = getForeign != 0;
        options.copies = copies;
        options.priceField = priceField;
        options.stagePriceLists = importPriceLists;
        readHostItems(options, progress);
    });
}

bool ReadCoinsMNHL(const Surface& surface, Context& context, const QString& compPath,
                   const QString& dbPath) {
    SurfaceProgress progress(surface);
    return reportFailures(context, context.caption(1),
                          [&] { readHostCurrencies(compPath, dbPath, progress); });
}

bool ReadSpecialPriceMNHL(const Surface& surface, Context& context, const QString& compPath,
                          const QString& dbPath, const QVariant& /*fromItemKey*/,
                          const QVariant& /*toItemKey*/) {
    SurfaceProgress progress(surface);
    return reportFailures(context, context.caption(1),
                          [&] { readHostSpecialPrices(compPath, dbPath, progress); });
}

void FillCmbItmQGrp(const Surface& surface, Context& context) {
    fillCombo(surface, context, QStringLiteral("cmbItmQGrp"));
}

void FillCmbItmBelong(const Surface& surface, Context& context) {
    fillCombo(surface, context, QStringLiteral("cmbItmBelong"));
}

void FillCmbPrice(const Surface& surface, Context& context) {
    fillCombo(surface, context, QStringLiteral("cmbPriceField"));
}

void FillHostLists(StoredValues& values, Context& context) {
    for (const ComboList& c : kHostLists) {
        reportFailures(context, context.caption(1), [&] {
            values.setList(c.combo.toString(),
                           readHostList(companyFolder(context.connection), c.list));
        });
    }
}

}  // namespace etq

#include "import/item_reader.h"

#include <QFileInfo>
#include <optional>

#include "import/host_reading.h"
#include "import/public_functions.h"
#include "jet/error.h"
#include "platform/failure.h"
#include "platform/progress.h"

namespace etq {

namespace {

using namespace hostread;
namespace oitm = host::oitm;

bool admitsKey(const ItemReadOptions& options, const QString& key) {
    if (!options.fromKey.isEmpty() && QString::compare(key, options.fromKey, Qt::CaseSensitive) < 0)
        return false;
    return options.toKey.isEmpty() || QString::compare(key, options.toKey, Qt::CaseSensitive) <= 0;
}

int fieldIndex(const jet::Recordset& recordset, const char* name) {
    const int index = recordset.fieldIndex(QString::fromLatin1(name));
    if (index < 0)
        jet::fail(jet::err::kItemNotFound,
                  QStringLiteral("Item not found in this collection: %1.").arg(name));
    return index;
}

// The item fields the reader writes, found once.
struct ItemFields {
    explicit ItemFields(const jet::Recordset& items)
        : key(fieldIndex(items, "ItemKey")),
          name(fieldIndex(items, "ItemName")),
          sort(fieldIndex(items, "ItemSort")),
          unit(fieldIndex(items, "Unit")),
          foreignName(fieldIndex(items, "Fname")),
          barcode(fieldIndex(items, "BarCode")),
          coin(fieldIndex(items, "Coin")),
          price(fieldIndex(items, "Price")),
          copies(fieldIndex(items, "Copies")),
          supplierCatalogNumber(fieldIndex(items, "SuppCatNum")),
          salesPack(fieldIndex(items, "SalPackUN")),
          purchasePack(fieldIndex(items, "PurPackUN")),
          ignoreInDoc(fieldIndex(items, "IgnoreInDoc")) {}
    int key, name, sort, unit, foreignName, barcode, coin, price, copies, supplierCatalogNumber,
        salesPack, purchasePack, ignoreInDoc;
};

struct PriceListFields {
    explicit PriceListFields(const jet::Recordset& prices)
        : key(fieldIndex(prices, "ItemKey")),
          list(fieldIndex(prices, "PriceList")),
          price(fieldIndex(prices, "Price")),
          currency(fieldIndex(prices, "Currency")) {}
    int key, list, price, currency;
};

// A price entry of the item file: the price in currency units and its currency.
struct Price {
    qint32 hundredths = 0;
    QString currency;
};

Price priceEntry(const DbfFile& file, qint64 record, int n) {
    const QString code = file.text(record, oitm::currency(n));
    return {file.int32(record, oitm::price(n).offset), code.isEmpty() ? kLocalCurrency : code};
}

// Reads host item records into tItems (and tTempPriceList) of an open database.
class ItemImport {
  public:
    ItemImport(jet::Database& db, const ItemReadOptions& options)
        : options_(options), items_(db.openRecordset(QStringLiteral("tItems"))), fields_(items_) {
        if (!items_.eof()) items_.moveFirst();
        if (options_.stagePriceLists) {
            priceLists_ = db.openRecordset(QStringLiteral("tTempPriceList"));
            priceListFields_.emplace(priceLists_);
        }
    }

    void read(const DbfFile& file, qint64 record) {
        const QString hostKey = file.text(record, oitm::kItemKey);
        if (hostKey.isEmpty() || !admitsKey(options_, hostKey)) return;
        const QString group = file.text(record, oitm::kGroup);
        if (options_.group && !group.isEmpty() &&
            wholeNumber16(file, record, oitm::kGroup) != *options_.group)
            return;
        const QString key = QuoteToApostrophe(hostKey);

        items_.findFirst(QStringLiteral("ItemKey=") + criterionLiteral(key, u'"'));
        if (items_.noMatch()) {
            items_.addNew();
            items_.setValue(fields_.key, key);
        } else {
            items_.edit();
        }
        setItemFields(file, record);
        if (options_.stagePriceLists) stagePrices(file, record, key);
        updateUnlessDuplicate(items_);
    }

  private:
    // A field read from the host is written only when the host has a text for it; otherwise
    // the stored value stays (a new row's stays null).
    void setIfGiven(int field, const QString& text) {
        if (!text.isEmpty()) items_.setValue(field, text);
    }

    void setItemFields(const DbfFile& file, qint64 record) {
        const QString foreignName = file.text(record, oitm::kForeignName);
        // With foreign names a blank foreign name leaves ItemName alone: the Hebrew name does
        // not stand in for it.
        setIfGiven(fields_.name,
                   options_.foreignNames ? foreignName : file.text(record, oitm::kItemName));
        setIfGiven(fields_.foreignName, foreignName);
        if (!file.text(record, oitm::kGroup).isEmpty())
            items_.setValue(fields_.sort, wholeNumber16(file, record, oitm::kGroup));
        setIfGiven(fields_.unit, file.text(record, oitm::kUnit));
        setIfGiven(fields_.barcode, file.text(record, oitm::kBarcode));
        setIfGiven(fields_.supplierCatalogNumber, file.text(record, oitm::kSupplierCatalogNumber));
        items_.setValue(fields_.copies, options_.copies);
        const Price price = priceEntry(file, record, options_.priceField);
        items_.setValue(fields_.price, price.hundredths / 100.0);
        items_.setValue(fields_.coin, price.currency);
        items_.setValue(fields_.salesPack, 1.0);
        items_.setValue(fields_.purchasePack, 1.0);
        if (options_.queryGroup && !file.text(record, oitm::kQueryGroups).isEmpty())
            items_.setValue(fields_.ignoreInDoc, options_.queryGroup->ignoreInDoc(wholeNumber32(
                                                     file, record, oitm::kQueryGroups)));
    }

    // Every price entry with a price becomes a row of its price list. An item the host holds
    // twice stages its prices once: the second rows are duplicates and are passed over.
    void stagePrices(const DbfFile& file, qint64 record, const QString& key) {
        for (int n = 1; n <= oitm::kPriceCount; ++n) {
            const Price price = priceEntry(file, record, n);
            if (price.hundredths == 0) continue;
            priceLists_.addNew();
            priceLists_.setValue(priceListFields_->key, key);
            priceLists_.setValue(priceListFields_->list, n);
            priceLists_.setValue(priceListFields_->price, price.hundredths / 100.0);
            priceLists_.setValue(priceListFields_->currency, price.currency);
            updateUnlessDuplicate(priceLists_);
        }
    }

    const ItemReadOptions& options_;
    jet::Recordset items_;
    ItemFields fields_;
    jet::Recordset priceLists_;
    std::optional<PriceListFields> priceListFields_;
};

void requirePriceField(int priceField, const QString& path) {
    if (priceField < 1 || priceField > oitm::kPriceCount)
        throw HostValueError(
            QStringLiteral("Price field %1 is not one of the %2 price entries of %3.")
                .arg(priceField)
                .arg(oitm::kPriceCount)
                .arg(path));
}

}  // namespace

bool QueryGroupRule::ignoreInDoc(qint32 mask) const {
    const bool set = bit >= 1 && bit <= 32 && ((quint32(mask) >> (bit - 1)) & 1u);
    return ignoreWhenSet ? set : !set;
}

void readHostItems(const ItemReadOptions& options, Progress& progress) {
    progress.clear();
    const QString path = hostFilePath(options.companyFolder, oitm::kLayout);
    if (!QFileInfo::exists(path))
        throw HostFileMissing(QStringLiteral("There is no item file %1").arg(path));

    jet::Database db = jet::Database::open(options.databasePath);
    ItemImport import(db, options);
    const DbfFile file = openHostFile(path, oitm::kLayout);
    requirePriceField(options.priceField, path);

    KeptWrites writes(db);
    forEachRecord(
        file, [&](qint64 record) { import.read(file, record); }, &progress, 5);
    writes.commit();
    progress.clear();
}

}  // namespace etq

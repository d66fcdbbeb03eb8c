#include "import/item_reader.h"

#include <QFileInfo>
#include <optional>

#include "db/local_databases.h"
#include "import/host_reading.h"
#include "import/public_functions.h"
#include "jet/error.h"
#include "jet/row_appender.h"
#include "platform/failure.h"
#include "platform/log.h"
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

// The fields of tItems the reader writes, in the order of the row it makes. The first is the
// key; the fields after kFirstAlways are written whatever the host holds, those before only when
// the host has a text for them (otherwise the stored value stays, a new row's stays Null).
enum ItemField {
    kKey,
    kName,
    kForeignName,
    kSort,
    kUnit,
    kBarcode,
    kSupplierCatalogNumber,
    kIgnoreInDoc,
    kCopies,
    kFirstAlways = kCopies,
    kPrice,
    kCoin,
    kSalesPack,
    kPurchasePack,
};
const QStringList kItemFields = {"ItemKey", "ItemName",   "Fname",       "ItemSort", "Unit",
                                 "BarCode", "SuppCatNum", "IgnoreInDoc", "Copies",   "Price",
                                 "Coin",    "SalPackUN",  "PurPackUN"};

enum PriceListField { kListKey, kList, kListPrice, kListCurrency };
const QStringList kPriceListFields = {"ItemKey", "PriceList", "Price", "Currency"};

jet::RowAppender::Upsert itemUpsert() {
    return {{kItemFields[kKey]}, kItemFields.mid(kName, kFirstAlways - kName)};
}

// A price entry of the item file: the price in currency units and its currency.
struct Price {
    qint32 hundredths = 0;
    QString currency;
};

Price priceEntry(const DbfFile& file, qint64 record, int n) {
    const QString code = file.text(record, oitm::currency(n));
    return {file.int32(record, oitm::price(n).offset), code.isEmpty() ? kLocalCurrency : code};
}

// Reads host item records into tItems (and tTempPriceList) of an open database. A key the item
// table holds has its row updated, a new key is added; the rows go in many at a time.
class ItemImport {
  public:
    ItemImport(jet::Database& db, const ItemReadOptions& options)
        : options_(options), items_(db, QStringLiteral("tItems"), kItemFields, itemUpsert()) {
        // An item the host holds twice stages its prices once: the second rows are duplicates
        // and are passed over.
        if (options_.stagePriceLists)
            priceLists_.emplace(db, QStringLiteral("tTempPriceList"), kPriceListFields,
                                jet::RowAppender::SkipDuplicateKeys);
    }

    void read(const DbfFile& file, qint64 record) {
        const QString hostKey = file.text(record, oitm::kItemKey);
        if (hostKey.isEmpty() || !admitsKey(options_, hostKey)) return;
        const QString group = file.text(record, oitm::kGroup);
        if (options_.group && !group.isEmpty() &&
            wholeNumber16(file, record, oitm::kGroup) != *options_.group)
            return;
        const QString key = QuoteToApostrophe(hostKey);
        setItemFields(file, record, key);
        if (options_.stagePriceLists) stagePrices(file, record, key);
        items_.addRow();
        if (items_.pendingRows() >= kRowsPerWrite) write();
    }

    // Writes the rows made so far; a reader that stops keeps what it read before the failure.
    void write() {
        items_.write();
        if (priceLists_) priceLists_->write();
    }

  private:
    static constexpr int kRowsPerWrite = 1000;

    void setIfGiven(int field, const QString& text) {
        if (!text.isEmpty()) items_.setText(field, text);
    }

    void setItemFields(const DbfFile& file, qint64 record, const QString& key) {
        items_.setText(kKey, key);
        const QString foreignName = file.text(record, oitm::kForeignName);
        // With foreign names a blank foreign name leaves ItemName alone: the Hebrew name does
        // not stand in for it.
        setIfGiven(kName, options_.foreignNames ? foreignName : file.text(record, oitm::kItemName));
        setIfGiven(kForeignName, foreignName);
        if (!file.text(record, oitm::kGroup).isEmpty())
            items_.setNumber(kSort, wholeNumber16(file, record, oitm::kGroup));
        setIfGiven(kUnit, file.text(record, oitm::kUnit));
        setIfGiven(kBarcode, file.text(record, oitm::kBarcode));
        setIfGiven(kSupplierCatalogNumber, file.text(record, oitm::kSupplierCatalogNumber));
        if (options_.queryGroup && !file.text(record, oitm::kQueryGroups).isEmpty())
            items_.setYesNo(kIgnoreInDoc, options_.queryGroup->ignoreInDoc(
                                              wholeNumber32(file, record, oitm::kQueryGroups)));
        items_.setNumber(kCopies, options_.copies);
        const Price price = priceEntry(file, record, options_.priceField);
        items_.setDouble(kPrice, price.hundredths / 100.0);
        items_.setText(kCoin, price.currency);
        items_.setDouble(kSalesPack, 1.0);
        items_.setDouble(kPurchasePack, 1.0);
    }

    // Every price entry with a price becomes a row of its price list.
    void stagePrices(const DbfFile& file, qint64 record, const QString& key) {
        for (int n = 1; n <= oitm::kPriceCount; ++n) {
            const Price price = priceEntry(file, record, n);
            if (price.hundredths == 0) continue;
            priceLists_->setText(kListKey, key);
            priceLists_->setNumber(kList, n);
            priceLists_->setDouble(kListPrice, price.hundredths / 100.0);
            priceLists_->setText(kListCurrency, price.currency);
            priceLists_->addRow();
        }
    }

    const ItemReadOptions& options_;
    jet::RowAppender items_;
    std::optional<jet::RowAppender> priceLists_;
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
    db::prepareForBulkWrites(db);
    ItemImport import(db, options);
    const DbfFile file = openHostFile(path, oitm::kLayout);
    requirePriceField(options.priceField, path);

    KeptWrites writes(db);
    try {
        forEachRecord(
            file, [&](qint64 record) { import.read(file, record); }, &progress, 5);
    } catch (...) {
        // The items before the one that failed stay written, as they always have.
        try {
            import.write();
        } catch (const std::exception& e) {
            qCWarning(log::import) << "keeping the items read before the failure:" << describe(e);
        }
        throw;
    }
    import.write();
    writes.commit();
    progress.clear();
}

}  // namespace etq

#include "import/host_lists.h"

#include <QFileInfo>
#include <functional>

#include "import/host_reading.h"
#include "import/public_functions.h"
#include "platform/failure.h"
#include "platform/progress.h"

namespace etq {

namespace {

using namespace hostread;

// The host file a list's entries come from.
struct ListFile {
    const host::HostLayout& layout;
    host::HostField number;  // the entry's data
    host::HostField name;    // the entry's text
};

const ListFile& fileOf(HostList list) {
    static const ListFile kPropertyGroups{host::oitg::kLayout, host::oitg::kNumber,
                                          host::oitg::kName};
    static const ListFile kItemGroups{host::oitb::kLayout, host::oitb::kNumber, host::oitb::kName};
    static const ListFile kPriceLists{host::opln::kLayout, host::opln::kNumber, host::opln::kName};
    switch (list) {
        case HostList::PropertyGroups:
            return kPropertyGroups;
        case HostList::ItemGroups:
            return kItemGroups;
        case HostList::PriceLists:
            break;
    }
    return kPriceLists;
}

QString existingHostFile(const QString& companyFolder, const host::HostLayout& layout) {
    const QString path = hostFilePath(companyFolder, layout);
    if (!QFileInfo::exists(path))
        throw HostFileMissing(QStringLiteral("There is no host file %1").arg(path));
    return path;
}

// Runs a reader of a small reference file over the database at dbPath, in one transaction.
// The database failing is told on the command line only: the window has always passed over it.
void readReferenceFile(const QString& compPath, const QString& dbPath,
                       const host::HostLayout& layout, Progress& progress,
                       const std::function<void(jet::Database&, const DbfFile&, Progress&)>& read) {
    progress.clear();
    const QString path = existingHostFile(compPath, layout);
    try {
        jet::Database db = jet::Database::open(dbPath);
        const DbfFile file = openHostFile(path, layout);
        KeptWrites writes(db);
        read(db, file, progress);
        writes.commit();
    } catch (const jet::JetError& e) {
        throw QuietFailure(
            QStringLiteral("Reading %1 into %2: %3").arg(path, dbPath, e.description()));
    }
    progress.clear();
}

}  // namespace

EntryList readHostList(const QString& companyFolder, HostList list) {
    const ListFile& source = fileOf(list);
    const DbfFile file =
        openHostFile(existingHostFile(companyFolder, source.layout), source.layout);
    EntryList entries;
    forEachRecord(file, [&](qint64 record) {
        const QString name = file.text(record, source.name);
        if (!name.isEmpty()) entries.append({name, wholeNumber16(file, record, source.number)});
    });
    return entries;
}

void readHostCurrencies(const QString& companyFolder, const QString& databasePath,
                        Progress& progress) {
    namespace ocrn = host::ocrn;
    readReferenceFile(
        companyFolder, databasePath, ocrn::kLayout, progress,
        [](jet::Database& db, const DbfFile& file, Progress& bar) {
            jet::Recordset currencies = db.openRecordset(QStringLiteral("tCurrencies"));
            auto setIfGiven = [&](const char* field, const QString& text) {
                if (!text.isEmpty()) currencies.setValue(QString::fromLatin1(field), text);
            };
            forEachRecord(
                file,
                [&](qint64 record) {
                    const QString code = file.text(record, ocrn::kCode);
                    currencies.findFirst(QStringLiteral("CURRENCY=") +
                                         criterionLiteral(code, u'\''));
                    if (currencies.noMatch()) {
                        currencies.addNew();
                        currencies.setValue(QStringLiteral("Currency"), code);
                    } else {
                        currencies.edit();
                    }
                    setIfGiven("Desc", file.text(record, ocrn::kDescription));
                    const QString hostSign = file.text(record, ocrn::kHostSign);
                    // Labels print the local currency with the shekel sign, whatever the host
                    // keeps for it.
                    setIfGiven("WizSign", code == kLocalCurrency && !hostSign.isEmpty()
                                              ? kLocalCurrencySign
                                              : hostSign);
                    setIfGiven("Sign", file.text(record, ocrn::kSign));
                    currencies.update();
                },
                &bar, 20);
        });
}

void readHostSpecialPrices(const QString& companyFolder, const QString& databasePath,
                           Progress& progress) {
    namespace ospp = host::ospp;
    readReferenceFile(
        companyFolder, databasePath, ospp::kLayout, progress,
        [](jet::Database& db, const DbfFile& file, Progress& bar) {
            jet::Recordset prices = db.openRecordset(QStringLiteral("tTempAlterPrices"));
            forEachRecord(
                file,
                [&](qint64 record) {
                    const QString itemKey = QuoteToApostrophe(file.text(record, ospp::kItemKey));
                    const QString accountKey = file.text(record, ospp::kAccountKey);
                    if (itemKey.isEmpty() || accountKey.isEmpty()) return;
                    prices.addNew();
                    prices.setValue(QStringLiteral("AccountKey"), accountKey);
                    prices.setValue(QStringLiteral("ItemKey"), itemKey);
                    prices.setValue(QStringLiteral("Price"),
                                    file.int32(record, ospp::kPrice.offset) / 100.0);
                    const QString coin = file.text(record, ospp::kCurrency);
                    if (!coin.isEmpty()) prices.setValue(QStringLiteral("Coin"), coin);
                    // The host may hold two prices for one account and item; the staging
                    // table keeps the first.
                    updateUnlessDuplicate(prices);
                },
                &bar, 5);
        });
}

}  // namespace etq

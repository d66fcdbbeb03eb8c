#include "import/host_lists.h"

#include <QFileInfo>
#include <functional>

#include "import/connection.h"
#include "import/host_reading.h"
#include "import/public_functions.h"
#include "shell/surface.h"

namespace etq {

namespace {

using namespace hostread;

// A combo box of the reading-items tab and the host file its entries come from.
struct HostList {
    QStringView combo;
    const host::HostLayout& layout;
    host::HostField number;  // the entry's item data
    host::HostField name;    // the entry's text
};

const HostList kPropertyGroups{u"cmbItmQGrp", host::oitg::kLayout, host::oitg::kNumber,
                               host::oitg::kName};
const HostList kItemGroups{u"cmbItmBelong", host::oitb::kLayout, host::oitb::kNumber,
                           host::oitb::kName};
const HostList kPriceLists{u"cmbPriceField", host::opln::kLayout, host::opln::kNumber,
                           host::opln::kName};

void fillCombo(const Surface& surface, const HostList& list) {
    const QString path = hostFilePath(companyFolder(), list.layout);
    if (!QFileInfo::exists(path)) return;
    try {
        const DbfFile file = openHostFile(path, list.layout);
        const ControlRef combo = surface.control(list.combo.toString());
        combo.clearList();
        forEachRecord(file, [&](qint64 record) {
            const QString name = file.text(record, list.name);
            if (name.isEmpty()) return;
            combo.addItem(name, wholeNumber16(file, record, list.number));
        });
    } catch (const std::exception& e) {
        reportFailure(e);
    }
}

// Runs a reader of a small reference file over the database at dbPath, in one transaction.
// The host file is damaged: that is told. The database fails: the reader ends without a
// message, as these readers always have, and the run that called it stops.
bool readReferenceFile(
    const Surface& surface, const QString& compPath, const QString& dbPath,
    const host::HostLayout& layout,
    const std::function<void(jet::Database&, const DbfFile&, ProgressBar&)>& read) {
    ProgressBar bar(surface);
    bar.clear();
    const QString path = hostFilePath(compPath, layout);
    if (!QFileInfo::exists(path)) return false;
    try {
        jet::Database db = jet::Database::open(dbPath);
        const DbfFile file = openHostFile(path, layout);
        KeptWrites writes(db);
        read(db, file, bar);
        writes.commit();
    } catch (const DbfError& e) {
        reportFailure(e);
        return false;
    } catch (const HostValueError& e) {
        reportFailure(e);
        return false;
    } catch (const std::exception&) {
        return false;
    }
    bar.clear();
    return true;
}

}  // namespace

void FillCmbItmQGrp(const Surface& surface) {
    fillCombo(surface, kPropertyGroups);
}

void FillCmbItmBelong(const Surface& surface) {
    fillCombo(surface, kItemGroups);
}

void FillCmbPrice(const Surface& surface) {
    fillCombo(surface, kPriceLists);
}

bool ReadCoinsMNHL(const Surface& surface, const QString& compPath, const QString& dbPath) {
    namespace ocrn = host::ocrn;
    return readReferenceFile(
        surface, compPath, dbPath, ocrn::kLayout,
        [](jet::Database& db, const DbfFile& file, ProgressBar& bar) {
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

bool ReadSpecialPriceMNHL(const Surface& surface, const QString& compPath, const QString& dbPath,
                          const QVariant& /*fromItemKey*/, const QVariant& /*toItemKey*/) {
    namespace ospp = host::ospp;
    return readReferenceFile(
        surface, compPath, dbPath, ospp::kLayout,
        [](jet::Database& db, const DbfFile& file, ProgressBar& bar) {
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

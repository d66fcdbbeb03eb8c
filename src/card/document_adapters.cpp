#include "card/document_adapters.h"

#include "card/boundary.h"
#include "card/import_adapters.h"
#include "card/print_adapters.h"
#include "db/db_values.h"
#include "db/file_names.h"
#include "db/local_databases.h"
#include "import/connection.h"
#include "import/host_lists.h"
#include "import/public_functions.h"
#include "platform/context.h"
#include "platform/failure.h"
#include "platform/progress.h"
#include "print/label_query.h"
#include "surface/control_values.h"
#include "surface/surface_progress.h"

namespace etq {

namespace {

constexpr int kError = 1;
constexpr int kScanningItems = 46;
constexpr int kScanningSpecialPrices = 48;
constexpr int kUpdatingMainTables = 50;

const QString kLineBreak = QStringLiteral("\r\n");

// A date box: day/month/year, or empty for no bound.
QDate dateOf(const ControlValues& values, const QString& box) {
    const QString text = values.text(box).trimmed();
    if (text.isEmpty()) return {};
    const QDate date = db::ParseDayMonthYear(text);
    if (!date.isValid())
        throw BadSetting(
            QStringLiteral("The date \"%1\" of %2 is not a day/month/year date.").arg(text, box));
    return date;
}

// Between the lines of an address: the text "0" in cmbAddressSeperator is a line break.
QString addressSeparatorOf(const ControlValues& values) {
    return values.text(QStringLiteral("cmbAddressSeperator")) == u"0" ? kLineBreak
                                                                      : QStringLiteral(",");
}

// The items step's arguments as ImportDocs gives them: the name choice, the copies and the price
// field of the reading-items tab.
ItemsByDocsArgs itemsByDocsArgs(const ControlValues& values, const DocImportOptions& run) {
    ItemsByDocsArgs args;
    args.companyFolder = run.companyFolder;
    args.tempDbPath = db::inFolder(run.dbFolder, db::kTempItemDatabaseFile);
    args.fromItemKey = values.text(QStringLiteral("txtFromItemKey"));
    args.toItemKey = values.text(QStringLiteral("txtToItemKey"));
    args.useForeignName = values.listIndex(QStringLiteral("CmbItemNameType")) == 1 ? 1 : 0;
    args.copies = copiesOf(values);
    args.priceField = priceFieldOf(values);
    return args;
}

}  // namespace

DocNumberBounds readDocNumberBounds(const ControlValues& values) {
    const QString to = values.text(QStringLiteral("txtToDocNum")).trimmed();
    return {TextToLong(values.text(QStringLiteral("txtFromDocNum"))), TextToLong(to),
            !to.isEmpty()};
}

DocImportOptions readDocImportOptions(const ControlValues& values, const Context& context) {
    DocImportOptions options;
    options.dbFolder = values.text(QStringLiteral("txtDBPath"));
    options.companyFolder = companyFolder(context.connection);
    options.fromDate = dateOf(values, QStringLiteral("txtFromDate"));
    options.toDate = dateOf(values, QStringLiteral("txtToDate"));
    options.useDeliveryLog = values.isChecked(QStringLiteral("chkUseDeliverLog"));
    options.readItems = values.isChecked(QStringLiteral("chkReadDocItems"));
    options.addressFrom = qint16(values.listIndex(QStringLiteral("cmbAddressFrom")) + 1);
    options.addressSeparator = addressSeparatorOf(values);
    options.fastWay = printsTheFastWay(values);
    const DocNumberBounds bounds = readDocNumberBounds(values);
    options.fromNumber = bounds.from;
    options.toNumber = bounds.to;
    options.toNumberEntered = bounds.toEntered;
    return options;
}

bool printsTheFastWay(const ControlValues& values) {
    return values.isChecked(QStringLiteral("chkOnlyLine0")) &&
           values.isChecked(QStringLiteral("chkUseFastWay"));
}

bool importItemsByDocs(const ControlValues& values, Context& context, Progress& progress,
                       const ItemsByDocsArgs& args) {
    progress.step(context.caption(kScanningItems));
    const bool priceLists = values.isChecked(QStringLiteral("chkReadPriceList"));
    if (!ReadItemMNHL(values, progress, context, args.companyFolder, args.tempDbPath,
                      args.fromItemKey, args.toItemKey, args.useForeignName, args.copies,
                      args.priceField, args.importPackUnits, args.byDocs, priceLists))
        return false;
    if (values.isChecked(QStringLiteral("ChkImportAlterPrices"))) {
        progress.step(context.caption(kScanningSpecialPrices));
        if (!reportFailures(context, context.caption(kError), [&] {
                readHostSpecialPrices(args.companyFolder, args.tempDbPath, progress);
            }))
            return false;
    }
    progress.step(context.caption(kUpdatingMainTables));
    return reportFailures(context, context.caption(kError),
                          [&] { db::MergeTempItems(args.tempDbPath); });
}

DocImportResult runDocImport(const ControlValues& values, Context& context, Progress& progress) {
    DocImportOptions options = readDocImportOptions(values, context);
    if (options.readItems) {
        options.importItems = [&values, &context, &progress,
                               args = itemsByDocsArgs(values, options)] {
            return importItemsByDocs(values, context, progress, args);
        };
    }
    options.readerFailed = [&context](qint16, const std::exception_ptr& failure) {
        reportFailures(context, context.caption(kError), [&] { std::rethrow_exception(failure); });
    };
    return importDocuments(options, context, progress);
}

qint32 ReadStockMnhl(Surface& surface, Context& context, const QString& compPath,
                     const QString& dbName, qint16 wizFileType, const QDate& fromDate,
                     const QDate& toDate, bool includeDraft, bool fastWay, qint16 addressFrom) {
    StockDocReadOptions options;
    options.companyFolder = compPath;
    options.workDbPath = dbName;
    options.wizFileType = wizFileType;
    options.fromDate = fromDate;
    options.toDate = toDate;
    options.includeDrafts = includeDraft;
    options.fastWay = fastWay;
    options.addressFrom = addressFrom;
    const DocNumberBounds bounds = readDocNumberBounds(SurfaceValues(surface));
    options.fromNumber = bounds.from;
    options.toNumber = bounds.to;
    options.toNumberEntered = bounds.toEntered;
    // The import run sets the separator before it reads; a reader called on its own breaks lines.
    if (!context.addressSeparator.isEmpty()) options.addressSeparator = context.addressSeparator;
    SurfaceProgress progress(surface);
    qint64 records = 0;
    reportFailures(context, context.caption(kError),
                   [&] { records = readStockDocuments(options, context, progress).recordCount; });
    return qint32(records);
}

bool ImportDocs(Surface& surface, Context& context) {
    SurfaceProgress progress(surface);
    bool completed = false;
    reportFailures(context, context.caption(kError), [&] {
        completed = !runDocImport(SurfaceValues(surface), context, progress).stopped;
    });
    return completed;
}

bool ImportItemsByDocs(Surface& surface, Context& context, const QString& wizPath,
                       const QString& myDBName, const QVariant& fromItemKey,
                       const QVariant& toItemKey, qint16 useFName, qint16 copies, qint16 priceField,
                       bool importPackUnits, bool byDocs) {
    SurfaceProgress progress(surface);
    return importItemsByDocs(SurfaceValues(surface), context, progress,
                             {wizPath, myDBName, fromItemKey, toItemKey, useFName, copies,
                              priceField, importPackUnits, byDocs});
}

QString PrintDocLabels(Surface& surface, Context& context) {
    if (printsTheFastWay(SurfaceValues(surface)) && !ImportDocs(surface, context)) return {};
    return PrintLabels(surface, context, DocumentLineLabels);
}

}  // namespace etq

#include "import/document_import.h"

#include <QFileInfo>
#include <optional>

#include "db/file_names.h"
#include "db/local_databases.h"
#include "jet/database.h"
#include "jet/recordset.h"
#include "jet/vb.h"
#include "platform/context.h"
#include "platform/failure.h"
#include "platform/folder_lock.h"
#include "platform/messages.h"
#include "platform/progress.h"

namespace etq {

namespace {

constexpr int kAttention = 30;
constexpr int kScanIsFinished = 38;
constexpr int kContinueAnyway = 51;

const QString kTypesToScan =
    QStringLiteral("Select * From tDocTypes Where Include Or IncludeDraft");

struct RunFiles {
    QString work, items, documents, tempItems, log;
};

RunFiles prepareFiles(const DocImportOptions& options) {
    const QString& folder = options.dbFolder;
    RunFiles files;
    if (options.useDeliveryLog) {
        files.log = db::inFolder(folder, db::kLogDatabaseFile);
        if (!QFileInfo::exists(files.log)) files.log = db::CreateLogDatabase(files.log);
    }
    files.work = db::inFolder(folder, db::kWorkDatabaseFile);
    files.items = db::inFolder(folder, db::kItemDatabaseFile);
    files.documents = db::inFolder(folder, db::kDocDatabaseFile);
    files.tempItems =
        db::CreateTempItemDatabase(db::inFolder(folder, db::kTempItemDatabaseFile), files.items);
    db::CreateDocDatabase(files.documents, files.items, files.work, files.log);
    return files;
}

StockDocReadOptions readerOptions(const DocImportOptions& options, const QString& workDb,
                                  qint16 docType, bool includeDrafts) {
    StockDocReadOptions reader;
    reader.companyFolder = options.companyFolder;
    reader.workDbPath = workDb;
    reader.wizFileType = docType;
    reader.fromDate = options.fromDate;
    reader.toDate = options.toDate;
    reader.includeDrafts = includeDrafts;
    reader.fastWay = options.fastWay;
    reader.addressFrom = options.addressFrom;
    reader.fromNumber = options.fromNumber;
    reader.toNumber = options.toNumber;
    reader.toNumberEntered = options.toNumberEntered;
    reader.addressSeparator = options.addressSeparator;
    return reader;
}

// The reader of one type. Its failure is the type's, not the run's.
DocTypeRead readType(const StockDocReadOptions& reader, Context& context, Progress& progress) {
    DocTypeRead read;
    read.docType = reader.wizFileType;
    try {
        read.scan = readStockDocuments(reader, context, progress);
    } catch (const std::exception&) {
        read.failure = std::current_exception();
    }
    return read;
}

bool continueAnyway(Context& context) {
    const Message question{context.caption(kContinueAnyway), context.caption(kAttention),
                           MsgIcon::Question, MsgButtons::YesNo};
    return context.messages().show(question) == MsgAnswer::Yes;
}

qint16 docTypeOf(const jet::Recordset& types) {
    const std::optional<qint16> type = vb::toInteger(types.value(QStringLiteral("DocType")));
    if (!type)
        jet::fail(jet::err::kTypeMismatch,
                  QStringLiteral("A row of tDocTypes has no document type number."));
    return *type;
}

bool isTrue(const QVariant& value) {
    return !value.isNull() && value.toBool();
}

// Reads the type of the current row of the type query, then the items when asked. False when
// the items step failed and the user chose not to go on.
bool scanType(const DocImportOptions& options, const QString& workDb, const jet::Recordset& types,
              Context& context, Progress& progress, DocImportResult& result) {
    const bool drafts = isTrue(types.value(QStringLiteral("IncludeDraft")));
    DocTypeRead& read = result.types.emplace_back(
        readType(readerOptions(options, workDb, docTypeOf(types), drafts), context, progress));
    if (read.failure && options.readerFailed) options.readerFailed(read.docType, read.failure);
    if (read.scan.recordCount == 0 || !options.readItems) return true;
    read.itemsImported = options.importItems();
    return read.itemsImported || continueAnyway(context);
}

}  // namespace

DocImportResult importDocuments(const DocImportOptions& options, Context& context,
                                Progress& progress) {
    if (options.readItems && !options.importItems)
        throw BadSetting(
            QStringLiteral("The document import was asked to read items without an "
                           "item import to do it."));
    const FolderLock lock(options.dbFolder);  // one run at a time rebuilds the folder's files
    const RunFiles files = prepareFiles(options);
    context.addressSeparator = options.addressSeparator;

    DocImportResult result;
    result.workDbPath = files.work;
    jet::Database work = jet::Database::open(files.work);
    for (jet::Recordset types = work.openRecordset(kTypesToScan); !types.eof(); types.moveNext()) {
        if (!isTrue(types.value(QStringLiteral("Include")))) continue;
        if (!scanType(options, files.work, types, context, progress, result)) {
            result.stopped = true;
            return result;
        }
    }
    progress.fill();
    progress.step(context.caption(kScanIsFinished));
    return result;
}

}  // namespace etq

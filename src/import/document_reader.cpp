#include "import/document_reader.h"

#include <QFileInfo>
#include <limits>
#include <optional>
#include <span>

#include "db/db_values.h"
#include "import/host_reading.h"
#include "import/public_functions.h"
#include "import/scan_ranges.h"
#include "jet/error.h"
#include "jet/row_appender.h"
#include "jet/vb.h"
#include "platform/context.h"
#include "platform/progress.h"

namespace etq {

namespace {

using namespace hostread;
namespace doc = host::stockdoc;
namespace line = host::stockdoc::line;

constexpr int kProgressEvery = 5;
// A large file's documents fill a working database of a hundred megabytes and more in one
// transaction; pages kept in memory need not be written and synced half-way.
constexpr int kScanCacheMiB = 256;
constexpr int kScanningDocuments = 45;
// Transfers between warehouses name no customer: their contact name is not taken.
constexpr qint16 kTransferType = 12;

// What the document database says about the type's host file.
struct DocumentFileDef {
    QString fileName;  // with ".dbf"
    qint64 nextStart = 0;
};

jet::Recordset requireRow(jet::Database& db, const QString& table, const QString& fields,
                          qint16 type) {
    jet::Recordset rs = db.openRecordset(
        QStringLiteral("Select %1 From %2 Where WizFileID = %3").arg(fields, table).arg(type));
    if (rs.eof())
        jet::fail(jet::err::kNoCurrentRecord,
                  QStringLiteral("No current record: the document database has no %1 row for "
                                 "document file %2.")
                      .arg(table)
                      .arg(type));
    return rs;
}

DocumentFileDef readFileDef(jet::Database& db, qint16 type) {
    DocumentFileDef def;
    def.fileName =
        NullToText(requireRow(db, QStringLiteral("tWizFiles"), QStringLiteral("Filename"), type)
                       .value(0)) +
        QStringLiteral(".dbf");
    const QVariant from =
        requireRow(db, QStringLiteral("tWizFileRanges"), QStringLiteral("FromIndx"), type).value(0);
    def.nextStart = from.isNull() ? 0 : from.toLongLong();
    return def;
}

void storePosition(jet::Database& db, qint16 type, qint64 recordCount) {
    const ScanPosition position = positionAfterScan(recordCount);
    db.execute(QStringLiteral("UPDATE tWizFileRanges SET LastIndx = %1, FromIndx = %2 "
                              "WHERE WizFileID = %3")
                   .arg(position.lastRecord)
                   .arg(position.nextStart)
                   .arg(type),
               jet::Database::FailOnError);
}

// A date field, YYYYMMDD. Blank, or no date of the calendar (month 13, 31 April): null.
QDate hostDate(const DbfFile& file, qint64 record, FixedField field) {
    const QByteArrayView bytes = file.bytes(record, field);
    if (bytes.size() != 8) return {};
    int parts[3] = {0, 0, 0};
    const int widths[3] = {4, 2, 2};
    qsizetype at = 0;
    for (int p = 0; p < 3; ++p) {
        for (int k = 0; k < widths[p]; ++k, ++at) {
            const char c = bytes[at];
            if (c < '0' || c > '9') return {};
            parts[p] = parts[p] * 10 + (c - '0');
        }
    }
    return QDate(parts[0], parts[1], parts[2]);
}

// The number a dBASE numeric field holds, read straight from its bytes: blanks, a sign, digits,
// a point and digits, blanks. Nothing for a blank field or one that holds anything else. The
// digits and the power of ten are exact doubles, so their quotient is the nearest double to the
// text, as a conversion of the text gives it.
std::optional<double> fieldNumber(QByteArrayView bytes) {
    static constexpr double kPowers[] = {1e0, 1e1, 1e2,  1e3,  1e4,  1e5,  1e6,  1e7,
                                         1e8, 1e9, 1e10, 1e11, 1e12, 1e13, 1e14, 1e15};
    qsizetype i = 0;
    const qsizetype n = bytes.size();
    while (i < n && bytes[i] == ' ')
        ++i;
    const bool negative = i < n && bytes[i] == '-';
    if (i < n && (bytes[i] == '-' || bytes[i] == '+')) ++i;
    qint64 digits = 0;
    int count = 0, decimals = 0;
    bool point = false;
    for (; i < n; ++i) {
        const char c = bytes[i];
        if (c >= '0' && c <= '9') {
            digits = digits * 10 + (c - '0');
            decimals += point;
            if (++count > 15) return std::nullopt;
        } else if (c == '.' && !point) {
            point = true;
        } else {
            break;
        }
    }
    while (i < n && (bytes[i] == ' ' || bytes[i] == '\0'))
        ++i;
    if (i != n || count == 0) return std::nullopt;
    const double value = double(digits) / kPowers[decimals];
    return negative ? -value : value;
}

// A line's quantity: 0 when blank; a text no dBASE writer makes is read as Val reads it.
double quantityOf(const DbfFile& file, qint64 record, FixedField field) {
    if (const std::optional<double> number = fieldNumber(file.bytes(record, field))) return *number;
    return vb::val(QStringView(file.text(record, field)));
}

// The fields the reader writes, by the index the appenders know them by.
namespace header {
enum Field {
    WizFileID,
    Number,
    RecIndex,
    DocType,
    Reference1,
    DocDate,
    DocDueDate,
    AccountKey,
    CardName,
    Address,
    NumAtCard,
    CntctName,
    Comments,
    Copies,
    TotalCrates,
    Include,
    IsDraft,
    FieldCount
};
constexpr const char* kNames[] = {
    "WizFileID",  "Number",     "RecIndex",    "DocType", "Reference1", "DocDate",
    "DocDueDate", "AccountKey", "CardName",    "Address", "NumAtCard",  "CntctName",
    "Comments",   "Copies",     "TotalCrates", "Include", "IsDraft"};
static_assert(std::size(kNames) == FieldCount);
}  // namespace header

namespace lines {
enum Field {
    WizFileID,
    HeadNumber,
    LineNum,
    Number,
    ItemKey,
    ItemName,
    Quantity,
    Warehouse,
    Copies,
    Include,
    SerialNum,
    VendorNum,
    FieldCount
};
constexpr const char* kNames[] = {"WizFileID", "HeadNumber", "LineNum",   "Number",
                                  "ItemKey",   "ItemName",   "Quantity",  "Warehouse",
                                  "Copies",    "Include",    "SerialNum", "VendorNum"};
static_assert(std::size(kNames) == FieldCount);
}  // namespace lines

QStringList fieldNames(std::span<const char* const> names) {
    QStringList list;
    for (const char* name : names)
        list << QString::fromLatin1(name);
    return list;
}

// What decides whether a record is read, taken from the record once.
struct RecordHead {
    QDate date;
    qint32 reference = 0;
    bool draft = false;
};

// Writes the documents of one file. A record's header and lines are written together after it
// has been read whole, so a record that cannot be read leaves nothing of itself.
class DocumentScan {
  public:
    DocumentScan(jet::Database& db, const StockDocReadOptions& options)
        : options_(options),
          headers_(db, QStringLiteral("tTempDocHeaders"), fieldNames(header::kNames),
                   jet::RowAppender::SkipDuplicateKeys),
          lines_(db, QStringLiteral("tTempDocLines"), fieldNames(lines::kNames),
                 jet::RowAppender::SkipDuplicateKeys) {}

    void read(const DbfFile& file, qint64 record) {
        if (file.isDeleted(record)) return;
        const std::optional<RecordHead> head = admitted(file, record);
        if (!head) return;
        const qint32 number = wholeNumber32(file, record, doc::kNumber);
        addHeader(file, record, number, *head);
        addLines(file, record, number);
        // A continuation record's header is there already: it is passed over.
        scan_.headers += headers_.write();
        scan_.lines += lines_.write();
    }

    StockDocScan& result() { return scan_; }

  private:
    std::optional<RecordHead> admitted(const DbfFile& file, qint64 record) const {
        if (file.text(record, doc::kStatus) == u"I") return std::nullopt;
        RecordHead head;
        head.draft = file.text(record, doc::kDraftMark) != u"N";
        if (head.draft && !options_.includeDrafts) return std::nullopt;
        head.date = hostDate(file, record, doc::kDate);
        if (!head.date.isValid()) return std::nullopt;
        if (options_.fromDate.isValid() && head.date < options_.fromDate) return std::nullopt;
        if (options_.toDate.isValid() && head.date > options_.toDate) return std::nullopt;
        head.reference = TextToLong(file.text(record, doc::kReference));
        if (options_.fromNumber > 0 && head.reference < options_.fromNumber) return std::nullopt;
        if (options_.toNumber > 0 && head.reference > options_.toNumber) return std::nullopt;
        return head;
    }

    // A text read from the host goes in only when there is one: a text field holds no empty text.
    static void setIfGiven(jet::RowAppender& rows, int field, const QString& text) {
        if (!text.isEmpty()) rows.setText(field, text);
    }

    void addHeader(const DbfFile& file, qint64 record, qint32 number, const RecordHead& head) {
        using namespace header;
        jet::RowAppender& h = headers_;
        h.setNumber(WizFileID, options_.wizFileType);
        h.setNumber(Number, number);
        h.setNumber(RecIndex, record);
        h.setNumber(DocType, options_.wizFileType);
        h.setNumber(Reference1, head.reference);
        h.setDate(DocDate, head.date);
        h.setDate(DocDueDate, hostDate(file, record, doc::kDueDate));
        setIfGiven(h, AccountKey, QuoteToApostrophe(file.text(record, doc::kAccountKey)));
        setIfGiven(h, CardName, db::RemoveQuoteChars(file.text(record, doc::kCustomerName)));
        setIfGiven(h, Address, addressText(file.text(record, doc::kAddress)));
        setIfGiven(h, NumAtCard, file.text(record, doc::kCustomerReference));
        if (options_.wizFileType != kTransferType)
            setIfGiven(h, CntctName, file.text(record, doc::kContactName));
        setIfGiven(h, Comments, file.text(record, doc::kRemarks));
        h.setNumber(Copies, 1);
        h.setNumber(TotalCrates, 1);
        h.setYesNo(Include, options_.fastWay);
        h.setYesNo(IsDraft, head.draft);
        h.addRow();
    }

    QString addressText(QString address) const {
        address.replace(u'\r', options_.addressSeparator);
        return address;
    }

    void addLines(const DbfFile& file, qint64 record, qint32 number) {
        const QString pageText = file.text(record, doc::kPage);
        const int page = pageText.isEmpty() ? 0 : wholeNumber16(file, record, doc::kPage);
        for (int slot = 1; slot <= doc::kLinesPerRecord; ++slot) {
            const QString key =
                QuoteToApostrophe(file.text(record, doc::slot(slot, line::kItemKey)));
            if (!key.isEmpty())
                addLine(file, record, number, page * doc::kLinesPerRecord + slot, slot, key);
        }
    }

    void addLine(const DbfFile& file, qint64 record, qint32 number, int lineNumber, int slot,
                 const QString& key) {
        using namespace lines;
        jet::RowAppender& l = lines_;
        const double quantity = quantityOf(file, record, doc::slot(slot, line::kQuantity));
        l.setNumber(WizFileID, options_.wizFileType);
        l.setNumber(HeadNumber, number);
        l.setNumber(LineNum, lineNumber);
        l.setNumber(Number, record);
        l.setText(ItemKey, key);
        setIfGiven(l, ItemName, file.text(record, doc::slot(slot, line::kItemName)));
        l.setDouble(Quantity, quantity);
        l.setNumber(Copies, db::CopiesFromQuantity(quantity));
        l.setYesNo(Include, true);
        setIfGiven(l, SerialNum, file.text(record, doc::slot(slot, line::kSerialNumber)));
        setIfGiven(l, VendorNum, file.text(record, doc::slot(slot, line::kVendorCatalogNumber)));
        if (const auto number = fieldNumber(file.bytes(record, doc::slot(slot, line::kWarehouse))))
            if (const auto warehouse = vb::toInteger(*number)) l.setNumber(Warehouse, *warehouse);
        l.addRow();
    }

    const StockDocReadOptions& options_;
    jet::RowAppender headers_;
    jet::RowAppender lines_;
    StockDocScan scan_;
};

// Opening a file from beyond its last record reads its header alone.
constexpr qint64 kHeaderOnly = std::numeric_limits<qint64>::max();

// The records a scan reads: from where the stored position says for the records the file has
// now, or from the first when a from number is given. Nothing when the file has no records.
std::optional<DbfFile> openForScan(const QString& path, const StockDocReadOptions& options,
                                   qint64 nextStart) {
    const qint64 records = DbfFile(path, kHeaderOnly).recordCount();
    if (records == 0) return std::nullopt;
    DbfFile file(path, options.fromNumber == 0 ? firstRecordToScan(nextStart, records) : 0);
    host::requireLayout(file, doc::kLayout);
    return file;
}

StockDocScan scanRecords(jet::Database& db, const DbfFile& file, const StockDocReadOptions& options,
                         Progress& progress) {
    db.setCacheSize(kScanCacheMiB);
    DocumentScan scan(db, options);
    KeptWrites writes(db);
    const qint64 count = file.recordCount();
    qint64 visited = 0;
    for (qint64 record = file.firstRecord(); record < count; ++record) {
        scan.read(file, record);
        if (++visited % kProgressEvery == 0) progress.show(record, count);
    }
    if (options.toNumber == 0 && !options.toNumberEntered)
        storePosition(db, options.wizFileType, count);
    writes.commit();

    StockDocScan result = scan.result();
    result.recordCount = count;
    result.firstRecord = file.firstRecord();
    return result;
}

}  // namespace

StockDocScan readStockDocuments(const StockDocReadOptions& options, Context& context,
                                Progress& progress) {
    progress.clear();
    progress.step(context.caption(kScanningDocuments));
    jet::Database db = jet::Database::open(options.workDbPath);
    const DocumentFileDef def = readFileDef(db, options.wizFileType);
    const QString path = hostFilePath(options.companyFolder, def.fileName);
    if (!QFileInfo::exists(path)) return {};
    const std::optional<DbfFile> file = openForScan(path, options, def.nextStart);
    if (!file) return {};
    const StockDocScan scan = scanRecords(db, *file, options, progress);
    progress.clear();
    return scan;
}

}  // namespace etq

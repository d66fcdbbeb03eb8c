#include "import/document_reader.h"

#include <QFileInfo>
#include <optional>

#include "db/db_values.h"
#include "import/host_reading.h"
#include "import/public_functions.h"
#include "import/scan_ranges.h"
#include "jet/error.h"
#include "jet/vb.h"
#include "platform/context.h"
#include "platform/progress.h"

namespace etq {

namespace {

using namespace hostread;
namespace doc = host::stockdoc;
namespace line = host::stockdoc::line;

constexpr int kProgressEvery = 5;
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

QVariant dateOrNull(QDate date) {
    return date.isValid() ? QVariant(date) : QVariant();
}

int fieldIndex(const jet::Recordset& recordset, const char* name) {
    const int index = recordset.fieldIndex(QString::fromLatin1(name));
    if (index < 0)
        jet::fail(jet::err::kItemNotFound,
                  QStringLiteral("Item not found in this collection: %1.").arg(name));
    return index;
}

struct HeaderFields {
    explicit HeaderFields(const jet::Recordset& rs)
        : wizFileId(fieldIndex(rs, "WizFileID")),
          number(fieldIndex(rs, "Number")),
          recIndex(fieldIndex(rs, "RecIndex")),
          docType(fieldIndex(rs, "DocType")),
          reference(fieldIndex(rs, "Reference1")),
          date(fieldIndex(rs, "DocDate")),
          dueDate(fieldIndex(rs, "DocDueDate")),
          accountKey(fieldIndex(rs, "AccountKey")),
          cardName(fieldIndex(rs, "CardName")),
          address(fieldIndex(rs, "Address")),
          numAtCard(fieldIndex(rs, "NumAtCard")),
          contactName(fieldIndex(rs, "CntctName")),
          comments(fieldIndex(rs, "Comments")),
          copies(fieldIndex(rs, "Copies")),
          crates(fieldIndex(rs, "TotalCrates")),
          include(fieldIndex(rs, "Include")),
          isDraft(fieldIndex(rs, "IsDraft")) {}
    int wizFileId, number, recIndex, docType, reference, date, dueDate, accountKey, cardName,
        address, numAtCard, contactName, comments, copies, crates, include, isDraft;
};

struct LineFields {
    explicit LineFields(const jet::Recordset& rs)
        : wizFileId(fieldIndex(rs, "WizFileID")),
          headNumber(fieldIndex(rs, "HeadNumber")),
          lineNum(fieldIndex(rs, "LineNum")),
          number(fieldIndex(rs, "Number")),
          itemKey(fieldIndex(rs, "ItemKey")),
          itemName(fieldIndex(rs, "ItemName")),
          quantity(fieldIndex(rs, "Quantity")),
          warehouse(fieldIndex(rs, "Warehouse")),
          copies(fieldIndex(rs, "Copies")),
          include(fieldIndex(rs, "Include")),
          serialNum(fieldIndex(rs, "SerialNum")),
          vendorNum(fieldIndex(rs, "VendorNum")) {}
    int wizFileId, headNumber, lineNum, number, itemKey, itemName, quantity, warehouse, copies,
        include, serialNum, vendorNum;
};

// What decides whether a record is read, taken from the record once.
struct RecordHead {
    QDate date;
    qint32 reference = 0;
    bool draft = false;
};

class DocumentScan {
  public:
    DocumentScan(jet::Database& db, const StockDocReadOptions& options)
        : options_(options),
          headers_(db.openRecordset(QStringLiteral("tTempDocHeaders"))),
          lines_(db.openRecordset(QStringLiteral("tTempDocLines"))),
          headerFields_(headers_),
          lineFields_(lines_) {}

    void read(const DbfFile& file, qint64 record) {
        if (file.isDeleted(record)) return;
        const std::optional<RecordHead> head = admitted(file, record);
        if (!head) return;
        const qint32 number = wholeNumber32(file, record, doc::kNumber);
        if (addHeader(file, record, number, *head)) ++scan_.headers;
        addLines(file, record, number);
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
    static void setIfGiven(jet::Recordset& rs, int field, const QString& text) {
        if (!text.isEmpty()) rs.setValue(field, text);
    }

    bool addHeader(const DbfFile& file, qint64 record, qint32 number, const RecordHead& head) {
        const HeaderFields& f = headerFields_;
        headers_.addNew();
        headers_.setValue(f.wizFileId, options_.wizFileType);
        headers_.setValue(f.number, number);
        headers_.setValue(f.recIndex, record);
        headers_.setValue(f.docType, options_.wizFileType);
        headers_.setValue(f.reference, head.reference);
        headers_.setValue(f.date, head.date);
        headers_.setValue(f.dueDate, dateOrNull(hostDate(file, record, doc::kDueDate)));
        setIfGiven(headers_, f.accountKey, QuoteToApostrophe(file.text(record, doc::kAccountKey)));
        setIfGiven(headers_, f.cardName,
                   db::RemoveQuoteChars(file.text(record, doc::kCustomerName)));
        setIfGiven(headers_, f.address, addressText(file.text(record, doc::kAddress)));
        setIfGiven(headers_, f.numAtCard, file.text(record, doc::kCustomerReference));
        if (options_.wizFileType != kTransferType)
            setIfGiven(headers_, f.contactName, file.text(record, doc::kContactName));
        setIfGiven(headers_, f.comments, file.text(record, doc::kRemarks));
        headers_.setValue(f.copies, 1);
        headers_.setValue(f.crates, 1);
        headers_.setValue(f.include, options_.fastWay);
        headers_.setValue(f.isDraft, head.draft);
        return updateUnlessDuplicate(headers_);
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
            if (key.isEmpty()) continue;
            if (addLine(file, record, number, page * doc::kLinesPerRecord + slot, slot, key))
                ++scan_.lines;
        }
    }

    bool addLine(const DbfFile& file, qint64 record, qint32 number, int lineNumber, int slot,
                 const QString& key) {
        const LineFields& f = lineFields_;
        const QString quantityText = file.text(record, doc::slot(slot, line::kQuantity));
        const double quantity = vb::val(QStringView(quantityText));
        lines_.addNew();
        lines_.setValue(f.wizFileId, options_.wizFileType);
        lines_.setValue(f.headNumber, number);
        lines_.setValue(f.lineNum, lineNumber);
        lines_.setValue(f.number, record);
        lines_.setValue(f.itemKey, key);
        setIfGiven(lines_, f.itemName, file.text(record, doc::slot(slot, line::kItemName)));
        lines_.setValue(f.quantity, quantity);
        lines_.setValue(f.include, true);
        lines_.setValue(f.copies, db::CopiesFromQuantity(quantity));
        setIfGiven(lines_, f.serialNum, file.text(record, doc::slot(slot, line::kSerialNumber)));
        setIfGiven(lines_, f.vendorNum,
                   file.text(record, doc::slot(slot, line::kVendorCatalogNumber)));
        if (const auto warehouse =
                vb::toInteger(file.text(record, doc::slot(slot, line::kWarehouse))))
            lines_.setValue(f.warehouse, *warehouse);
        return updateUnlessDuplicate(lines_);
    }

    const StockDocReadOptions& options_;
    jet::Recordset headers_;
    jet::Recordset lines_;
    HeaderFields headerFields_;
    LineFields lineFields_;
    StockDocScan scan_;
};

}  // namespace

StockDocScan readStockDocuments(const StockDocReadOptions& options, Context& context,
                                Progress& progress) {
    progress.clear();
    progress.step(context.caption(kScanningDocuments));
    jet::Database db = jet::Database::open(options.workDbPath);
    const DocumentFileDef def = readFileDef(db, options.wizFileType);
    const QString path = hostFilePath(options.companyFolder, def.fileName);
    if (!QFileInfo::exists(path)) return {};

    const DbfFile file = openHostFile(path, doc::kLayout);
    const qint64 count = file.recordCount();
    if (count == 0) return {};

    DocumentScan scan(db, options);
    const qint64 first = options.fromNumber == 0 ? firstRecordToScan(def.nextStart, count) : 0;
    KeptWrites writes(db);
    qint64 visited = 0;
    for (qint64 record = first; record < count; ++record) {
        scan.read(file, record);
        if (++visited % kProgressEvery == 0) progress.show(record, count);
    }
    if (options.toNumber == 0 && !options.toNumberEntered)
        storePosition(db, options.wizFileType, count);
    writes.commit();
    progress.clear();

    StockDocScan result = scan.result();
    result.recordCount = count;
    result.firstRecord = first;
    return result;
}

}  // namespace etq

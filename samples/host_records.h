#pragma once

// Records of the host's files as plain values, for the demo company and for tests that write
// exactly the host data they need. Texts are written as given (Windows-1255, blank-padded);
// a text longer than its field is refused, never cut.

#include <QDate>
#include <QList>
#include <QString>
#include <array>
#include <optional>

#include "samples/dbf_writer.h"

namespace etq::demo {

struct PriceEntry {
    qint32 hundredths = 0;  // 1999 is 19.99
    QString currency;       // blank: the local currency
};

struct ItemRecord {
    QString key;
    QString name;
    QString foreignName;
    QString group;  // item group number as decimal text; blank for none
    QString barcode;
    QString supplierCatalogNumber;
    QString unit;
    std::array<PriceEntry, 10> prices{};  // price entries 1..10
    QString queryGroups;                  // decimal text of a bit mask; bit 1 = property group 1
    bool deleted = false;
};

struct PropertyGroupRecord {  // oitg
    int number = 0;
    QString name;
    bool deleted = false;
};

struct ItemGroupRecord {  // oitb
    int number = 0;
    QString name;
    bool deleted = false;
};

struct PriceListRecord {  // opln
    int number = 0;
    QString name;
    bool deleted = false;
};

struct CurrencyRecord {  // ocrn
    QString code;        // "¦" for the local currency
    QString description;
    QString hostSign;
    QString sign;
    bool deleted = false;
};

struct SpecialPriceRecord {  // ospp
    QString itemKey;
    QString accountKey;
    PriceEntry price;
    bool deleted = false;
};

struct AccountRecord {  // ocrd
    QString key;
    QString name;
    QString address;
    QString city;
    QString phone;
    bool deleted = false;
};

struct DocumentLine {
    std::optional<double> quantity;  // none: a blank quantity
    QString itemKey;                 // blank: an empty slot
    QString itemName;
    QString vendorCatalogNumber;
    QString serialNumber;
    std::optional<int> warehouse;
};

// One stock document. It is written as one record per ten lines (at least one record), each
// with the same header fields and pages 0, 1, 2, ...
struct StockDocument {
    int number = 0;
    QString reference;  // decimal text, normally
    QString accountKey;
    QDate date;
    QString status = QStringLiteral("O");     // "I": the host's readers skip the record
    QString draftMark = QStringLiteral("N");  // "N": not a draft; anything else is a draft
    QString customerReference;
    QString address;  // lines separated by carriage returns
    QString remarks;
    QDate secondDate;
    QDate dueDate;
    QString customerName;
    QString contactName;
    QList<DocumentLine> lines;
    bool deleted = false;  // marks every record of the document
};

// Each adds the record(s) of one value to a writer of its file's layout.
void append(DbfWriter& writer, const ItemRecord& item);
void append(DbfWriter& writer, const PropertyGroupRecord& group);
void append(DbfWriter& writer, const ItemGroupRecord& group);
void append(DbfWriter& writer, const PriceListRecord& list);
void append(DbfWriter& writer, const CurrencyRecord& currency);
void append(DbfWriter& writer, const SpecialPriceRecord& price);
void append(DbfWriter& writer, const AccountRecord& account);
void append(DbfWriter& writer, const StockDocument& document);

// The layout of the file each kind of record goes into.
const host::HostLayout& layoutOf(const ItemRecord&);
const host::HostLayout& layoutOf(const PropertyGroupRecord&);
const host::HostLayout& layoutOf(const ItemGroupRecord&);
const host::HostLayout& layoutOf(const PriceListRecord&);
const host::HostLayout& layoutOf(const CurrencyRecord&);
const host::HostLayout& layoutOf(const SpecialPriceRecord&);
const host::HostLayout& layoutOf(const AccountRecord&);
const host::HostLayout& layoutOf(const StockDocument&);

// Writes `records` as the file at `path` (which may be empty: a file of no records).
template <class Record>
void writeHostFile(const QString& path, const QList<Record>& records,
                   QDate lastUpdate = kDefaultLastUpdate) {
    DbfWriter writer(path, layoutOf(Record{}), lastUpdate);
    for (const Record& record : records)
        append(writer, record);
    writer.close();
}

}  // namespace etq::demo

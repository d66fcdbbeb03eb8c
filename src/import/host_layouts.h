#pragma once

// The fixed record layouts of the host's dBASE files. The readers take every field at these
// places, whatever the file's own field descriptors say; the demo company writes its files from
// the same tables (names and types are what our files declare in their descriptors).

#include <QByteArray>
#include <QList>
#include <span>
#include <string_view>

#include "import/dbf_file.h"

namespace etq::host {

struct HostField {
    std::string_view name;  // the dBASE field name in files we write
    char type = 'C';        // 'C' text, 'N' decimal text, 'D' date YYYYMMDD, 'I' 32-bit LE integer
    int offset = 0;         // from the record's start: byte 0 is the deletion flag
    int width = 0;
    int decimals = 0;

    constexpr operator FixedField() const { return {offset, width}; }
    constexpr int end() const { return offset + width; }
};

constexpr HostField shifted(HostField field, int by) {
    field.offset += by;
    return field;
}

// Equal entries side by side: the price entries of an item, the line slots of a document.
// Written files name an entry's fields with the entry number appended ("PRICE3").
struct HostRepeat {
    int start = 0;   // offset of entry 1 from the record's start
    int stride = 0;  // bytes from one entry to the next
    int count = 0;
    std::span<const HostField> fields;  // offsets inside the entry

    constexpr int entryOffset(int n) const { return start + stride * (n - 1); }
    // `field` (one of `fields`) of entry n, n = 1..count.
    constexpr HostField of(int n, HostField field) const { return shifted(field, entryOffset(n)); }
};

struct HostLayout {
    std::string_view fileName;  // the fixed name in the company folder; empty for document files
    std::string_view what;      // what a record is, for messages
    int recordLength = 0;       // what our files use; readers need at least the last field's end
    std::span<const HostField> fields;
    std::span<const HostRepeat> repeats;
};

// A layout's field at its place in the record, repeats expanded and named.
struct PlacedField {
    QByteArray name;
    char type = 'C';
    int offset = 0;
    int width = 0;
    int decimals = 0;
};

// Every field of `layout` in record order.
QList<PlacedField> placedFields(const HostLayout& layout);

// The bytes a reader needs a record to have: the end of the layout's last field.
int layoutEnd(const HostLayout& layout);

// Throws DbfError when the records of `file` are too short for `layout`.
void requireLayout(const DbfFile& file, const HostLayout& layout);

// The 12-byte price entry of items and special prices: bytes 4..7 the price in hundredths,
// bytes 8..9 the currency code (blank for the local currency). The other bytes are unused.
namespace price_entry {
inline constexpr int kSize = 12;
inline constexpr HostField kPrice{"PRICE", 'I', 4, 4};
inline constexpr HostField kCurrency{"CURRENCY", 'C', 8, 2};
inline constexpr HostField kFields[] = {kPrice, kCurrency};
}  // namespace price_entry

// oitm.dbf: items.
namespace oitm {
inline constexpr HostField kItemKey{"ITEMCODE", 'C', 1, 13};
inline constexpr HostField kItemName{"ITEMNAME", 'C', 14, 40};
inline constexpr HostField kForeignName{"FRGNNAME", 'C', 54, 30};
inline constexpr HostField kGroup{"ITMSGRPCOD", 'N', 84, 4};
inline constexpr HostField kBarcode{"CODEBARS", 'C', 104, 16};
inline constexpr HostField kSupplierCatalogNumber{"SUPPCATNUM", 'C', 197, 13};
inline constexpr HostField kUnit{"UNIT", 'C', 210, 5};
inline constexpr HostRepeat kPriceEntries{272, price_entry::kSize, 10, price_entry::kFields};
inline constexpr HostField kQueryGroups{"QRYGROUPS", 'N', 422, 8};

inline constexpr int kPriceCount = kPriceEntries.count;
// Price entry n, n = 1..10: the price in hundredths (read with int32) and the currency code.
constexpr FixedField price(int n) {
    return kPriceEntries.of(n, price_entry::kPrice);
}
constexpr FixedField currency(int n) {
    return kPriceEntries.of(n, price_entry::kCurrency);
}

inline constexpr HostField kFields[] = {kItemKey, kItemName,   kForeignName,
                                        kGroup,   kBarcode,    kSupplierCatalogNumber,
                                        kUnit,    kQueryGroups};
inline constexpr HostRepeat kRepeats[] = {kPriceEntries};
inline constexpr HostLayout kLayout{"oitm.dbf", "item record", 430, kFields, kRepeats};
}  // namespace oitm

// oitg.dbf: item property groups (the query groups of items are bits numbered by them).
namespace oitg {
inline constexpr HostField kNumber{"GROUPCODE", 'N', 1, 4};
inline constexpr HostField kName{"GROUPNAME", 'C', 5, 30};
inline constexpr HostField kFields[] = {kNumber, kName};
inline constexpr HostLayout kLayout{"oitg.dbf", "item property group record", 49, kFields, {}};
}  // namespace oitg

// oitb.dbf: item groups.
namespace oitb {
inline constexpr HostField kNumber{"GROUPCODE", 'N', 1, 4};
inline constexpr HostField kName{"GROUPNAME", 'C', 5, 20};
inline constexpr HostField kFields[] = {kNumber, kName};
inline constexpr HostLayout kLayout{"oitb.dbf", "item group record", 30, kFields, {}};
}  // namespace oitb

// opln.dbf: price lists 1..10, named.
namespace opln {
inline constexpr HostField kNumber{"LISTNUM", 'N', 1, 2};
inline constexpr HostField kName{"LISTNAME", 'C', 3, 32};
inline constexpr HostField kFields[] = {kNumber, kName};
inline constexpr HostLayout kLayout{"opln.dbf", "price list record", 58, kFields, {}};
}  // namespace opln

// ocrn.dbf: currencies. The local currency's code is "¦".
namespace ocrn {
inline constexpr HostField kCode{"CURRCODE", 'C', 1, 2};
inline constexpr HostField kDescription{"CURRNAME", 'C', 3, 20};
inline constexpr HostField kHostSign{"HOSTSIGN", 'C', 23, 20};
inline constexpr HostField kSign{"SIGN", 'C', 63, 2};
inline constexpr HostField kFields[] = {kCode, kDescription, kHostSign, kSign};
inline constexpr HostLayout kLayout{"ocrn.dbf", "currency record", 72, kFields, {}};
}  // namespace ocrn

// ospp.dbf: special prices per account and item; bytes 24..35 are a price entry.
namespace ospp {
inline constexpr int kPriceEntryOffset = 24;
inline constexpr HostField kItemKey{"ITEMCODE", 'C', 1, 13};
inline constexpr HostField kAccountKey{"CARDCODE", 'C', 14, 8};
inline constexpr HostField kPrice = shifted(price_entry::kPrice, kPriceEntryOffset);
inline constexpr HostField kCurrency = shifted(price_entry::kCurrency, kPriceEntryOffset);
inline constexpr HostField kFields[] = {kItemKey, kAccountKey, kPrice, kCurrency};
inline constexpr HostLayout kLayout{"ospp.dbf", "special price record", 44, kFields, {}};
}  // namespace ospp

// ocrd.dbf: accounts (customers and suppliers).
namespace ocrd {
inline constexpr HostField kAccountKey{"CARDCODE", 'C', 1, 8};
inline constexpr HostField kName{"CARDNAME", 'C', 9, 50};
inline constexpr HostField kAddress{"ADDRESS", 'C', 59, 100};
inline constexpr HostField kCity{"CITY", 'C', 159, 30};
inline constexpr HostField kPhone{"PHONE", 'C', 189, 20};
inline constexpr HostField kFields[] = {kAccountKey, kName, kAddress, kCity, kPhone};
inline constexpr HostLayout kLayout{"ocrd.dbf", "account record", 209, kFields, {}};
}  // namespace ocrd

// Stock document files (delivery notes, invoices, orders, ...): one record per page of ten
// lines; a longer document continues in the next records with the same document number and
// pages 1, 2, ... The host counts these offsets after the deletion flag, hence the 1 +.
namespace stockdoc {
inline constexpr HostField kNumber{"DOCNUM", 'N', 1 + 0, 8};
inline constexpr HostField kPage{"PAGE", 'N', 1 + 8, 4};
inline constexpr HostField kReference{"REFNUM", 'C', 1 + 12, 8};
inline constexpr HostField kAccountKey{"CARDCODE", 'C', 1 + 20, 8};
inline constexpr HostField kDate{"DOCDATE", 'D', 1 + 28, 8};
inline constexpr HostField kStatus{"STATUS", 'C', 1 + 36, 1};  // "I": not to be read
inline constexpr HostField kCustomerReference{"NUMATCARD", 'C', 1 + 39, 16};
inline constexpr HostField kAddress{"ADDRESS", 'C', 1 + 55, 254};  // lines end in CR
inline constexpr HostField kRemarks{"COMMENTS", 'C', 1 + 309, 100};
inline constexpr HostField kDraftMark{"DRAFT", 'C', 1 + 500, 1};  // "N": not a draft
inline constexpr HostField kSecondDate{"TAXDATE", 'D', 1 + 3130, 8};
inline constexpr HostField kDueDate{"DUEDATE", 'D', 1 + 3138, 8};
inline constexpr HostField kCustomerName{"CARDNAME", 'C', 1 + 3184, 100};
inline constexpr HostField kContactName{"CNTCTNAME", 'C', 1 + 3420, 90};

// A line slot; an empty item key means an empty slot.
namespace line {
inline constexpr HostField kQuantity{"QTY", 'N', 0, 10, 2};
inline constexpr HostField kItemKey{"ITEMCODE", 'C', 57, 13};
inline constexpr HostField kItemName{"ITEMNAME", 'C', 70, 40};
inline constexpr HostField kVendorCatalogNumber{"VENDNUM", 'C', 152, 13};
inline constexpr HostField kSerialNumber{"SERIAL", 'C', 165, 17};
inline constexpr HostField kWarehouse{"WHS", 'N', 182, 2};
inline constexpr HostField kFields[] = {kQuantity,     kItemKey,  kItemName, kVendorCatalogNumber,
                                        kSerialNumber, kWarehouse};
}  // namespace line

inline constexpr HostRepeat kLineSlots{1 + 512, 260, 10, line::kFields};
inline constexpr int kLinesPerRecord = kLineSlots.count;
// Field `field` (one of line::k...) of line slot k, k = 1..10.
constexpr FixedField slot(int k, HostField field) {
    return kLineSlots.of(k, field);
}

// The host reads 3512 bytes after the deletion flag.
inline constexpr int kRecordLength = 1 + 3512;

inline constexpr HostField kFields[] = {
    kNumber,  kPage,    kReference, kAccountKey, kDate,    kStatus,       kCustomerReference,
    kAddress, kRemarks, kDraftMark, kSecondDate, kDueDate, kCustomerName, kContactName};
inline constexpr HostRepeat kRepeats[] = {kLineSlots};
inline constexpr HostLayout kLayout{"", "stock document record", kRecordLength, kFields, kRepeats};
}  // namespace stockdoc

}  // namespace etq::host

#include "samples/host_records.h"

namespace etq::demo {

namespace h = etq::host;

namespace {

void setPrice(DbfRecord& record, FixedField price, FixedField currency, const PriceEntry& entry) {
    record.setInt32(price, entry.hundredths);
    record.setText(currency, entry.currency);
}

void setOptionalNumber(DbfRecord& record, FixedField field, std::optional<int> value) {
    if (value) record.setNumber(field, *value);
}

void setLine(DbfRecord& record, int slot, const DocumentLine& line) {
    namespace l = h::stockdoc::line;
    if (line.quantity)
        record.setNumber(h::stockdoc::slot(slot, l::kQuantity), *line.quantity,
                         l::kQuantity.decimals);
    record.setText(h::stockdoc::slot(slot, l::kItemKey), line.itemKey);
    record.setText(h::stockdoc::slot(slot, l::kItemName), line.itemName);
    record.setText(h::stockdoc::slot(slot, l::kVendorCatalogNumber), line.vendorCatalogNumber);
    record.setText(h::stockdoc::slot(slot, l::kSerialNumber), line.serialNumber);
    setOptionalNumber(record, h::stockdoc::slot(slot, l::kWarehouse), line.warehouse);
}

DbfRecord documentPage(const DbfWriter& writer, const StockDocument& d, int page) {
    namespace s = h::stockdoc;
    DbfRecord r = writer.newRecord();
    r.setDeleted(d.deleted);
    r.setNumber(s::kNumber, d.number);
    r.setNumber(s::kPage, page);
    r.setText(s::kReference, d.reference);
    r.setText(s::kAccountKey, d.accountKey);
    r.setDate(s::kDate, d.date);
    r.setText(s::kStatus, d.status);
    r.setText(s::kCustomerReference, d.customerReference);
    r.setText(s::kAddress, d.address);
    r.setText(s::kRemarks, d.remarks);
    r.setText(s::kDraftMark, d.draftMark);
    r.setDate(s::kSecondDate, d.secondDate);
    r.setDate(s::kDueDate, d.dueDate);
    r.setText(s::kCustomerName, d.customerName);
    r.setText(s::kContactName, d.contactName);
    const qsizetype first = qsizetype(page) * s::kLinesPerRecord;
    for (int slot = 1; slot <= s::kLinesPerRecord && first + slot - 1 < d.lines.size(); ++slot)
        setLine(r, slot, d.lines[first + slot - 1]);
    return r;
}

// The small reference files all hold a number and a name.
void appendNumberedName(DbfWriter& writer, FixedField numberField, FixedField nameField, int number,
                        const QString& name, bool deleted) {
    DbfRecord r = writer.newRecord();
    r.setDeleted(deleted);
    r.setNumber(numberField, number);
    r.setText(nameField, name);
    writer.append(r);
}

}  // namespace

void append(DbfWriter& writer, const ItemRecord& item) {
    namespace o = h::oitm;
    DbfRecord r = writer.newRecord();
    r.setDeleted(item.deleted);
    r.setText(o::kItemKey, item.key);
    r.setText(o::kItemName, item.name);
    r.setText(o::kForeignName, item.foreignName);
    r.setNumberText(o::kGroup, item.group);
    r.setText(o::kBarcode, item.barcode);
    r.setText(o::kSupplierCatalogNumber, item.supplierCatalogNumber);
    r.setText(o::kUnit, item.unit);
    for (int n = 1; n <= o::kPriceCount; ++n)
        setPrice(r, o::price(n), o::currency(n), item.prices[n - 1]);
    r.setNumberText(o::kQueryGroups, item.queryGroups);
    writer.append(r);
}

void append(DbfWriter& writer, const PropertyGroupRecord& group) {
    appendNumberedName(writer, h::oitg::kNumber, h::oitg::kName, group.number, group.name,
                       group.deleted);
}

void append(DbfWriter& writer, const ItemGroupRecord& group) {
    appendNumberedName(writer, h::oitb::kNumber, h::oitb::kName, group.number, group.name,
                       group.deleted);
}

void append(DbfWriter& writer, const PriceListRecord& list) {
    appendNumberedName(writer, h::opln::kNumber, h::opln::kName, list.number, list.name,
                       list.deleted);
}

void append(DbfWriter& writer, const CurrencyRecord& currency) {
    DbfRecord r = writer.newRecord();
    r.setDeleted(currency.deleted);
    r.setText(h::ocrn::kCode, currency.code);
    r.setText(h::ocrn::kDescription, currency.description);
    r.setText(h::ocrn::kHostSign, currency.hostSign);
    r.setText(h::ocrn::kSign, currency.sign);
    writer.append(r);
}

void append(DbfWriter& writer, const SpecialPriceRecord& price) {
    DbfRecord r = writer.newRecord();
    r.setDeleted(price.deleted);
    r.setText(h::ospp::kItemKey, price.itemKey);
    r.setText(h::ospp::kAccountKey, price.accountKey);
    setPrice(r, h::ospp::kPrice, h::ospp::kCurrency, price.price);
    writer.append(r);
}

void append(DbfWriter& writer, const AccountRecord& account) {
    DbfRecord r = writer.newRecord();
    r.setDeleted(account.deleted);
    r.setText(h::ocrd::kAccountKey, account.key);
    r.setText(h::ocrd::kName, account.name);
    r.setText(h::ocrd::kAddress, account.address);
    r.setText(h::ocrd::kCity, account.city);
    r.setText(h::ocrd::kPhone, account.phone);
    writer.append(r);
}

void append(DbfWriter& writer, const StockDocument& document) {
    const int pages =
        std::max<int>(1, int((document.lines.size() + h::stockdoc::kLinesPerRecord - 1) /
                             h::stockdoc::kLinesPerRecord));
    for (int page = 0; page < pages; ++page)
        writer.append(documentPage(writer, document, page));
}

const h::HostLayout& layoutOf(const ItemRecord&) {
    return h::oitm::kLayout;
}
const h::HostLayout& layoutOf(const PropertyGroupRecord&) {
    return h::oitg::kLayout;
}
const h::HostLayout& layoutOf(const ItemGroupRecord&) {
    return h::oitb::kLayout;
}
const h::HostLayout& layoutOf(const PriceListRecord&) {
    return h::opln::kLayout;
}
const h::HostLayout& layoutOf(const CurrencyRecord&) {
    return h::ocrn::kLayout;
}
const h::HostLayout& layoutOf(const SpecialPriceRecord&) {
    return h::ospp::kLayout;
}
const h::HostLayout& layoutOf(const AccountRecord&) {
    return h::ocrd::kLayout;
}
const h::HostLayout& layoutOf(const StockDocument&) {
    return h::stockdoc::kLayout;
}

}  // namespace etq::demo

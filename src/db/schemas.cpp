#include "db/schemas.h"

#include "db/file_names.h"

namespace etq::db::schema {

using jet::FieldDef;
using jet::FieldType;
using jet::TableDef;

namespace {

constexpr FieldType Boolean = FieldType::Boolean;
constexpr FieldType Byte = FieldType::Byte;
constexpr FieldType Integer = FieldType::Integer;
constexpr FieldType Long = FieldType::Long;
constexpr FieldType Double = FieldType::Double;
constexpr FieldType Date = FieldType::Date;
FieldDef text(const char* name, int size) {
    return {name, FieldType::Text, size};
}
FieldDef of(const char* name, FieldType type) {
    return {name, type, 0};
}

// A staging table has the fields and key of the table it feeds, under its own name.
TableDef renamed(const TableDef& def, const char* name) {
    TableDef copy = def;
    copy.name = name;
    return copy;
}

}  // namespace

const TableDef& tempDocHeaders() {
    static const TableDef def{
        "tTempDocHeaders",
        {of("WizFileID", Long),    of("Number", Long),       of("RecIndex", Long),
         of("DocType", Integer),   of("Reference1", Long),   of("DocDate", Date),
         of("DocDueDate", Date),   text("AccountKey", 15),   of("Include", Boolean),
         text("CardName", 100),    text("Address", 254),     text("City", 100),
         text("ZipCode", 254),     text("CntctPrsn", 90),    of("TotalCrates", Integer),
         of("Copies", Integer),    text("Phone1", 20),       text("Phone2", 20),
         text("NumAtCard", 20),    text("MailAddress", 100), text("MailZipCod", 20),
         text("MailCity", 50),     text("MailCounty", 50),   text("MailCountry", 50),
         of("IsDraft", Boolean),   text("StampNum", 20),     of("TrnspCode", Integer),
         text("TrnspName", 30),    text("CntctName", 50),    text("CntctTel1", 20),
         text("CntctNotes1", 100), text("CntctMobile", 50),  text("Comments", 254)},
        {"WizFileID", "Number"}};
    return def;
}

const TableDef& tempDocLines() {
    static const TableDef def{
        "tTempDocLines",
        {of("WizFileID", Long), of("HeadNumber", Long), of("LineNum", Integer), of("Number", Long),
         text("ItemKey", 20), text("ItemName", 100), of("Quantity", Double),
         of("Warehouse", Integer), of("Copies", Integer), of("Include", Boolean),
         text("SerialNum", 20), of("PackUN", Double), of("PackCopies", Long), text("BlockNum", 100),
         text("CodeBars", 50), text("VendorNum", 50), of("Length1", Double), of("Width1", Double)},
        {"WizFileID", "HeadNumber", "LineNum"}};
    return def;
}

const TableDef& transports() {
    static const TableDef def{
        "tTransports", {of("TrnspCode", Integer), text("TrnspName", 30)}, {"TrnspCode"}};
    return def;
}

const QList<Link>& workLinks() {
    static const QList<Link> links = {
        {"tDocTypes", &kDocDatabaseFile},     {"tCurrencies", &kDocDatabaseFile},
        {"tWizFiles", &kDocDatabaseFile},     {"tWizFileRanges", &kDocDatabaseFile},
        {"tItems", &kItemDatabaseFile},       {"tAlterKeys", &kItemDatabaseFile},
        {"tAlterPrices", &kItemDatabaseFile}, {"tPriceList", &kItemDatabaseFile},
        {"tAccountDef", &kItemDatabaseFile},
    };
    return links;
}

const SavedQuery kWorkQueries[2] = {
    {"qSelectDocHeaders",
     "SELECT (tDocTypes.DocDesc + '') AS MyDocDesc , tTempDocHeaders.Reference1, Format$(tTempDocHeaders.DocDate,'dd/mm/yy'), tTempDocHeaders.AccountKey, tTempDocHeaders.Include, tTempDocHeaders.CardName, tTempDocHeaders.WizFileID, tTempDocHeaders.Number FROM (tTempDocHeaders Inner Join tDocTypes On tDocTypes.DocType = tTempDocHeaders.DocType) ORDER BY tTempDocHeaders.DocType, tTempDocHeaders.Reference1, tTempDocHeaders.DocDate"},
    {"qSelectDocLines",
     "SELECT tTempDocLines.LineNum, tTempDocLines.ItemKey, tItems.ItemName, tTempDocLines.Quantity, tTempDocLines.Warehouse, tTempDocLines.Copies, tTempDocLines.Include FROM (tTempDocLines Inner Join tItems On tItems.ItemKey = tTempDocLines.ItemKey) ORDER BY tTempDocLines.HeadNumber, tTempDocLines.LineNum"},
};

const TableDef& items() {
    static const TableDef def{
        "tItems",
        {text("ItemKey", 20),     text("ItemName", 100),     of("ItemSort", Integer),
         text("Filter", 7),       text("Unit", 5),           text("PurchaseUnit", 5),
         text("Fname", 100),      text("Local", 16),         text("BarCode", 16),
         text("Coin", 3),         of("Price", Double),       of("Weight", Double),
         of("Volume", Double),    of("LastUpdate", Date),    text("Version", 50),
         of("Copies", Byte),      of("PrintLabel", Boolean), text("SuppCatNum", 20),
         of("SalPackUN", Double), of("PurPackUN", Double),   of("IgnoreInDoc", Boolean)},
        {"ItemKey"}};
    return def;
}

const TableDef& alterKeys() {
    static const TableDef def{
        "tAlterKeys",
        {text("AccountKey", 15), text("ItemKey", 20), text("AlterNum", 20), text("AlterBar", 20)},
        {"AccountKey", "ItemKey"}};
    return def;
}

const TableDef& alterPrices() {
    static const TableDef def{
        "tAlterPrices",
        {text("AccountKey", 15), text("ItemKey", 20), of("Price", Double), text("Coin", 3)},
        {"AccountKey", "ItemKey"}};
    return def;
}

const TableDef& accountDef() {
    static const TableDef def{"tAccountDef",
                              {text("AccountKey", 15), of("PriceList", Integer),
                               text("LabelName", 50), of("Include", Boolean)},
                              {"AccountKey"}};
    return def;
}

const TableDef& priceList() {
    static const TableDef def{
        "tPriceList",
        {text("ItemKey", 20), of("PriceList", Integer), of("Price", Double), text("Currency", 3)},
        {"ItemKey", "PriceList"}};
    return def;
}

const SavedQuery kItemQueries[3] = {
    {"qSelectItems",
     "SELECT ItemKey, ItemName, Copies, PrintLabel FROM tItems ORDER BY tItems.PrintLabel, tItems.Itemkey"},
    {"qSelectMarkedItems",
     "SELECT ItemKey, ItemName, Copies, PrintLabel FROM tItems Where PrintLabel = True ORDER BY tItems.PrintLabel, tItems.Itemkey"},
    {"qEditItems",
     "SELECT ItemKey, ItemName, Unit, BarCode, Price FROM tItems ORDER BY tItems.Itemkey"},
};

const TableDef& tempItems() {
    static const TableDef def = renamed(items(), "tTempItems");
    return def;
}
const TableDef& tempAlterKeys() {
    static const TableDef def = renamed(alterKeys(), "tTempAlterKeys");
    return def;
}
const TableDef& tempAlterPrices() {
    static const TableDef def = renamed(alterPrices(), "tTempAlterPrices");
    return def;
}
const TableDef& tempPriceList() {
    static const TableDef def = renamed(priceList(), "tTempPriceList");
    return def;
}

const char* const kTempItemLinks[4] = {"tItems", "tAlterKeys", "tAlterPrices", "tPriceList"};

const SavedQuery kTempItemQueries[3] = {
    {"qAddUpdateAlterKeys",
     "UPDATE tTempAlterKeys LEFT JOIN tAlterKeys ON (tTempAlterKeys.AccountKey = tAlterKeys.AccountKey) AND (tTempAlterKeys.ItemKey = tAlterKeys.ItemKey) SET tAlterKeys.AccountKey = tTempAlterKeys.AccountKey, tAlterKeys.ItemKey = tTempAlterKeys.ItemKey, tAlterKeys.AlterNum = tTempAlterKeys.AlterNum"},
    {"qAddUpdateAlterPrices",
     "UPDATE tTempAlterPrices LEFT JOIN tAlterPrices ON (tTempAlterPrices.AccountKey = tAlterPrices.AccountKey) AND (tTempAlterPrices.ItemKey = tAlterPrices.ItemKey) SET tAlterPrices.AccountKey = tTempAlterPrices.AccountKey, tAlterPrices.ItemKey = tTempAlterPrices.ItemKey, tAlterPrices.Price = tTempAlterPrices.Price, tAlterPrices.Coin = tTempAlterPrices.Coin"},
    {"qAddUpdatePriceList",
     "UPDATE tTempPriceList LEFT JOIN tPriceList ON (tTempPriceList.ItemKey = tPriceList.ItemKey) AND (tTempPriceList.PriceList = tPriceList.PriceList) SET tPriceList.ItemKey = tTempPriceList.ItemKey, tPriceList.PriceList = tTempPriceList.PriceList, tPriceList.Price = tTempPriceList.Price, tPriceList.Currency = tTempPriceList.Currency"},
};

const TableDef& stockLog() {
    static const TableDef def{
        "tStockLog",
        {of("WizFileID", Long), of("Number", Long), of("DocType", Integer), of("Reference1", Long),
         of("DocDate", Date), of("LogDate", Date), of("TrnspCode", Integer), of("Boxes", Integer),
         of("ShipOrder", Integer)},
        {"WizFileID", "Number"}};
    return def;
}

}  // namespace etq::db::schema

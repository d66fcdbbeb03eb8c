#include "platform/label_fields.h"

#include <array>

namespace etq {

namespace {

// Some slots send under the variable "-": the label software receives them as they are. The unit
// (slot 5) is read from `Unit`, the column the item import fills; `Local`, which nothing writes,
// is left to slot 31.
constexpr std::array<LabelFieldSlot, kLabelFieldCount> kSlots = {{
    {0, u"Item code", u"ItemKey", u"1", u"ItemKey", u"מפתח פריט"},
    {1, u"Item name", u"ItemName", u"1", u"ItemName", u"שם פריט"},
    {2, u"", u"ItemSort", u"", u"ItemSort", u"קבוצת פריט"},
    {3, u"Foreign name", u"FName", u"1", u"FName", u"שם לועזי"},
    {4, u"Barcode", u"BarCode", u"1", u"BarCode", u"ברקוד"},
    {5, u"Unit", u"Unit", u"1", u"Unit", u"יחידת מידה"},
    {6, u"Price", u"Price", u"2", u"Price", u"מחיר"},
    {7, u"Currency", u"CoinSign", u"1", u"CoinSign", u"מטבע"},
    {8, u"Serial Number", u"SerialNum", u"1", u"SerialNum", u"מספר סידורי"},
    {9, u"BP code", u"CardCode", u"1", u"CardCode", u"מפתח לקוח/ספק"},
    {10, u"Doc. Number", u"Reference1", u"1", u"Reference1", u"אסמכתא"},
    {11, u"Special price", u"AltItemPrice", u"2", u"SpecialPrice", u"מחיר מיוחד"},
    {12, u"Alter. Code", u"AltItemKey", u"1", u"AlterKey", u"מפתח חליפי"},
    {13, u"Alter. Barcode", u"AltItemBar", u"1", u"AlterBar", u"ברקוד חליפי"},
    {14, u"BP list price", u"CardPrice", u"2", u"ListPrice", u"מחיר מחירון הלקוח"},
    {15, u"BP name", u"CardName", u"1", u"CardName", u"שם לקוח/ספק"},
    {16, u"Block number", u"-", u"1", u"BlockNum", u"מספר בלוק"},
    {17, u"Stamp number", u"-", u"1", u"StampNum", u"מספר חותמת"},
    {18, u"Address", u"Address", u"1", u"Address", u"כתובת"},
    {19, u"Phone", u"Phone", u"1", u"Phone1", u"טלפון"},
    {20, u"Delivery By", u"-", u"1", u"TrnspName", u"אופן משלוח"},
    {21, u"Pack Init.", u"PackStart", u"1", u"PackStart", u"מספר חבילה ראשון"},
    {22, u"City", u"City", u"1", u"City", u"עיר"},
    {23, u"Contact name", u"CntctName", u"1", u"CntctName", u"איש קשר"},
    {24, u"Cont. phone", u"CntctTel1", u"1", u"CntctTel1", u"טלפון איש קשר"},
    {25, u"Cont. remarks", u"CntctNotes1", u"2", u"CntctNotes1", u"הערות איש קשר"},
    {26, u"Doc.type", u"Symbol", u"1", u"SymbolHeb", u"סוג מסמך"},
    {27, u"Copies", u"Copies", u"1", u"Copies", u"עותקים"},
    {28, u"Due Date", u"DocDueDate", u"3", u"DocDueDate", u"תאריך אספקה"},
    {29, u"Comments", u"Comments", u"2", u"Comments", u"הערות"},
    {30, u"Supp. Cat.", u"SupCatNum", u"1", u"SuppCatNum", u"מספר קטלוגי של הספק"},
    {31, u"IDQualify", u"-", u"1", u"Local", u"סיווג מזהה"},
    {32, u"Cont. Mobile", u"CntctMobile", u"1", u"CntctMobile", u"נייד איש קשר"},
    {33, u"NumAtCard", u"NumAtCard", u"2", u"NumAtCard", u"מספר אצל הלקוח"},
    {34, u"Quantity", u"Quantity", u"1", u"Quantity", u"כמות"},
    {35, u"PPackUn", u"-", u"1", u"PPackUn", u"יחידות באריזת רכש"},
    {36, u"SPackUn", u"-", u"1", u"SPackUn", u"יחידות באריזת מכירה"},
    {37, u"BarCode", u"-", u"1", u"LineBar", u"ברקוד בשורה"},
    {38, u"Vendor Num.", u"LineVNum", u"1", u"LineVNum", u"מספר קטלוגי בשורה"},
    {39, u"Length", u"-", u"1", u"LineLen1", u"אורך"},
    {40, u"", u"CompName", u"", u"CompName", u"שם החברה"},
}};

}  // namespace

std::span<const LabelFieldSlot, kLabelFieldCount> labelFieldSlots() {
    return kSlots;
}

FieldFormat fieldFormat(QStringView formatTag) {
    if (formatTag == u"2") return FieldFormat::Price;
    if (formatTag == u"3") return FieldFormat::Date;
    return FieldFormat::Plain;
}

}  // namespace etq

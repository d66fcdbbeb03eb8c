#include "surface/surface_controls.h"

#include <array>
#include <vector>

#include "platform/label_fields.h"

namespace etq {

using namespace Qt::StringLiterals;

namespace {

using K = ControlKind;

// The working controls of the tabs with the labels that caption them, the frames, the pictures
// that act as shortcuts, and the message line and progress bar below the tabs. The 41 label
// field slots of tab 5 come from the slot table and are added after these.
constexpr ControlSpec kControls[] = {
    // Tab 0: labels by items.
    {u"lblFromItem", -1, K::Label, 0, u"", u"מפריט:", u"From item:", u"", 0, 0},
    {u"txtFromItem", -1, K::TextBox, 0, u"", u"", u"", u"", 0, 1},
    {u"LblToKey", -1, K::Label, 0, u"", u"עד פריט:", u"To item:", u"העתקת 'מפריט'", 1, 0},
    {u"txtToItem", -1, K::TextBox, 0, u"", u"", u"", u"", 1, 1},
    {u"ChkUseAccountKey", -1, K::CheckBox, 0, u"", u"להשתמש במק\"טים חליפיים/מחירים מיוחדים?",
     u"Use Alternate items/prices?", u"", 2, 0, 1, 2},
    {u"lblAccountKey", -1, K::Label, 0, u"", u"לקוח/ספק:", u"Account:", u"", 3, 0},
    {u"txtAccountKey", -1, K::TextBox, 0, u"", u"", u"", u"", 3, 1},
    {u"Image3", -1, K::Picture, 0, u"", u"", u"", u"בחירת פריטים להדפסה", 4, 0},
    {u"cmdSelectItems", -1, K::CommandButton, 0, u"", u"בחירת פריטים להדפסה",
     u"Select items to print", u"", 4, 1},
    {u"Image5", -1, K::Picture, 0, u"", u"", u"", u"הדפסת מדבקות", 5, 0},
    {u"cmdPrintItmes", -1, K::CommandButton, 0, u"", u"הדפסת מדבקות", u"Print labels",
     u"Print labels", 5, 1},
    {u"cmdSaveDef4", -1, K::CommandButton, 0, u"", u"שמור הגדרות", u"Save settings", u"", 6, 1},

    // Tab 1: labels by documents.
    {u"LblFromDate", -1, K::Label, 1, u"", u"מתאריך:", u"From date:", u"", 0, 0},
    {u"txtFromDate", -1, K::TextBox, 1, u"", u"", u"", u"", 0, 1},
    {u"lblFromDocNum", -1, K::Label, 1, u"", u"מאסמכתא:", u"From doc. no.:", u"", 0, 3},
    {u"txtFromDocNum", -1, K::TextBox, 1, u"", u"", u"", u"", 0, 4},
    {u"LblToDate", -1, K::Label, 1, u"", u"עד תאריך:", u"To date:", u"העתקת 'מתאריך'", 1, 0},
    {u"txtToDate", -1, K::TextBox, 1, u"", u"", u"", u"", 1, 1},
    {u"LblToRef", -1, K::Label, 1, u"", u"עד אסמכתא:", u"To doc. no.:", u"העתקת 'מאסמכתא'", 1, 3},
    {u"txtToDocNum", -1, K::TextBox, 1, u"", u"", u"", u"", 1, 4},
    {u"chkReadDocItems", -1, K::CheckBox, 1, u"", u"לקרוא גם את פריטי המסמכים",
     u"Read the documents' items", u"", 2, 0, 1, 2},
    {u"chkPrintHeadLabel", -1, K::CheckBox, 1, u"", u"מדבקת כותרת לכל מסמך",
     u"Head label for every document", u"", 2, 3, 1, 2},
    {u"chkOnlyLine0", -1, K::CheckBox, 1, u"", u"כותרות המסמכים בלבד", u"Document headers only",
     u"", 3, 0, 1, 2},
    {u"chkUseFastWay", -1, K::CheckBox, 1, u"", u"דרך מהירה", u"Fast way", u"", 3, 3, 1, 2},
    {u"Image6", -1, K::Picture, 1, u"", u"", u"", u"קריאת מסמכים", 4, 0},
    {u"cmdImportDocs", -1, K::CommandButton, 1, u"", u"קריאת מסמכים ונתונים נוספים",
     u"Scan documents and related data", u"", 4, 1},
    {u"cmdRanges", -1, K::CommandButton, 1, u"", u"הגדרות מיוחדות למסמכים",
     u"Document special settings", u"", 4, 4},
    {u"Image7", -1, K::Picture, 1, u"", u"", u"", u"בחירת מסמכים ושורות", 5, 0},
    {u"cmdSelectDocItems", -1, K::CommandButton, 1, u"", u"בחירת מסמכים ושורות",
     u"Select document lines", u"", 5, 1},
    {u"cmdDLog", -1, K::CommandButton, 1, u"", u"מסלולי חלוקה", u"Shipping Routes", u"", 5, 4},
    {u"Image8", -1, K::Picture, 1, u"", u"", u"", u"הדפסת מדבקות לשורות", 6, 0},
    {u"cmdPrintDocButt", -1, K::CommandButton, 1, u"", u"הדפסת מדבקות לשורות שנבחרו",
     u"Print labels for selected lines", u"Print labels for selected lines", 6, 1},
    {u"cmdSaveDef5", -1, K::CommandButton, 1, u"", u"שמור הגדרות", u"Save settings", u"", 6, 4},

    // Tab 2: reading items.
    {u"lblFromItemKey", -1, K::Label, 2, u"", u"מפריט:", u"From item:", u"", 0, 0},
    {u"txtFromItemKey", -1, K::TextBox, 2, u"", u"", u"", u"", 0, 1},
    {u"lblToItemKey", -1, K::Label, 2, u"", u"עד פריט:", u"To item:", u"", 1, 0},
    {u"txtToItemKey", -1, K::TextBox, 2, u"", u"", u"", u"", 1, 1},
    {u"chkItmQGrp", -1, K::CheckBox, 2, u"", u"לפי קבוצת שאילתה:", u"By query group:", u"", 2, 0},
    {u"cmbItmQGrp", -1, K::ComboBox, 2, u"", u"", u"", u"", 2, 1},
    {u"cmbItmQGrpBy", -1, K::ComboBox, 2, u"", u"", u"", u"", 2, 2},
    {u"chkItmBelong", -1, K::CheckBox, 2, u"", u"רק פריטים מקבוצה:", u"Only items of group:", u"",
     3, 0},
    {u"cmbItmBelong", -1, K::ComboBox, 2, u"", u"", u"", u"", 3, 1},
    {u"lblPriceField", -1, K::Label, 2, u"", u"מחיר לפי:", u"Price from:", u"", 4, 0},
    {u"cmbPriceField", -1, K::ComboBox, 2, u"", u"", u"", u"", 4, 1},
    {u"lblItemNameType", -1, K::Label, 2, u"", u"שם הפריט לפי:", u"Item name from:", u"", 5, 0},
    {u"CmbItemNameType", -1, K::ComboBox, 2, u"", u"", u"", u"", 5, 1},
    {u"lblCopies", -1, K::Label, 2, u"", u"מספר עותקים:", u"Copies:", u"", 6, 0},
    {u"txtCopies", -1, K::TextBox, 2, u"", u"", u"", u"", 6, 1},
    {u"chkReadPriceList", -1, K::CheckBox, 2, u"", u"לקרוא את כל המחירונים",
     u"Read all price lists", u"", 7, 0, 1, 3},
    {u"ChkImportAlterPrices", -1, K::CheckBox, 2, u"", u"לקרוא מחירים מיוחדים",
     u"Read special prices", u"", 8, 0, 1, 3},
    {u"ChkClean", -1, K::CheckBox, 2, u"", u"לנקות את טבלת הפריטים לפני הקריאה",
     u"Clean the item table first", u"", 9, 0, 1, 3},
    {u"CmdImportItems", -1, K::CommandButton, 2, u"", u"סריקת פריטים", u"Scan items", u"", 10, 1},
    {u"cmdSaveDef2", -1, K::CommandButton, 2, u"", u"שמור הגדרות", u"Save settings", u"", 10, 2},

    // Tab 3: tables and settings.
    {u"lblPrinter", -1, K::Label, 3, u"", u"מדפסת למדבקות ישירות:", u"Printer for direct labels:",
     u"", 0, 0},
    {u"cmbPrinter", -1, K::ComboBox, 3, u"", u"", u"", u"", 0, 1},
    // How the built-in labels reach the printer: the page in the browser, or a PDF drawn here
    // and sent to the printer.
    {u"cmbPrintMode", -1, K::ComboBox, 3, u"", u"", u"", u"דף בדפדפן או הדפסה ישירה למדפסת", 0, 2},
    {u"cmdAlterKeys", -1, K::CommandButton, 3, u"", u"פריטים חלופיים", u"Alternate Items", u"", 1,
     1},
    {u"cmdAccDef", -1, K::CommandButton, 3, u"", u"הגדרות לקוח/ספק", u"Customer Definitions", u"",
     2, 1},
    {u"cmdEditItems", -1, K::CommandButton, 3, u"", u"עריכת פריטים", u"Items Table", u"", 3, 1},

    // Tab 4: general settings.
    {u"lblCompanyName", -1, K::Label, 4, u"", u"שם החברה:", u"Company name:", u"", 0, 0},
    {u"txtCompanyName", -1, K::TextBox, 4, u"", u"", u"", u"", 0, 1},
    {u"lblDBPath", -1, K::Label, 4, u"", u"תיקיית הנתונים:", u"Database folder:", u"", 1, 0},
    {u"txtDBPath", -1, K::TextBox, 4, u"", u"", u"", u"", 1, 1},
    {u"DDEorOLE", -1, K::Frame, 4, u"", u"הדפסה באמצעות", u"Print with", u"", 2, 0, 1, 2},
    {u"OptOLE", 0, K::OptionButton, 4, u"DDEorOLE", u"NiceLabel", u"NiceLabel", u"", 0, 0},
    {u"OptOLE", 1, K::OptionButton, 4, u"DDEorOLE", u"CodeSoft", u"CodeSoft", u"", 0, 1},
    {u"OptOLE", 2, K::OptionButton, 4, u"DDEorOLE", u"BarTender", u"BarTender", u"", 0, 2},
    {u"OptOLE", 3, K::OptionButton, 4, u"DDEorOLE", u"Direct", u"Direct", u"", 0, 3},
    {u"OptOLE", 4, K::OptionButton, 4, u"DDEorOLE", u"FastLabel", u"FastLabel", u"", 0, 4},
    {u"OptOLE", 5, K::OptionButton, 4, u"DDEorOLE", u"gLabels", u"gLabels", u"", 0, 5},
    {u"PrinterType", -1, K::Frame, 4, u"", u"סוג המדפסת", u"Printer type", u"", 3, 0, 1, 2},
    {u"OptPrinter", 0, K::OptionButton, 4, u"PrinterType", u"A4", u"A4", u"", 0, 0},
    {u"OptPrinter", 1, K::OptionButton, 4, u"PrinterType", u"Thermal", u"Thermal", u"", 0, 1},
    {u"lblLabelSoftware", -1, K::Label, 4, u"", u"תוכנת עיצוב המדבקה:", u"Label design software:",
     u"", 4, 0},
    {u"txtLabelSoftware", -1, K::TextBox, 4, u"", u"", u"", u"", 4, 1},
    {u"CmdDir", 2, K::Picture, 4, u"", u"", u"", u"בחירת תוכנת העיצוב", 4, 2},
    {u"lblLabelName", -1, K::Label, 4, u"", u"קובץ מדבקה:", u"Label file:", u"", 5, 0},
    {u"txtLabelName", -1, K::TextBox, 4, u"", u"", u"", u"", 5, 1},
    {u"CmdDir", 1, K::Picture, 4, u"", u"", u"", u"בחירת קובץ מדבקה", 5, 2},
    {u"ImgEdit", 1, K::Picture, 4, u"", u"", u"", u"עריכת המדבקה בתוכנת העיצוב", 5, 3},
    {u"lblLabelNameHead", -1, K::Label, 4, u"", u"קובץ מדבקת כותרת:", u"Head label file:", u"", 6,
     0},
    {u"txtLabelNameHead", -1, K::TextBox, 4, u"", u"", u"", u"", 6, 1},
    {u"CmdDir", 0, K::Picture, 4, u"", u"", u"", u"בחירת קובץ מדבקת כותרת", 6, 2},
    {u"ImgEdit", 0, K::Picture, 4, u"", u"", u"", u"עריכת מדבקת הכותרת בתוכנת העיצוב", 6, 3},
    {u"cmdLabDesign", -1, K::CommandButton, 4, u"", u"הדפסה ישירה", u"Items Table", u"", 7, 1},
    {u"CmdConnect", -1, K::CommandButton, 4, u"", u"הגדרות חיבור למנהל קלאסיק", u"Connect to SBO",
     u"", 8, 1},
    {u"cmdSaveDef1", -1, K::CommandButton, 4, u"", u"שמור הגדרות", u"Save settings", u"", 9, 1},

    // Tab 5: data for the label (the slots are added from the slot table).
    {u"lblPrintDelay", -1, K::Label, 5, u"", u"השהיה אחרי כל מדבקה (שניות):",
     u"Delay after each label (seconds):", u"", 14, 0, 1, 2},
    {u"txtPrintDelay", -1, K::TextBox, 5, u"", u"", u"", u"", 14, 2},
    {u"lblPriceFormat", -1, K::Label, 5, u"", u"תבנית מחיר:", u"Price format:", u"", 14, 4, 1, 1},
    {u"txtPriceFormat", -1, K::TextBox, 5, u"", u"", u"", u"", 14, 5},
    {u"CmdSaveFields", -1, K::CommandButton, 5, u"", u"שמור הגדרות", u"Save settings", u"", 14, 8,
     1, 2},

    // Tab 6: settings for reading documents.
    {u"lblAddressFrom", -1, K::Label, 6, u"", u"הכתובת מתוך:", u"Address from:", u"", 0, 0},
    {u"cmbAddressFrom", -1, K::ComboBox, 6, u"", u"", u"", u"", 0, 1},
    {u"lblAddressSeperator", -1, K::Label, 6, u"", u"מפריד בין חלקי הכתובת:", u"Address separator:",
     u"0 = ירידת שורה", 1, 0},
    {u"cmbAddressSeperator", -1, K::ComboBox, 6, u"", u"", u"", u"0 = ירידת שורה", 1, 1},
    {u"lblCopiesAt", -1, K::Label, 6, u"", u"מספר העותקים לפי:", u"Copies by:", u"", 2, 0},
    {u"cmbCopiesAt", -1, K::ComboBox, 6, u"", u"", u"", u"", 2, 1},
    {u"lblLine0From", -1, K::Label, 6, u"", u"שורות להדפסה:", u"Lines to print:", u"", 3, 0},
    {u"cmbLine0From", -1, K::ComboBox, 6, u"", u"", u"", u"", 3, 1},
    {u"lblLine0Copies", -1, K::Label, 6, u"", u"עותקים למדבקת כותרת:", u"Head label copies:", u"",
     4, 0},
    {u"txtLine0Copies", -1, K::TextBox, 6, u"", u"", u"", u"", 4, 1},
    {u"chkUseDeliverLog", -1, K::CheckBox, 6, u"", u"לנהל יומן משלוחים", u"Keep a delivery log",
     u"", 5, 0, 1, 2},
    {u"cmdSaveDef6", -1, K::CommandButton, 6, u"", u"שמור הגדרות", u"Save Settings", u"", 6, 1},
    // The grid's model and its data control come with the document type grid.
    {u"VSDocTypes", -1, K::Grid, 6, u"", u"", u"", u"", 0, 3, 7, 2},
    {u"cmdAllDocTypes", -1, K::CommandButton, 6, u"", u"סמן את כולם", u"Select all", u"", 7, 3},
    {u"cmdNoDocTypes", -1, K::CommandButton, 6, u"", u"בטל את כולם", u"Unselect all", u"", 7, 4},

    // Tab 7: about.
    {u"lblMaker", -1, K::Label, 7, u"", u"Corvan Information Systems",
     u"Corvan Information Systems", u"", 0, 0},
    {u"lblProduct", -1, K::Label, 7, u"", u"מדבקות לפריטים ולמסמכים של מנהל קלאסיק - Etiquon",
     u"Etiquon - item and document labels for Menahel Classic", u"", 1, 0},
    {u"lblVersion", -1, K::Label, 7, u"", u"גרסה " ETIQUON_VERSION, u"Version " ETIQUON_VERSION,
     u"", 2, 0},
    {u"lblContact", -1, K::Label, 7, u"", u"לשאלות ולתמיכה פנו למשווק התוכנה",
     u"For questions and support contact your dealer", u"", 3, 0},
    {u"cmdUpgrade", -1, K::CommandButton, 7, u"", u"שדרוג בסיס הנתונים", u"", u"", 4, 0},

    // Outside the tab strip.
    {u"MainTab", -1, K::TabStrip, -1, u"", u"", u"", u"", 0, 0},
    {u"Message1", -1, K::Label, -1, u"", u"", u"", u"", 1, 0},
    {u"ProgressFrame", -1, K::Shape, -1, u"", u"", u"", u"", 2, 0},
    {u"ProgressFill", -1, K::Shape, -1, u"ProgressFrame", u"", u"", u"", 0, 0},
};

// Tab 5 shows the slots in three blocks of 14 rows; a block is a check box, the description
// and the variable name, then a spacer column.
constexpr int kSlotRows = 14;
constexpr int kSlotBlockColumns = 4;

void addSlotControls(std::vector<ControlSpec>& controls) {
    for (const LabelFieldSlot& s : labelFieldSlots()) {
        const int row = s.slot % kSlotRows;
        const int column = (s.slot / kSlotRows) * kSlotBlockColumns;
        controls.push_back(
            {u"ChkFldSend", s.slot, K::CheckBox, 5, u"", u"", u"", s.toolTip, row, column});
        controls.push_back({u"LblFldDesc", s.slot, K::Label, 5, u"", s.description, s.column, u"",
                            row, column + 1});
        controls.push_back({u"LblFldName", s.slot, K::Label, 5, u"", s.variable, s.formatTag, u"",
                            row, column + 2});
    }
}

const std::vector<ControlSpec>& table() {
    static const std::vector<ControlSpec> controls = [] {
        std::vector<ControlSpec> all(std::begin(kControls), std::end(kControls));
        addSlotControls(all);
        return all;
    }();
    return controls;
}

constexpr DesignList kDesignLists[] = {
    {u"CmbItemNameType", u"שם פריט;שם לועזי"},
    {u"cmbItmQGrpBy", u"רק פריטים בקבוצה;ללא פריטים בקבוצה"},
    {u"cmbAddressFrom", u"כתובת המסמך;כתובת הלקוח"},
    // The document import reads the text "0" as a line break between address parts.
    {u"cmbAddressSeperator", u"0;,"},
    {u"cmbCopiesAt", u"כמות בשורה;עותק אחד לשורה"},
    {u"cmbLine0From", u"כל השורות;שורה ראשונה בלבד"},
    {u"cmbPrintMode", u"דף בדפדפן;הדפסה ישירה"},
};

}  // namespace

std::span<const ControlSpec> surfaceControls() {
    return table();
}

const ControlSpec* findControlSpec(QStringView name, int index) {
    for (const ControlSpec& c : table())
        if (c.name == name && c.index == index) return &c;
    return nullptr;
}

int controlArraySize(QStringView name) {
    int count = 0;
    for (const ControlSpec& c : table())
        if (c.name == name && c.index >= 0) ++count;
    return count;
}

QStringList tabCaptions() {
    // The abbreviation mark in the first two captions is the plain double quote.
    return {u"מדבקות ע\"פ פריטים"_s,   u"מדבקות ע\"פ מסמכים"_s,
            u"קריאת פריטים"_s,         u"טבלאות והגדרות"_s,
            u"הגדרות כלליות"_s,        u"נתונים למדבקה"_s,
            u"הגדרות לקריאת מסמכים"_s, u"Corvan"_s};
}

std::span<const DesignList> designLists() {
    return kDesignLists;
}

}  // namespace etq

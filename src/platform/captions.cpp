#include "platform/captions.h"

#include <array>

namespace etq {

using namespace Qt::StringLiterals;

namespace {

struct Caption {
    QString hebrew;
    QString english;
};

// The caption table, numbered from 1. Every message, progress text and grid header of the
// component comes from here. Entry 29 is deliberately not a translation: the Hebrew asks about
// overwriting alternate keys and barcodes, the English about initialising all items.
const std::array<Caption, 54>& table() {
    static const std::array<Caption, 54> captions = {{
        {u"תקלה"_s, u"Error"_s},                                      // 1
        {u"הבדיקה הסתיימה בהצלחה"_s, u"Test is successfull"_s},       // 2
        {u"הבדיקה לא הסתיימה בהצלחה"_s, u"Test is unsuccessfull"_s},  // 3
        {u"תאור"_s, u"Description"_s},                                // 4
        {u"תנועה אחרונה שנמשכה"_s, u"Last Transaction"_s},            // 5
        {u"משיכה הבאה החל מתנועה"_s, u"Next scan start"_s},           // 6
        {u"סוג מסמך"_s, u"Doc. type"_s},                              // 7
        {u"אסמכתא"_s, u"Doc. No."_s},                                 // 8
        {u"תאריך"_s, u"Date"_s},                                      // 9
        {u"לקוח/ספק"_s, u"Biz Partner"_s},                            // 10
        {u"להדפיס?"_s, u"Print?"_s},                                  // 11
        {u"שם לקוח/ספק"_s, u"BP Name"_s},                             // 12
        {u"שורה"_s, u"Line"_s},                                       // 13
        {u"מפתח פריט"_s, u"Item Code"_s},                             // 14
        {u"שם פריט"_s, u"Item Name"_s},                               // 15
        {u"כמות"_s, u"Quantity"_s},                                   // 16
        {u"מחסן"_s, u"Warehouse"_s},                                  // 17
        {u"עותקים"_s, u"Copies"_s},                                   // 18
        {u"להדפיס?"_s, u"Print?"_s},                                  // 19
        {u"מידה"_s, u"Unit"_s},                                       // 20
        {u"ברקוד"_s, u"Barcode"_s},                                   // 21
        {u"מחיר"_s, u"Price"_s},                                      // 22
        {u"מפתח חליפי"_s, u"Alt.Item Code"_s},                        // 23
        {u"ברקוד חליפי"_s, u"Alt.BarCode"_s},                         // 24
        {u"מחירון"_s, u"Price List"_s},                               // 25
        {u"קובץ מדבקה"_s, u"Label file"_s},                           // 26
        {u"לסרוק?"_s, u"Scan?"_s},                                    // 27
        {u"טיוטות?"_s, u"Draft?"_s},                                  // 28
        {u"אתה בטוח שברצונך לדרוס את המפתחות והברקודים החליפיים?"_s,
         u"Are you sure to initialize all items?"_s},                                 // 29
        {u"שימו לב"_s, u"Attention"_s},                                               // 30
        {u"קורא פריטים..."_s, u"Scanning items..."_s},                                // 31
        {u"קורא מטבעות..."_s, u"Scanning currencies..."_s},                           // 32
        {u"קורא חליפיים..."_s, u"Scanning alternate items..."_s},                     // 33
        {u"קורא מחירים מיוחדים..."_s, u"Scanning special prices..."_s},               // 34
        {u"קורא את כל המחירונים..."_s, u"Scanning all price lists..."_s},             // 35
        {u"מעדכן נתוני פריטים בטבלאות ראשיות..."_s, u"Updating main tables..."_s},    // 36
        {u"מכין את בסיס הנתונים..."_s, u"Preparing database..."_s},                   // 37
        {u"הקריאה הסתיימה בהצלחה"_s, u"Scan is finished"_s},                          // 38
        {u"תוכנת עיצוב המדבקה לא נמצאה"_s, u"Can not find label design software"_s},  // 39
        {u"קובץ המדבקה אינו נמצא. האם לפתוח בכל זאת את תוכנת עיצוב המדבקה?"_s,
         u"Label file not found. Opem anyway?"_s},                                  // 40
        {u"למחוק את השורה?"_s, u"Delete line?"_s},                                  // 41
        {u"מנקה פריטים..."_s, u"Initializing items..."_s},                          // 42
        {u"מנקה פריטים חליפיים..."_s, u"Initializing alternate items..."_s},        // 43
        {u"הכנת המדבקות הסתיימה"_s, u"Labels are prepared"_s},                      // 44
        {u"סורק מסמכים"_s, u"Scanning documents"_s},                                // 45
        {u"קורא פריטים..."_s, u"Scanning items..."_s},                              // 46
        {u"קורא פריטים חליפיים..."_s, u"Scanning alternate items..."_s},            // 47
        {u"קורא מחירים מיוחדים..."_s, u"Scanning special prices..."_s},             // 48
        {u"קורא את המחירונים הנדרשים..."_s, u"Scanning price lists..."_s},          // 49
        {u"מעדכן נתוני פריטים בטבלאות ראשיות..."_s, u"Updating main tables..."_s},  // 50
        {u"להמשיך בכל זאת?"_s, u"Continue anyway?"_s},                              // 51
        {u""_s, u""_s},                                                             // 52
        {u""_s, u""_s},                                                             // 53
        {u""_s, u""_s},                                                             // 54
    }};
    return captions;
}

}  // namespace

QString GetCaption(int n, qint16 selector) {
    if (n < 1 || n > int(table().size())) return {};
    // Selector + 1 picks the column, with -1 counted as Hebrew; other selectors have no text.
    const int index = selector == -1 ? 1 : selector + 1;
    const Caption& c = table()[size_t(n - 1)];
    if (index == 1) return c.hebrew;
    if (index == 2) return c.english;
    return {};
}

qint16 GetColumnAlignment(qint16 selector) {
    return selector > 0 ? 1 : 7;
}

}  // namespace etq

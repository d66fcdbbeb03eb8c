#include "samples/demo_company.h"

#include <QDir>
#include <stdexcept>

#include "samples/host_records.h"

namespace etq::demo {

namespace {

// splitmix64: tiny, and the same sequence on every platform and library.
class Random {
  public:
    explicit Random(quint64 seed) : state_(seed) {}
    quint64 next() {
        quint64 z = (state_ += 0x9E3779B97F4A7C15ull);
        z = (z ^ (z >> 30)) * 0xBF58476D1CE4E5B9ull;
        z = (z ^ (z >> 27)) * 0x94D049BB133111EBull;
        return z ^ (z >> 31);
    }
    int below(int n) { return int(next() % quint64(n)); }
    int between(int low, int high) { return low + below(high - low + 1); }
    bool percent(int p) { return below(100) < p; }

  private:
    quint64 state_;
};

struct Product {
    int group;
    const char16_t* name;
    const char* foreignName;
    const char16_t* unit;
    int price;  // hundredths
};

const Product kProducts[] = {
    {1, u"חלב 3%", "Milk 3%", u"ליטר", 690},
    {1, u"גבינה לבנה 5%", "White cheese 5%", u"יח'", 590},
    {1, u"יוגורט טבעי", "Plain yogurt", u"יח'", 450},
    {1, u"גבינה צהובה", "Yellow cheese", u"ק\"ג", 5990},
    {1, u"חמאה", "Butter", u"יח'", 890},
    {1, u"שמנת מתוקה", "Sweet cream", u"יח'", 790},
    {1, u"קוטג' 5%", "Cottage cheese 5%", u"יח'", 620},
    {2, u"לחם אחיד פרוס", "Sliced bread", u"יח'", 790},
    {2, u"חלה מתוקה", "Sweet challah", u"יח'", 1290},
    {2, u"פיתות", "Pita bread", u"שקית", 990},
    {2, u"לחמניות", "Rolls", u"שקית", 1190},
    {2, u"עוגת שמרים", "Yeast cake", u"יח'", 2490},
    {3, u"מים מינרליים", "Mineral water", u"בקבוק", 390},
    {3, u"מיץ תפוזים", "Orange juice", u"בקבוק", 1290},
    {3, u"משקה קולה", "Cola", u"בקבוק", 790},
    {3, u"סודה", "Soda water", u"בקבוק", 350},
    {3, u"בירה לאגר", "Lager beer", u"פחית", 890},
    {3, u"יין אדום יבש", "Dry red wine", u"בקבוק", 4990},
    {4, u"עגבניות", "Tomatoes", u"ק\"ג", 690},
    {4, u"מלפפונים", "Cucumbers", u"ק\"ג", 590},
    {4, u"תפוחי עץ", "Apples", u"ק\"ג", 990},
    {4, u"בננות", "Bananas", u"ק\"ג", 790},
    {4, u"תפוחי אדמה", "Potatoes", u"ק\"ג", 490},
    {5, u"נוזל כלים", "Dish soap", u"יח'", 1190},
    {5, u"אבקת כביסה", "Laundry powder", u"יח'", 3490},
    {5, u"אקונומיקה", "Bleach", u"יח'", 790},
    {5, u"נייר טואלט", "Toilet paper", u"מארז", 3290},
    {6, u"שוקולד חלב", "Milk chocolate", u"יח'", 590},
    {6, u"חטיף בוטנים", "Peanut snack", u"יח'", 450},
    {6, u"ופלים במילוי", "Filled wafers", u"יח'", 690},
    {7, u"טונה בשמן", "Tuna in oil", u"פחית", 790},
    {7, u"תירס מתוק", "Sweet corn", u"פחית", 590},
    {7, u"אורז פרסי", "Persian rice", u"ק\"ג", 1090},
    {7, u"פסטה ספגטי", "Spaghetti", u"יח'", 590},
    {7, u"שמן זית כתית מעולה", "Virgin olive oil", u"בקבוק", 3990},
    {7, u"קמח לבן", "White flour", u"ק\"ג", 550},
    {8, u"שניצל עוף", "Chicken schnitzel", u"ק\"ג", 4490},
    {8, u"אפונה קפואה", "Frozen peas", u"יח'", 990},
    {8, u"פיצה משפחתית", "Family pizza", u"יח'", 2990},
    {8, u"גלידת וניל", "Vanilla ice cream", u"יח'", 2490},
};

struct Variant {
    const char16_t* name;  // appended to the product's name
    const char* foreignName;
    int pricePercent;
};

const Variant kVariants[] = {
    {u"", "", 100},
    {u" מארז 3", " 3-pack", 270},
    {u" גדול", " large", 160},
    {u" קטן", " small", 70},
    {u" אורגני", " organic", 140},
    {u" ללא גלוטן", " gluten free", 130},
    {u" מבצע", " offer", 85},
    {u" מהדרין", " mehadrin", 110},
    {u" מותג פרטי", " store brand", 80},
    {u" יבוא", " imported", 150},
};

const char16_t* const kItemGroups[] = {u"מוצרי חלב",      u"מאפים",  u"משקאות",
                                       u"פירות וירקות",   u"ניקיון", u"חטיפים ומתוקים",
                                       u"שימורים ויבשים", u"קפואים", u"כללי"};

const char16_t* const kPropertyGroups[] = {u"כשר למהדרין", u"ללא גלוטן",       u"מבצע החודש",
                                           u"מוצר יבוא",   u"אורגני",          u"טבעוני",
                                           u"מוצר קירור",  u"לא למכירה במשלוח"};

const char16_t* const kPriceLists[] = {
    u"מחירון רגיל", u"מחירון סיטונאי", u"מחירון מוסדות", u"מחירון דולרי", u"מחירון יורו",
    u"מבצע חודשי",  u"מחירון עובדים",  u"מחירון חנויות", u"מחירון ייצוא", u"מחירון לקוחות VIP"};

struct Account {
    const char* key;
    const char16_t* name;
    const char16_t* street;
    const char16_t* city;
    const char* phone;
    const char16_t* contact;
};

const Account kAccounts[] = {
    {"20001", u"סופרמרקט השכונה בע\"מ", u"רחוב הרצל 12", u"תל אביב", "03-5551201", u"יוסי כהן"},
    {"20002", u"מכולת אצל שמעון", u"רחוב הנביאים 4", u"ירושלים", "02-6241133", u"שמעון לוי"},
    {"20003", u"מינימרקט הדקל", u"שדרות בן גוריון 88", u"חיפה", "04-8123456", u"רונית מזרחי"},
    {"20004", u"רשת חנויות 'השוק הטרי'", u"רחוב ויצמן 30", u"כפר סבא", "09-7654321", u"אבי פרץ"},
    {"20005", u"קפה נחת", u"רחוב דיזנגוף 150", u"תל אביב", "03-5229988", u"מיכל ביטון"},
    {"20006", u"מסעדת הגפן", u"רחוב העצמאות 7", u"באר שבע", "08-6277001", u"דוד אברהם"},
    {"20007", u"צרכניית המושב", u"משק 23", u"מושב בני דרום", "08-8591234", u"שרה פרידמן"},
    {"20008", u"בית ספר אלון", u"רחוב האלון 1", u"רעננה", "09-7711223", u"נועה שפירא"},
    {"20009", u"מעונות גן חיים", u"רחוב הגפן 19", u"רמת גן", "03-6737373", u"אורי גולן"},
    {"20010", u"קיוסק הים", u"טיילת החוף", u"נתניה", "09-8623300", u"עמית דהן"},
    {"20011", u"פיצריה בלה נאפולי", u"רחוב סוקולוב 55", u"הרצליה", "09-9504040", u"ליאור אוחיון"},
    {"20012", u"מאפיית אבולעפיה", u"רחוב יפת 7", u"תל אביב-יפו", "03-6834958", u"חנה אבולעפיה"},
    {"20013", u"חברת ההסעדה \"טעמים\"", u"אזור תעשייה צפוני", u"קיסריה", "04-6101010", u"משה רוזן"},
    {"20014", u"מלון הנסיכה", u"רחוב הדקלים 2", u"אילת", "08-6360000", u"תמר ששון"},
    {"20015", u"מרכול בית הכרם", u"רחוב בית הכרם 40", u"ירושלים", "02-6523131", u"אליהו נגר"},
    {"20016", u"סיטונאות הגליל בע\"מ", u"אזור התעשייה", u"כרמיאל", "04-9881122", u"סמיר חורי"},
    {"20017", u"שוק העיר", u"רחוב הרצל 100", u"ראשון לציון", "03-9661212", u"גלית אזולאי"},
    {"20018", u"מחסני המזון המרכזיים", u"רחוב המלאכה 3", u"חולון", "03-5567788", u"רפי סויסה"},
    {"AB-101", u"אלקטרו-קפה יבוא", u"רחוב הברזל 21", u"תל אביב", "03-6479900", u"דנה קליין"},
    {"SUP7", u"ספקי המשק בע\"מ", u"רחוב התעשייה 9", u"פתח תקווה", "03-9345678", u"קובי מלכה"},
};

const char16_t* const kRemarks[] = {
    u"", u"לפרוק בבוקר בלבד", u"להתקשר לפני הגעה", u"סחורה בקירור - לא להשאיר בשמש",
    u"", u"משלוח דחוף"};

QString text(const char* ascii) {
    return QString::fromLatin1(ascii);
}
QString text(const char16_t* utf16) {
    return QString::fromUtf16(utf16);
}

// A valid EAN-13 with the Israeli prefix 729.
QString ean13(quint64 body) {
    QString digits =
        QStringLiteral("729") + QString::number(body % 1000000000ull).rightJustified(9, '0');
    int sum = 0;
    for (int i = 0; i < 12; ++i)
        sum += (digits[i].digitValue()) * (i % 2 ? 3 : 1);
    return digits + QString::number((10 - sum % 10) % 10);
}

QString itemKey(int index) {
    // Mostly numbers; now and then a key with letters, as shops give their own goods.
    if (index % 37 == 5) return QStringLiteral("KT-%1").arg(1000 + index);
    return QString::number(10000 + index);
}

ItemRecord makeItem(int index, Random& random) {
    const int productCount = int(std::size(kProducts));
    const Product& product = kProducts[index % productCount];
    const Variant& variant = kVariants[(index / productCount) % int(std::size(kVariants))];
    ItemRecord item;
    item.key = itemKey(index);
    item.name = text(product.name) + text(variant.name);
    if (!random.percent(30))
        item.foreignName = text(product.foreignName) + text(variant.foreignName);
    item.group = QString::number(product.group);
    if (!random.percent(10)) item.barcode = ean13(quint64(index) * 7919 + random.below(1000));
    if (random.percent(60))
        item.supplierCatalogNumber = QStringLiteral("S%1").arg(random.between(10000, 99999));
    item.unit = text(product.unit);
    const int local = product.price * variant.pricePercent / 100 + random.between(-20, 20) * 5;
    item.prices[0] = {local, {}};
    item.prices[1] = {local * 85 / 100, {}};
    if (random.percent(50)) item.prices[2] = {local * 90 / 100, {}};
    if (random.percent(60)) item.prices[3] = {local * 10 / 36, QStringLiteral("$")};
    if (random.percent(40)) item.prices[4] = {local * 10 / 40, QStringLiteral("EU")};
    if (random.percent(20)) item.prices[5] = {local * 75 / 100, {}};
    if (random.percent(10)) item.prices[9] = {local * 10 / 37, QStringLiteral("$")};
    if (!random.percent(30)) item.queryGroups = QString::number(random.below(256));
    item.deleted = index % 97 == 13;
    return item;
}

// Items go straight to disk (a benchmark company has a hundred thousand); the first few
// hundred live ones are kept for the documents and special prices to name.
QList<ItemRecord> writeItems(const QString& path, int count, Random& random) {
    constexpr int kKept = 400;
    QList<ItemRecord> kept;
    DbfWriter writer(path, host::oitm::kLayout);
    for (int i = 0; i < count; ++i) {
        const ItemRecord item = makeItem(i, random);
        append(writer, item);
        if (!item.deleted && kept.size() < kKept) kept.append(item);
    }
    writer.close();
    if (kept.isEmpty()) throw std::invalid_argument("the demo company needs a live item");
    return kept;
}

template <class Record>
QList<Record> numberedNames(std::span<const char16_t* const> names) {
    QList<Record> records;
    for (int i = 0; i < int(names.size()); ++i)
        records.append({i + 1, text(names[i])});
    return records;
}

QList<CurrencyRecord> makeCurrencies() {
    return {
        {QStringLiteral("¦"), QStringLiteral("שקל חדש"), QStringLiteral("ש\"ח"),
         QStringLiteral("₪")},
        {QStringLiteral("$"), QStringLiteral("דולר ארה\"ב"), QStringLiteral("$"),
         QStringLiteral("$")},
        {QStringLiteral("EU"), QStringLiteral("אירו"), QStringLiteral("EUR"), QStringLiteral("€")},
        {QStringLiteral("£"), QStringLiteral("לירה שטרלינג"), QStringLiteral("GBP"),
         QStringLiteral("£")},
    };
}

QList<AccountRecord> makeAccounts() {
    QList<AccountRecord> accounts;
    for (const Account& a : kAccounts)
        accounts.append({text(a.key), text(a.name), text(a.street), text(a.city), text(a.phone)});
    return accounts;
}

QList<SpecialPriceRecord> makeSpecialPrices(const QList<ItemRecord>& items, Random& random) {
    QList<SpecialPriceRecord> prices;
    for (int account : {0, 3, 5, 12}) {
        for (int n = 0; n < 6; ++n) {
            const ItemRecord& item = items[random.below(int(items.size()))];
            const bool dollars = account == 12 && n % 2 == 0;
            const qint32 local = item.prices[0].hundredths * random.between(80, 95) / 100;
            prices.append(
                {item.key,
                 text(kAccounts[account].key),
                 {dollars ? local * 10 / 36 : local, dollars ? QStringLiteral("$") : QString()}});
        }
    }
    prices[7].deleted = true;
    return prices;
}

DocumentLine makeLine(const ItemRecord& item, Random& random) {
    DocumentLine line;
    line.itemKey = item.key;
    line.itemName = item.name;
    line.vendorCatalogNumber = item.supplierCatalogNumber;
    const bool byWeight = item.unit == QStringLiteral("ק\"ג");
    line.quantity = byWeight ? random.between(25, 2000) / 100.0 : double(random.between(1, 48));
    if (random.percent(15))
        line.serialNumber = QStringLiteral("SN%1").arg(random.between(100000, 999999));
    line.warehouse = random.between(1, 3);
    return line;
}

// Line counts of a file's documents: one page, exactly full, two and three pages among them.
constexpr int kLineCounts[] = {3, 10, 23, 1, 11, 7, 15};

QList<StockDocument> makeDocuments(const DemoDocumentFile& file, const QList<ItemRecord>& items,
                                   Random& random) {
    QList<StockDocument> documents;
    QDate date(2025, 1, 2 + file.wizFileId);
    for (int k = 0; k < int(std::size(kLineCounts)); ++k) {
        const Account& account = kAccounts[random.below(int(std::size(kAccounts)))];
        StockDocument d;
        d.number = file.wizFileId * 100 + k + 1;
        d.reference = QString::number(file.wizFileId * 10000 + 501 + k);
        date = date.addDays(random.between(20, 80));
        d.date = date;
        d.secondDate = date;
        d.dueDate = date.addDays(30);
        d.status = random.percent(40) ? QStringLiteral("C") : QStringLiteral("O");
        d.customerReference = random.percent(50)
                                  ? QStringLiteral("PO-%1").arg(random.between(1000, 9999))
                                  : QString();
        d.remarks = text(kRemarks[random.below(int(std::size(kRemarks)))]);
        d.contactName = text(account.contact);
        // Transfers move goods between warehouses: no customer.
        if (file.wizFileId != 12) {
            d.accountKey = text(account.key);
            d.customerName = text(account.name);
            d.address = text(account.street) + u'\r' + text(account.city);
        }
        for (int n = 0; n < kLineCounts[k]; ++n)
            d.lines.append(makeLine(items[random.below(int(items.size()))], random));
        documents.append(d);
    }
    // A few drafts (one with a blank mark), one record the host marked "I", one deleted.
    documents[3].draftMark = QStringLiteral("Y");
    // Quantities a label run must cope with: a weighed return, a bulk line beyond 999 labels,
    // a line of nothing; and an item the shop's item file no longer holds.
    if (file.wizFileId == 1) {
        QList<DocumentLine>& lines = documents[1].lines;
        lines[2].quantity = -3.6;
        lines[5].quantity = 2500;
        lines[7].quantity = 0;
        lines[8].itemKey = QStringLiteral("99999");
        lines[8].itemName = QStringLiteral("מארז שי לחג (הופסק)");
        lines[8].vendorCatalogNumber.clear();
    }
    if (file.wizFileId == 4) documents[5].draftMark = QString();
    if (file.wizFileId == 2) documents[3].status = QStringLiteral("I");
    if (file.wizFileId == 1) documents[5].deleted = true;
    return documents;
}

QString pathIn(const QString& dir, std::string_view fileName) {
    return dir + u'/' + QString::fromLatin1(fileName.data(), qsizetype(fileName.size()));
}

}  // namespace

void writeDemoCompany(const QString& dir, const DemoOptions& options) {
    if (options.items < 1) throw std::invalid_argument("the demo company needs at least one item");
    if (!QDir().mkpath(dir))
        throw std::runtime_error("Cannot make the folder " + dir.toStdString());
    Random random(options.seed);
    const QList<ItemRecord> items =
        writeItems(pathIn(dir, host::oitm::kLayout.fileName), options.items, random);
    writeHostFile(pathIn(dir, host::oitg::kLayout.fileName),
                  numberedNames<PropertyGroupRecord>(kPropertyGroups));
    writeHostFile(pathIn(dir, host::oitb::kLayout.fileName),
                  numberedNames<ItemGroupRecord>(kItemGroups));
    writeHostFile(pathIn(dir, host::opln::kLayout.fileName),
                  numberedNames<PriceListRecord>(kPriceLists));
    writeHostFile(pathIn(dir, host::ocrn::kLayout.fileName), makeCurrencies());
    writeHostFile(pathIn(dir, host::ocrd::kLayout.fileName), makeAccounts());
    writeHostFile(pathIn(dir, host::ospp::kLayout.fileName), makeSpecialPrices(items, random));
    for (const DemoDocumentFile& file : kDemoDocumentFiles)
        writeHostFile(dir + u'/' + QLatin1StringView(file.baseName) + QStringLiteral(".dbf"),
                      makeDocuments(file, items, random));
}

}  // namespace etq::demo

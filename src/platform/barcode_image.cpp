#include "platform/barcode_image.h"

#include "platform/bmp_file.h"
#include "platform/codepage1255.h"

#include <QFile>

#include <zint.h>

#include <algorithm>
#include <cmath>
#include <cstring>

namespace etq {

namespace {

enum class Family { Code39, Code128, Ean, Itf };

struct BarType {
    int code;
    const char* name;
    Family family;
    int symbology;  // zint's symbology; EAN and full-ASCII Code 39 adjust it per output
    int eanDigits;  // EAN: digits before the check digit
};

// zint cannot force Code 128 subset A, so CODE-128A gets automatic Code 128: it switches to
// subset A wherever the data holds control characters and otherwise picks the shortest
// subsets, so the symbol decodes to the same text.
constexpr BarType kBarTypes[] = {
    {bar_type::Code39, "CODE-39", Family::Code39, BARCODE_CODE39, 0},
    {bar_type::Code128, "CODE-128", Family::Code128, BARCODE_CODE128, 0},
    {bar_type::Interleaved2of5, "Interleaved 2 of 5", Family::Itf, BARCODE_C25INTER, 0},
    {bar_type::Ean8, "EAN-8", Family::Ean, BARCODE_EANX, 7},
    {bar_type::Ean13, "EAN-13", Family::Ean, BARCODE_EANX, 12},
    {bar_type::Code128A, "CODE-128A", Family::Code128, BARCODE_CODE128, 0},
    {bar_type::Code128B, "CODE-128B", Family::Code128, BARCODE_CODE128B, 0},
};

constexpr int kUnitInch = 0;
// zint's largest scale is 100, and a module is 2 x scale pixels.
constexpr double kMaxNarrowBarPixels = 200.0;
// zint's option_2 for Code 39 and Interleaved 2 of 5: add the check character and show it.
constexpr int kAddCheckCharacter = 1;

const BarType* findBarType(int code) {
    for (const BarType& type : kBarTypes) {
        if (type.code == code) return &type;
    }
    return nullptr;
}

bool isDigits(const QString& text) {
    for (QChar c : text) {
        if (c < u'0' || c > u'9') return false;
    }
    return true;
}

// The library takes its text in the Hebrew code page, so Code 128 carries a Hebrew letter as
// its Windows-1255 byte (an extended character), as the host's own text has it. Returns an
// empty array when a character has no byte in the code page.
QByteArray hostBytes(const QString& text) {
    const bool ascii =
        std::all_of(text.begin(), text.end(), [](QChar c) { return c.unicode() < 0x80; });
    if (ascii) return text.toLatin1();
    QByteArray bytes = encode1255(text, Unmappable::QuestionMark);
    return decode1255(bytes) == text ? bytes : QByteArray();
}

bool isBitmapName(const QString& path) {
    return path.endsWith(QLatin1String(".bmp"), Qt::CaseInsensitive);
}

}  // namespace

// What zint is asked to encode for one symbol.
struct BarcodeImage::Encoding {
    int symbology = 0;
    int option2 = 0;
    QByteArray data;
};

namespace {

using Encoding = BarcodeImage::Encoding;

// EAN symbols always carry a check digit, so the number of digits given decides: up to the
// payload length (7 for EAN-8, 12 for EAN-13) the digits are zero-padded on the left and the
// check digit is added; one digit more means the check digit is given, and it is verified.
// The check digit flag cannot change that without making a wrong symbol.
QString prepareEan(const BarType& type, const QString& text, Encoding& out) {
    if (!isDigits(text)) return QStringLiteral("%1 takes digits only").arg(type.name);
    if (text.size() <= type.eanDigits) {
        out.symbology = BARCODE_EANX;
        out.data = text.rightJustified(type.eanDigits, u'0').toLatin1();
    } else if (text.size() == type.eanDigits + 1) {
        out.symbology = BARCODE_EANX_CHK;
        out.data = text.toLatin1();
    } else {
        return QStringLiteral("%1 takes at most %2 digits").arg(type.name).arg(type.eanDigits + 1);
    }
    return {};
}

// Returns the reason when the text cannot be encoded as this bar type.
QString encodingOf(const BarType& type, const QString& text, bool checkDigit, bool fullAscii,
                   Encoding& out) {
    if (type.family == Family::Ean) return prepareEan(type, text, out);
    out.symbology = type.symbology;
    out.data = hostBytes(text);
    if (out.data.isEmpty()) return QStringLiteral("%1 cannot encode this text").arg(type.name);
    switch (type.family) {
        case Family::Code39:
            if (fullAscii) out.symbology = BARCODE_EXCODE39;
            out.option2 = checkDigit ? kAddCheckCharacter : 0;
            break;
        case Family::Itf:
            out.option2 = checkDigit ? kAddCheckCharacter : 0;
            break;
        case Family::Code128:  // its check character is part of every symbol
        case Family::Ean:
            break;
    }
    return {};
}

// One zint module is 2 x scale pixels, scale in steps of 0.5: the narrow bar becomes a whole
// number of pixels, at least one.
float scaleForNarrowBar(double pixels) {
    return float(std::max(1.0, std::round(pixels)) / 2.0);
}

QString settingsProblem(const BarcodeSettings& s) {
    if (s.unit != kUnitInch) {
        return QStringLiteral("Unknown barcode unit %1 (0 = inches)").arg(s.unit);
    }
    if (s.resoX <= 0 || s.resoY <= 0) {
        return QStringLiteral("Barcode resolution %1 x %2 is not above 0")
            .arg(s.resoX)
            .arg(s.resoY);
    }
    const double narrowPixels = double(s.dimX) * s.resoX;
    if (!(narrowPixels > 0.0 && narrowPixels <= kMaxNarrowBarPixels)) {
        return QStringLiteral("Narrow bar width %1 is out of range").arg(s.dimX);
    }
    const double barPixels = double(s.barHeight) * s.resoY;
    if (!(barPixels > 0.0 && std::isfinite(barPixels))) {
        return QStringLiteral("Bar height %1 is not above 0").arg(s.barHeight);
    }
    if (s.rotation != 0 && s.rotation != 90 && s.rotation != 180 && s.rotation != 270) {
        return QStringLiteral("Barcode rotation %1 is not 0, 90, 180 or 270").arg(s.rotation);
    }
    return {};
}

// Sets every input of the reused symbol: encoding writes some of them back (the height, for
// one), so nothing may carry over from the previous symbol. `scale` is half the units of one
// module, `height` the bars' height in modules.
void prepareSymbol(zint_symbol* symbol, const BarcodeSettings& s, const Encoding& encoding,
                   float scale, float height) {
    ZBarcode_Clear(symbol);
    symbol->symbology = encoding.symbology;
    symbol->input_mode = DATA_MODE;
    symbol->option_2 = encoding.option2;
    symbol->scale = scale;
    symbol->height = height;
    symbol->show_hrt = s.showDesc ? 1 : 0;
}

// The bitmap's pixels: the narrow bar a whole number of them, the bars as high as the setting
// at its resolution.
void prepareBitmapSymbol(zint_symbol* symbol, const BarcodeSettings& s, const Encoding& encoding,
                         const QByteArray& fileName) {
    const float scale = scaleForNarrowBar(double(s.dimX) * s.resoX);
    const double barPixels = std::max(1.0, std::round(double(s.barHeight) * s.resoY));
    prepareSymbol(symbol, s, encoding, scale, float(barPixels / (2.0 * scale)));
    std::memcpy(symbol->outfile, fileName.constData(), size_t(fileName.size()) + 1);
}

// zint's vector unit is two scales: a scale of one half makes a module one unit.
constexpr float kModuleScale = 0.5f;
constexpr double kMillimetresPerInch = 25.4;

}  // namespace

void BarcodeImage::SymbolDeleter::operator()(zint_symbol* symbol) const {
    ZBarcode_Delete(symbol);
}

BarcodeImage::BarcodeImage() : symbol_(ZBarcode_Create()) {}

BarcodeImage::~BarcodeImage() = default;

bool BarcodeImage::fail(const QString& reason) {
    lastError_ = reason;
    return false;
}

bool BarcodeImage::OutputBitmap(const QString& path) {
    if (!symbol_) return fail(QStringLiteral("The barcode library has no memory for a symbol"));
    const QByteArray fileName = QFile::encodeName(path);
    if (!isBitmapName(path)) {
        return fail(QStringLiteral("Barcode file \"%1\" is not named .bmp").arg(path));
    }
    if (fileName.size() >= int(sizeof(symbol_->outfile))) {
        return fail(QStringLiteral("Barcode file path is longer than %1 bytes: %2")
                        .arg(sizeof(symbol_->outfile) - 1)
                        .arg(path));
    }
    // A bitmap left from an earlier output must not stand in for one that failed; one that
    // succeeds overwrites it.
    const QString problem = writeBitmap(fileName);
    if (problem.isEmpty()) {
        lastError_.clear();
        return true;
    }
    QFile::remove(path);
    return fail(problem);
}

QString BarcodeImage::prepareEncoding(Encoding& encoding) const {
    const BarType* type = findBarType(settings_.barType);
    if (!type) return QStringLiteral("Unknown barcode type %1").arg(settings_.barType);
    if (const QString problem = settingsProblem(settings_); !problem.isEmpty()) return problem;
    const QString& text = settings_.data;
    if (text.isEmpty()) return QStringLiteral("No data for the %1 barcode").arg(type->name);
    const QString refusal =
        encodingOf(*type, text, settings_.checkDigit, settings_.c39Ascii, encoding);
    if (!refusal.isEmpty()) return QStringLiteral("%1 (data \"%2\")").arg(refusal, text);
    return {};
}

QString BarcodeImage::encodeFailure() const {
    const BarType* type = findBarType(settings_.barType);
    return QStringLiteral("%1 barcode of \"%2\": %3")
        .arg(type ? type->name : "", settings_.data, QString::fromUtf8(symbol_->errtxt));
}

QString BarcodeImage::writeBitmap(const QByteArray& fileName) {
    Encoding encoding;
    if (const QString refusal = prepareEncoding(encoding); !refusal.isEmpty()) return refusal;
    zint_symbol* symbol = symbol_.get();
    prepareBitmapSymbol(symbol, settings_, encoding, fileName);
    const auto* data = reinterpret_cast<const unsigned char*>(encoding.data.constData());
    if (ZBarcode_Encode(symbol, data, int(encoding.data.size())) >= ZINT_ERROR ||
        ZBarcode_Buffer(symbol, settings_.rotation) >= ZINT_ERROR)
        return encodeFailure();
    // zint's raster, written as the BMP its own output makes, without its per-pixel conversion.
    QString error;
    if (!writeMonochromeBmp(fileName, symbol->bitmap, symbol->bitmap_width, symbol->bitmap_height,
                            &error))
        return error;
    return {};
}

bool BarcodeImage::OutputVector(BarcodeVector& out) {
    out = {};
    if (!symbol_) return fail(QStringLiteral("The barcode library has no memory for a symbol"));
    Encoding encoding;
    if (const QString refusal = prepareEncoding(encoding); !refusal.isEmpty()) return fail(refusal);
    zint_symbol* symbol = symbol_.get();
    prepareSymbol(symbol, settings_, encoding, kModuleScale, settings_.barHeight / settings_.dimX);
    const auto* data = reinterpret_cast<const unsigned char*>(encoding.data.constData());
    if (ZBarcode_Encode(symbol, data, int(encoding.data.size())) >= ZINT_ERROR ||
        ZBarcode_Buffer_Vector(symbol, settings_.rotation) >= ZINT_ERROR)
        return fail(encodeFailure());

    const double module = double(settings_.dimX) * kMillimetresPerInch;
    const zint_vector* vector = symbol->vector;
    out.size = QSizeF(vector->width * module, vector->height * module);
    for (const zint_vector_rect* r = vector->rectangles; r; r = r->next)
        out.bars.emplace_back(r->x * module, r->y * module, r->width * module, r->height * module);
    for (const zint_vector_string* t = vector->strings; t; t = t->next) {
        const auto halign = t->halign == 1   ? BarcodeVector::Text::Left
                            : t->halign == 2 ? BarcodeVector::Text::Right
                                             : BarcodeVector::Text::Centre;
        out.texts.push_back({QPointF(t->x * module, t->y * module), t->fsize * module, halign,
                             QString::fromUtf8(reinterpret_cast<const char*>(t->text), t->length)});
    }
    lastError_.clear();
    return true;
}

}  // namespace etq

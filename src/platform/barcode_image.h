#pragma once

#include <QPointF>
#include <QRectF>
#include <QString>

#include <memory>
#include <vector>

struct zint_symbol;

namespace etq {

// Bar type codes of the barcode library, as the label page passes them to SetBarType.
namespace bar_type {
inline constexpr int Code39 = 0;
inline constexpr int Code128 = 1;  // automatic subsets
inline constexpr int Interleaved2of5 = 4;
inline constexpr int Ean8 = 9;
inline constexpr int Ean13 = 10;
inline constexpr int Code128A = 14;
inline constexpr int Code128B = 15;
}  // namespace bar_type

// What the setters of BarcodeImage keep for its next bitmap.
struct BarcodeSettings {
    int unit = 0;
    int barType = bar_type::Code39;
    QString data;
    float dimX = 0.01f;
    float barHeight = 0.4f;
    int rotation = 0;
    bool c39Ascii = false;
    bool checkDigit = true;
    bool showDesc = false;
    int resoX = 200;
    int resoY = 200;
};

// A symbol as shapes, to be drawn sharp at any size: its bars and the human-readable text, in
// millimetres from the symbol's top left corner. A module is DimX inches wide and the bars are
// BarHeight inches high, whatever the resolution.
struct BarcodeVector {
    struct Text {
        enum Align { Centre, Left, Right };
        QPointF baseline;  // the point of the baseline that `align` names
        double size;       // the font's size, in millimetres
        Align align;
        QString text;
    };
    QSizeF size;
    std::vector<QRectF> bars;
    std::vector<Text> texts;
};

// The barcode library's instance: settings made through the setters stay until changed, and
// every OutputBitmap writes one bitmap from the current settings. Constructing opens the
// instance, destroying closes it; one instance serves any number of bitmaps.
//
// Flags are whole numbers, non-zero meaning on (the label page passes -1 for on). Lengths are
// in the current unit (0 = inches) and turn into pixels at the UserResoX/UserResoY resolution
// in dots per unit. Rotation is in degrees: 0, 90, 180 or 270.
class BarcodeImage {
  public:
    BarcodeImage();
    ~BarcodeImage();
    BarcodeImage(const BarcodeImage&) = delete;
    BarcodeImage& operator=(const BarcodeImage&) = delete;

    void SetUnit(int unit) { settings_.unit = unit; }
    void SetBarType(int code) { settings_.barType = code; }
    void SetData(const QString& text) { settings_.data = text; }
    void SetDimX(float narrowBarWidth) { settings_.dimX = narrowBarWidth; }
    void SetBarHeight(float height) { settings_.barHeight = height; }
    void SetRotation(int degrees) { settings_.rotation = degrees; }
    void SetC39Ascii(int flag) { settings_.c39Ascii = flag != 0; }
    void SetCheckDigit(int flag) { settings_.checkDigit = flag != 0; }
    void SetShowDesc(int flag) { settings_.showDesc = flag != 0; }
    void SetUserResoX(int dotsPerUnit) { settings_.resoX = dotsPerUnit; }
    void SetUserResoY(int dotsPerUnit) { settings_.resoY = dotsPerUnit; }

    // Accepted, and without effect on the bitmaps made here:
    // - zint draws the human-readable text from the encoded data (an EAN's with its check
    //   digit); the label page describes every barcode by its own data.
    void SetDesc(const QString&) {}
    // - zint draws Code 39's wide bars twice and Interleaved 2 of 5's three times as wide as
    //   the narrow ones, with no setting for either; Code 128 and EAN have no wide bars.
    void SetWideBarRatio(float) {}
    // - the bitmap is exactly as large as the symbol, so there is no room to align it in.
    void SetHoriAlign(int) {}
    void SetVertAlign(int) {}
    // - the Code 128 user option has no counterpart in zint: the bar type alone chooses
    //   between automatic subsets and subset B.
    void SetC128User(int) {}
    // - features the label page always turns off: a description stretched to the bars, a
    //   frame, text on several lines, UPC-E.
    void SetMatchDesc(int) {}
    void SetMatchFrame(int) {}
    void SetMultiLine(int) {}
    void SetUPCEUser(int) {}

    // Writes a 1-bit BMP of the current settings to path (its name must end in ".bmp", in any
    // case). On failure returns false, leaves no file under that name and keeps the reason
    // in lastError(); a success clears it.
    bool OutputBitmap(const QString& path);
    // The same symbol as shapes (the resolution does not matter). On failure returns false, with
    // the reason in lastError(), and `out` empty.
    bool OutputVector(BarcodeVector& out);
    const QString& lastError() const { return lastError_; }

    struct Encoding;

  private:
    struct SymbolDeleter {
        void operator()(zint_symbol* symbol) const;
    };

    bool fail(const QString& reason);
    // What zint is to encode for the current settings; the reason when they cannot be encoded.
    QString prepareEncoding(Encoding& encoding) const;
    QString encodeFailure() const;
    // Encodes the current settings and writes the bitmap; the reason when it cannot.
    QString writeBitmap(const QByteArray& fileName);

    BarcodeSettings settings_;
    std::unique_ptr<zint_symbol, SymbolDeleter> symbol_;
    QString lastError_;
};

}  // namespace etq

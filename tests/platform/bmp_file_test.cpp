// Our BMP writer against libzint's own BMP output for the same symbols: the same bytes.
#include "platform/bmp_file.h"

#include <gtest/gtest.h>

#include <QFile>
#include <QTemporaryDir>
#include <cstring>

#include <zint.h>

namespace etq {
namespace {

struct Symbol {
    int symbology;
    const char* data;
    float scale;
    float height;
    bool text;
    int rotation;
};

QByteArray contents(const QString& path) {
    QFile file(path);
    return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
}

TEST(BmpFileTest, SameBytesAsZintsOwnBitmap) {
    const Symbol symbols[] = {
        {BARCODE_EANX, "729000000001", 1, 40, false, 0},
        {BARCODE_EANX, "5512345", 1, 40, true, 0},
        {BARCODE_CODE128, "Etq-42 abc", 1.5f, 20, true, 90},
        {BARCODE_CODE39, "ABC-1", 1, 40, false, 180},
        {BARCODE_C25INTER, "1234567", 2, 10, true, 270},
        {BARCODE_CODE128B, "x", 0.5f, 80, false, 0},
    };
    QTemporaryDir dir;
    int n = 0;
    for (const Symbol& s : symbols) {
        ++n;
        const QByteArray theirs = (dir.path() + QStringLiteral("/z%1.bmp").arg(n)).toLocal8Bit();
        const QByteArray ours = (dir.path() + QStringLiteral("/e%1.bmp").arg(n)).toLocal8Bit();
        zint_symbol* symbol = ZBarcode_Create();
        symbol->symbology = s.symbology;
        symbol->scale = s.scale;
        symbol->height = s.height;
        symbol->show_hrt = s.text ? 1 : 0;
        std::strcpy(symbol->outfile, theirs.constData());
        const auto* data = reinterpret_cast<const unsigned char*>(s.data);
        ASSERT_LT(ZBarcode_Encode(symbol, data, int(std::strlen(s.data))), ZINT_ERROR) << n;
        ASSERT_LT(ZBarcode_Print(symbol, s.rotation), ZINT_ERROR) << n;
        ASSERT_LT(ZBarcode_Buffer(symbol, s.rotation), ZINT_ERROR) << n;
        QString error;
        EXPECT_TRUE(writeMonochromeBmp(ours, symbol->bitmap, symbol->bitmap_width,
                                       symbol->bitmap_height, &error))
            << error.toStdString();
        ZBarcode_Delete(symbol);
        const QByteArray expected = contents(QString::fromLocal8Bit(theirs));
        ASSERT_FALSE(expected.isEmpty()) << n;
        EXPECT_EQ(contents(QString::fromLocal8Bit(ours)), expected) << "symbol " << n;
    }
}

TEST(BmpFileTest, UnwritableFileIsReported) {
    const unsigned char white[3] = {0xff, 0xff, 0xff};
    QString error;
    EXPECT_FALSE(writeMonochromeBmp("/nonexistent-folder/x.bmp", white, 1, 1, &error));
    EXPECT_TRUE(error.contains("/nonexistent-folder/x.bmp")) << error.toStdString();
}

}  // namespace
}  // namespace etq

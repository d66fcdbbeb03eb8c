// Bitmaps are written to disk and read back by a real decoder (zbarimg) and by their BMP header.
#include "platform/barcode_image.h"

#include <gtest/gtest.h>

#include <QFile>
#include <QProcess>
#include <QTemporaryDir>
#include <QtEndian>
#include <cmath>

namespace etq {
namespace {

namespace bt = bar_type;

struct Barcode {
    int barType = bt::Code128;
    QString text;
    bool checkDigit = false;
    bool c39Ascii = false;
    bool showDesc = false;
    float dimX = 0.01f;
    float barHeight = 0.4f;
    int rotation = 0;
    int resoY = 200;
};

// The calls the label page makes for one bitmap, in its order and with its values.
void configure(BarcodeImage& image, const Barcode& b) {
    auto flag = [](bool on) { return on ? -1 : 0; };
    image.SetUnit(0);
    image.SetBarType(b.barType);
    image.SetData(b.text);
    image.SetDesc(b.text);
    image.SetDimX(b.dimX);
    image.SetWideBarRatio(2.2f);
    image.SetBarHeight(b.barHeight);
    image.SetHoriAlign(1);
    image.SetVertAlign(1);
    image.SetRotation(b.rotation);
    image.SetC128User(0);
    image.SetC39Ascii(flag(b.c39Ascii));
    image.SetCheckDigit(flag(b.checkDigit));
    image.SetMatchDesc(0);
    image.SetMatchFrame(0);
    image.SetMultiLine(0);
    image.SetShowDesc(flag(b.showDesc));
    image.SetUPCEUser(0);
    image.SetUserResoX(200);
    image.SetUserResoY(b.resoY);
}

bool write(const Barcode& b, const QString& path, QString* error = nullptr) {
    BarcodeImage image;
    configure(image, b);
    const bool ok = image.OutputBitmap(path);
    if (error) *error = image.lastError();
    return ok;
}

QString decode(const QString& path) {
    QProcess zbar;
    zbar.start("zbarimg", {"-q", "--raw", "-Si25.min-length=4", path});
    zbar.waitForFinished();
    return QString::fromUtf8(zbar.readAllStandardOutput()).trimmed();
}

struct BmpHeader {
    QByteArray magic;
    qint32 width = 0;
    qint32 height = 0;
    quint16 bitsPerPixel = 0;
};

BmpHeader readBmpHeader(const QString& path) {
    QFile file(path);
    if (!file.open(QIODevice::ReadOnly)) return {};
    const QByteArray head = file.read(30);
    if (head.size() < 30) return {};
    const char* p = head.constData();
    return {head.left(2), qFromLittleEndian<qint32>(p + 18), qFromLittleEndian<qint32>(p + 22),
            qFromLittleEndian<quint16>(p + 28)};
}

QByteArray contents(const QString& path) {
    QFile file(path);
    return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
}

class BarcodeImageTest : public ::testing::Test {
  protected:
    QString path(const QString& name) const { return dir.filePath(name); }
    QTemporaryDir dir;
};

TEST_F(BarcodeImageTest, BitmapsDecodeToTheDataOfEveryBarType) {
    const struct {
        Barcode barcode;
        QString decoded;
    } cases[] = {
        {{.barType = bt::Ean13, .text = "590123412345"}, "5901234123457"},
        {{.barType = bt::Ean13, .text = "590123412345", .checkDigit = true, .showDesc = true},
         "5901234123457"},
        {{.barType = bt::Ean13, .text = "5901234123457", .checkDigit = true}, "5901234123457"},
        {{.barType = bt::Ean13, .text = "12345"}, "0000000123457"},
        {{.barType = bt::Ean8, .text = "5512345", .checkDigit = true}, "55123457"},
        {{.barType = bt::Ean8, .text = "55123457"}, "55123457"},
        {{.barType = bt::Code128, .text = "Etq-42 abc"}, "Etq-42 abc"},
        {{.barType = bt::Code128A, .text = "ABC123"}, "ABC123"},
        {{.barType = bt::Code128B, .text = "AB12cd", .showDesc = true}, "AB12cd"},
        {{.barType = bt::Code39, .text = "ABC-1"}, "ABC-1"},
        {{.barType = bt::Code39, .text = "ABC-1", .checkDigit = true}, "ABC-1R"},
        // full ASCII; zbarimg does not expand it
        {{.barType = bt::Code39, .text = "ab", .c39Ascii = true}, "+A+B"},
        {{.barType = bt::Interleaved2of5, .text = "123456"}, "123456"},
        {{.barType = bt::Interleaved2of5, .text = "123456", .checkDigit = true}, "01234565"},
    };
    int n = 0;
    for (const auto& c : cases) {
        const QString file = path(QStringLiteral("B%1.BMP").arg(++n));
        QString error;
        ASSERT_TRUE(write(c.barcode, file, &error))
            << c.barcode.text.toStdString() << error.toStdString();
        EXPECT_TRUE(error.isEmpty());
        EXPECT_EQ(decode(file), c.decoded) << "bar type " << c.barcode.barType;
    }
}

TEST_F(BarcodeImageTest, HebrewLettersTravelAsTheirCodePageBytes) {
    const QString file = path("B0100001.BMP");
    ASSERT_TRUE(write({.barType = bt::Code128, .text = QString::fromUtf8("אב12")}, file));
    // zbarimg drops Code 128's extended-character shift, so the zint program, fed the
    // Windows-1255 bytes of the letters, makes the symbol to compare with.
    const QString expected = path("expected.bmp");
    QProcess zint;
    zint.start("zint", {"--binary", "-b", "20", "--esc", "-d", R"(\xE0\xE112)", "--scale=1",
                        "--height=40", "--notext", "-o", expected});
    ASSERT_TRUE(zint.waitForFinished());
    ASSERT_EQ(zint.exitCode(), 0) << zint.readAllStandardError().toStdString();
    EXPECT_EQ(contents(file), contents(expected));
}

TEST_F(BarcodeImageTest, PixelSizeFollowsNarrowBarAndHeightAt200DotsPerInch) {
    // "ABC123" in Code 128 is 101 modules wide; so is "123456" in subset B, while automatic
    // subsets pack its digits in pairs (68 modules).
    const struct {
        Barcode barcode;
        const char* name;
        qint32 width, height;
    } cases[] = {
        {{.barType = bt::Code128, .text = "ABC123"}, "a.BMP", 202, 80},
        {{.barType = bt::Code128, .text = "ABC123"}, "b.bmp", 202, 80},
        {{.barType = bt::Code128, .text = "ABC123", .dimX = 0.015f}, "c.BMP", 303, 80},
        {{.barType = bt::Code128, .text = "ABC123", .dimX = 0.001f}, "d.BMP", 101, 80},
        {{.barType = bt::Code128, .text = "ABC123", .showDesc = true}, "e.BMP", 202, 96},
        {{.barType = bt::Code128, .text = "ABC123", .resoY = 100}, "f.BMP", 202, 40},
        {{.barType = bt::Code128, .text = "ABC123", .rotation = 90}, "g.BMP", 80, 202},
        {{.barType = bt::Code128B, .text = "123456"}, "h.BMP", 202, 80},
        {{.barType = bt::Code128, .text = "123456"}, "i.BMP", 136, 80},
        {{.barType = bt::Code128A, .text = "123456"}, "j.BMP", 136, 80},
    };
    for (const auto& c : cases) {
        const QString file = path(c.name);
        ASSERT_TRUE(write(c.barcode, file)) << c.name;
        const BmpHeader header = readBmpHeader(file);
        EXPECT_EQ(header.magic, "BM") << c.name;
        EXPECT_EQ(header.bitsPerPixel, 1) << c.name;
        EXPECT_EQ(header.width, c.width) << c.name;
        EXPECT_EQ(header.height, c.height) << c.name;
    }
}

TEST_F(BarcodeImageTest, BadDataOrSettingsFailWithAReasonAndLeaveNoBitmap) {
    const struct {
        Barcode barcode;
        const char* reason;
    } cases[] = {
        {{.barType = bt::Ean13, .text = "12345A789012"}, "digits only"},
        {{.barType = bt::Ean13, .text = "5901234123458"}, "check digit"},
        {{.barType = bt::Ean8, .text = "55123458", .checkDigit = true}, "check digit"},
        {{.barType = bt::Ean13, .text = "59012341234570"}, "at most 13 digits"},
        {{.barType = bt::Ean8, .text = "551234570"}, "at most 8 digits"},
        {{.barType = bt::Interleaved2of5, .text = "12A4"}, "Interleaved 2 of 5"},
        {{.barType = bt::Code39, .text = "AB@"}, "CODE-39"},
        {{.barType = bt::Code39, .text = QString::fromUtf8("aé"), .c39Ascii = true}, "CODE-39"},
        {{.barType = bt::Code128, .text = QString::fromUtf8("中")}, "cannot encode"},
        {{.barType = bt::Code128, .text = ""}, "No data"},
        {{.barType = 99, .text = "123"}, "Unknown barcode type 99"},
        {{.barType = bt::Code128, .text = "A", .dimX = 0.0f}, "Narrow bar"},
        {{.barType = bt::Code128, .text = "A", .dimX = 5.0f}, "Narrow bar"},
        {{.barType = bt::Code128, .text = "A", .barHeight = -0.4f}, "Bar height"},
        {{.barType = bt::Code128, .text = "A", .rotation = 45}, "rotation"},
    };
    const QString file = path("B0100001.BMP");
    for (const auto& c : cases) {
        // A bitmap of an earlier run under the same name must not stand in for the new one.
        ASSERT_TRUE(write({.barType = bt::Code128, .text = "OLD"}, file));
        QString error;
        EXPECT_FALSE(write(c.barcode, file, &error)) << c.reason;
        EXPECT_TRUE(error.contains(c.reason)) << c.reason << " / " << error.toStdString();
        EXPECT_FALSE(QFile::exists(file)) << c.reason;
    }
}

TEST_F(BarcodeImageTest, FileProblemsAreReportedAndOtherFilesLeftAlone) {
    QString error;
    const QString missingFolder = path("no/such/folder/B0100001.BMP");
    EXPECT_FALSE(write({.barType = bt::Code128, .text = "A1"}, missingFolder, &error));
    EXPECT_TRUE(error.contains(missingFolder)) << error.toStdString();

    const QString page = path("etiqon1.htm");  // not a bitmap name: refused and left alone
    QFile pageFile(page);
    ASSERT_TRUE(pageFile.open(QIODevice::WriteOnly) && pageFile.write("<html>") == 6);
    pageFile.close();
    EXPECT_FALSE(write({.barType = bt::Code128, .text = "A1"}, page, &error));
    EXPECT_TRUE(error.contains(".bmp"));
    EXPECT_EQ(contents(page), "<html>");

    const QString longPath = path(QString(300, u'x') + ".BMP");
    EXPECT_FALSE(write({.barType = bt::Code128, .text = "A1"}, longPath, &error));
    EXPECT_TRUE(error.contains("longer than 255 bytes")) << error.toStdString();
}

TEST_F(BarcodeImageTest, OneInstanceForManyBitmapsWritesWhatFreshInstancesWrite) {
    const Barcode run[] = {
        {.barType = bt::Ean13, .text = "590123412345", .checkDigit = true, .showDesc = true},
        {.barType = bt::Code39, .text = "ABC-1", .checkDigit = true},
        {.barType = bt::Ean13, .text = "5901234123458"},  // fails in between
        {.barType = bt::Code128, .text = "Etq-42 abc", .dimX = 0.015f, .barHeight = 0.3f},
        {.barType = bt::Ean8, .text = "5512345"},
        {.barType = bt::Interleaved2of5, .text = "1234567", .checkDigit = true, .rotation = 180},
        {.barType = bt::Code39, .text = "ab", .c39Ascii = true, .showDesc = true},
        {.barType = bt::Code128B, .text = "AB12cd"},
    };
    BarcodeImage shared;
    int n = 0;
    for (const Barcode& b : run) {
        ++n;
        const QString sharedFile = path(QStringLiteral("S%1.BMP").arg(n));
        const QString freshFile = path(QStringLiteral("F%1.BMP").arg(n));
        configure(shared, b);
        const bool sharedOk = shared.OutputBitmap(sharedFile);
        QString freshError;
        EXPECT_EQ(sharedOk, write(b, freshFile, &freshError)) << n;
        EXPECT_EQ(shared.lastError(), freshError) << n;
        EXPECT_EQ(contents(sharedFile), contents(freshFile)) << n;
    }
}

// The same symbols as shapes: a module is DimX inches and the bars BarHeight inches, whatever
// the resolution; the refusals are the bitmap's.
TEST_F(BarcodeImageTest, VectorsAreTheSymbolInMillimetres) {
    const struct {
        Barcode barcode;
        int modules;  // across, with EAN's room for its first digit
        double bars;  // the bars' height, mm
        int texts;
    } cases[] = {
        {{.barType = bt::Ean13, .text = "729000000590", .showDesc = true}, 113, 10.16, 3},
        {{.barType = bt::Code128, .text = "ABC123", .dimX = 0.02f, .barHeight = 0.5f, .resoY = 90},
         101,
         12.7,
         0},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.barcode.text.toStdString());
        BarcodeImage image;
        configure(image, c.barcode);
        BarcodeVector vector;
        ASSERT_TRUE(image.OutputVector(vector)) << image.lastError().toStdString();
        const double module = c.barcode.dimX * 25.4;
        EXPECT_NEAR(vector.size.width(), c.modules * module, 1e-3);
        double tallest = 0;
        for (const QRectF& bar : vector.bars) {
            EXPECT_GE(bar.left(), 0);
            EXPECT_LE(bar.right(), vector.size.width() + 1e-6);
            EXPECT_NEAR(std::fmod(bar.width() / module + 1e-6, 1.0), 0, 1e-3);  // whole modules
            tallest = std::max(tallest, bar.height());
        }
        EXPECT_GE(tallest, c.bars - 1e-3);
        EXPECT_EQ(int(vector.texts.size()), c.texts);
    }

    BarcodeImage image;
    configure(image, {.barType = bt::Ean13, .text = "ABC"});
    BarcodeVector vector;
    EXPECT_FALSE(image.OutputVector(vector));
    EXPECT_EQ(image.lastError(), "EAN-13 takes digits only (data \"ABC\")");
    EXPECT_TRUE(vector.bars.empty());
}

}  // namespace
}  // namespace etq

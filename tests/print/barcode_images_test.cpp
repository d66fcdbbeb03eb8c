// Barcode bitmaps made from the label query of a real working database, decoded back by
// zbarimg.
#include "print/barcode_images.h"

#include <QFileInfo>
#include <QProcess>

#include "platform/barcode_image.h"
#include "print/label_query.h"
#include "print_fixture.h"

namespace etq::print::test {
namespace {

QString decode(const QString& bitmap) {
    QProcess zbar;
    zbar.start("zbarimg", {"-q", "--raw", bitmap});
    if (!zbar.waitForFinished(30000)) return "<zbarimg did not finish>";
    return QString::fromUtf8(zbar.readAllStandardOutput()).trimmed();
}

TEST(BmpNameTest, PadsFieldToTwoAndRecordToFiveDigits) {
    EXPECT_EQ(BmpName(4, 1), "B0400001.BMP");
    EXPECT_EQ(BmpName(7, 12), "B0700012.BMP");
    EXPECT_EQ(BmpName(40, 99999), "B4099999.BMP");
    EXPECT_EQ(BmpName(4, 123456), "B04123456.BMP");  // past five digits the name grows
}

TEST(BarTypeMappingTest, DesignerListToLibraryCodes) {
    const int codes[] = {0, 0, 1, 14, 15, 9, 10, 4};
    for (qint16 i = 0; i < 8; ++i) {
        EXPECT_EQ(mapBarType(i).libraryCode, codes[i]) << i;
        EXPECT_EQ(mapBarType(i).fullAscii, i == 1) << i;
    }
    EXPECT_EQ(mapBarType(42).libraryCode, 42);
}

class BarcodeImagesTest : public PrintTest {
  protected:
    void SetUp() override {
        PrintTest::SetUp();
        folder = dir.path() + "/print";
        QDir().mkpath(folder);
    }
    QString sql() const { return BuildLabelQuery(LabelQueryInput{}); }
    BarcodeRun make(const QString& column, int fldId, qint16 barType) {
        LabelBarDef bar = def.bar;
        bar.BarType = barType;
        return MakeBarcodeImages(folder, column, fldId, workDb(), sql(), bar);
    }
    QString bitmap(int fldId, int record) const { return folder + "/" + BmpName(fldId, record); }
    QString folder;
};

TEST_F(BarcodeImagesTest, Ean13AndCode128DecodeToTheirValues) {
    addItems({{"A-100", "סבון", "7290000000015"}, {"B-200", "מברשת", "7290000000022"}});
    const BarcodeRun ean = make("BarCode", 4, 6);  // EAN-13
    EXPECT_EQ(ean.records, 2);
    EXPECT_EQ(ean.bitmaps, 2);
    EXPECT_EQ(decode(bitmap(4, 1)), "7290000000015");
    EXPECT_EQ(decode(bitmap(4, 2)), "7290000000022");
    const BarcodeRun code128 = make("ItemKey", 0, 2);  // CODE-128
    EXPECT_EQ(code128.bitmaps, 2);
    EXPECT_EQ(decode(bitmap(0, 1)), "A-100");
    EXPECT_EQ(decode(bitmap(0, 2)), "B-200");
    // Subset A cannot be forced: the closest symbol still reads as the key.
    make("ItemKey", 1, 3);
    EXPECT_EQ(decode(bitmap(1, 1)), "A-100");
}

TEST_F(BarcodeImagesTest, ValueWithoutTextUsesUpItsRecordNumber) {
    addItems({{"K1", "a", {}}, {"K2", "b", "7290000000022"}});
    const BarcodeRun run = make("BarCode", 4, 6);
    EXPECT_EQ(run.records, 2);
    EXPECT_EQ(run.bitmaps, 1);
    EXPECT_FALSE(QFileInfo::exists(bitmap(4, 1)));
    EXPECT_EQ(decode(bitmap(4, 2)), "7290000000022");
}

TEST_F(BarcodeImagesTest, CutToLeftLenThenPrefixed) {
    addItems({{"ABCDEF", "a", {}}});
    LabelBarDef bar = def.bar;
    bar.BarType = 2;
    bar.LeftLen = 3;
    bar.LeftPrefix = "X";
    MakeBarcodeImages(folder, "ItemKey", 0, workDb(), sql(), bar);
    EXPECT_EQ(decode(bitmap(0, 1)), "XABC");
}

TEST_F(BarcodeImagesTest, DataTheSymbologyRefusesGivesNoBitmapAndAReason) {
    addItems({{"K1", "a", "72900A0000015"}, {"K2", "b", "7290000000022"}});
    const BarcodeRun run = make("BarCode", 4, 6);
    EXPECT_EQ(run.bitmaps, 1);
    ASSERT_EQ(run.refused.size(), 1);
    EXPECT_TRUE(run.refused[0].startsWith("B0400001.BMP: EAN-13 takes digits only"))
        << run.refused[0].toStdString();
    EXPECT_FALSE(QFileInfo::exists(bitmap(4, 1)));
    EXPECT_TRUE(QFileInfo::exists(bitmap(4, 2)));
}

TEST_F(BarcodeImagesTest, EmptyQueryWritesNothingAndMissingColumnFails) {
    EXPECT_EQ(make("BarCode", 4, 6).records, 0);
    EXPECT_TRUE(QDir(folder).isEmpty());
    addItems({{"K1", "a", "7290000000022"}});
    EXPECT_THROW(make("SerialNum", 8, 6), jet::JetError);  // slot 8 is not in the query
}

TEST(WriteBarcodeBitmapTest, NonPositiveBarWidthsTakeTheirDefaults) {
    QTemporaryDir dir;
    LabelBarDef bar;
    bar.BarType = 1;  // library code for Code 128
    bar.BarHeight = 0.4f;
    BarcodeImage instance;
    ASSERT_TRUE(WriteBarcodeBitmap("HELLO", dir.path() + "/B0000001.BMP", bar, instance))
        << instance.lastError().toStdString();
    EXPECT_FLOAT_EQ(bar.DimX, 0.01f);
    EXPECT_FLOAT_EQ(bar.WideBarRatio, 2.2f);
    EXPECT_EQ(decode(dir.path() + "/B0000001.BMP"), "HELLO");
}

}  // namespace
}  // namespace etq::print::test

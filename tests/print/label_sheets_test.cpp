// gLabels' catalogue of label sheet products: lengths in their units, parts sold under another
// part's geometry, the order labels fill a sheet, and the products glabels-data installs.
#include "print/label_sheets.h"

#include <gtest/gtest.h>

#include <QDir>
#include <QFile>
#include <QTemporaryDir>

#include "support/qt_print.h"

namespace etq::print::test {
namespace {

constexpr double kPt = 25.4 / 72;

TEST(SheetLengthTest, EveryUnitOfTheCatalogueBecomesMillimetres) {
    const struct {
        const char* text;
        std::optional<double> mm;
    } cases[] = {
        {"21.2", 21.2 * kPt}, {"9pt", 9 * kPt},       {"5mm", 5},
        {"0.5in", 12.7},      {"1.5cm", 15},          {"2pc", 24 * kPt},
        {" 3 mm ", 3},        {"wide", std::nullopt}, {"", std::nullopt},
    };
    for (const auto& c : cases) {
        const std::optional<double> mm = sheetLength(QString(c.text));
        ASSERT_EQ(mm.has_value(), c.mm.has_value()) << c.text;
        if (mm) {
            EXPECT_NEAR(*mm, *c.mm, 1e-9) << c.text;
        }
    }
}

void write(const QString& path, const QByteArray& text) {
    QFile file(path);
    ASSERT_TRUE(file.open(QIODevice::WriteOnly));
    file.write(text);
}

TEST(SheetCatalogueTest, ProductsOfAFolderWithTheirEquivalentsInTheOrderLabelsFill) {
    QTemporaryDir dir;
    write(
        dir.filePath("paper-sizes.xml"),
        R"(<Glabels-paper-sizes><Paper-size id="A4" _name="A4" pwg_size="iso_a4" width="210mm" height="297mm"/></Glabels-paper-sizes>)");
    write(dir.filePath("test-templates.xml"), R"(<?xml version="1.0"?>
<Glabels-templates xmlns="http://glabels.org/xmlns/3.0/">
  <Template brand="Test" part="R2" size="A4" _description="Two by two">
    <Meta category="label"/>
    <Label-rectangle id="0" width="90mm" height="1.5in" round="2mm">
      <Markup-margin size="1mm"/>
      <Layout nx="2" ny="2" x0="10mm" y0="20mm" dx="100mm" dy="50mm"/>
    </Label-rectangle>
  </Template>
  <Template brand="Test" part="R2-B" equiv="R2"/>
  <Template brand="Test" part="Dots" size="Other" width="100mm" height="50mm">
    <Label-round id="0" radius="10mm">
      <Layout nx="1" ny="1" x0="5mm" y0="5mm" dx="0" dy="0"/>
      <Layout nx="1" ny="1" x0="60mm" y0="5mm" dx="0" dy="0"/>
    </Label-round>
  </Template>
  <Template brand="Test" part="NoPaper"><Label-rectangle id="0" width="1in" height="1in"><Layout nx="1" ny="1" x0="0" y0="0" dx="0" dy="0"/></Label-rectangle></Template>
  <Template brand="Test" part="Lost" equiv="Nowhere"/>
</Glabels-templates>)");
    write(dir.filePath("broken-templates.xml"), "<Glabels-templates><Template brand=");

    const SheetCatalogue catalogue(dir.path());
    ASSERT_EQ(catalogue.sheets().size(), 3u);
    const LabelSheet* r2 = catalogue.find("test", "r2");
    ASSERT_NE(r2, nullptr);
    EXPECT_EQ(r2->description, "Two by two");
    EXPECT_EQ(r2->paperName, "A4");
    EXPECT_EQ(r2->paper, QSizeF(210, 297));
    EXPECT_EQ(r2->shape, LabelSheet::Shape::Rectangle);
    EXPECT_DOUBLE_EQ(r2->corner, 2);
    EXPECT_DOUBLE_EQ(r2->label.width(), 90);
    EXPECT_DOUBLE_EQ(r2->label.height(), 38.1);
    // Rows from the top, each from the right, as the page fills its grid.
    EXPECT_EQ(r2->positions, (std::vector<QPointF>{{110, 20}, {10, 20}, {110, 70}, {10, 70}}));
    EXPECT_EQ(r2->columns, 2);
    EXPECT_EQ(r2->rows, 2);

    const LabelSheet* sold = catalogue.find("Test", "R2-B");
    ASSERT_NE(sold, nullptr);
    EXPECT_EQ(sold->name(), "Test R2-B");
    EXPECT_EQ(sold->positions, r2->positions);
    EXPECT_EQ(sold->description, "Two by two");

    const LabelSheet* dots = catalogue.find("Test", "Dots");
    ASSERT_NE(dots, nullptr);
    EXPECT_EQ(dots->paper, QSizeF(100, 50));
    EXPECT_EQ(dots->paperName, "");
    EXPECT_EQ(dots->shape, LabelSheet::Shape::Round);
    EXPECT_EQ(dots->label, QSizeF(20, 20));
    EXPECT_EQ(dots->positions, (std::vector<QPointF>{{60, 5}, {5, 5}}));
    EXPECT_EQ(dots->columns, 2);
    EXPECT_EQ(dots->rows, 1);

    QStringList found;
    for (const LabelSheet* sheet : catalogue.search("  test r2 "))
        found << sheet->name();
    EXPECT_EQ(found, QStringList({"Test R2", "Test R2-B"}));
    EXPECT_EQ(catalogue.search("").size(), 3u);
}

// glabels-data's Avery 7160: 181.4 x 108 points, 3 x 7 from 21.2, 43.9 points, 187.2 and 108
// points apart; L7160 is sold with its geometry.
TEST(SheetCatalogueTest, TheInstalledCatalogueHasItsMakersProducts) {
    const SheetCatalogue& installed = SheetCatalogue::installed();
    EXPECT_GT(installed.sheets().size(), 1000u) << SheetCatalogue::installedFolder().toStdString();
    const LabelSheet* sheet = installed.find("Avery", "L7160");
    ASSERT_NE(sheet, nullptr);
    EXPECT_EQ(sheet->paperName, "A4");
    EXPECT_EQ(sheet->columns, 3);
    EXPECT_EQ(sheet->rows, 7);
    EXPECT_NEAR(sheet->label.width(), 181.4 * kPt, 1e-9);
    EXPECT_NEAR(sheet->label.height(), 108 * kPt, 1e-9);
    ASSERT_EQ(sheet->positions.size(), 21u);
    EXPECT_NEAR(sheet->positions[0].x(), (21.2 + 2 * 187.2) * kPt, 1e-9);
    EXPECT_NEAR(sheet->positions[0].y(), 43.9 * kPt, 1e-9);
    EXPECT_NEAR(sheet->positions[20].x(), 21.2 * kPt, 1e-9);
    EXPECT_NEAR(sheet->positions[20].y(), (43.9 + 6 * 108) * kPt, 1e-9);
}

}  // namespace
}  // namespace etq::print::test

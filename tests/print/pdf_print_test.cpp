// The demo's labels as a PDF drawn without a browser, checked with independent tools: pdfinfo
// for the page, pdftoppm to render it, zbarimg to read every label's barcode, pdftotext for the
// Hebrew names, and the rendered outlines measured against the label sheet product's positions.
#include <gtest/gtest.h>

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QProcess>
#include <QRectF>
#include <QRegularExpression>
#include <QTemporaryDir>
#include <cmath>

#include "jet/database.h"
#include "jet/recordset.h"
#include "support/process_run.h"
#include "support/qt_print.h"
#include "support/test_env.h"

#include "demo_fixture.h"

namespace etq::print::test {
namespace {

using etq::test::ProcessResult;
using etq::test::runProcess;

constexpr double kPt = 25.4 / 72;

// A page rendered by pdftoppm as an 8-bit grey image.
struct Render {
    int width = 0;
    int height = 0;
    int dpi = 0;
    QByteArray pixels;

    bool dark(int x, int y) const { return quint8(pixels[qsizetype(y) * width + x]) < 128; }
    double mm(double pixel) const { return pixel * 25.4 / dpi; }

    // The part of the page inside `area` (mm) as a PGM file zbarimg reads.
    QString crop(const QRectF& area, const QString& file) const {
        const int x0 = int(area.left() / 25.4 * dpi), y0 = int(area.top() / 25.4 * dpi);
        const int w = int(area.width() / 25.4 * dpi), h = int(area.height() / 25.4 * dpi);
        QByteArray out = QStringLiteral("P5\n%1 %2\n255\n").arg(w).arg(h).toLatin1();
        for (int y = y0; y < y0 + h; ++y)
            out += pixels.mid(qsizetype(y) * width + x0, w);
        QFile f(file);
        if (!f.open(QIODevice::WriteOnly) || f.write(out) != out.size()) return {};
        return file;
    }

    // The centres (mm) of the lines that run across (rows) or down (columns) more than
    // `share` of the page: the labels' outlines.
    std::vector<double> lines(bool rows, double share) const {
        const int count = rows ? height : width, length = rows ? width : height;
        std::vector<double> centres;
        int first = -1;
        for (int i = 0; i <= count; ++i) {
            int dark = 0;
            for (int j = 0; i < count && j < length; ++j)
                dark += rows ? this->dark(j, i) : this->dark(i, j);
            const bool line = dark > share * length;
            if (line && first < 0) first = i;
            if (!line && first >= 0) {
                centres.push_back(mm((first + i) / 2.0));
                first = -1;
            }
        }
        return centres;
    }
};

Render render(const QString& pdf, int page, int dpi, const QString& prefix) {
    const ProcessResult r =
        runProcess("pdftoppm", {"-f", QString::number(page), "-l", QString::number(page), "-r",
                                QString::number(dpi), "-gray", "-singlefile", pdf, prefix});
    Render out;
    out.dpi = dpi;
    QFile file(prefix + ".pgm");
    if (r.exitCode != 0 || !file.open(QIODevice::ReadOnly)) {
        ADD_FAILURE() << "pdftoppm: " << r.err.toStdString();
        return out;
    }
    // "P5\n<w> <h>\n255\n" and the pixels.
    const QList<QByteArray> head = file.read(64).split('\n');
    const QList<QByteArray> size = head.value(1).split(' ');
    out.width = size.value(0).toInt();
    out.height = size.value(1).toInt();
    file.seek(head[0].size() + head[1].size() + head[2].size() + 3);
    out.pixels = file.readAll();
    EXPECT_EQ(out.pixels.size(), qsizetype(out.width) * out.height);
    return out;
}

// "Page size:  595.276 x 841.89 pts (A4)" and "Pages: 1".
struct PdfInfo {
    double width = 0;
    double height = 0;
    int pages = 0;
};
PdfInfo pdfInfo(const QString& pdf) {
    const ProcessResult r = runProcess("pdfinfo", {pdf});
    PdfInfo info;
    const QRegularExpressionMatch size =
        QRegularExpression(R"(Page size:\s+([\d.]+) x ([\d.]+) pts)").match(r.out);
    info.width = size.captured(1).toDouble();
    info.height = size.captured(2).toDouble();
    info.pages = QRegularExpression(R"(Pages:\s+(\d+))").match(r.out).captured(1).toInt();
    return info;
}

class PdfPrintTest : public DemoTest {
  protected:
    void SetUp() override {
        DemoTest::SetUp();
        const ProcessResult demo = runDemo();
        ASSERT_EQ(demo.exitCode, 0) << demo.err.toStdString();
        const QStringList barcode = marked("BarCode"), name = marked("ItemName");
        const QStringList copies = marked("Copies");
        for (qsizetype item = 0; item < barcode.size(); ++item)
            for (int copy = 0; copy < copies[item].toInt(); ++copy) {
                barcodes << barcode[item];
                names << name[item];
            }
    }
    ProcessResult printPdf(const QStringList& args) {
        return cli(QStringList{"print-items", "--db", work.path() + "/db"} + args);
    }
    // Each label's barcode as zbarimg reads it from its own part of the page.
    QStringList readLabels(const Render& page, const std::vector<QRectF>& labels) {
        QStringList read;
        for (size_t i = 0; i < labels.size(); ++i)
            read << decode(page.crop(labels[i], work.filePath(QString("label%1.pgm").arg(i))));
        return read;
    }

    QStringList barcodes;  // label by label, in item order, each copy
    QStringList names;
};

// 12 items with 2 copies each on the demo's grid of 4 x 6 on A4: one exact A4 page, the labels
// filled from the top right, every barcode readable, every name there as text.
TEST_F(PdfPrintTest, TheDemosLabelsOnTheGridOfAnA4Page) {
    ASSERT_EQ(barcodes.size(), 24);
    const QString pdf = work.filePath("labels.pdf");
    const ProcessResult r = printPdf({"--output", pdf});
    ASSERT_EQ(r.exitCode, 0) << r.err.toStdString();
    EXPECT_EQ(lastLine(r.out), pdf);
    EXPECT_TRUE(r.out.contains("24 labels on 1 page"));

    const PdfInfo info = pdfInfo(pdf);
    EXPECT_NEAR(info.width, 210 / kPt, 0.001);
    EXPECT_NEAR(info.height, 297 / kPt, 0.001);
    EXPECT_EQ(info.pages, 1);

    std::vector<QRectF> labels;
    for (int p = 0; p < 24; ++p)
        labels.emplace_back((3 - p % 4) * 52.5, (p / 4) * 49.5, 52.5, 49.5);
    EXPECT_EQ(readLabels(render(pdf, 1, 300, work.filePath("grid")), labels), barcodes);

    // Qt places every glyph of its own, and pdftotext guesses the gaps between words of right
    // to left text from their places: the names are compared without blanks (nor the
    // direction marks pdftotext adds).
    const QRegularExpression layout(QStringLiteral("[\\s\u200e\u200f\u202a-\u202e\u2066-\u2069]"));
    const QString text = runProcess("pdftotext", {pdf, "-"}).out.remove(layout);
    for (QString name : names)
        EXPECT_GE(text.count(name.remove(layout)), 2) << name.toStdString();
}

// With a label sheet product chosen, every label lies where the product has it: Avery L7160 (as
// 7160: labels of 181.4 x 108 points, 3 across from 21.2 points and 187.2 apart, 7 down from
// 43.9 points and 108 apart). Its outlines, measured on the page at 600 dots per inch, are
// within 0.2 mm of those positions; 24 labels take one sheet of 21 and 3 of the next.
TEST_F(PdfPrintTest, LabelsLieWhereTheSheetProductHasThem) {
    ASSERT_EQ(cli({"config", "set", "DirectLabel", "SheetBrand", "Avery"}).exitCode, 0);
    ASSERT_EQ(cli({"config", "set", "DirectLabel", "SheetPart", "L7160"}).exitCode, 0);
    const QString pdf = work.filePath("sheet.pdf");
    const ProcessResult r = printPdf({"--output", pdf, "--outlines"});
    ASSERT_EQ(r.exitCode, 0) << r.err.toStdString();
    EXPECT_TRUE(r.out.contains("24 labels on 2 pages"));
    const PdfInfo info = pdfInfo(pdf);
    EXPECT_NEAR(info.width, 210 / kPt, 0.001);
    EXPECT_NEAR(info.height, 297 / kPt, 0.001);
    EXPECT_EQ(info.pages, 2);

    std::vector<double> across, down;
    std::vector<QRectF> labels;
    for (int row = 0; row < 7; ++row) {
        down.push_back((43.9 + row * 108) * kPt);
        for (int column = 2; column >= 0; --column)
            labels.emplace_back((21.2 + column * 187.2) * kPt, (43.9 + row * 108) * kPt,
                                181.4 * kPt, 108 * kPt);
    }
    down.push_back((43.9 + 7 * 108) * kPt);
    for (int column = 0; column < 3; ++column) {
        across.push_back((21.2 + column * 187.2) * kPt);
        across.push_back((21.2 + column * 187.2 + 181.4) * kPt);
    }

    const Render first = render(pdf, 1, 600, work.filePath("sheet1"));
    const struct {
        const char* what;
        std::vector<double> measured;
        const std::vector<double>& expected;
    } edges[] = {{"across", first.lines(false, 0.6), across},
                 {"down", first.lines(true, 0.6), down}};
    for (const auto& e : edges) {
        ASSERT_EQ(e.measured.size(), e.expected.size()) << e.what;
        for (size_t i = 0; i < e.expected.size(); ++i)
            EXPECT_NEAR(e.measured[i], e.expected[i], 0.2) << e.what << " " << i;
    }

    EXPECT_EQ(readLabels(first, labels), barcodes.mid(0, 21));
    const QStringList second = readLabels(render(pdf, 2, 300, work.filePath("sheet2")), labels);
    EXPECT_EQ(second.mid(0, 3), barcodes.mid(21));
    EXPECT_EQ(second.mid(3), QStringList(18, QString()));
}

// --printer sends the PDF with lp to that printer, on its paper (a stand-in CUPS with A5 as its
// default); --output and --printer together send the file written; direct print chosen in the
// settings sends it without either; an option without its value is refused.
TEST_F(PdfPrintTest, ThePrinterOptionSendsThePdfWithLp) {
    QTemporaryDir cups;
    auto script = [&](const QString& name, const QByteArray& body) {
        QFile file(cups.filePath(name));
        ASSERT_TRUE(file.open(QIODevice::WriteOnly));
        file.write("#!/bin/sh\n" + body);
        file.close();
        file.setPermissions(file.permissions() | QFile::ExeOwner);
    };
    script("lpoptions", "[ \"$3\" = \"-l\" ] && echo 'PageSize/Media Size: Letter *A5'\nexit 0\n");
    script("lp",
           "echo \"$*\" >> \"$(dirname \"$0\")/log\"\n"
           "for last; do :; done\ncp \"$last\" \"$(dirname \"$0\")/sent.pdf\"\n");
    env.insert("PATH", cups.path() + ":" + env.value("PATH"));

    ProcessResult r = printPdf({"--printer", "Zebra_GK420"});
    ASSERT_EQ(r.exitCode, 0) << r.err.toStdString();
    EXPECT_TRUE(lastLine(r.out).endsWith("/etiqon1.pdf")) << r.out.toStdString();
    EXPECT_TRUE(r.out.contains("24 labels on 1 page sent to the printer"));
    const PdfInfo a5 = pdfInfo(cups.filePath("sent.pdf"));
    EXPECT_NEAR(a5.width, 148 / kPt, 0.001);
    EXPECT_NEAR(a5.height, 210 / kPt, 0.001);

    const QString pdf = work.filePath("both.pdf");
    ASSERT_EQ(printPdf({"--output", pdf, "--printer", "Zebra_GK420"}).exitCode, 0);
    QFile log(cups.filePath("log"));
    ASSERT_TRUE(log.open(QIODevice::ReadOnly));
    const QStringList calls = QString::fromUtf8(log.readAll()).trimmed().split('\n');
    ASSERT_EQ(calls.size(), 2);
    EXPECT_EQ(calls[0], "-d Zebra_GK420 -- " + lastLine(r.out));
    EXPECT_EQ(calls[1], "-d Zebra_GK420 -- " + pdf);

    // Direct print chosen in the settings, no printer chosen: the default printer prints.
    ASSERT_EQ(cli({"config", "set", "GeneralParams", "PrintMode", "1"}).exitCode, 0);
    r = printPdf({});
    ASSERT_EQ(r.exitCode, 0) << r.err.toStdString();
    log.seek(0);
    EXPECT_EQ(QString::fromUtf8(log.readAll()).trimmed().split('\n').value(2),
              "-- " + lastLine(r.out));

    EXPECT_EQ(printPdf({"--output"}).exitCode, 2);
    EXPECT_EQ(printPdf({"--printer="}).exitCode, 2);
}

}  // namespace
}  // namespace etq::print::test

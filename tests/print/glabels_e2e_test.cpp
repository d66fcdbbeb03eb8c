// The gLabels route end to end: glabels-3-batch makes the PDF, a stand-in lp records what would
// be printed, and independent tools read the labels back (pdftoppm and zbarimg for each label's
// barcode, pdftotext for the names).
#include <QDir>
#include <QFile>
#include <QRegularExpression>

#include "platform/progress.h"
#include "print/label_software.h"
#include "print/print_engine.h"
#include "print_fixture.h"
#include "support/process_run.h"

namespace etq::print::test {
namespace {

using etq::test::ProcessResult;
using etq::test::runProcess;

const QString kDemoDesign = QStringLiteral(ETIQUON_SOURCE_DIR "/samples/labels/demo-items.glabels");

// The demo design's sheet: A4, 4 x 6 labels of 52.5 x 49.5 mm, filled row by row from the left.
constexpr int kColumns = 4, kRows = 6;
constexpr double kLabelWidthMm = 52.5, kLabelHeightMm = 49.5;
constexpr int kDpi = 150;

// "729" and nine digits of n, with the check digit.
QString ean13(int n) {
    const QString digits = QString("729%1").arg(n, 9, 10, QLatin1Char('0'));
    int sum = 0;
    for (int i = 0; i < 12; ++i)
        sum += digits[i].digitValue() * (i % 2 ? 3 : 1);
    return digits + QString::number((10 - sum % 10) % 10);
}

// The barcode of every label of every page, in print order, up to the first position of a page
// that has none (gLabels fills the positions in order). Each position is cut out and decoded
// alone: zbarimg reports equal symbols of one image once.
QStringList labelBarcodes(const QString& pdf, const QString& scratch) {
    const ProcessResult info = runProcess("pdfinfo", {pdf});
    const int pages = QRegularExpression("Pages:\\s+(\\d+)").match(info.out).captured(1).toInt();
    QStringList out;
    const double mm = kDpi / 25.4;
    for (int page = 1; page <= pages; ++page) {
        for (int cell = 0; cell < kColumns * kRows; ++cell) {
            const QString image = scratch + QString("/cell-%1-%2").arg(page).arg(cell);
            runProcess(
                "pdftoppm",
                {"-r", QString::number(kDpi), "-f", QString::number(page), "-l",
                 QString::number(page), "-x",
                 QString::number(qRound(cell % kColumns * kLabelWidthMm * mm)), "-y",
                 QString::number(qRound(cell / kColumns * kLabelHeightMm * mm)), "-W",
                 QString::number(int(kLabelWidthMm * mm)), "-H",
                 QString::number(int(kLabelHeightMm * mm)), "-png", "-singlefile", pdf, image});
            const QString barcode =
                runProcess("zbarimg", {"-q", "--raw", image + ".png"}).out.trimmed();
            if (barcode.isEmpty()) break;
            out << barcode;
        }
    }
    return out;
}

// The PDF's text with blanks and direction marks taken out: pdftotext spaces out some Hebrew
// letters and wraps runs in embedding marks.
QString plainText(const QString& pdf) {
    QString text = runProcess("pdftotext", {pdf, "-"}).out;
    return text.remove(QRegularExpression("[\\s\\x{200e}\\x{200f}\\x{202a}-\\x{202e}]"));
}

// A stand-in lp first on PATH: it writes its arguments, one run a line, or fails as told.
class StandInLp {
  public:
    StandInLp() : path_(qgetenv("PATH")) {
        qputenv("PATH", (dir_.path() + ":").toLocal8Bit() + path_);
        program("echo \"$@\" >> \"$(dirname \"$0\")/log\"\n");
    }
    ~StandInLp() { qputenv("PATH", path_); }
    void program(const QByteArray& script) {
        QFile file(dir_.filePath("lp"));
        EXPECT_TRUE(file.open(QIODevice::WriteOnly));
        file.write("#!/bin/sh\n" + script);
        file.close();
        file.setPermissions(file.permissions() | QFile::ExeOwner);
    }
    QStringList runs() const {
        QFile log(dir_.filePath("log"));
        if (!log.open(QIODevice::ReadOnly)) return {};
        return QString::fromUtf8(log.readAll()).split('\n', Qt::SkipEmptyParts);
    }
    QString folder() const { return dir_.path(); }

  private:
    QTemporaryDir dir_;
    QByteArray path_;
};

// etiquon-cli print-items with gLabels chosen, on three marked items with Hebrew names and
// EAN-13 barcodes (2, 3 and 1 copies) and one item not marked.
class GLabelsCliTest : public ::testing::Test {
  protected:
    void SetUp() override {
        ASSERT_EQ(cli({"init-db", "--db", db()}).exitCode, 0);
        jet::Database items = jet::Database::open(db() + "/etqnitm.kdb");
        jet::Recordset rs = items.openRecordset("tItems");
        const struct {
            const char* key;
            const char* name;
            int copies;
            bool marked;
        } kItems[] = {{"A1", "סבון ריחני", 2, true},
                      {"B2", "מברשת שיניים", 3, true},
                      {"C3", "משחה", 1, true},
                      {"D4", "מגבת", 4, false}};
        int n = 100;
        for (const auto& item : kItems) {
            rs.addNew();
            rs.setValue("ItemKey", item.key);
            rs.setValue("ItemName", QString::fromUtf8(item.name));
            rs.setValue("BarCode", ean13(++n));
            rs.setValue("Coin", QStringLiteral("¦"));
            rs.setValue("Price", 4.5);
            rs.setValue("Copies", item.copies);
            rs.setValue("PrintLabel", item.marked);
            rs.update();
        }
        for (const char* kv :
             {"GeneralParams OptOLE3 False", "GeneralParams OptOLE5 True",
              "GeneralParams OptPrinter0 True", "GeneralParams OptPrinter1 False",
              "GeneralParams DefPrinter -1", "LabelVars FldSend01 1", "LabelVars FldSend04 1",
              "LabelVars FldSend06 1", "LabelVars FldSend07 1"})
            ASSERT_EQ(cli(QStringList{"config", "set"} + QString(kv).split(' ')).exitCode, 0);
        ASSERT_EQ(cli({"config", "set", "GeneralParams", "LabelName", kDemoDesign}).exitCode, 0);
    }
    QString db() const { return dir.path() + "/db"; }
    static ProcessResult cli(const QStringList& args) {
        return runProcess(ETIQUON_CLI, QStringList{"--setting-id", "13"} + args);
    }
    QTemporaryDir dir;
    StandInLp lp;
};

TEST_F(GLabelsCliTest, OutputFileHoldsEveryCopyWithItsBarcodeAndName) {
    const QString pdf = dir.path() + "/labels.pdf";
    const ProcessResult r = cli({"print-items", "--db", db(), "--output", pdf});
    ASSERT_EQ(r.exitCode, 0) << r.err.toStdString();
    EXPECT_EQ(r.out.trimmed().split('\n').last(), pdf);
    EXPECT_TRUE(lp.runs().isEmpty());  // kept, not printed

    EXPECT_EQ(labelBarcodes(pdf, dir.path()), (QStringList{ean13(101), ean13(101), ean13(102),
                                                           ean13(102), ean13(102), ean13(103)}));
    const QString text = plainText(pdf);
    const struct {
        const char* name;
        int labels;
    } names[] = {{"סבוןריחני", 2}, {"מברשתשיניים", 3}, {"משחה", 1}, {"מגבת", 0}};
    for (const auto& n : names)
        EXPECT_EQ(text.count(QString::fromUtf8(n.name)), n.labels) << n.name;
}

// Printing: the PDF goes to the printer named on the command line, or to lp's default; it stays
// in the run's private print folder. A printer CUPS refuses ends the run with the engine's
// message.
TEST_F(GLabelsCliTest, LabelsGoToThePrinterAndStayInThePrintFolder) {
    ProcessResult r = cli({"print-items", "--db", db(), "--printer", "Office_HP"});
    ASSERT_EQ(r.exitCode, 0) << r.err.toStdString();
    const QString kept = r.out.trimmed().split('\n').last();
    EXPECT_TRUE(QFileInfo(kept).isFile());
    EXPECT_TRUE(kept.contains("/etiquon/etiqon/run-")) << kept.toStdString();
    r = cli({"print-items", "--db", db()});
    ASSERT_EQ(r.exitCode, 0) << r.err.toStdString();
    EXPECT_EQ(lp.runs(), (QStringList{"-d Office_HP -- " + kept, "-- " + r.out.trimmed()}));

    lp.program("echo 'lp: Error - No default destination.' >&2\nexit 1\n");
    r = cli({"print-items", "--db", db()});
    EXPECT_EQ(r.exitCode, 1);
    EXPECT_TRUE(r.err.contains(
        "lp: lp: Error - No default destination. In Line 10, LabelID = 0, Var = CoinSign, Value = ₪"))
        << r.err.toStdString();
}

// The engine on document lines through gLabels: one head label before each document's lines,
// each design's labels printed when the design closes.
class GLabelsRouteTest : public PrintTest {
  protected:
    void SetUp() override {
        PrintTest::SetUp();
        addItems({{"A1", "סבון", ean13(7), 3.5, 1}});
        QFile sample(kDemoDesign);
        ASSERT_TRUE(sample.open(QIODevice::ReadOnly));
        design = sample.readAll();
        // The document number on the label too.
        design.replace(R"(<Field name="CoinSign"/>)",
                       R"(<Field name="CoinSign"/> <Field name="Reference1"/>)");
    }
    QString writeDesign(const QString& name, const QByteArray& text) {
        QFile file(dir.filePath(name));
        EXPECT_TRUE(file.open(QIODevice::WriteOnly));
        file.write(text);
        return file.fileName();
    }
    LabelSoftwareOptions options() {
        LabelSoftwareOptions o;
        o.workDatabase = workDb();
        o.kind = kGLabels;
        o.labelFile = writeDesign("lines.glabels", design);
        o.headLabelFile = writeDesign("head.glabels", design);
        o.query.queryType = DocumentLineLabels;
        for (int slot : {1, 4, 6, 7, 10})
            o.query.fieldChecks[size_t(slot)] = true;
        return o;
    }
    void addDocuments() {
        jet::Database work = jet::Database::open(workDb());
        work.execute(
            "INSERT INTO tTempDocHeaders (WizFileID, Number, Reference1, Include) VALUES (1, 10, 5001, True), (1, 11, 5002, True)");
        work.execute(
            "INSERT INTO tTempDocLines (WizFileID, HeadNumber, LineNum, ItemKey, Copies, Include) VALUES (1, 10, 1, 'A1', 1, True), (1, 10, 2, 'A1', 1, True), (1, 10, 3, 'A1', 1, True), (1, 11, 1, 'A1', 1, True), (1, 11, 2, 'A1', 1, True)");
    }
    QString failureOf(const LabelSoftwareOptions& o) {
        try {
            printWithLabelSoftware(o, context, progress, pacing);
            return {};
        } catch (const Failure& e) {
            return e.description();
        }
    }
    QByteArray design;
    StandInLp lp;
    NoProgress progress;
    SystemPacing pacing;
};

TEST_F(GLabelsRouteTest, HeadLabelsPrintBeforeEachDocumentsLines) {
    addDocuments();
    LabelSoftwareOptions o = options();
    o.headLabels = true;
    o.printer = "Zebra";
    ASSERT_EQ(failureOf(o), "");
    const QStringList runs = lp.runs();
    ASSERT_EQ(runs.size(), 4);
    const struct {
        const char* reference;
        int labels;
    } expected[] = {{"5001", 1}, {"5001", 3}, {"5002", 1}, {"5002", 2}};
    for (int i = 0; i < 4; ++i) {
        SCOPED_TRACE(i);
        ASSERT_TRUE(runs[i].startsWith("-d Zebra -- /"));
        const QString pdf = runs[i].mid(QString("-d Zebra -- ").size());
        EXPECT_EQ(plainText(pdf).count(expected[i].reference), expected[i].labels);
        EXPECT_EQ(labelBarcodes(pdf, dir.path()).size(), expected[i].labels);
    }
}

// What would print labels short of a value, or cannot print at all, ends the run with the
// engine's message, and nothing goes to the printer.
TEST_F(GLabelsRouteTest, WhatWouldPrintShortEndsTheRun) {
    addDocuments();
    const QString lines = writeDesign("lines.glabels", design);
    QByteArray unmerged = design;
    unmerged.replace(R"(<Merge type="Text/Comma/Line1Keys" src="items.csv"/>)", "");
    const QString noMerge = writeDesign("nomerge.glabels", unmerged);
    const struct {
        const char* name;
        QString labelFile;
        int slotOn, slotOff;
        QString message;
    } cases[] = {
        {"a field the design lacks", lines, 0, -1,
         "The label design " + lines +
             " has no merge field \"ItemKey\" In Line 7, LabelID = 0, Var = ItemKey, Value = A1"},
        {"a merge field left without value", lines, -1, 10,
         "The label design " + lines +
             " merges the field \"Reference1\", which was given no value: check that field on the label data tab In Line 8, LabelID = 0, Var = CoinSign, Value = ₪"},
        {"no merge source", noMerge, -1, -1,
         "The label design " + noMerge +
             " has no merge source: give it a text merge source with the field names on its first line (Text/Comma/Line1Keys) In Line 5, LabelID = 0, Var = , Value = "},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        LabelSoftwareOptions o = options();
        o.labelFile = c.labelFile;
        if (c.slotOn >= 0) o.query.fieldChecks[size_t(c.slotOn)] = true;
        if (c.slotOff >= 0) o.query.fieldChecks[size_t(c.slotOff)] = false;
        EXPECT_EQ(failureOf(o), c.message);
    }
    qputenv("PATH", lp.folder().toLocal8Bit());  // lp, and no glabels-3-batch
    EXPECT_EQ(
        failureOf(options()),
        "gLabels is not available here: glabels-3-batch is not installed (Debian package glabels) In Line 2, LabelID = 0, Var = , Value = ");
    EXPECT_TRUE(lp.runs().isEmpty());
}

}  // namespace
}  // namespace etq::print::test

// The built-in labels of 10,000 marked items as a PDF drawn here, against the browser's way to
// the same paper: the HTML route (query, bitmaps, page) followed by headless Chromium printing
// that page to PDF, in the same run. The labels are the demo's: the name in bold, an EAN-13
// barcode with its digits and the price, 4 x 6 on A4. Prints figures; passes or fails nothing.
//   label_pdf_bench [LABELS] [--disk]
#include <QDir>
#include <QElapsedTimer>
#include <QFile>
#include <QFileInfo>
#include <QGuiApplication>
#include <QProcess>
#include <QTemporaryDir>
#include <QTextStream>
#include <memory>

#include "platform/progress.h"
#include "print/label_definition.h"
#include "print/label_page.h"
#include "print/label_pdf.h"

#include "bench_labels.h"

using namespace etq;

namespace {

// Headless Chromium's print of the page to PDF, with a profile of its own; seconds, or -1.
double chromiumSeconds(const QString& page, const QString& pdf, const QString& profile) {
    QProcess chromium;
    QElapsedTimer timer;
    timer.start();
    chromium.start(QStringLiteral("chromium"),
                   {"--headless", "--no-sandbox", "--disable-gpu", "--disable-quic",
                    "--no-first-run", "--disable-background-networking",
                    "--disable-component-update", "--disable-sync", "--no-pdf-header-footer",
                    "--user-data-dir=" + profile, "--print-to-pdf=" + pdf, "file://" + page});
    if (!chromium.waitForFinished(-1) || chromium.exitCode() != 0 || !QFileInfo::exists(pdf)) {
        QTextStream(stderr) << "chromium failed: " << chromium.readAllStandardError() << Qt::endl;
        return -1;
    }
    return timer.nsecsElapsed() / 1e9;
}

LabelDefinition demoDefinition() {
    LabelDefinition def;
    GetSetLabelDef(LoadLabelDef, QStringLiteral("Etiquon"), def);
    LabelCell& name = def.cells[0];
    name.UseCell = true;
    name.FldID = 1;
    name.FontWeight = 2;
    name.FontSize = 11;
    LabelCell& barcode = def.cells[1];
    barcode.UseCell = true;
    barcode.FldID = 4;
    barcode.ViewType = 1;
    LabelCell& price = def.cells[2];
    price.UseCell = true;
    price.FldID = 6;
    price.FontSize = 12;
    price.Prefix = QStringLiteral("מחיר:");
    def.bar.BarType = 6;
    def.bar.ShowDesc = true;
    def.bar.UserResoX = 0;
    def.bar.UserResoY = 0;
    return def;
}

}  // namespace

int main(int argc, char** argv) {
    const bool disk = argc > 1 && QString(argv[argc - 1]) == "--disk";
    const std::unique_ptr<QTemporaryDir> scratch = bench::scratchFolder(disk);
    qputenv("QT_QPA_PLATFORM", "offscreen");
    QGuiApplication app(argc, argv);
    const int labels =
        argc > 1 && !QString(argv[1]).startsWith("--") ? QString(argv[1]).toInt() : 10000;
    QTextStream out(stdout);
    const QString workDb = bench::prepareLabelFolder(scratch->path() + "/db", labels);

    LabelPageInput input;
    input.query.queryType = ItemLabels;
    input.query.order = Ascending;
    LabelDefinition def = demoDefinition();
    NoProgress progress;

    // The PDF drawn here, as a direct print writes it (without sending it).
    constexpr int kRounds = 3;
    QList<double> pdfRuns;
    PdfLabels pdf;
    PdfDestination destination;
    destination.file = scratch->path() + "/labels.pdf";
    QElapsedTimer timer;
    for (int round = 0; round < kRounds; ++round) {
        timer.start();
        pdf = printLabelsPdf(workDb, input, def, destination, progress);
        pdfRuns.append(timer.nsecsElapsed() / 1e9);
    }
    const double pdfSeconds = bench::median(pdfRuns);

    // The browser's way: the page and its bitmaps, then Chromium's print of them.
    timer.start();
    const QString page = printBuiltInLabels(workDb, input, def, progress).pagePath;
    const double pageSeconds = timer.nsecsElapsed() / 1e9;
    QDir().mkpath(scratch->path() + "/chromium");
    const QString chromiumPdf = scratch->path() + "/chromium.pdf";
    const double printSeconds = chromiumSeconds(page, chromiumPdf, scratch->path() + "/chromium");
    if (printSeconds < 0) return 1;
    const double browserSeconds = pageSeconds + printSeconds;

    out << "labels: " << labels << ", folder: " << scratch->path() << "\n";
    out << QString("PDF drawn here, median of %1: %2 s, %3 labels/s (%4 pages, %5 KiB)\n")
               .arg(kRounds)
               .arg(pdfSeconds, 0, 'f', 3)
               .arg(labels / pdfSeconds, 0, 'f', 0)
               .arg(pdf.pages)
               .arg(QFileInfo(pdf.path).size() / 1024);
    out << QString("HTML route %1 s + headless Chromium print %2 s = %3 s, %4 labels/s (%5 KiB)\n")
               .arg(pageSeconds, 0, 'f', 3)
               .arg(printSeconds, 0, 'f', 3)
               .arg(browserSeconds, 0, 'f', 3)
               .arg(labels / browserSeconds, 0, 'f', 0)
               .arg(QFileInfo(chromiumPdf).size() / 1024);
    out << QString("PDF here / browser route: %1 (target: below 1)\n")
               .arg(pdfSeconds / browserSeconds, 0, 'f', 3);
    return 0;
}

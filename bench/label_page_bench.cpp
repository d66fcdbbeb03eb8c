// The built-in label page for 10,000 marked items with one barcode cell: the whole print run
// (query, 10,000 EAN-13 bitmaps, the page), against zint's own command-line tool making the
// same 10,000 bitmaps from a batch file. Prints figures; passes or fails nothing.
//   label_page_bench [LABELS] [--disk]
#include <QCoreApplication>
#include <QDir>
#include <QElapsedTimer>
#include <QFile>
#include <QFileInfo>
#include <QProcess>
#include <QTemporaryDir>
#include <QTextStream>
#include <algorithm>
#include <memory>

#include "db/file_names.h"
#include "db/local_databases.h"
#include "jet/database.h"
#include "jet/recordset.h"
#include "platform/progress.h"
#include "platform/settings_store.h"
#include "print/barcode_images.h"
#include "print/label_definition.h"
#include "print/label_page.h"
#include "print/label_query.h"

#include "bench_labels.h"

using namespace etq;

namespace {

using bench::ean13;
using bench::median;

// zint's tool, one bitmap per line of a batch file, as our bitmaps are made: EAN-13 with its
// check digit given, a 2-pixel module, 80-pixel bars, no text.
double zintSeconds(const QString& folder, int labels) {
    const QString input = folder + "/zint-input.txt";
    QFile file(input);
    if (!file.open(QIODevice::WriteOnly)) return -1;
    for (int i = 0; i < labels; ++i)
        file.write(ean13(i).toLatin1() + '\n');
    file.close();
    QDir().mkpath(folder + "/zint");
    QProcess zint;
    zint.setWorkingDirectory(folder + "/zint");
    QElapsedTimer timer;
    timer.start();
    zint.start(QStringLiteral("zint"), {"--batch", "--barcode=14", "--scale=1", "--height=40",
                                        "--notext", "--output=B~~~~~.bmp", "--input=" + input});
    if (!zint.waitForFinished(-1) || zint.exitCode() != 0) {
        QTextStream(stderr) << "zint failed: " << zint.readAllStandardError() << Qt::endl;
        return -1;
    }
    return timer.nsecsElapsed() / 1e9;
}

}  // namespace

int main(int argc, char** argv) {
    // "--disk" measures in the temporary folder instead of memory.
    const bool disk = argc > 1 && QString(argv[argc - 1]) == "--disk";
    const std::unique_ptr<QTemporaryDir> scratchDir = bench::scratchFolder(disk);
    QTemporaryDir& scratch = *scratchDir;
    const bool inMemory = scratch.path().startsWith(QStringLiteral("/dev/shm"));
    QCoreApplication app(argc, argv);
    const int labels =
        argc > 1 && !QString(argv[1]).startsWith("--") ? QString(argv[1]).toInt() : 10000;
    QTextStream out(stdout);

    const QString folder = scratch.path() + "/db";
    const QString workDb = bench::prepareLabelFolder(folder, labels);
    if (workDb.isEmpty()) return 1;

    LabelPageInput input;
    input.query.queryType = ItemLabels;
    input.query.order = Ascending;
    LabelDefinition def;
    GetSetLabelDef(LoadLabelDef, QStringLiteral("Etiquon"), def);
    def.cells[0].UseCell = true;
    def.cells[0].FldID = 4;  // BarCode
    def.cells[0].ViewType = 1;
    def.bar.BarType = 6;  // EAN-13
    NoProgress progress;

    // Rounds as a user runs them: each print run writes into a new folder of its own. zint
    // writes into an emptied folder each round.
    constexpr int kRounds = 5;
    QList<double> runs;
    QList<double> zints;
    QString page;
    QElapsedTimer timer;
    for (int round = 0; round < kRounds; ++round) {
        timer.start();
        page = printBuiltInLabels(workDb, input, def, progress).pagePath;
        runs.append(timer.nsecsElapsed() / 1e9);
        if (page.isEmpty()) return 1;
        QDir(scratch.path() + "/zint").removeRecursively();
        zints.append(zintSeconds(scratch.path(), labels));
        if (zints.last() < 0) return 1;
    }
    const QString runFolder = QFileInfo(page).path();
    const int bitmaps = int(QDir(runFolder).entryList({"B*.BMP"}, QDir::Files).size());

    // The parts alone: the bitmaps with one library instance, and the page.
    timer.restart();
    MakeBarcodeImages(runFolder, "BarCode", 4, workDb, BuildLabelQuery(input.query), def.bar);
    const double images = timer.nsecsElapsed() / 1e9;
    timer.restart();
    writeLabelPage(page, workDb, input, def, progress);
    const double pageOnly = timer.nsecsElapsed() / 1e9;

    const double whole = median(runs);
    const double zint = median(zints);
    out << "labels: " << labels << ", bitmaps written: " << bitmaps
        << ", page: " << QFile(page).size() / 1024 << " KiB, folder: " << scratch.path()
        << (inMemory ? " (tmpfs)" : "") << "\n";
    out << QString("whole print run, median of %1: %2 s, %3 labels/s (first run %4 s)\n")
               .arg(kRounds)
               .arg(whole, 0, 'f', 3)
               .arg(labels / whole, 0, 'f', 0)
               .arg(runs.first(), 0, 'f', 3);
    out << QString("  bitmaps with one instance alone: %1 s; page alone: %2 s\n")
               .arg(images, 0, 'f', 3)
               .arg(pageOnly, 0, 'f', 3);
    out << QString("zint --batch, the same bitmaps, median: %1 s, %2 bitmaps/s\n")
               .arg(zint, 0, 'f', 3)
               .arg(labels / zint, 0, 'f', 0)
        << QString("whole run / zint tool: %1 (target: below 1)\n").arg(whole / zint, 0, 'f', 2);
    out.flush();
    return 0;
}

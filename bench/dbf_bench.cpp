// How fast the demo company is written, and how fast the host item file is read field by field
// through DbfFile, as the item reader reads it.
//
//   dbf_bench [items]      (default 100000)
//
// Prints the time to write the company, and records per second and nanoseconds per field read
// for a pass over oitm.dbf that takes every field the item reader uses.
#include <QCoreApplication>
#include <QElapsedTimer>
#include <QTemporaryDir>
#include <QTextStream>

#include "import/dbf_file.h"
#include "import/host_layouts.h"
#include "samples/demo_company.h"

namespace h = etq::host;

int main(int argc, char** argv) {
    QCoreApplication app(argc, argv);
    const int items = argc > 1 ? QString::fromLocal8Bit(argv[1]).toInt() : 100000;
    QTextStream out(stdout);
    QTemporaryDir dir;

    QElapsedTimer timer;
    timer.start();
    etq::demo::writeDemoCompany(dir.path(), {.items = items, .seed = 1});
    out << "write demo company, " << items << " items: " << timer.elapsed() << " ms\n";

    timer.restart();
    const etq::DbfFile file(dir.filePath("oitm.dbf"));
    h::requireLayout(file, h::oitm::kLayout);
    const qint64 openNs = timer.nsecsElapsed();

    timer.restart();
    qint64 fieldsRead = 0, checksum = 0;
    for (qint64 i = 0; i < file.recordCount(); ++i) {
        if (file.isDeleted(i)) continue;
        for (const h::HostField& f : h::oitm::kFields)
            checksum += file.text(i, f).size();
        for (int n = 1; n <= h::oitm::kPriceCount; ++n) {
            checksum += file.int32(i, h::oitm::price(n).offset);
            checksum += file.text(i, h::oitm::currency(n)).size();
        }
        fieldsRead += 1 + std::size(h::oitm::kFields) + 2 * h::oitm::kPriceCount;
    }
    const qint64 readNs = timer.nsecsElapsed();
    out << "open oitm.dbf (" << file.recordCount() << " records): " << openNs / 1000 << " us\n";
    out << "read every item field: " << readNs / 1000000 << " ms, "
        << qint64(file.recordCount() * 1e9 / qMax<qint64>(readNs, 1)) << " records/s, "
        << double(readNs) / qMax<qint64>(fieldsRead, 1) << " ns per field (checksum " << checksum
        << ")\n";
    return 0;
}

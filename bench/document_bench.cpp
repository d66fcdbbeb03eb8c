// How fast the document reader scans a host document file into the working database, against a
// Python peer in the same run, and how fast an incremental scan finds what the host appended.
//
//   document_bench [documents] [appended]      (default 50000 500)
//
// The delivery note file holds `documents` documents of ten lines each, one record apiece. The
// full scan reads it into a fresh working database; the peer (bench/document_peer.py:
// python3-dbfread reading by field name, sqlite3 inserting, one transaction) writes the same rows
// into another, and the two are compared row by row. Printed: both times and the ratio ours /
// peer (aim: at most 0.2). Then `appended` documents are added to the end of the file and the
// next scan, which starts where the full scan ended, is timed against the full scan (aim: at
// most 5%).
#include <sqlite3.h>

#include <QCoreApplication>
#include <QDir>
#include <QElapsedTimer>
#include <QFile>
#include <QProcess>
#include <QTemporaryDir>
#include <QTextStream>
#include <cstdio>

#include "bench_sqlite.h"
#include "db/file_names.h"
#include "db/local_databases.h"
#include "import/document_reader.h"
#include "platform/context.h"
#include "platform/progress.h"
#include "samples/host_records.h"

namespace {

namespace db = etq::db;
using etq::demo::DocumentLine;
using etq::demo::StockDocument;

const char16_t* const kCustomers[] = {
    u"סופרמרקט השכונה בע\"מ", u"מכולת אצל שמעון", u"מינימרקט הדקל", u"קפה נחת", u"מסעדת הגפן",
    u"צרכניית המושב",         u"מאפיית אבולעפיה"};
const char16_t* const kStreets[] = {u"רחוב הרצל 12", u"רחוב הנביאים 4", u"שדרות בן גוריון 88",
                                    u"רחוב דיזנגוף 150", u"משק 23"};
const char16_t* const kCities[] = {u"תל אביב", u"ירושלים", u"חיפה", u"באר שבע", u"נתניה"};
const char16_t* const kProducts[] = {u"חלב 3%",    u"לחם אחיד פרוס", u"מים מינרליים",
                                     u"עגבניות",   u"נוזל כלים",     u"שוקולד חלב",
                                     u"טונה בשמן", u"גלידת וניל"};

template <std::size_t N>
QString pick(const char16_t* const (&texts)[N], int i) {
    return QString::fromUtf16(texts[i % int(N)]);
}

StockDocument benchDocument(int i) {
    StockDocument d;
    d.number = 100000 + i;
    d.reference = QString::number(500000 + i);
    d.accountKey = QString::number(20001 + i % 500);
    d.date = QDate(2025, 1, 1).addDays(i % 365);
    d.dueDate = d.date.addDays(30);
    d.customerReference = QStringLiteral("PO-%1").arg(i % 9000 + 1000);
    d.address = pick(kStreets, i) + u'\r' + pick(kCities, i / 7);
    d.remarks = i % 3 ? QString() : QStringLiteral("לפרוק בבוקר בלבד");
    d.customerName = pick(kCustomers, i);
    d.contactName = QStringLiteral("יוסי כהן");
    for (int n = 0; n < 10; ++n) {
        DocumentLine line;
        line.itemKey = QString::number(10000 + (i * 7 + n * 13) % 5000);
        line.itemName = pick(kProducts, i + n);
        line.quantity = (i + n) % 4 ? double((i + n) % 48 + 1) : ((i + n) % 2000) / 100.0;
        line.vendorCatalogNumber = QStringLiteral("S%1").arg(10000 + n);
        if (n == 0) line.serialNumber = QStringLiteral("SN%1").arg(i);
        line.warehouse = 1 + n % 3;
        d.lines.append(line);
    }
    return d;
}

void writeDocumentFile(const QString& path, int documents) {
    etq::demo::DbfWriter writer(path, etq::host::stockdoc::kLayout);
    for (int i = 0; i < documents; ++i)
        etq::demo::append(writer, benchDocument(i));
    writer.close();
}

struct Folder {
    QString company, db;
    QString path(const QString& name) const { return db::inFolder(db, name); }
    QString freshWorkDatabase(const QString& name) const {
        QFile::remove(path(name));
        const QString made = db::CreateDocDatabase(path(db::kDocDatabaseFile),
                                                   path(db::kItemDatabaseFile), path(name), {});
        if (made.isEmpty()) std::exit(1);
        return made;
    }
};

Folder prepare(const QTemporaryDir& dir) {
    Folder f{dir.filePath("company"), dir.filePath("db")};
    QDir().mkpath(f.company);
    QDir().mkpath(f.db);
    if (!QFile::copy(ETIQUON_DELIVERED_KDB, f.path(db::kDocDatabaseFile))) std::exit(1);
    db::CreateItemDatabase(f.path(db::kItemDatabaseFile));
    db::AddAccountTables(f.path(db::kItemDatabaseFile));
    QFile::setPermissions(f.path(db::kDocDatabaseFile), QFile::ReadOwner | QFile::WriteOwner);
    return f;
}

struct Timed {
    double seconds = 0;
    etq::StockDocScan scan;
};

Timed scanOurs(const Folder& f, const QString& workDb) {
    etq::StockDocReadOptions options;
    options.companyFolder = f.company;
    options.workDbPath = workDb;
    options.wizFileType = 1;
    etq::Context context;
    etq::NoProgress progress;
    QElapsedTimer timer;
    timer.start();
    Timed t;
    t.scan = etq::readStockDocuments(options, context, progress);
    t.seconds = timer.nsecsElapsed() / 1e9;
    return t;
}

// The peer's own figure: the scan after the interpreter has started and imported its modules.
double scanPeer(const QString& dbf, const QString& workDb) {
    QProcess peer;
    peer.start(QStringLiteral(ETIQUON_PYTHON3),
               {QStringLiteral(ETIQUON_BENCH_DIR "/document_peer.py"), dbf, workDb, "1"});
    if (!peer.waitForFinished(-1) || peer.exitCode() != 0) {
        std::fprintf(stderr, "peer failed: %s\n", peer.readAllStandardError().constData());
        std::exit(1);
    }
    return QString::fromUtf8(peer.readAllStandardOutput()).section(u'\n', 0, 0).toDouble();
}

// Rows of one database that the other lacks, both ways, for both document tables.
qint64 differingRows(const QString& ours, const QString& peer) {
    sqlite3* db = nullptr;
    etq::bench::check(sqlite3_open(ours.toUtf8().constData(), &db), db);
    etq::bench::check(
        sqlite3_exec(db, ("ATTACH '" + peer.toUtf8() + "' AS peer").constData(), 0, 0, 0), db);
    qint64 differing = 0;
    for (const char* table : {"tTempDocHeaders", "tTempDocLines"}) {
        for (const auto& [a, b] : {std::pair{"main", "peer"}, std::pair{"peer", "main"}}) {
            const QByteArray sql = QStringLiteral(
                                       "SELECT count(*) FROM (SELECT * FROM %1.%3 "
                                       "EXCEPT SELECT * FROM %2.%3)")
                                       .arg(a, b, table)
                                       .toUtf8();
            sqlite3_stmt* s = nullptr;
            etq::bench::check(sqlite3_prepare_v2(db, sql.constData(), -1, &s, nullptr), db);
            etq::bench::check(sqlite3_step(s), db);
            differing += sqlite3_column_int64(s, 0);
            sqlite3_finalize(s);
        }
    }
    sqlite3_close(db);
    return differing;
}

QString ms(double seconds) {
    return QString::number(qRound64(seconds * 1000)) + " ms";
}

}  // namespace

int main(int argc, char** argv) {
    QCoreApplication app(argc, argv);
    const int documents = argc > 1 ? QString::fromLocal8Bit(argv[1]).toInt() : 50000;
    const int appended = argc > 2 ? QString::fromLocal8Bit(argv[2]).toInt() : 500;
    QTextStream out(stdout);
    QTemporaryDir dir;
    const Folder f = prepare(dir);
    const QString dbf = f.company + "/dlvnote.dbf";
    writeDocumentFile(dbf, documents);

    const Timed full = scanOurs(f, f.freshWorkDatabase(db::kWorkDatabaseFile));
    const QString peerDb = f.freshWorkDatabase("peer.tmp");
    const double peer = scanPeer(dbf, peerDb);
    out << documents << " documents of 10 lines (" << full.scan.headers << " headers, "
        << full.scan.lines << " lines):\n"
        << "  our full scan:             " << ms(full.seconds) << "\n"
        << "  peer (dbfread + sqlite3):  " << ms(peer) << "\n"
        << "  ratio ours / peer: " << QString::number(full.seconds / peer, 'f', 3)
        << " (aim: at most 0.2)\n"
        << "  rows that differ from the peer's: "
        << differingRows(f.path(db::kWorkDatabaseFile), peerDb) << "\n";
    out.flush();

    writeDocumentFile(dbf, documents + appended);
    const Timed next = scanOurs(f, f.freshWorkDatabase(db::kWorkDatabaseFile));
    out << "incremental scan finding " << next.scan.headers
        << " appended documents: " << ms(next.seconds) << ", "
        << QString::number(100 * next.seconds / full.seconds, 'f', 1)
        << "% of the full scan (aim: at most 5%)\n";
    return 0;
}

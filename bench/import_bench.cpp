// How fast the item import reads a host item file into the item database, with all ten price
// lists staged and merged, against a plain prepared-statement bulk insert of the same rows
// (the items into tItems, their prices into tPriceList) into the same schema.
//
//   import_bench [items...]      (default 10000 100000)
//
// For each size: the import (ReadItemMNHL into a fresh item database, then MergeTempItems),
// the plain insert, records per second of each, and the ratio import / plain (the aim is at
// most 3). With several sizes it prints how the time grows against the item count (the aim
// for ten times the items is at most twelve times the time).
#include <sqlite3.h>

#include <QCoreApplication>
#include <QDir>
#include <QElapsedTimer>
#include <QTemporaryDir>
#include <QTextStream>
#include <cstdio>

#include "bench_sqlite.h"
#include "db/file_names.h"
#include "db/local_databases.h"
#include "import/item_reader.h"
#include "platform/progress.h"
#include "samples/host_records.h"

namespace {

using etq::bench::bindText;
using etq::bench::check;
using etq::demo::ItemRecord;
namespace db = etq::db;

constexpr int kLists = 10;
const QString kLocal = QStringLiteral("\u00A6");

ItemRecord benchItem(int i) {
    ItemRecord item;
    item.key = QString::number(1000000 + i);
    item.name = QStringLiteral("פריט לדוגמה %1").arg(i);
    item.foreignName = QStringLiteral("Sample item %1").arg(i);
    item.group = QString::number(1 + i % 9);
    item.barcode = QStringLiteral("729%1").arg(i, 10, 10, QChar(u'0'));
    item.supplierCatalogNumber = QStringLiteral("S-%1").arg(i);
    item.unit = QStringLiteral("יח'");
    for (int n = 0; n < kLists; ++n)
        item.prices[n] = {100 + (i * 7 + n * 13) % 9000, n % 3 == 2 ? QStringLiteral("$") : ""};
    item.queryGroups = QString::number(i % 256);
    return item;
}

// A new item database, as a first import makes it.
QString freshItemDatabase(const QString& folder) {
    const QString path = db::inFolder(folder, db::kItemDatabaseFile);
    db::CreateItemDatabase(path);
    db::AddAccountTables(path);
    return path;
}

// The same rows the import writes, with plain prepared statements in one transaction.
double plainInsert(const QString& path, const QList<ItemRecord>& items) {
    sqlite3* db = nullptr;
    check(sqlite3_open(path.toUtf8().constData(), &db), db);
    sqlite3_stmt* item = nullptr;
    sqlite3_stmt* price = nullptr;
    QElapsedTimer timer;
    timer.start();
    check(sqlite3_exec(db, "BEGIN", nullptr, nullptr, nullptr), db);
    check(
        sqlite3_prepare_v2(
            db,
            "INSERT INTO tItems (ItemKey, ItemName, Fname, ItemSort, Unit, BarCode, SuppCatNum, Copies, Price, Coin, SalPackUN, PurPackUN) VALUES (?1, ?2, ?3, ?4, ?5, ?6, ?7, ?8, ?9, ?10, ?11, ?12)",
            -1, &item, nullptr),
        db);
    check(
        sqlite3_prepare_v2(
            db,
            "INSERT INTO tPriceList (ItemKey, PriceList, Price, Currency) VALUES (?1, ?2, ?3, ?4)",
            -1, &price, nullptr),
        db);
    for (const ItemRecord& it : items) {
        bindText(item, 1, it.key);
        bindText(item, 2, it.name);
        bindText(item, 3, it.foreignName);
        sqlite3_bind_int(item, 4, it.group.toInt());
        bindText(item, 5, it.unit);
        bindText(item, 6, it.barcode);
        bindText(item, 7, it.supplierCatalogNumber);
        sqlite3_bind_int(item, 8, 1);
        sqlite3_bind_double(item, 9, it.prices[0].hundredths / 100.0);
        bindText(item, 10, kLocal);
        sqlite3_bind_double(item, 11, 1.0);
        sqlite3_bind_double(item, 12, 1.0);
        check(sqlite3_step(item), db);
        sqlite3_reset(item);
        for (int n = 0; n < kLists; ++n) {
            bindText(price, 1, it.key);
            sqlite3_bind_int(price, 2, n + 1);
            sqlite3_bind_double(price, 3, it.prices[n].hundredths / 100.0);
            bindText(price, 4, it.prices[n].currency.isEmpty() ? kLocal : it.prices[n].currency);
            check(sqlite3_step(price), db);
            sqlite3_reset(price);
        }
    }
    sqlite3_finalize(item);
    sqlite3_finalize(price);
    check(sqlite3_exec(db, "COMMIT", nullptr, nullptr, nullptr), db);
    const double seconds = timer.nsecsElapsed() / 1e9;
    sqlite3_close(db);
    return seconds;
}

// The import's way: the host file read into tItems and tTempPriceList, then merged.
double import(const QString& company, const QString& folder) {
    const QString itemDb = freshItemDatabase(folder);
    const QString tempDb =
        db::CreateTempItemDatabase(db::inFolder(folder, db::kTempItemDatabaseFile), itemDb);
    etq::ItemReadOptions options;
    options.companyFolder = company;
    options.databasePath = tempDb;
    options.copies = 1;
    options.stagePriceLists = true;
    etq::NoProgress progress;
    QElapsedTimer timer;
    timer.start();
    etq::readHostItems(options, progress);
    db::MergeTempItems(tempDb);
    return timer.nsecsElapsed() / 1e9;
}

}  // namespace

int main(int argc, char** argv) {
    QCoreApplication app(argc, argv);
    QList<int> sizes;
    for (int i = 1; i < argc; ++i)
        sizes << QString::fromLocal8Bit(argv[i]).toInt();
    if (sizes.isEmpty()) sizes = {10000, 100000};
    QTextStream out(stdout);
    double first = 0;
    for (int count : sizes) {
        QTemporaryDir dir;
        const QString company = dir.filePath("company");
        QList<ItemRecord> items;
        for (int i = 0; i < count; ++i)
            items.append(benchItem(i));
        QDir().mkpath(company);
        etq::demo::writeHostFile(company + "/oitm.dbf", items);

        QDir().mkpath(dir.filePath("import"));
        QDir().mkpath(dir.filePath("plain"));
        const double imported = import(company, dir.filePath("import"));
        const double plain = plainInsert(freshItemDatabase(dir.filePath("plain")), items);
        const qint64 rows = qint64(count) * (1 + kLists);
        out << count << " items (" << rows << " rows with their " << kLists << " prices):\n"
            << "  import, staged and merged: " << qRound(imported * 1000) << " ms, "
            << qRound64(count / imported) << " items/s\n"
            << "  plain prepared inserts:    " << qRound(plain * 1000) << " ms, "
            << qRound64(count / plain) << " items/s\n"
            << "  ratio import / plain: " << QString::number(imported / plain, 'f', 2)
            << " (aim: at most 3)\n";
        if (first == 0) {
            first = imported;
        } else {
            out << "  time against the first size: " << QString::number(imported / first, 'f', 1)
                << "x for " << QString::number(double(count) / sizes.first(), 'f', 1)
                << "x the items (aim: at most 12x for 10x)\n";
        }
        out.flush();
    }
    return 0;
}

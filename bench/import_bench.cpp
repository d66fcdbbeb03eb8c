// How fast the item import runs, measured in one run against two others doing the same work:
//
//   import_bench [items...]      (default 10000 100000)
//
// For each size, on a company whose items carry all ten price lists:
// - ours: the whole item import run (importItems, as etiquon-cli import-items --price-lists),
//   with the time of each of its steps;
// - the peer: a forty-line Python import as a user would write it (bench/import_peer.py:
//   python3-dbfread and sqlite3 upserts in one transaction); aim: ours at most 0.5 of it;
// - the floor: plain prepared SQLite statements writing the same rows the shortest way (the
//   items upserted, the price rows staged in an unindexed scratch table and merged with one
//   statement); aim: ours at most 1.5 of it;
// and that ours and the peer leave the same rows. With several sizes it prints how the time
// grows (aim: at most 11 times for ten times the items), and at the largest size how long
// marking and clearing every item takes (mark-items --all / --none; aim: under a second).
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
#include "dialogs/bound_grid_model.h"
#include "dialogs/item_selection.h"
#include "import/item_import.h"
#include "platform/context.h"
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

QList<ItemRecord> writeCompany(const QString& company, int count) {
    QList<ItemRecord> items;
    for (int i = 0; i < count; ++i)
        items.append(benchItem(i));
    QDir().mkpath(company);
    etq::demo::writeHostFile(company + "/oitm.dbf", items);
    etq::demo::writeHostFile(
        company + "/ocrn.dbf",
        QList<etq::demo::CurrencyRecord>{{kLocal, "שקל", "NIS", "NS"}, {"$", "דולר", "USD", "$"}});
    return items;
}

// Seconds since the last mark, per step the run shows.
class StepTimes : public etq::Progress {
  public:
    StepTimes() { timer_.start(); }
    void step(const QString& text) override {
        close();
        current_ = text;
    }
    void show(qint64, qint64) override {}
    void clear() override {}
    void fill() override {}
    QString report() {
        close();
        return lines_.join(QStringLiteral(", "));
    }

  private:
    void close() {
        const double seconds = timer_.nsecsElapsed() / 1e9;
        timer_.restart();
        lines_ << QStringLiteral("%1 %2 ms")
                      .arg(current_.isEmpty() ? "preparing" : current_)
                      .arg(qRound(seconds * 1000));
    }
    QElapsedTimer timer_;
    QString current_;
    QStringList lines_;
};

double ours(const QString& company, const QString& folder, QString* steps) {
    QDir().mkpath(folder);
    QFile::copy(ETIQUON_DELIVERED_KDB, db::inFolder(folder, db::kDocDatabaseFile));
    QFile::setPermissions(db::inFolder(folder, db::kDocDatabaseFile),
                          QFile::ReadOwner | QFile::WriteOwner);
    etq::ItemImportOptions options;
    options.databaseFolder = folder;
    options.companyFolder = company;
    options.items.priceField = 1;
    options.items.copies = 1;
    options.items.stagePriceLists = true;
    etq::Context context;
    context.language = 1;
    StepTimes times;
    QElapsedTimer timer;
    timer.start();
    etq::importItems(options, context, times);
    const double seconds = timer.nsecsElapsed() / 1e9;
    *steps = times.report();
    return seconds;
}

double peer(const QString& company, const QString& folder) {
    QDir().mkpath(folder);
    const QString itemDb =
        db::CreateItemDatabaseWithAccounts(db::inFolder(folder, db::kItemDatabaseFile));
    QProcess python;
    python.start(
        QStringLiteral(ETIQUON_PYTHON3),
        {QStringLiteral(ETIQUON_BENCH_DIR "/import_peer.py"), company + "/oitm.dbf", itemDb});
    if (!python.waitForFinished(-1) || python.exitCode() != 0) {
        std::fprintf(stderr, "the Python peer failed: %s\n",
                     python.readAllStandardError().constData());
        std::exit(1);
    }
    return python.readAllStandardOutput().trimmed().toDouble();
}

void exec(sqlite3* db, const char* sql) {
    check(sqlite3_exec(db, sql, nullptr, nullptr, nullptr), db);
}

sqlite3_stmt* prepare(sqlite3* db, const char* sql) {
    sqlite3_stmt* statement = nullptr;
    check(sqlite3_prepare_v2(db, sql, -1, &statement, nullptr), db);
    return statement;
}

void step(sqlite3_stmt* statement, sqlite3* db) {
    check(sqlite3_step(statement), db);
    sqlite3_reset(statement);
}

// The same rows with plain prepared statements: the items upserted one by one, the price rows
// into an unindexed table of a scratch file without a journal, then merged in one statement.
double floorRun(const QString& folder, const QList<ItemRecord>& items) {
    QDir().mkpath(folder);
    const QString itemDb =
        db::CreateItemDatabaseWithAccounts(db::inFolder(folder, db::kItemDatabaseFile));
    sqlite3* db = nullptr;
    check(sqlite3_open(itemDb.toUtf8().constData(), &db), db);
    QElapsedTimer timer;
    timer.start();
    const QByteArray scratch = (folder + "/scratch.db").toUtf8();
    exec(db, ("ATTACH '" + scratch + "' AS scratch").constData());
    exec(db, "PRAGMA scratch.journal_mode = OFF");
    exec(db, "CREATE TABLE scratch.prices (ItemKey, PriceList, Price, Currency)");
    exec(db, "BEGIN");
    sqlite3_stmt* item = prepare(
        db,
        "INSERT INTO tItems (ItemKey, ItemName, Fname, ItemSort, Unit, BarCode, SuppCatNum, Copies, Price, Coin, SalPackUN, PurPackUN) VALUES (?1, ?2, ?3, ?4, ?5, ?6, ?7, ?8, ?9, ?10, ?11, ?12) ON CONFLICT(ItemKey) DO UPDATE SET ItemName = excluded.ItemName, Price = excluded.Price");
    sqlite3_stmt* price = prepare(db, "INSERT INTO scratch.prices VALUES (?1, ?2, ?3, ?4)");
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
        step(item, db);
        for (int n = 0; n < kLists; ++n) {
            bindText(price, 1, it.key);
            sqlite3_bind_int(price, 2, n + 1);
            sqlite3_bind_double(price, 3, it.prices[n].hundredths / 100.0);
            bindText(price, 4, it.prices[n].currency.isEmpty() ? kLocal : it.prices[n].currency);
            step(price, db);
        }
    }
    sqlite3_finalize(item);
    sqlite3_finalize(price);
    exec(
        db,
        "INSERT INTO tPriceList (ItemKey, PriceList, Price, Currency) SELECT ItemKey, PriceList, Price, Currency FROM scratch.prices WHERE true ON CONFLICT(ItemKey, PriceList) DO UPDATE SET Price = excluded.Price, Currency = excluded.Currency");
    exec(db, "COMMIT");
    const double seconds = timer.nsecsElapsed() / 1e9;
    sqlite3_close(db);
    return seconds;
}

QStringList rows(const QString& path, const char* sql) {
    sqlite3* db = nullptr;
    check(sqlite3_open(path.toUtf8().constData(), &db), db);
    sqlite3_stmt* statement = prepare(db, sql);
    QStringList out;
    while (sqlite3_step(statement) == SQLITE_ROW) {
        QStringList cells;
        for (int i = 0; i < sqlite3_column_count(statement); ++i)
            cells << QString::fromUtf8(
                reinterpret_cast<const char*>(sqlite3_column_text(statement, i)));
        out << cells.join(u'|');
    }
    sqlite3_finalize(statement);
    sqlite3_close(db);
    return out;
}

// Whether two item databases hold the same items and price list rows.
bool sameRows(const QString& a, const QString& b) {
    for (
        const char* sql :
        {"SELECT ItemKey, ItemName, Fname, ItemSort, Unit, BarCode, SuppCatNum, Copies, Price, Coin, SalPackUN, PurPackUN FROM tItems ORDER BY ItemKey",
         "SELECT ItemKey, PriceList, Price, Currency FROM tPriceList ORDER BY ItemKey, PriceList"})
        if (rows(a, sql) != rows(b, sql)) return false;
    return true;
}

// Marking and clearing every item as mark-items --all and --none do: seconds of each.
std::pair<double, double> markAll(const QString& folder) {
    etq::BoundGridModel grid;
    etq::ItemSelection selection(grid, {});
    selection.open(folder, 0, 0);
    QElapsedTimer timer;
    timer.start();
    selection.markAll(true);
    const double marked = timer.nsecsElapsed() / 1e9;
    timer.restart();
    selection.markAll(false);
    return {marked, timer.nsecsElapsed() / 1e9};
}

QString ms(double seconds) {
    return QStringLiteral("%1 ms").arg(qRound(seconds * 1000));
}

QString ratio(double a, double b) {
    return QString::number(a / b, 'f', 2);
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
        const QList<ItemRecord> items = writeCompany(company, count);
        QString steps;
        const double ourTime = ours(company, dir.filePath("ours"), &steps);
        const double peerTime = peer(company, dir.filePath("peer"));
        const double floorTime = floorRun(dir.filePath("floor"), items);
        const bool same = sameRows(db::inFolder(dir.filePath("ours"), db::kItemDatabaseFile),
                                   db::inFolder(dir.filePath("peer"), db::kItemDatabaseFile));
        out << count << " items, " << qint64(count) * (1 + kLists)
            << " rows with their ten price lists:\n"
            << "  ours:  " << ms(ourTime) << " (" << steps << ")\n"
            << "  peer:  " << ms(peerTime) << " (python3-dbfread and sqlite3)\n"
            << "  floor: " << ms(floorTime) << " (plain prepared statements)\n"
            << "  ours / peer:  " << ratio(ourTime, peerTime) << " (aim: at most 0.5)\n"
            << "  ours / floor: " << ratio(ourTime, floorTime) << " (aim: at most 1.5)\n"
            << "  ours and the peer leave the same rows: " << (same ? "yes" : "NO") << "\n";
        if (first == 0) {
            first = ourTime;
        } else {
            out << "  time against the first size: " << QString::number(ourTime / first, 'f', 1)
                << "x for " << QString::number(double(count) / sizes.first(), 'f', 1)
                << "x the items (aim: at most 11x for 10x)\n";
        }
        if (count == sizes.last()) {
            const auto [marked, cleared] = markAll(dir.filePath("ours"));
            out << "  marking all " << count << " items: " << ms(marked)
                << ", clearing them: " << ms(cleared) << " (aim: under a second each)\n";
        }
        out.flush();
        if (!same) return 1;
    }
    return 0;
}

// How fast the engine writes rows of the item table's shape through recordsets, against the
// same rows written with plain prepared SQLite statements in the same run.
//
//   jet_bench [rows]      (default 100000)
//
// Prints rows per second for each way and the ratio recordset / plain (lower is better; the
// aim is at most 2).
#include <sqlite3.h>

#include <QCoreApplication>
#include <QElapsedTimer>
#include <QTemporaryDir>
#include <QTextStream>
#include <cstdio>

#include "bench_sqlite.h"
#include "jet/database.h"
#include "jet/recordset.h"
#include "jet/sql_translator.h"

using namespace etq::jet;
using etq::bench::bindValue;
using etq::bench::check;

namespace {

TableDef itemsShape() {
    return {"tItems",
            {{"ItemKey", FieldType::Text, 20},      {"ItemName", FieldType::Text, 100},
             {"ItemSort", FieldType::Integer, 0},   {"Filter", FieldType::Text, 7},
             {"Unit", FieldType::Text, 5},          {"PurchaseUnit", FieldType::Text, 5},
             {"Fname", FieldType::Text, 100},       {"Local", FieldType::Text, 16},
             {"BarCode", FieldType::Text, 16},      {"Coin", FieldType::Text, 3},
             {"Price", FieldType::Double, 0},       {"Weight", FieldType::Double, 0},
             {"Volume", FieldType::Double, 0},      {"LastUpdate", FieldType::Date, 0},
             {"Version", FieldType::Text, 50},      {"Copies", FieldType::Byte, 0},
             {"PrintLabel", FieldType::Boolean, 0}, {"SuppCatNum", FieldType::Text, 20},
             {"SalPackUN", FieldType::Double, 0},   {"PurPackUN", FieldType::Double, 0},
             {"IgnoreInDoc", FieldType::Boolean, 0}},
            {"ItemKey"}};
}

// The fields an item import writes, in the order it writes them.
const char* const kWritten[] = {"ItemName", "Fname",      "ItemSort", "Unit",
                                "BarCode",  "SuppCatNum", "Copies",   "Price",
                                "Coin",     "SalPackUN",  "PurPackUN"};
constexpr int kWrittenCount = int(std::size(kWritten));

struct Item {
    QString key;
    QVariant values[kWrittenCount];
};

QList<Item> makeItems(int count, int pass) {
    QList<Item> items;
    items.reserve(count);
    for (int i = 0; i < count; ++i) {
        Item it;
        it.key = QString::number(100000 + i);
        it.values[0] = QString("פריט לדוגמה %1").arg(i);
        it.values[1] = QString("Sample item %1").arg(i);
        it.values[2] = i % 40;
        it.values[3] = QString("יח'");
        it.values[4] = QString("7290000%1").arg(i, 6, 10, QChar('0'));
        it.values[5] = QString("S-%1").arg(i);
        it.values[6] = 1 + pass;
        it.values[7] = (i % 5000) / 100.0 + pass;
        it.values[8] = QString("¦");
        it.values[9] = 1.0;
        it.values[10] = 1.0;
        items.append(it);
    }
    return items;
}

// Plain prepared statements: one INSERT per row in one transaction.
double plainInsert(const QString& path, const QList<Item>& items) {
    sqlite3* db = nullptr;
    sqlite3_open(path.toUtf8().constData(), &db);
    QString sql = "INSERT INTO tItems (ItemKey";
    for (const char* f : kWritten)
        sql += QString(", \"%1\"").arg(f);
    sql += ") VALUES (?1";
    for (int i = 0; i < kWrittenCount; ++i)
        sql += QString(", ?%1").arg(i + 2);
    sql += ")";
    sqlite3_stmt* insert = nullptr;
    QElapsedTimer timer;
    timer.start();
    check(sqlite3_exec(db, "BEGIN", nullptr, nullptr, nullptr), db);
    check(sqlite3_prepare_v2(db, sql.toUtf8().constData(), -1, &insert, nullptr), db);
    for (const Item& it : items) {
        bindValue(insert, 1, it.key);
        for (int i = 0; i < kWrittenCount; ++i)
            bindValue(insert, i + 2, it.values[i]);
        check(sqlite3_step(insert), db);
        sqlite3_reset(insert);
    }
    sqlite3_finalize(insert);
    check(sqlite3_exec(db, "COMMIT", nullptr, nullptr, nullptr), db);
    const double seconds = timer.nsecsElapsed() / 1e9;
    sqlite3_close(db);
    return seconds;
}

// Plain prepared statements: find the row by key, then update it.
double plainUpdate(const QString& path, const QList<Item>& items) {
    sqlite3* db = nullptr;
    sqlite3_open(path.toUtf8().constData(), &db);
    QString sql = "UPDATE tItems SET ";
    for (int i = 0; i < kWrittenCount; ++i)
        sql += QString("%1\"%2\" = ?%3").arg(i ? ", " : "").arg(kWritten[i]).arg(i + 1);
    sql += QString(" WHERE rowid = ?%1").arg(kWrittenCount + 1);
    sqlite3_stmt* find = nullptr;
    sqlite3_stmt* update = nullptr;
    QElapsedTimer timer;
    timer.start();
    check(sqlite3_exec(db, "BEGIN", nullptr, nullptr, nullptr), db);
    check(sqlite3_prepare_v2(db, "SELECT rowid FROM tItems WHERE ItemKey = ?1", -1, &find, nullptr),
          db);
    check(sqlite3_prepare_v2(db, sql.toUtf8().constData(), -1, &update, nullptr), db);
    for (const Item& it : items) {
        bindValue(find, 1, it.key);
        if (sqlite3_step(find) != SQLITE_ROW) std::exit(2);
        const sqlite3_int64 rowid = sqlite3_column_int64(find, 0);
        sqlite3_reset(find);
        for (int i = 0; i < kWrittenCount; ++i)
            bindValue(update, i + 1, it.values[i]);
        sqlite3_bind_int64(update, kWrittenCount + 1, rowid);
        check(sqlite3_step(update), db);
        sqlite3_reset(update);
    }
    sqlite3_finalize(find);
    sqlite3_finalize(update);
    check(sqlite3_exec(db, "COMMIT", nullptr, nullptr, nullptr), db);
    const double seconds = timer.nsecsElapsed() / 1e9;
    sqlite3_close(db);
    return seconds;
}

double recordsetInsert(const QString& path, const QList<Item>& items) {
    Database db = Database::open(path);
    QElapsedTimer timer;
    timer.start();
    db.beginTrans();
    Recordset rs = db.openRecordset("tItems");
    const int key = rs.fieldIndex("ItemKey");
    int fields[kWrittenCount];
    for (int i = 0; i < kWrittenCount; ++i)
        fields[i] = rs.fieldIndex(kWritten[i]);
    for (const Item& it : items) {
        rs.addNew();
        rs.setValue(key, it.key);
        for (int i = 0; i < kWrittenCount; ++i)
            rs.setValue(fields[i], it.values[i]);
        rs.update();
    }
    rs.close();
    db.commitTrans();
    return timer.nsecsElapsed() / 1e9;
}

// The import's way: FindFirst on the key, then Edit and Update.
double recordsetFindEdit(const QString& path, const QList<Item>& items) {
    Database db = Database::open(path);
    QElapsedTimer timer;
    timer.start();
    db.beginTrans();
    Recordset rs = db.openRecordset("tItems");
    for (const Item& it : items) {
        rs.findFirst("ItemKey=\"" + it.key + "\"");
        if (rs.noMatch()) std::exit(3);
        rs.edit();
        for (int i = 0; i < kWrittenCount; ++i)
            rs.setValue(kWritten[i], it.values[i]);
        rs.update();
    }
    rs.close();
    db.commitTrans();
    return timer.nsecsElapsed() / 1e9;
}

QString findPlan(const QString& path) {
    sqlite3* db = nullptr;
    sqlite3_open(path.toUtf8().constData(), &db);
    const QString find =
        QString(
            "EXPLAIN QUERY PLAN SELECT rowid FROM \"tItems\" WHERE (%1) AND rowid >= 0 ORDER BY rowid")
            .arg(sql::translateCriterion("ItemKey=\"100\"").sql);
    sqlite3_stmt* s = nullptr;
    sqlite3_prepare_v2(db, find.toUtf8().constData(), -1, &s, nullptr);
    QString plan;
    while (sqlite3_step(s) == SQLITE_ROW)
        plan += QString::fromUtf8(reinterpret_cast<const char*>(sqlite3_column_text(s, 3))) + "; ";
    sqlite3_finalize(s);
    sqlite3_close(db);
    return plan;
}

}  // namespace

int main(int argc, char** argv) {
    QCoreApplication app(argc, argv);
    const int count = argc > 1 ? std::atoi(argv[1]) : 100000;
    QTemporaryDir dir;
    const QString plainFile = dir.filePath("plain.kdb");
    const QString rsFile = dir.filePath("recordset.kdb");
    for (const QString& f : {plainFile, rsFile})
        Database::create(f).createTable(itemsShape());

    const QList<Item> first = makeItems(count, 0);
    const QList<Item> second = makeItems(count, 1);
    const double plainAdd = plainInsert(plainFile, first);
    const double rsAdd = recordsetInsert(rsFile, first);
    const double plainEdit = plainUpdate(plainFile, second);
    const double rsEdit = recordsetFindEdit(rsFile, second);

    QTextStream out(stdout);
    auto line = [&](const char* what, double plain, double recordset) {
        out << QString("%1 %2 rows: plain %3 rows/s, recordset %4 rows/s, ratio %5\n")
                   .arg(what)
                   .arg(count)
                   .arg(qint64(count / plain))
                   .arg(qint64(count / recordset))
                   .arg(recordset / plain, 0, 'f', 2);
    };
    line("insert (AddNew/Update)     ", plainAdd, rsAdd);
    line("update (FindFirst/Edit)    ", plainEdit, rsEdit);
    out << "FindFirst plan: " << findPlan(rsFile) << "\n";
    return 0;
}

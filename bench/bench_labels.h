#pragma once

// What the label benchmarks share: a scratch folder for the run's settings and files (in memory
// when the machine has a tmpfs), and a database folder whose items are all marked for printing.
#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QTemporaryDir>
#include <algorithm>
#include <memory>

#include "db/file_names.h"
#include "db/local_databases.h"
#include "jet/database.h"
#include "jet/recordset.h"

namespace etq::bench {

// A valid EAN-13 with the Israeli prefix.
inline QString ean13(int n) {
    const QString digits = QStringLiteral("729") + QString::number(n).rightJustified(9, u'0');
    int sum = 0;
    for (int i = 0; i < 12; ++i)
        sum += digits[i].digitValue() * (i % 2 ? 3 : 1);
    return digits + QString::number((10 - sum % 10) % 10);
}

inline double median(QList<double> values) {
    std::sort(values.begin(), values.end());
    return values[values.size() / 2];
}

// Settings, print folders and databases of this run in a folder of its own: in memory when the
// machine has a tmpfs (a desktop's runtime folder, where the print folder lives, is one), on
// disk with `disk`. Call before the application is made.
inline std::unique_ptr<QTemporaryDir> scratchFolder(bool disk) {
    const bool inMemory = !disk && QFileInfo(QStringLiteral("/dev/shm")).isWritable();
    auto scratch = std::make_unique<QTemporaryDir>(
        inMemory ? QStringLiteral("/dev/shm/etiquon-bench-XXXXXX")
                 : QDir::tempPath() + QStringLiteral("/etiquon-bench-XXXXXX"));
    for (const char* var : {"XDG_CONFIG_HOME", "XDG_RUNTIME_DIR", "XDG_CACHE_HOME"}) {
        const QString dir = scratch->path() + "/" + var;
        QDir().mkpath(dir);
        QFile::setPermissions(dir, QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);
        qputenv(var, dir.toLocal8Bit());
    }
    return scratch;
}

// A database folder of `labels` items, named "פריט n" with EAN-13 barcodes, one copy each, all
// marked; returns its working database.
inline QString prepareLabelFolder(const QString& folder, int labels) {
    QDir().mkpath(folder);
    const QString docDb = db::inFolder(folder, db::kDocDatabaseFile);
    const QString itemDb = db::inFolder(folder, db::kItemDatabaseFile);
    const QString workDb = db::inFolder(folder, db::kWorkDatabaseFile);
    QFile::copy(ETIQUON_DELIVERED_KDB, docDb);
    QFile::setPermissions(docDb, QFile::ReadOwner | QFile::WriteOwner);
    db::CreateItemDatabase(itemDb);
    db::AddAccountTables(itemDb);
    db::CreateDocDatabase(docDb, itemDb, workDb, {});
    jet::Database items = jet::Database::open(itemDb);
    items.beginTrans();
    jet::Recordset rs = items.openRecordset(QStringLiteral("tItems"));
    for (int i = 0; i < labels; ++i) {
        rs.addNew();
        rs.setValue(QStringLiteral("ItemKey"), QString::number(100000 + i));
        rs.setValue(QStringLiteral("ItemName"), QStringLiteral("פריט %1").arg(i));
        rs.setValue(QStringLiteral("BarCode"), ean13(i));
        rs.setValue(QStringLiteral("Coin"), QStringLiteral("¦"));
        rs.setValue(QStringLiteral("Price"), 9.9);
        rs.setValue(QStringLiteral("Copies"), 1);
        rs.setValue(QStringLiteral("PrintLabel"), true);
        rs.update();
    }
    items.commitTrans();
    return workDb;
}

}  // namespace etq::bench

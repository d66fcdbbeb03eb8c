#include "db/local_databases.h"

#include <QFile>
#include <QFileInfo>

#include "db/file_names.h"
#include "db/schemas.h"
#include "platform/context.h"
#include "platform/failure.h"
#include "platform/progress.h"

namespace etq::db {

using jet::Database;

namespace {

// Creation replaces a file that is there.
void removeExisting(const QString& path) {
    if (!QFileInfo::exists(path)) return;
    QFile file(path);
    if (!file.remove())
        jet::fail(jet::err::kCannotOpen,
                  QString("Cannot replace '%1': %2.").arg(path, file.errorString()));
}

void createQueries(Database& db, const schema::SavedQuery* queries, size_t count) {
    for (size_t i = 0; i < count; ++i)
        db.createQuery(queries[i].name, queries[i].sql);
}

}  // namespace

void AttachTable(Database& db, const QString& sourcePath, const QString& tableName) {
    db.linkTable(tableName, sourcePath, tableName);
}

QString CreateDocDatabase(const QString& docRefPath, const QString& itemDbPath,
                          const QString& workPath, const QString& logDbPath) {
    removeExisting(workPath);
    Database db = Database::create(workPath);
    db.createTable(schema::tempDocHeaders());
    db.createTable(schema::tempDocLines());
    db.createTable(schema::transports());
    for (const schema::Link& link : schema::workLinks()) {
        const bool fromItems = *link.sourceFile == kItemDatabaseFile;
        AttachTable(db, fromItems ? itemDbPath : docRefPath, link.table);
    }
    if (!logDbPath.isEmpty()) AttachTable(db, logDbPath, schema::stockLog().name);
    createQueries(db, schema::kWorkQueries, std::size(schema::kWorkQueries));
    return workPath;
}

QString CreateItemDatabase(const QString& path) {
    removeExisting(path);
    Database db = Database::create(path);
    for (const jet::TableDef* t : {&schema::items(), &schema::alterKeys(), &schema::alterPrices()})
        db.createTable(*t);
    createQueries(db, schema::kItemQueries, std::size(schema::kItemQueries));
    return path;
}

QString AddAccountTables(const QString& path) {
    // A missing file is told in English whatever the language, as the upgrade always did.
    if (!QFileInfo::exists(path)) throw Failure("Database not found", "Error");
    Database db = Database::open(path);
    db.createTable(schema::accountDef());
    db.createTable(schema::priceList());
    return path;
}

QString CreateTempItemDatabase(const QString& tempPath, const QString& itemDbPath) {
    removeExisting(tempPath);
    Database db = Database::create(tempPath);
    for (const jet::TableDef* t : {&schema::tempItems(), &schema::tempAlterKeys(),
                                   &schema::tempAlterPrices(), &schema::tempPriceList()})
        db.createTable(*t);
    for (const char* table : schema::kTempItemLinks)
        AttachTable(db, itemDbPath, table);
    createQueries(db, schema::kTempItemQueries, std::size(schema::kTempItemQueries));
    return tempPath;
}

void MergeTempItems(const QString& tempPath) {
    Database db = Database::open(tempPath);
    db.execute("qAddUpdateAlterKeys");
    db.execute("qAddUpdateAlterPrices");
    const QString priceMerge = db.querySql("qAddUpdatePriceList");
    for (int n = 1; n <= 10; ++n)
        db.execute(priceMerge + " Where tTempPriceList.PriceList = " + QString::number(n));
}

QString CreateLogDatabase(const QString& path) {
    removeExisting(path);
    Database db = Database::create(path);
    db.createTable(schema::stockLog());
    return path;
}

void CleanItemTables(const QString& itemDbPath, bool cleanItems, bool alterPrices,
                     const Context& context, Progress& progress) {
    Database db = Database::open(itemDbPath);
    if (!cleanItems) return;
    progress.step(context.caption(42));
    db.execute("DELETE * FROM tItems");
    if (alterPrices) db.execute("Delete * From tAlterPrices");
}

void UpgradeItemDatabase(const QString& folder) {
    const QString path = inFolder(folder, kItemDatabaseFile);
    if (QFileInfo::exists(path)) AddAccountTables(path);
}

}  // namespace etq::db

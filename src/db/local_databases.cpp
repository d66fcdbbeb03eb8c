#include "db/local_databases.h"

#include <QFileInfo>

#include "db/file_names.h"
#include "db/schemas.h"
#include "platform/context.h"
#include "platform/failure.h"
#include "platform/folder_lock.h"
#include "platform/progress.h"

namespace etq::db {

using jet::Database;

namespace {

void createQueries(Database& db, const schema::SavedQuery* queries, size_t count) {
    for (size_t i = 0; i < count; ++i)
        db.createQuery(queries[i].name, queries[i].sql);
}

void addItemTables(Database& db) {
    for (const jet::TableDef* t : {&schema::items(), &schema::alterKeys(), &schema::alterPrices()})
        db.createTable(*t);
    createQueries(db, schema::kItemQueries, std::size(schema::kItemQueries));
}

void addAccountTables(Database& db) {
    db.createTable(schema::accountDef());
    db.createTable(schema::priceList());
}

}  // namespace

void AttachTable(Database& db, const QString& sourcePath, const QString& tableName) {
    db.linkTable(tableName, sourcePath, tableName);
}

QString CreateDocDatabase(const QString& docRefPath, const QString& itemDbPath,
                          const QString& workPath, const QString& logDbPath) {
    jet::StagedDatabase staged(workPath);  // replaces a file that is there, once complete
    Database& db = staged.database();
    db.createTable(schema::tempDocHeaders());
    db.createTable(schema::tempDocLines());
    db.createTable(schema::transports());
    for (const schema::Link& link : schema::workLinks()) {
        const bool fromItems = *link.sourceFile == kItemDatabaseFile;
        AttachTable(db, fromItems ? itemDbPath : docRefPath, link.table);
    }
    if (!logDbPath.isEmpty()) AttachTable(db, logDbPath, schema::stockLog().name);
    createQueries(db, schema::kWorkQueries, std::size(schema::kWorkQueries));
    staged.commit();
    return workPath;
}

QString CreateItemDatabase(const QString& path) {
    jet::StagedDatabase staged(path);  // replaces a file that is there, once complete
    addItemTables(staged.database());
    staged.commit();
    return path;
}

QString CreateItemDatabaseWithAccounts(const QString& path) {
    jet::StagedDatabase staged(path);
    addItemTables(staged.database());
    addAccountTables(staged.database());
    staged.commit();
    return path;
}

QString AddAccountTables(const QString& path) {
    // A missing file is told in English whatever the language, as the upgrade always did.
    if (!QFileInfo::exists(path)) throw Failure("Database not found", "Error");
    Database db = Database::open(path);
    db.beginTrans();  // both tables or neither, whenever the upgrade stops
    addAccountTables(db);
    db.commitTrans();
    return path;
}

QString CreateTempItemDatabase(const QString& tempPath, const QString& itemDbPath) {
    jet::StagedDatabase staged(tempPath);  // replaces a file that is there, once complete
    Database& db = staged.database();
    for (const jet::TableDef* t : {&schema::tempItems(), &schema::tempAlterKeys(),
                                   &schema::tempAlterPrices(), &schema::tempPriceList()})
        db.createTable(*t);
    for (const char* table : schema::kTempItemLinks)
        AttachTable(db, itemDbPath, table);
    createQueries(db, schema::kTempItemQueries, std::size(schema::kTempItemQueries));
    staged.commit();
    return tempPath;
}

void prepareForBulkWrites(Database& tempDb) {
    tempDb.setScratch();
    tempDb.setCacheSize(128);
}

void MergeTempItems(const QString& tempPath) {
    Database db = Database::open(tempPath);
    prepareForBulkWrites(db);
    db.execute("qAddUpdateAlterKeys");
    db.execute("qAddUpdateAlterPrices");
    const QString priceMerge = db.querySql("qAddUpdatePriceList");
    for (int n = 1; n <= 10; ++n)
        db.execute(priceMerge + " Where tTempPriceList.PriceList = " + QString::number(n));
}

QString CreateLogDatabase(const QString& path) {
    jet::StagedDatabase staged(path);  // replaces a file that is there, once complete
    staged.database().createTable(schema::stockLog());
    staged.commit();
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
    if (!QFileInfo(folder).isDir())
        throw Failure(QStringLiteral("There is no database folder %1").arg(folder));
    const FolderLock lock(folder);
    const QString path = inFolder(folder, kItemDatabaseFile);
    if (!QFileInfo::exists(path)) return;
    // Account tables added to a file without its items would make a broken file look upgraded.
    if (const QString why = whyUnusable(path, itemTableNames()); !why.isEmpty()) throw Failure(why);
    AddAccountTables(path);
}

QStringList itemTableNames() {
    return {schema::items().name, schema::alterKeys().name, schema::alterPrices().name};
}

QString whyUnusable(const QString& path, const QStringList& tables) {
    try {
        Database db = Database::open(path);
        QStringList missing;
        for (const QString& table : tables)
            if (!db.hasTable(table)) missing << table;
        if (missing.isEmpty()) return {};
        return QString("%1 lacks the tables %2").arg(path, missing.join(", "));
    } catch (const jet::JetError& e) {
        return QString("%1 is damaged or not a database of Etiquon: %2").arg(path, e.description());
    }
}

}  // namespace etq::db

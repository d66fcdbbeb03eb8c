#pragma once

#include <QString>
#include <QStringList>
#include <functional>

#include "jet/database.h"

// The creation routines of the component's databases. Each creating routine returns the path
// it made; a failure throws (the engine's JetError, or a Failure) and the caller reports it. A
// file is built under a temporary name and put in place only when complete
// (jet::StagedDatabase): a failure or a kill leaves the file that was there as it was, never a
// half-built one.
namespace etq {
class Context;
class Progress;
}  // namespace etq

namespace etq::db {

// The working database: the document tables, links to the permanent tables of the document
// and item databases (and of the log database when logDbPath is not empty), and its queries.
QString CreateDocDatabase(const QString& docRefPath, const QString& itemDbPath,
                          const QString& workPath, const QString& logDbPath);

// Links table tableName of the file sourcePath into db. Failures go to the caller.
void AttachTable(jet::Database& db, const QString& sourcePath, const QString& tableName);

// The item database with tItems, tAlterKeys, tAlterPrices and its queries. Replaces a file
// that is there: its items, alternate keys and special prices are lost.
QString CreateItemDatabase(const QString& path);

// The item database as a first run and a clean import need it: CreateItemDatabase and
// AddAccountTables in one file that appears complete.
QString CreateItemDatabaseWithAccounts(const QString& path);

// Adds tAccountDef and tPriceList to an item database (the upgrade of an older file), both or
// neither. A missing file is the Failure "Database not found", titled "Error" whatever the
// language.
QString AddAccountTables(const QString& path);

// The temporary items database: staging tables, links to the item database at itemDbPath, and
// the merge queries.
QString CreateTempItemDatabase(const QString& tempPath, const QString& itemDbPath);

// The temporary items database, open for a run that writes many rows through it: a scratch file
// each run builds anew needs neither journal nor syncs, and the files its links reach get the
// memory to keep a large transaction's pages (the item database stays journaled and synced).
void prepareForBulkWrites(jet::Database& tempDb);

// Merges the staged rows into the item database: alternate keys, special prices, then price
// lists 1 to 10, one statement each. Rows staged with another price list number stay unmerged.
// Does not report: a failing statement throws to the caller, and what ran before it stays.
void MergeTempItems(const QString& tempPath);

// The log database with tStockLog.
QString CreateLogDatabase(const QString& path);

// Empties the item table before an import when `cleanItems` is set, and the special prices
// too when `alterPrices` is set as well; shows caption 42 as the step first.
void CleanItemTables(const QString& itemDbPath, bool cleanItems, bool alterPrices,
                     const Context& context, Progress& progress);

// What the upgrade does with the database folder: adds the account tables to an existing item
// database, holding the folder's lock. A folder without one has nothing to upgrade, which is no
// failure; a folder that does not exist, or an item database that is damaged or lacks its item
// tables, is a Failure that says why.
void UpgradeItemDatabase(const QString& folder);

// The tables an item database cannot do without (the account tables come with the upgrade).
QStringList itemTableNames();

// Why the database file at `path` cannot be used as it stands: it does not open as a database
// of ours, or it lacks one of `tables`. Empty when it can.
QString whyUnusable(const QString& path, const QStringList& tables);

}  // namespace etq::db

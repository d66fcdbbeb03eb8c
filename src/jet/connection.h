#pragma once

// The engine's inside: one SQLite connection with its attached link files, a cache of prepared
// statements and of table definitions. Shared by a Database and the recordsets opened on it.

#include <sqlite3.h>

#include <QHash>
#include <QString>
#include <QVariant>
#include <memory>

#include "jet/error.h"
#include "jet/types.h"

namespace etq::jet::detail {

class Connection;

// A prepared statement in use. A cached statement is reset when the use ends, so it holds no
// lock between calls; a statement made for one use only is finalized.
class Stmt {
  public:
    Stmt() = default;
    Stmt(Connection* conn, sqlite3_stmt* stmt, bool cached)
        : conn_(conn), stmt_(stmt), cached_(cached) {}
    Stmt(Stmt&& other) noexcept { *this = std::move(other); }
    Stmt& operator=(Stmt&& other) noexcept;
    Stmt(const Stmt&) = delete;
    Stmt& operator=(const Stmt&) = delete;
    ~Stmt() { release(); }

    sqlite3_stmt* get() const { return stmt_; }
    void bind(int index, const QVariant& value);  // 1-based
    bool step();                                  // true while a row is there
    int columnCount() const { return sqlite3_column_count(stmt_); }
    QVariant column(int index) const;  // 0-based, in its stored form
    void reset();

  private:
    void release();
    Connection* conn_ = nullptr;
    sqlite3_stmt* stmt_ = nullptr;
    bool cached_ = false;
};

class Connection {
  public:
    Connection(sqlite3* db, QString path);
    ~Connection();

    sqlite3* db() const { return db_; }
    const QString& path() const { return path_; }

    // A prepared statement: cached ones serve the small fixed statements of recordsets and
    // finds; others are made for one use.
    Stmt prepare(const QString& sql, bool cache = true);
    void exec(const QString& sql);  // a statement without rows or parameters

    // Throws the engine error for a failed SQLite call.
    [[noreturn]] void raise(int rc, const QString& context = {}) const;

    // Table definitions, local and linked, by name (case-insensitive).
    const TableDef* findTableDef(const QString& name);
    void forgetDefinitions() { defs_.clear(); }

    // The link files attached under an alias; a link whose file is missing is remembered so
    // that a statement naming it can say which file is missing.
    QString attach(const QString& path);  // returns the alias
    void noteBrokenLink(const QString& table, const QString& path) {
        broken_[table.toLower()] = path;
    }

    int transactionDepth = 0;

  private:
    TableDef readTableDef(const QString& schema, const QString& table, const QString& name);

    sqlite3* db_;
    QString path_;
    QHash<QString, sqlite3_stmt*> cache_;
    QHash<QString, TableDef> defs_;     // by lower-case name
    QHash<QString, QString> attached_;  // absolute path -> alias
    QHash<QString, QString> broken_;    // lower-case table name -> missing file
};

// A value read from the file, as the field's type gives it to callers: Yes/No as bool, dates
// as QDateTime, whole numbers as int.
QVariant fromStored(const QVariant& stored, const FieldDef* def);
// A value for a field, checked against the field's type and size: the form that is stored.
// Throws the engine's errors for a value that does not fit.
QVariant toStored(const QVariant& value, const FieldDef& def, const QString& table);

void registerFunctions(sqlite3* db);

}  // namespace etq::jet::detail

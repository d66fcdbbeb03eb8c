#pragma once

#include <sqlite3.h>

#include <QString>
#include <stdexcept>

#include "platform/context.h"

namespace etq::test {

// A database file that stands for the host's SQL Server database: its price lists (OPLN) and
// carriers (OSHP) with Hebrew names, an empty name and a Null name, read through the real ODBC
// driver manager and SQLite's ODBC driver (registered as "SQLite3").
inline void writeSqlSourceFile(const QString& path, bool withRows = true) {
    sqlite3* db = nullptr;
    if (sqlite3_open(path.toUtf8().constData(), &db) != SQLITE_OK)
        throw std::runtime_error("cannot make " + path.toStdString());
    const char* tables =
        "CREATE TABLE OPLN (ListNum INTEGER, ListName NVARCHAR(32));"
        "CREATE TABLE OSHP (TrnspCode INTEGER, TrnspName NVARCHAR(40));";
    const char* rows =
        "INSERT INTO OPLN VALUES (1, 'מחירון בסיס'), (2, ''), (3, NULL), (4, '  סיטונאי  ');"
        "INSERT INTO OSHP VALUES (7, 'שליחויות צפון'), (3, 'דואר ישראל'), (9, ''), (5, NULL);";
    char* error = nullptr;
    const bool ok = sqlite3_exec(db, tables, nullptr, nullptr, &error) == SQLITE_OK &&
                    (!withRows || sqlite3_exec(db, rows, nullptr, nullptr, &error) == SQLITE_OK);
    const std::string message = error ? error : "";
    sqlite3_free(error);
    sqlite3_close(db);
    if (!ok) throw std::runtime_error(message);
}

// Connection parameters that reach the file through SQLite's ODBC driver, with a password that
// holds ";" and "}" (the driver has no use for it, but it must not change the text).
inline ConnParams sqlSourceParams(const QString& path) {
    ConnParams params;
    params.driver = "SQLite3";
    params.server = "srv";
    params.user = "reader";
    params.password = "p;w}d";
    params.database = path;
    return params;
}

}  // namespace etq::test

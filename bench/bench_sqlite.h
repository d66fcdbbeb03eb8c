#pragma once

// Plain SQLite calls for the benchmarks' reference runs: what the engine is measured against.
#include <sqlite3.h>

#include <QString>
#include <QVariant>
#include <cstdio>
#include <cstdlib>

namespace etq::bench {

// Stops the benchmark at the first failing call: a reference run that fails measures nothing.
inline void check(int rc, sqlite3* db) {
    if (rc != SQLITE_OK && rc != SQLITE_DONE && rc != SQLITE_ROW) {
        std::fprintf(stderr, "sqlite: %s\n", sqlite3_errmsg(db));
        std::exit(1);
    }
}

inline void bindText(sqlite3_stmt* s, int index, const QString& text) {
    const QByteArray b = text.toUtf8();
    sqlite3_bind_text(s, index, b.constData(), int(b.size()), SQLITE_TRANSIENT);
}

inline void bindValue(sqlite3_stmt* s, int index, const QVariant& v) {
    if (v.typeId() == QMetaType::QString)
        bindText(s, index, v.toString());
    else if (v.typeId() == QMetaType::Double)
        sqlite3_bind_double(s, index, v.toDouble());
    else
        sqlite3_bind_int64(s, index, v.toLongLong());
}

}  // namespace etq::bench

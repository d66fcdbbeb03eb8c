#pragma once

// The inside of a recordset, shared by the recordset and the database that opens it.

#include <QHash>
#include <QList>
#include <QVector>
#include <memory>
#include <optional>
#include <vector>

#include "jet/connection.h"
#include "jet/recordset.h"
#include "jet/sql_translator.h"

namespace etq::jet {

struct Recordset::Impl {
    static std::unique_ptr<Impl> forTable(std::shared_ptr<detail::Connection> conn,
                                          const TableDef& table);
    static std::unique_ptr<Impl> forQuery(std::shared_ptr<detail::Connection> conn,
                                          const QString& jetSql);

    // A column of the recordset and where its values are written.
    struct Column {
        QString name;
        std::optional<FieldDef> def;  // the base table's field; none for a computed column
        int base = -1;                // index into bases; -1 = not updatable
        QString baseColumn;
    };
    struct Base {
        QString table;  // as the statements name it
        QString schemaTable;
    };
    // A row of a query recordset: its values and the rowid of each base table's row.
    struct Row {
        QVector<QVariant> values;
        QVector<qint64> rowids;
    };

    std::shared_ptr<detail::Connection> conn;
    bool tableMode = false;
    QString sourceSql;  // query recordsets: the text they were opened on, for requery

    QList<Column> columns;
    QList<Base> bases;
    QHash<QString, int> columnByName;       // lower-case name -> index
    QHash<QString, int> columnByExactName;  // as written, so the usual lookup allocates nothing

    // Statement texts by the set of columns written (bit i = column i), built once each.
    QHash<quint64, QString> insertSql;
    QHash<quint64, QString> updateSql;  // table recordsets only
    quint64 changedMask() const;
    QString buildUpdateSql(int base) const;
    QString buildInsertSql(int base) const;
    // The statement `build` makes for base `base`, kept in `kept` by the set of changed columns
    // when `keep` allows it (a mask of 64 bits tells the sets of at most 64 columns apart).
    QString writeSql(QHash<quint64, QString>& kept, bool keep, int base,
                     QString (Impl::*build)(int) const) const;
    // Binds the changed values of base `base` from ?1 on; the number of values bound.
    int bindChanged(detail::Stmt& statement, int base) const;

    // Table recordsets: the rowids in order, and the current row once it has been read.
    std::vector<qint64> keys;
    mutable qint64 cachedKey = -1;
    mutable QVector<QVariant> cachedRow;
    QString selectRowSql;

    // Query recordsets: every row, read when the recordset opens.
    std::vector<Row> rows;
    QString translatedSql;
    QList<sql::SourceTable> rowidTables;

    int pos = -1;  // -1 before the first row, count() after the last
    bool currentDeleted = false;
    bool noMatch = false;

    EditMode mode = NoEdit;
    QVector<QVariant> buffer;  // stored forms
    std::vector<bool> changed;

    int count() const { return tableMode ? int(keys.size()) : int(rows.size()); }
    bool onRow() const { return pos >= 0 && pos < count() && !currentDeleted; }
    void requireRow() const;
    void load();
    const QVector<QVariant>& currentStored() const;
    qint64 rowidOf(int row, int base) const;
    int columnIndex(const QString& name) const;
    void leaveEdit();

    void writeEdit();
    void writeNew();
    int findFrom(int start, const QString& criterion);
    int findInTable(int start, const QString& criterion);
    int findInRows(int start, const QString& criterion);
    // Finds in a table: criteria of one shape share one statement; the literals are bound.
    struct FindStatement {
        QString sql;
        int literalCount = 0;
    };
    QHash<QString, FindStatement> findByShape;
};

}  // namespace etq::jet

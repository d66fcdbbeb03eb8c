#pragma once

// New rows for one table, written several at a time by one prepared statement: the fast way for
// a run that appends many rows (an import writes hundreds of thousands). A recordset pays for
// finding its statement, for values in QVariant and for a statement per row; this pays for none.
//
// What a recordset promises still holds: every value is checked against its field when it is
// set, and fails with the same error (3163 too long, 3315 empty text, 3349 overflow, 3421 no
// conversion); a key that is there already fails with 3022. With SkipDuplicateKeys a row whose
// key is there already (or comes twice in one write) is left out and the others are written, as
// the readers have always passed over duplicates; any other failure still fails the write. With
// an Upsert, a row whose key is there already is written over the stored row instead, as a
// reader that finds a key and edits its row does: the key stays, and a field the reader leaves
// alone when the host has nothing for it keeps its stored value where the new one is Null.
//
// The caller holds the transaction; the appender writes only in write(). A failed write writes
// none of its rows and drops them.

#include <QDate>
#include <QList>
#include <QString>
#include <QStringList>
#include <QVariant>
#include <map>
#include <memory>
#include <vector>

#include "jet/database.h"
#include "jet/types.h"

namespace etq::jet {

namespace detail {
class Stmt;
}

class RowAppender {
  public:
    enum Duplicates { FailOnDuplicateKey, SkipDuplicateKeys };

    // What an Upsert writes over a stored row with the same `key` (fields of a unique index).
    struct Upsert {
        QStringList key;
        QStringList keepWhenNull;  // fields that keep their stored value where the new is Null
    };

    // Rows of `table` (local or linked) setting `fields`, which the table must have (3265).
    RowAppender(Database& db, const QString& table, const QStringList& fields,
                Duplicates duplicates = FailOnDuplicateKey);
    // Rows that update the stored row of their key, or are added when there is none.
    RowAppender(Database& db, const QString& table, const QStringList& fields,
                const Upsert& upsert);
    ~RowAppender();
    RowAppender(const RowAppender&) = delete;
    RowAppender& operator=(const RowAppender&) = delete;

    // Values of the row being made, by index into `fields`; Null until set. Each throws the
    // engine's error for a value its field cannot hold, as Recordset::setValue does.
    void setValue(int field, const QVariant& value);
    void setText(int field, const QString& text);
    void setNumber(int field, qint64 number);
    void setDouble(int field, double number);
    void setYesNo(int field, bool yes);
    void setDate(int field, QDate date);  // an invalid date is Null
    void setNull(int field);

    // Ends the row being made; it waits for write() with the others, and a new row starts.
    void addRow();
    int pendingRows() const { return int(pending_.size() / fields_.size()); }
    // Writes the waiting rows and returns how many went in (duplicates left out do not count).
    int write();

  private:
    // A value in the form the file stores.
    struct Value {
        enum Kind : quint8 { Null, Integer, Real, Text } kind = Null;
        qint64 integer = 0;
        double real = 0;
        QString text;
    };

    const FieldDef& def(int field) const;
    Value& slot(int field);
    void setStored(int field, const QVariant& stored);
    detail::Stmt& statementFor(int rows);
    int writeRows(int first, int rows);

    Database db_;  // a copy keeps the file open while the appender lives
    QString table_;
    QList<FieldDef> fields_;
    QString conflictClause_;  // what follows the VALUES of the statement
    std::vector<Value> current_;
    std::vector<Value> pending_;  // rows in order, fields_.size() values each
    std::map<int, std::unique_ptr<detail::Stmt>> statements_;  // by the rows they take
};

}  // namespace etq::jet

#include "jet/row_appender.h"

#include <algorithm>
#include <limits>

#include "jet/connection.h"
#include "jet/sql_translator.h"
#include "jet/vb.h"

namespace etq::jet {

namespace {

// Rows go in by statements of a fixed number of rows, so that each statement is prepared once
// (a statement for every count of waiting rows costs more to prepare than to run); the rows left
// over go in one by one. SQLite takes at most 32766 parameters in one statement.
constexpr int kMaxParameters = 32766;
constexpr int kRowsPerStatement = 256;

bool fitsWhole(FieldType type, qint64 n) {
    switch (type) {
        case FieldType::Byte:
            return n >= 0 && n <= 255;
        case FieldType::Integer:
            return n >= std::numeric_limits<qint16>::min() &&
                   n <= std::numeric_limits<qint16>::max();
        case FieldType::Long:
            return n >= std::numeric_limits<qint32>::min() &&
                   n <= std::numeric_limits<qint32>::max();
        default:
            return false;
    }
}

}  // namespace

RowAppender::RowAppender(Database& db, const QString& table, const QStringList& fields,
                         Duplicates duplicates)
    : db_(db) {
    const TableDef def = db.tableDef(table);
    table_ = def.name;
    for (const QString& name : fields) {
        const FieldDef* field = def.field(name);
        if (!field)
            fail(err::kItemNotFound,
                 QString("Item not found in this collection (field '%1' of '%2').")
                     .arg(name, table_));
        fields_.append(*field);
    }
    if (fields_.isEmpty()) fail(err::kInvalidArgument, "Rows to append need at least one field.");
    current_.resize(size_t(fields_.size()));
    // Only a uniqueness conflict is passed over: a broken field rule still fails.
    if (duplicates == SkipDuplicateKeys)
        conflictClause_ = QStringLiteral(" ON CONFLICT DO NOTHING");
}

RowAppender::RowAppender(Database& db, const QString& table, const QStringList& fields,
                         const Upsert& upsert)
    : RowAppender(db, table, fields, FailOnDuplicateKey) {
    QStringList key, sets;
    for (const QString& name : upsert.key)
        key << sql::quoteName(name);
    for (const FieldDef& f : fields_) {
        if (upsert.key.contains(f.name, Qt::CaseInsensitive)) continue;
        const QString name = sql::quoteName(f.name);
        // In DO UPDATE a bare name is the stored row's field, "excluded." the new row's.
        sets << (upsert.keepWhenNull.contains(f.name, Qt::CaseInsensitive)
                     ? QString("%1 = COALESCE(excluded.%1, %1)").arg(name)
                     : QString("%1 = excluded.%1").arg(name));
    }
    if (key.isEmpty()) fail(err::kInvalidArgument, "An upsert needs the fields of its key.");
    conflictClause_ =
        sets.isEmpty()
            ? QString(" ON CONFLICT(%1) DO NOTHING").arg(key.join(", "))
            : QString(" ON CONFLICT(%1) DO UPDATE SET %2").arg(key.join(", "), sets.join(", "));
}

RowAppender::~RowAppender() = default;

const FieldDef& RowAppender::def(int field) const {
    if (field < 0 || field >= fields_.size())
        fail(err::kItemNotFound, "Item not found in this collection.");
    return fields_[field];
}

RowAppender::Value& RowAppender::slot(int field) {
    def(field);
    return current_[size_t(field)];
}

void RowAppender::setStored(int field, const QVariant& stored) {
    Value& value = slot(field);
    value = Value{};
    if (stored.isNull() || !stored.isValid()) return;
    switch (stored.typeId()) {
        case QMetaType::QString:
            value.kind = Value::Text;
            value.text = stored.toString();
            break;
        case QMetaType::Double:
            value.kind = Value::Real;
            value.real = stored.toDouble();
            break;
        default:
            value.kind = Value::Integer;
            value.integer = stored.toLongLong();
    }
}

// The typed setters take the common case straight; anything else goes the recordset's way,
// which converts what it can and throws the engine's error for the rest.
void RowAppender::setValue(int field, const QVariant& value) {
    setStored(field, detail::toStored(value, def(field), table_));
}

void RowAppender::setText(int field, const QString& text) {
    const FieldDef& f = def(field);
    if (f.type != FieldType::Text || text.isEmpty() || text.size() > f.size)
        return setValue(field, text);
    Value& value = slot(field);
    value.kind = Value::Text;
    value.text = text;
}

void RowAppender::setNumber(int field, qint64 number) {
    const FieldDef& f = def(field);
    Value& value = slot(field);
    if (fitsWhole(f.type, number)) {
        value.kind = Value::Integer;
        value.integer = number;
    } else if (f.type == FieldType::Double) {
        value.kind = Value::Real;
        value.real = double(number);
    } else {
        setValue(field, QVariant(number));
    }
}

void RowAppender::setDouble(int field, double number) {
    if (def(field).type != FieldType::Double) return setValue(field, number);
    Value& value = slot(field);
    value.kind = Value::Real;
    value.real = number;
}

void RowAppender::setYesNo(int field, bool yes) {
    if (def(field).type != FieldType::Boolean) return setValue(field, yes);
    Value& value = slot(field);
    value.kind = Value::Integer;
    value.integer = yes ? -1 : 0;
}

void RowAppender::setDate(int field, QDate date) {
    if (!date.isValid()) return setNull(field);
    if (def(field).type != FieldType::Date) return setValue(field, date);
    Value& value = slot(field);
    value.kind = Value::Real;
    value.real = vb::toSerial(date);
}

void RowAppender::setNull(int field) {
    slot(field) = Value{};
}

void RowAppender::addRow() {
    for (Value& value : current_) {
        pending_.push_back(std::move(value));
        value = Value{};
    }
}

int RowAppender::write() {
    const int rows = pendingRows();
    const int perStatement = std::clamp(kMaxParameters / int(fields_.size()), 1, kRowsPerStatement);
    int written = 0;
    // The statements of one write go in whole or not at all.
    detail::Connection& connection = db_.connection();
    connection.exec("SAVEPOINT row_appender");
    try {
        int first = 0;
        for (; first + perStatement <= rows; first += perStatement)
            written += writeRows(first, perStatement);
        for (; first < rows; ++first)
            written += writeRows(first, 1);
    } catch (...) {
        pending_.clear();
        connection.exec("ROLLBACK TO row_appender");
        connection.exec("RELEASE row_appender");
        throw;
    }
    connection.exec("RELEASE row_appender");
    pending_.clear();
    return written;
}

detail::Stmt& RowAppender::statementFor(int rows) {
    std::unique_ptr<detail::Stmt>& statement = statements_[rows];
    if (statement) return *statement;
    QStringList names, marks;
    for (const FieldDef& f : fields_) {
        names << sql::quoteName(f.name);
        marks << QStringLiteral("?");
    }
    const QString row = u'(' + marks.join(u',') + u')';
    QStringList values;
    for (int r = 0; r < rows; ++r)
        values << row;
    const QString text = QString("INSERT INTO %1 (%2) VALUES %3")
                             .arg(sql::quoteName(table_), names.join(", "), values.join(u',')) +
                         conflictClause_;
    statement = std::make_unique<detail::Stmt>(db_.connection().prepare(text, false));
    return *statement;
}

int RowAppender::writeRows(int first, int rows) {
    detail::Stmt& statement = statementFor(rows);
    sqlite3_stmt* s = statement.get();
    const size_t width = size_t(fields_.size());
    for (size_t i = 0; i < size_t(rows) * width; ++i) {
        const Value& value = pending_[size_t(first) * width + i];
        const int index = int(i) + 1;
        switch (value.kind) {
            case Value::Null:
                sqlite3_bind_null(s, index);
                break;
            case Value::Integer:
                sqlite3_bind_int64(s, index, value.integer);
                break;
            case Value::Real:
                sqlite3_bind_double(s, index, value.real);
                break;
            case Value::Text:
                // The text stays in pending_ until the statement has run and been reset.
                sqlite3_bind_text16(s, index, value.text.utf16(), int(value.text.size() * 2),
                                    SQLITE_STATIC);
                break;
        }
    }
    try {
        statement.step();
    } catch (...) {
        statement.reset();
        throw;
    }
    const int written = sqlite3_changes(db_.connection().db());
    // Every parameter is bound again before the next run: no need to clear them.
    sqlite3_reset(s);
    return written;
}

}  // namespace etq::jet

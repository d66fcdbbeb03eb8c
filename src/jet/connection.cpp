#include "jet/connection.h"

#include <QDir>
#include <QFileInfo>
#include <QRegularExpression>
#include <QTimeZone>
#include <QUrl>
#include <cmath>

#include "jet/sql_translator.h"
#include "jet/vb.h"

namespace etq::jet::detail {

// ---------------------------------------------------------------------------------------------
// Stmt

Stmt& Stmt::operator=(Stmt&& other) noexcept {
    if (this != &other) {
        release();
        conn_ = other.conn_;
        stmt_ = other.stmt_;
        cached_ = other.cached_;
        other.stmt_ = nullptr;
    }
    return *this;
}

void Stmt::release() {
    if (!stmt_) return;
    if (cached_) {
        sqlite3_reset(stmt_);
        sqlite3_clear_bindings(stmt_);
    } else {
        sqlite3_finalize(stmt_);
    }
    stmt_ = nullptr;
}

void Stmt::bind(int index, const QVariant& value) {
    int rc = SQLITE_OK;
    if (value.isNull() || !value.isValid()) {
        rc = sqlite3_bind_null(stmt_, index);
    } else {
        switch (value.typeId()) {
            case QMetaType::Bool:
                rc = sqlite3_bind_int(stmt_, index, value.toBool() ? -1 : 0);
                break;
            case QMetaType::Int:
            case QMetaType::UInt:
            case QMetaType::Short:
            case QMetaType::UShort:
            case QMetaType::Char:
            case QMetaType::UChar:
            case QMetaType::SChar:
            case QMetaType::Long:
            case QMetaType::LongLong:
            case QMetaType::ULongLong:
            case QMetaType::ULong:
                rc = sqlite3_bind_int64(stmt_, index, value.toLongLong());
                break;
            case QMetaType::Double:
            case QMetaType::Float:
                rc = sqlite3_bind_double(stmt_, index, value.toDouble());
                break;
            case QMetaType::QDate:
                rc = sqlite3_bind_double(stmt_, index, vb::toSerial(value.toDate()));
                break;
            case QMetaType::QDateTime:
                rc = sqlite3_bind_double(stmt_, index, vb::toSerial(value.toDateTime()));
                break;
            case QMetaType::QByteArray: {
                const QByteArray b = value.toByteArray();
                rc =
                    sqlite3_bind_blob(stmt_, index, b.constData(), int(b.size()), SQLITE_TRANSIENT);
                break;
            }
            default: {
                const QByteArray text = value.toString().toUtf8();
                rc = sqlite3_bind_text(stmt_, index, text.constData(), int(text.size()),
                                       SQLITE_TRANSIENT);
                break;
            }
        }
    }
    if (rc != SQLITE_OK) conn_->raise(rc);
}

bool Stmt::step() {
    const int rc = sqlite3_step(stmt_);
    if (rc == SQLITE_ROW) return true;
    if (rc == SQLITE_DONE) return false;
    // The statement's own error text says more than the step's code.
    const int code = sqlite3_extended_errcode(conn_->db());
    sqlite3_reset(stmt_);
    conn_->raise(code);
}

QVariant Stmt::column(int index) const {
    switch (sqlite3_column_type(stmt_, index)) {
        case SQLITE_INTEGER:
            return QVariant(qlonglong(sqlite3_column_int64(stmt_, index)));
        case SQLITE_FLOAT:
            return QVariant(sqlite3_column_double(stmt_, index));
        case SQLITE_TEXT:
            return QVariant(
                QString::fromUtf8(reinterpret_cast<const char*>(sqlite3_column_text(stmt_, index)),
                                  sqlite3_column_bytes(stmt_, index)));
        case SQLITE_BLOB:
            return QVariant(QByteArray(static_cast<const char*>(sqlite3_column_blob(stmt_, index)),
                                       sqlite3_column_bytes(stmt_, index)));
        default:
            return QVariant();
    }
}

void Stmt::reset() {
    sqlite3_reset(stmt_);
    sqlite3_clear_bindings(stmt_);
}

// ---------------------------------------------------------------------------------------------
// Connection

Connection::Connection(sqlite3* db, QString path) : db_(db), path_(std::move(path)) {}

Connection::~Connection() {
    for (sqlite3_stmt* s : std::as_const(cache_))
        sqlite3_finalize(s);
    sqlite3_close_v2(db_);
}

Stmt Connection::prepare(const QString& sql, bool cache) {
    if (cache) {
        const auto it = cache_.constFind(sql);
        if (it != cache_.constEnd() && !sqlite3_stmt_busy(it.value()))
            return Stmt(this, it.value(), true);
    }
    const QByteArray utf8 = sql.toUtf8();
    sqlite3_stmt* stmt = nullptr;
    const char* tail = nullptr;
    const int rc = sqlite3_prepare_v3(db_, utf8.constData(), int(utf8.size()),
                                      cache ? SQLITE_PREPARE_PERSISTENT : 0, &stmt, &tail);
    if (rc != SQLITE_OK) raise(sqlite3_extended_errcode(db_), sql);
    if (tail && QByteArray(tail).trimmed().size() > 0) {
        sqlite3_finalize(stmt);
        fail(err::kSyntax, QString("Characters found after end of SQL statement: '%1'.")
                               .arg(QString::fromUtf8(tail)));
    }
    if (!stmt) fail(err::kSyntax, "The statement is empty.");
    if (cache && !cache_.contains(sql)) {
        // Statements of one-off shapes would pile up; a full cache starts again.
        if (cache_.size() >= 256) {
            for (auto i = cache_.begin(); i != cache_.end();) {
                if (sqlite3_stmt_busy(i.value())) {
                    ++i;
                } else {
                    sqlite3_finalize(i.value());
                    i = cache_.erase(i);
                }
            }
        }
        cache_.insert(sql, stmt);
        return Stmt(this, stmt, true);
    }
    return Stmt(this, stmt, false);
}

void Connection::exec(const QString& sql) {
    char* message = nullptr;
    const int rc = sqlite3_exec(db_, sql.toUtf8().constData(), nullptr, nullptr, &message);
    sqlite3_free(message);
    if (rc != SQLITE_OK) raise(sqlite3_extended_errcode(db_), sql);
}

namespace {

// The field rules are CHECK constraints named "<field>: <rule>", so that a write that breaks
// one (also from a statement, or from another program) is reported as the engine reports it.
[[noreturn]] void raiseCheck(const QString& message) {
    static const QRegularExpression re(
        "CHECK constraint failed: (.+): (too long|empty|range|yes/no|number)");
    const QRegularExpressionMatch m = re.match(message);
    if (!m.hasMatch()) fail(err::kConversion, "A value breaks a field rule: " + message);
    const QString field = m.captured(1);
    const QString rule = m.captured(2);
    if (rule == "too long")
        fail(
            err::kTooLong,
            QString(
                "The field is too small to accept the amount of data you attempted to add (field '%1').")
                .arg(field));
    if (rule == "empty")
        fail(err::kZeroLength, QString("Field '%1' cannot be a zero-length string.").arg(field));
    if (rule == "range")
        fail(err::kOverflow, QString("Numeric field overflow (field '%1').").arg(field));
    if (rule == "yes/no")
        fail(err::kConversion, QString("Field '%1' takes True (-1) or False (0).").arg(field));
    fail(err::kConversion,
         QString("Data type conversion error (field '%1' takes a number).").arg(field));
}

}  // namespace

void Connection::raise(int rc, const QString& context) const {
    const QString message = QString::fromUtf8(sqlite3_errmsg(db_));
    switch (rc) {
        case SQLITE_CONSTRAINT_PRIMARYKEY:
        case SQLITE_CONSTRAINT_UNIQUE:
            fail(
                err::kDuplicateKey,
                "The changes you requested to the table were not successful because they would create duplicate values in the index, primary key, or relationship. Change the data in the field or fields that contain duplicate data, remove the index, or redefine the index to permit duplicate entries and try again.");
        case SQLITE_CONSTRAINT_NOTNULL:
            fail(err::kNullKey, "Index or primary key cannot contain a Null value.");
        case SQLITE_CONSTRAINT_CHECK:
            raiseCheck(message);
        case SQLITE_BUSY:
        case SQLITE_BUSY_SNAPSHOT:
        case SQLITE_LOCKED:
            fail(err::kLocked, QString("Could not update; currently locked (%1).").arg(path_));
        case SQLITE_READONLY:
        case SQLITE_READONLY_DBMOVED:
            fail(err::kReadOnly,
                 QString("Cannot update. Database or object is read-only (%1).").arg(path_));
        case SQLITE_NOTADB:
        case SQLITE_CORRUPT:
            fail(err::kUnrecognizedFormat,
                 QString("Unrecognized database format '%1'.").arg(path_));
        case SQLITE_FULL:
            fail(err::kGeneric, QString("Not enough space on disk (%1).").arg(path_));
        case SQLITE_CANTOPEN:
            fail(err::kCannotOpen,
                 QString("The database engine cannot open the file '%1'.").arg(path_));
        default:
            break;
    }
    static const QRegularExpression noTable("^no such table: (?:[^.]+\\.)?(.+)$");
    static const QRegularExpression noColumn("^no such column: (.+)$");
    static const QRegularExpression noFunction("^no such function: (.+)$");
    static const QRegularExpression exists("^table \"?([^\"]+)\"? already exists$");
    if (const auto m = noTable.match(message); m.hasMatch()) {
        const QString table = m.captured(1);
        const auto it = broken_.constFind(table.toLower());
        if (it != broken_.constEnd())
            fail(err::kFileNotFound,
                 QString("Could not find file '%1' (linked table '%2').").arg(it.value(), table));
        fail(
            err::kTableNotFound,
            QString(
                "The database engine cannot find the input table or query '%1'. Make sure it exists and that its name is spelled correctly.")
                .arg(table));
    }
    if (const auto m = noColumn.match(message); m.hasMatch())
        fail(err::kUnknownField,
             QString("Unknown field '%1' in the statement.").arg(m.captured(1)));
    if (const auto m = noFunction.match(message); m.hasMatch())
        fail(err::kUnknownFunction,
             QString("Undefined function '%1' in expression.").arg(m.captured(1)));
    if (const auto m = exists.match(message); m.hasMatch())
        fail(err::kAlreadyExists, QString("Table '%1' already exists.").arg(m.captured(1)));
    if ((rc & 0xff) == SQLITE_ERROR && message.contains("syntax error"))
        fail(err::kSyntax,
             QString("Syntax error in query expression (%1): %2").arg(message, context));
    if ((rc & 0xff) == SQLITE_CONSTRAINT) fail(err::kDuplicateKey, message);
    // A function of ours that refused its arguments says so in its own words.
    fail(err::kGeneric, context.isEmpty() ? message : QString("%1 (%2)").arg(message, context));
}

QString Connection::attach(const QString& path) {
    const QString absolute = QFileInfo(path).absoluteFilePath();
    if (const auto it = attached_.constFind(absolute); it != attached_.constEnd())
        return it.value();
    const QString alias = QString("link%1").arg(attached_.size() + 1);
    // mode=rw: attaching must never create a missing file.
    QUrl url = QUrl::fromLocalFile(absolute);
    url.setQuery("mode=rw");
    Stmt attach = prepare(QString("ATTACH DATABASE ?1 AS \"%1\"").arg(alias), false);
    attach.bind(1, QString::fromUtf8(url.toEncoded()));
    try {
        attach.step();
        // A file that is not a database fails only when it is read.
        Stmt probe =
            prepare(QString("SELECT count(*) FROM \"%1\".sqlite_master").arg(alias), false);
        probe.step();
    } catch (const JetError&) {
        sqlite3_exec(db_, QString("DETACH DATABASE \"%1\"").arg(alias).toUtf8().constData(),
                     nullptr, nullptr, nullptr);
        fail(err::kUnrecognizedFormat, QString("Unrecognized database format '%1'.").arg(absolute));
    }
    attached_.insert(absolute, alias);
    return alias;
}

TableDef Connection::readTableDef(const QString& schema, const QString& table,
                                  const QString& name) {
    TableDef def;
    def.name = name;
    Stmt info =
        prepare(QString("PRAGMA \"%1\".table_info(%2)").arg(schema, sql::quoteText(table)), false);
    QList<QPair<int, QString>> key;
    while (info.step()) {
        FieldDef field;
        field.name = info.column(1).toString();
        if (!parseDeclaredType(info.column(2).toString(), &field.type, &field.size)) {
            // A table made by other means: take its values as they come.
            field.type = FieldType::Text;
            field.size = 255;
        }
        def.fields.append(field);
        if (const int pk = info.column(5).toInt(); pk > 0) key.append({pk, field.name});
    }
    std::sort(key.begin(), key.end());
    for (const auto& k : key)
        def.primaryKey << k.second;
    return def;
}

const TableDef* Connection::findTableDef(const QString& name) {
    const QString lower = name.toLower();
    if (const auto it = defs_.constFind(lower); it != defs_.constEnd()) return &it.value();
    // The first schema that has the table is the one a statement reaches: main, then the links.
    Stmt schemas = prepare("PRAGMA database_list", false);
    while (schemas.step()) {
        const QString schema = schemas.column(1).toString();
        if (schema == "temp") continue;
        Stmt find = prepare(
            QString(
                "SELECT name FROM \"%1\".sqlite_master WHERE type = 'table' AND name = ?1 COLLATE NOCASE")
                .arg(schema),
            false);
        find.bind(1, name);
        if (find.step()) {
            const QString actual = find.column(0).toString();
            const TableDef def = readTableDef(schema, actual, actual);
            return &defs_.insert(lower, def).value();
        }
    }
    return nullptr;
}

// ---------------------------------------------------------------------------------------------
// Values

QVariant fromStored(const QVariant& stored, const FieldDef* def) {
    if (!def || stored.isNull() || !stored.isValid()) return stored;
    switch (def->type) {
        case FieldType::Boolean:
            return QVariant(stored.toLongLong() != 0);
        case FieldType::Byte:
        case FieldType::Integer:
        case FieldType::Long:
            if (stored.typeId() == QMetaType::LongLong) return QVariant(int(stored.toLongLong()));
            return stored;
        case FieldType::Date:
            if (stored.typeId() == QMetaType::LongLong || stored.typeId() == QMetaType::Double) {
                return vb::fromSerial(stored.toDouble());
            }
            return stored;
        case FieldType::Double:
            if (stored.typeId() == QMetaType::LongLong) return QVariant(stored.toDouble());
            return stored;
        case FieldType::Text:
            return stored.typeId() == QMetaType::QString ? stored : QVariant(stored.toString());
    }
    return stored;
}

namespace {

[[noreturn]] void conversionError(const FieldDef& def, const QString& table,
                                  const QVariant& value) {
    fail(err::kConversion,
         QString("Data type conversion error: field '%1.%2' (%3) cannot take '%4'.")
             .arg(table, def.name, typeName(def.type), vb::toText(value)));
}

QVariant wholeNumber(const QVariant& value, const FieldDef& def, const QString& table, qint64 low,
                     qint64 high) {
    const std::optional<double> d = vb::toNumber(value);
    if (!d || !std::isfinite(*d)) conversionError(def, table, value);
    if (*d < double(low) - 0.5 || *d > double(high) + 0.5)
        fail(err::kOverflow,
             QString("Numeric field overflow: field '%1.%2' (%3) holds %4 to %5, not %6.")
                 .arg(table, def.name, typeName(def.type))
                 .arg(low)
                 .arg(high)
                 .arg(vb::toText(value)));
    const qint64 r = vb::roundHalfEven(*d);
    if (r < low || r > high)
        fail(err::kOverflow,
             QString("Numeric field overflow: field '%1.%2' (%3) holds %4 to %5, not %6.")
                 .arg(table, def.name, typeName(def.type))
                 .arg(low)
                 .arg(high)
                 .arg(r));
    return QVariant(r);
}

std::optional<double> dateSerialOf(const QVariant& value) {
    if (value.typeId() == QMetaType::QString) {
        const QString text = value.toString().trimmed();
        for (const char* f : {"d/M/yyyy", "d/M/yyyy H:mm:ss", "d/M/yyyy H:mm", "yyyy-MM-dd",
                              "yyyy-MM-ddTHH:mm:ss", "yyyy-MM-dd HH:mm:ss"}) {
            const QDateTime dt = QDateTime::fromString(text, QString::fromLatin1(f));
            if (dt.isValid()) return vb::toSerial(dt);
        }
    }
    return vb::toNumber(value);
}

}  // namespace

QVariant toStored(const QVariant& value, const FieldDef& def, const QString& table) {
    if (value.isNull() || !value.isValid()) return QVariant();
    switch (def.type) {
        case FieldType::Boolean: {
            if (value.typeId() == QMetaType::QString) {
                const QString t = value.toString().trimmed().toLower();
                if (t == "true" || t == "yes" || t == "on") return QVariant(qint64(-1));
                if (t == "false" || t == "no" || t == "off") return QVariant(qint64(0));
            }
            const std::optional<double> d = vb::toNumber(value);
            if (!d) conversionError(def, table, value);
            return QVariant(qint64(*d != 0 ? -1 : 0));
        }
        case FieldType::Byte:
            return wholeNumber(value, def, table, 0, 255);
        case FieldType::Integer:
            return wholeNumber(value, def, table, -32768, 32767);
        case FieldType::Long:
            return wholeNumber(value, def, table, -2147483648LL, 2147483647LL);
        case FieldType::Double: {
            const std::optional<double> d = vb::toNumber(value);
            if (!d) conversionError(def, table, value);
            return QVariant(*d);
        }
        case FieldType::Date: {
            const std::optional<double> d = dateSerialOf(value);
            if (!d) conversionError(def, table, value);
            return QVariant(*d);
        }
        case FieldType::Text: {
            const QString text = vb::toText(value);
            if (text.isEmpty())
                fail(err::kZeroLength,
                     QString("Field '%1.%2' cannot be a zero-length string.").arg(table, def.name));
            if (text.size() > def.size)
                fail(
                    err::kTooLong,
                    QString(
                        "The field is too small to accept the amount of data you attempted to add: field '%1.%2' holds %3 characters, the value has %4.")
                        .arg(table, def.name)
                        .arg(def.size)
                        .arg(text.size()));
            return QVariant(text);
        }
    }
    return value;
}

}  // namespace etq::jet::detail

#include "jet/database.h"

#include <QDir>
#include <QFileInfo>

#include "jet/connection.h"
#include "jet/recordset.h"
#include "jet/recordset_impl.h"
#include "jet/sql_translator.h"

namespace etq::jet {

using detail::Connection;
using detail::Stmt;
using sql::quoteName;
using sql::quoteText;

namespace {

// Files of the component carry this id, so a stray SQLite file is not taken for one.
constexpr int kApplicationId = 0x45545131;  // "ETQ1"

// The catalog tables: what the file records besides the user's tables.
const char* const kCatalog[] = {
    "CREATE TABLE MSysInfo (Name TEXT NOT NULL PRIMARY KEY, Value TEXT)",
    "CREATE TABLE MSysLinks (Name TEXT NOT NULL COLLATE NOCASE PRIMARY KEY, Connect TEXT NOT NULL, SourceTable TEXT NOT NULL)",
    "CREATE TABLE MSysQueries (Name TEXT NOT NULL COLLATE NOCASE PRIMARY KEY, SQL TEXT NOT NULL)",
};

std::shared_ptr<Connection> openConnection(const QString& path, int flags) {
    sqlite3* db = nullptr;
    const int rc = sqlite3_open_v2(QFileInfo(path).absoluteFilePath().toUtf8().constData(), &db,
                                   flags | SQLITE_OPEN_URI, nullptr);
    auto conn = std::make_shared<Connection>(db, path);
    if (rc != SQLITE_OK) {
        if (!QFileInfo(path).dir().exists())
            fail(err::kBadPath,
                 QString("'%1' isn't a valid path.").arg(QFileInfo(path).absolutePath()));
        conn->raise(rc);
    }
    sqlite3_extended_result_codes(db, 1);
    sqlite3_busy_timeout(db, 5000);
    // A double-quoted name that names nothing must be an error, never a text.
    sqlite3_db_config(db, SQLITE_DBCONFIG_DQS_DML, 0, nullptr);
    sqlite3_db_config(db, SQLITE_DBCONFIG_DQS_DDL, 0, nullptr);
    detail::registerFunctions(db);
    conn->exec("PRAGMA cache_size = -16000");
    return conn;
}

// Field rules are CHECK constraints named "<field>: <rule>"; the connection turns a broken
// rule back into the engine's error.
QString columnDefinition(const FieldDef& f, bool inKey) {
    const QString n = quoteName(f.name);
    QString out = n + " " + declaredType(f);
    if (f.type == FieldType::Text) out += " COLLATE NOCASE";
    if (inKey) out += " NOT NULL";
    auto rule = [&](const char* what, const QString& check) {
        out += QString(" CONSTRAINT %1 CHECK (%2)").arg(quoteName(f.name + ": " + what), check);
    };
    switch (f.type) {
        case FieldType::Text:
            rule("too long", QString("length(%1) <= %2").arg(n).arg(f.size));
            rule("empty", n + " <> ''");
            break;
        case FieldType::Boolean:
            rule("yes/no", n + " IN (-1, 0)");
            break;
        case FieldType::Byte:
            rule("range", n + " BETWEEN 0 AND 255");
            break;
        case FieldType::Integer:
            rule("range", n + " BETWEEN -32768 AND 32767");
            break;
        case FieldType::Long:
            rule("range", n + " BETWEEN -2147483648 AND 2147483647");
            break;
        case FieldType::Double:
        case FieldType::Date:
            // Two choices and a null test: SQLite makes a temporary table for a constant IN list
            // of three or more on every run of the statement, which costs more than the row.
            rule("number", QString("%1 IS NULL OR typeof(%1) IN ('integer', 'real')").arg(n));
            break;
    }
    return out;
}

void checkDefinition(const TableDef& def) {
    if (def.name.trimmed().isEmpty()) fail(err::kInvalidArgument, "A table needs a name.");
    if (def.fields.isEmpty())
        fail(err::kInvalidArgument, QString("Table '%1' has no fields.").arg(def.name));
    QStringList seen;
    for (const FieldDef& f : def.fields) {
        if (f.name.trimmed().isEmpty())
            fail(err::kInvalidArgument, QString("A field of '%1' has no name.").arg(def.name));
        if (seen.contains(f.name, Qt::CaseInsensitive))
            fail(err::kInvalidArgument,
                 QString("Field '%1' is defined twice in '%2'.").arg(f.name, def.name));
        seen << f.name;
        if (f.type == FieldType::Text && (f.size < 1 || f.size > 255))
            fail(err::kInvalidArgument,
                 QString("Text field '%1' needs a size of 1 to 255.").arg(f.name));
    }
    for (const QString& k : def.primaryKey)
        if (!def.field(k))
            fail(err::kItemNotFound,
                 QString("Index field '%1' is not a field of '%2'.").arg(k, def.name));
}

}  // namespace

// ---------------------------------------------------------------------------------------------

Database Database::create(const QString& path, const QString& locale) {
    if (QFileInfo::exists(path))
        fail(err::kDatabaseExists, QString("Database '%1' already exists.").arg(path));
    return initialize(path, locale);
}

Database Database::initialize(const QString& path, const QString& locale) {
    Database db(openConnection(path, SQLITE_OPEN_READWRITE | SQLITE_OPEN_CREATE));
    Connection& c = *db.conn_;
    c.exec("BEGIN");
    for (const char* ddl : kCatalog)
        c.exec(ddl);
    Stmt info = c.prepare("INSERT INTO MSysInfo (Name, Value) VALUES (?1, ?2)", false);
    for (const auto& [name, value] :
         {std::pair<QString, QString>{"Locale", locale}, {"Format", "Etiquon 1"}}) {
        info.bind(1, name);
        info.bind(2, value);
        info.step();
        info.reset();
    }
    c.exec(QString("PRAGMA application_id = %1").arg(kApplicationId));
    c.exec("COMMIT");
    return db;
}

Database Database::open(const QString& path) {
    if (!QFileInfo::exists(path))
        fail(err::kFileNotFound, QString("Could not find file '%1'.").arg(path));
    Database db(openConnection(path, SQLITE_OPEN_READWRITE));
    Connection& c = *db.conn_;
    try {
        Stmt id = c.prepare("PRAGMA application_id", false);
        if (!id.step() || id.column(0).toInt() != kApplicationId)
            throw JetError(err::kUnrecognizedFormat, {});
    } catch (const JetError&) {
        fail(err::kUnrecognizedFormat, QString("Unrecognized database format '%1'.").arg(path));
    }
    db.attachLinks();
    return db;
}

void Database::attachLinks() {
    for (const LinkDef& link : links()) {
        const QString source = link.sourcePath();
        if (!QFileInfo::exists(source)) {
            conn_->noteBrokenLink(link.name, source);
            continue;
        }
        try {
            conn_->attach(source);
        } catch (const JetError&) {
            conn_->noteBrokenLink(link.name, source);
        }
    }
}

void Database::close() {
    conn_.reset();
}

Connection& Database::connection() const {
    if (!conn_) fail(err::kClosed, "Object invalid or no longer set (the database is closed).");
    return *conn_;
}

QString Database::path() const {
    return connection().path();
}

QString Database::locale() const {
    Stmt s = connection().prepare("SELECT Value FROM main.MSysInfo WHERE Name = 'Locale'");
    return s.step() ? s.column(0).toString() : QString();
}

// --- definitions --------------------------------------------------------------------------

bool Database::nameTaken(const QString& name) const {
    return hasTable(name) || hasQuery(name);
}

void Database::createTable(const TableDef& def) {
    checkDefinition(def);
    if (nameTaken(def.name))
        fail(err::kAlreadyExists, QString("Table '%1' already exists.").arg(def.name));
    QStringList columns;
    for (const FieldDef& f : def.fields)
        columns << columnDefinition(f, def.primaryKey.contains(f.name, Qt::CaseInsensitive));
    if (!def.primaryKey.isEmpty()) {
        QStringList key;
        for (const QString& k : def.primaryKey)
            key << quoteName(def.field(k)->name);
        columns << "PRIMARY KEY (" + key.join(", ") + ")";
    }
    connection().exec(
        QString("CREATE TABLE main.%1 (%2)").arg(quoteName(def.name), columns.join(", ")));
    conn_->forgetDefinitions();
}

TableDef Database::tableDef(const QString& name) const {
    if (const TableDef* def = connection().findTableDef(name)) {
        TableDef result = *def;
        // A linked table is known here by its link's name.
        for (const LinkDef& link : links())
            if (link.name.compare(name, Qt::CaseInsensitive) == 0) result.name = link.name;
        return result;
    }
    for (const LinkDef& link : links()) {
        if (link.name.compare(name, Qt::CaseInsensitive) == 0)
            fail(err::kFileNotFound, QString("Could not find file '%1' (linked table '%2').")
                                         .arg(link.sourcePath(), name));
    }
    fail(err::kTableNotFound,
         QString("The database engine cannot find the input table or query '%1'.").arg(name));
}

bool Database::hasTable(const QString& name) const {
    Stmt s = connection().prepare(
        "SELECT 1 FROM main.sqlite_master WHERE type = 'table' AND name = ?1 COLLATE NOCASE UNION ALL SELECT 1 FROM main.MSysLinks WHERE Name = ?1");
    s.bind(1, name);
    return s.step();
}

QStringList Database::tableNames() const {
    QStringList names;
    Stmt s = connection().prepare(
        "SELECT name FROM main.sqlite_master WHERE type = 'table' AND name NOT LIKE 'MSys%' AND name NOT LIKE 'sqlite%' ORDER BY rowid");
    while (s.step())
        names << s.column(0).toString();
    for (const LinkDef& link : links())
        names << link.name;
    return names;
}

void Database::linkTable(const QString& name, const QString& sourcePath,
                         const QString& sourceTable) {
    const QString source = sourceTable.isEmpty() ? name : sourceTable;
    if (source.compare(name, Qt::CaseInsensitive) != 0)
        fail(err::kInvalidArgument,
             QString("A linked table keeps the name of its source table ('%1').").arg(source));
    if (nameTaken(name)) fail(err::kAlreadyExists, QString("Table '%1' already exists.").arg(name));
    if (!QFileInfo::exists(sourcePath))
        fail(err::kFileNotFound, QString("Could not find file '%1'.").arg(sourcePath));
    const QString alias = connection().attach(sourcePath);
    Stmt find = conn_->prepare(
        QString(
            "SELECT name FROM \"%1\".sqlite_master WHERE type = 'table' AND name = ?1 COLLATE NOCASE")
            .arg(alias),
        false);
    find.bind(1, source);
    if (!find.step())
        fail(err::kTableNotFound,
             QString("The database engine cannot find the input table or query '%1' in '%2'.")
                 .arg(source, sourcePath));
    Stmt add = conn_->prepare(
        "INSERT INTO main.MSysLinks (Name, Connect, SourceTable) VALUES (?1, ?2, ?3)", false);
    add.bind(1, name);
    // Absolute: a relative path would mean another file from another working folder.
    add.bind(2, ";DATABASE=" + QFileInfo(sourcePath).absoluteFilePath());
    add.bind(3, find.column(0).toString());
    add.step();
    conn_->forgetDefinitions();
}

QList<LinkDef> Database::links() const {
    QList<LinkDef> list;
    Stmt s = connection().prepare(
        "SELECT Name, Connect, SourceTable FROM main.MSysLinks ORDER BY rowid");
    while (s.step())
        list.append({s.column(0).toString(), s.column(1).toString(), s.column(2).toString()});
    return list;
}

void Database::createQuery(const QString& name, const QString& sqlText) {
    if (name.trimmed().isEmpty()) fail(err::kInvalidArgument, "A query needs a name.");
    if (nameTaken(name)) fail(err::kObjectExists, QString("Object '%1' already exists.").arg(name));
    // The engine checks the text when the query is made; the tables may come later.
    sql::Options syntaxOnly;
    syntaxOnly.primaryKey = [](const QString&) { return QStringList{"?"}; };
    sql::translate(sqlText, syntaxOnly);
    Stmt add =
        connection().prepare("INSERT INTO main.MSysQueries (Name, SQL) VALUES (?1, ?2)", false);
    add.bind(1, name);
    add.bind(2, sqlText);
    add.step();
}

QString Database::querySql(const QString& name) const {
    Stmt s = connection().prepare("SELECT SQL FROM main.MSysQueries WHERE Name = ?1");
    s.bind(1, name);
    return s.step() ? s.column(0).toString() : QString();
}

bool Database::hasQuery(const QString& name) const {
    Stmt s = connection().prepare("SELECT 1 FROM main.MSysQueries WHERE Name = ?1");
    s.bind(1, name);
    return s.step();
}

QStringList Database::queryNames() const {
    QStringList names;
    Stmt s = connection().prepare("SELECT Name FROM main.MSysQueries ORDER BY rowid");
    while (s.step())
        names << s.column(0).toString();
    return names;
}

// --- work ---------------------------------------------------------------------------------

int Database::execute(const QString& sqlOrQueryName, ExecuteOption option) {
    Connection& c = connection();
    QString text = sqlOrQueryName;
    const QString saved = querySql(sqlOrQueryName.trimmed());
    if (!saved.isEmpty()) text = saved;
    sql::Options options;
    options.ignoreRowErrors = option == SkipFailingRows;
    options.primaryKey = [this](const QString& table) { return tableDef(table).primaryKey; };
    const sql::Translation t = sql::translate(text, options);
    if (t.kind == sql::Translation::Select)
        fail(err::kInvalidArgument, "Cannot execute a select query.");
    Stmt s = c.prepare(t.sql);
    while (s.step()) {
    }
    return sqlite3_changes(c.db());
}

Recordset Database::openRecordset(const QString& source) {
    const QString name = source.trimmed();
    if (hasTable(name)) return Recordset(Recordset::Impl::forTable(conn_, tableDef(name)));
    const QString saved = querySql(name);
    if (saved.isEmpty() && !name.contains(u' '))
        fail(err::kTableNotFound,
             QString("The database engine cannot find the input table or query '%1'.").arg(name));
    return Recordset(Recordset::Impl::forQuery(conn_, saved.isEmpty() ? source : saved));
}

void Database::setCacheSize(int mebibytes) {
    if (mebibytes < 1) fail(err::kInvalidArgument, "A cache needs at least 1 MiB.");
    QStringList schemas;
    for (Stmt list = connection().prepare("PRAGMA database_list", false); list.step();)
        schemas << list.column(1).toString();
    for (const QString& schema : schemas)
        if (schema != u"temp")
            connection().exec(QString("PRAGMA %1.cache_size = -%2")
                                  .arg(sql::quoteName(schema))
                                  .arg(qint64(mebibytes) * 1024));
}

void Database::setScratch() {
    connection().exec("PRAGMA main.journal_mode = OFF");
    connection().exec("PRAGMA main.synchronous = OFF");
}

void Database::beginTrans() {
    Connection& c = connection();
    c.exec(c.transactionDepth == 0 ? QString("BEGIN")
                                   : QString("SAVEPOINT level%1").arg(c.transactionDepth));
    ++c.transactionDepth;
}

void Database::commitTrans() {
    Connection& c = connection();
    if (c.transactionDepth == 0) fail(err::kInvalidArgument, "Commit without a transaction.");
    --c.transactionDepth;
    c.exec(c.transactionDepth == 0 ? QString("COMMIT")
                                   : QString("RELEASE level%1").arg(c.transactionDepth));
}

void Database::rollback() {
    Connection& c = connection();
    if (c.transactionDepth == 0) fail(err::kInvalidArgument, "Rollback without a transaction.");
    --c.transactionDepth;
    if (c.transactionDepth == 0) {
        c.exec("ROLLBACK");
    } else {
        c.exec(QString("ROLLBACK TO level%1").arg(c.transactionDepth));
        c.exec(QString("RELEASE level%1").arg(c.transactionDepth));
    }
}

}  // namespace etq::jet

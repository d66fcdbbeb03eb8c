#include "import/odbc.h"

#include <sql.h>
#include <sqlext.h>

#include <QStringList>

#include "platform/failure.h"

namespace etq::odbc {

namespace {

// What the driver manager and the driver said about the handle's last call.
QString diagnostics(SQLSMALLINT type, SQLHANDLE handle) {
    QStringList records;
    SQLCHAR state[6];
    SQLCHAR text[1024];
    SQLINTEGER native = 0;
    SQLSMALLINT length = 0;
    for (SQLSMALLINT i = 1;
         SQLGetDiagRec(type, handle, i, state, &native, text, sizeof text, &length) == SQL_SUCCESS;
         ++i)
        records << QStringLiteral("%1 (%2)").arg(
            QString::fromUtf8(reinterpret_cast<char*>(text)),
            QString::fromLatin1(reinterpret_cast<char*>(state)));
    return records.join(QStringLiteral("; "));
}

// An ODBC handle, freed with its owner.
class Handle {
  public:
    Handle(SQLSMALLINT type, SQLHANDLE parent, const char* what) : type_(type) {
        if (!SQL_SUCCEEDED(SQLAllocHandle(type, parent, &handle_))) {
            handle_ = SQL_NULL_HANDLE;
            throw QuietFailure(QStringLiteral("ODBC: cannot allocate %1").arg(what));
        }
    }
    ~Handle() {
        if (handle_ != SQL_NULL_HANDLE) SQLFreeHandle(type_, handle_);
    }
    Handle(const Handle&) = delete;
    Handle& operator=(const Handle&) = delete;

    SQLHANDLE get() const { return handle_; }
    // Throws the handle's diagnostics when `result` is a failure.
    void check(SQLRETURN result, const QString& doing) const {
        if (SQL_SUCCEEDED(result)) return;
        const QString said = diagnostics(type_, handle_);
        throw QuietFailure(said.isEmpty() ? doing + QStringLiteral(" failed")
                                          : doing + QStringLiteral(": ") + said);
    }

  private:
    SQLSMALLINT type_;
    SQLHANDLE handle_ = SQL_NULL_HANDLE;
};

// The driver manager's environment, speaking ODBC 3.
class Environment : public Handle {
  public:
    Environment() : Handle(SQL_HANDLE_ENV, SQL_NULL_HANDLE, "an environment") {
        check(SQLSetEnvAttr(get(), SQL_ATTR_ODBC_VERSION,
                            reinterpret_cast<SQLPOINTER>(SQL_OV_ODBC3), 0),
              QStringLiteral("ODBC version"));
    }
};

// An open connection of the text; closed when it goes.
class Connection {
  public:
    explicit Connection(const QString& text)
        : connection_(SQL_HANDLE_DBC, environment_.get(), "a connection") {
        SQLSetConnectAttr(connection_.get(), SQL_ATTR_LOGIN_TIMEOUT,
                          reinterpret_cast<SQLPOINTER>(SQLULEN(kLoginTimeoutSeconds)), 0);
        QByteArray utf8 = text.toUtf8();
        SQLCHAR completed[1024];
        SQLSMALLINT length = 0;
        connection_.check(
            SQLDriverConnect(connection_.get(), nullptr, reinterpret_cast<SQLCHAR*>(utf8.data()),
                             SQL_NTS, completed, sizeof completed, &length, SQL_DRIVER_NOPROMPT),
            QStringLiteral("ODBC connection"));
        connected_ = true;
    }
    ~Connection() {
        if (connected_) SQLDisconnect(connection_.get());
    }
    Connection(const Connection&) = delete;
    Connection& operator=(const Connection&) = delete;

    SQLHANDLE get() const { return connection_.get(); }

  private:
    Environment environment_;
    Handle connection_;
    bool connected_ = false;
};

// One column of the current row as text, read in pieces as long as the driver has more.
QVariant columnText(const Handle& statement, SQLUSMALLINT column) {
    QString text;
    SQLWCHAR piece[512];
    for (;;) {
        SQLLEN indicator = 0;
        const SQLRETURN result =
            SQLGetData(statement.get(), column, SQL_C_WCHAR, piece, sizeof piece, &indicator);
        if (result == SQL_NO_DATA) break;
        statement.check(result, QStringLiteral("ODBC read of column %1").arg(column));
        if (indicator == SQL_NULL_DATA) return QVariant();
        qsizetype units = 0;
        while (units < qsizetype(std::size(piece)) && piece[units] != 0)
            ++units;
        text += QString::fromUtf16(reinterpret_cast<const char16_t*>(piece), units);
        if (result == SQL_SUCCESS) break;  // with info: the piece was cut short, more follows
    }
    return text;
}

}  // namespace

QString bracedValue(const QString& value) {
    QString braced = value;
    braced.replace(u'}', QStringLiteral("}}"));
    return u'{' + braced + u'}';
}

QString attributeValue(const QString& value) {
    static const QString kMeaningful = QStringLiteral("[]{}(),;?*=!@");
    bool plain = value.isEmpty() || (!value.front().isSpace() && !value.back().isSpace());
    for (const QChar c : value)
        if (kMeaningful.contains(c)) plain = false;
    return plain ? value : bracedValue(value);
}

QString attribute(const QString& key, const QString& value) {
    return key + u'=' + attributeValue(value);
}

QList<Row> readRows(const QString& connectionText, const QString& select) {
    Connection connection(connectionText);
    Handle statement(SQL_HANDLE_STMT, connection.get(), "a statement");
    QByteArray sql = select.toUtf8();
    statement.check(SQLExecDirect(statement.get(), reinterpret_cast<SQLCHAR*>(sql.data()), SQL_NTS),
                    QStringLiteral("\"%1\"").arg(select));
    SQLSMALLINT columns = 0;
    statement.check(SQLNumResultCols(statement.get(), &columns),
                    QStringLiteral("\"%1\"").arg(select));
    QList<Row> rows;
    for (;;) {
        const SQLRETURN fetched = SQLFetch(statement.get());
        if (fetched == SQL_NO_DATA) break;
        statement.check(fetched, QStringLiteral("\"%1\"").arg(select));
        Row row;
        for (SQLUSMALLINT c = 1; c <= SQLUSMALLINT(columns); ++c)
            row.append(columnText(statement, c));
        rows.append(row);
    }
    return rows;
}

void testConnection(const QString& connectionText) {
    Connection connection(connectionText);
}

}  // namespace etq::odbc

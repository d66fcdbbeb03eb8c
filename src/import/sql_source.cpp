#include "import/sql_source.h"

#include "import/connection.h"
#include "import/odbc.h"
#include "import/public_functions.h"

namespace etq {

namespace {

// A number column read as text: "3", or "3.0" from a driver that writes decimals.
int wholeNumber(const QVariant& text) {
    return qRound(text.toString().trimmed().toDouble());
}

// The rows of a two-column list, number then name, as entries of the named rows.
std::optional<EntryList> readList(const ConnParams& params, const QString& select) {
    const QList<odbc::Row> rows = odbc::readRows(sqlServerConnString(params), select);
    if (rows.isEmpty()) return std::nullopt;
    EntryList entries;
    for (const odbc::Row& row : rows) {
        const QString name = NullToText(row.value(1));
        if (!name.isEmpty()) entries.append({name, wholeNumber(row.value(0))});
    }
    return entries;
}

}  // namespace

std::optional<EntryList> ReadPriceLists(const ConnParams& params) {
    return readList(params, QStringLiteral("SELECT ListNum, ListName FROM OPLN"));
}

std::optional<EntryList> ReadCarriers(const ConnParams& params) {
    return readList(params,
                    QStringLiteral("SELECT TrnspCode, TrnspName FROM OSHP Order By TrnspName"));
}

void TestSqlServerConnection(const ConnParams& params) {
    odbc::testConnection(sqlServerConnString(params));
}

}  // namespace etq

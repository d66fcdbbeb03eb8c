#pragma once

#include <QList>
#include <QString>
#include <QVariant>

// A database reached through ODBC (unixODBC's driver manager and the driver the connection text
// names): open a connection text, run one SELECT, read all its rows, close. Nothing stays open
// between calls. Every failure (no such driver, a server that does not answer, a refused login, a
// statement the database rejects) throws QuietFailure with the driver's own diagnostics.
namespace etq::odbc {

// A value of a connection text between braces, every "}" in it doubled: "a;b}c" -> "{a;b}}c}".
QString bracedValue(const QString& value);

// A value of a connection text: as it is when nothing in it has a meaning in the text, else
// braced, so that no value can end itself early or add an attribute. Plain values stay plain
// because some drivers (SQLite's) take braces as part of a value.
QString attributeValue(const QString& value);

// "Key=value" with the value as attributeValue gives it.
QString attribute(const QString& key, const QString& value);

// One row: each column's text, a Null as an invalid QVariant.
using Row = QList<QVariant>;

// The rows of `select` on the connection the text opens, in the order the database gives them.
QList<Row> readRows(const QString& connectionText, const QString& select);

// Opens the connection and closes it again: whether the text reaches its database.
void testConnection(const QString& connectionText);

// How long a connection may take to open before it counts as unreachable, in seconds.
inline constexpr int kLoginTimeoutSeconds = 15;

}  // namespace etq::odbc

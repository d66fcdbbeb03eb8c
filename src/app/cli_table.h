#pragma once

#include <QList>
#include <QStringList>
#include <QVariant>
#include <optional>

namespace etq::cli {

// How a command prints rows: a plain table under its column names (on a terminal), one row a
// line with tab-separated values (piped), or a JSON array of objects.
enum class RowFormat { Table, Tsv, Json };

// Removes "--format table|tsv|json" from args. Without it: a table when stdout is a terminal,
// tab-separated otherwise. Nothing for a value it does not know (printed as an error).
std::optional<RowFormat> takeFormat(QStringList& args);

// Prints the rows under their column names. In tab-separated lines a Null is empty and a tab,
// line break or backslash inside a value is written \t, \n, \r or \\; in JSON a Null is null.
void printRows(const QStringList& columns, const QList<QVariantList>& rows, RowFormat format);

}  // namespace etq::cli

#include "app/cli_table.h"

#include <unistd.h>

#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <QTextStream>
#include <cstdio>

#include "app/cli_command.h"
#include "jet/vb.h"

namespace etq::cli {

namespace {

QString escapedForTsv(const QString& text) {
    QString out;
    out.reserve(text.size());
    for (const QChar c : text) {
        if (c == u'\\')
            out += QStringLiteral("\\\\");
        else if (c == u'\t')
            out += QStringLiteral("\\t");
        else if (c == u'\n')
            out += QStringLiteral("\\n");
        else if (c == u'\r')
            out += QStringLiteral("\\r");
        else
            out += c;
    }
    return out;
}

QStringList cellsOf(const QVariantList& row) {
    QStringList cells;
    for (const QVariant& value : row)
        cells << escapedForTsv(vb::toText(value));
    return cells;
}

void printTable(QTextStream& out, const QStringList& columns, const QList<QVariantList>& rows) {
    QList<QStringList> lines{columns};
    for (const QVariantList& row : rows)
        lines << cellsOf(row);
    QList<qsizetype> widths(columns.size(), 0);
    for (const QStringList& line : lines)
        for (qsizetype c = 0; c < line.size() && c < widths.size(); ++c)
            widths[c] = std::max(widths[c], line[c].size());
    for (const QStringList& line : lines) {
        QString text;
        for (qsizetype c = 0; c < line.size(); ++c)
            text += c + 1 < line.size() ? line[c].leftJustified(widths[c] + 2) : line[c];
        out << text.trimmed() << '\n';
    }
}

}  // namespace

std::optional<RowFormat> takeFormat(QStringList& args) {
    const QString format = takeOption(args, QStringLiteral("--format"));
    if (format.isEmpty()) return isatty(fileno(stdout)) ? RowFormat::Table : RowFormat::Tsv;
    if (format == u"table") return RowFormat::Table;
    if (format == u"tsv") return RowFormat::Tsv;
    if (format == u"json") return RowFormat::Json;
    printError(QStringLiteral("--format takes table, tsv or json, not '%1'").arg(format));
    return std::nullopt;
}

void printRows(const QStringList& columns, const QList<QVariantList>& rows, RowFormat format) {
    QTextStream out(stdout);
    switch (format) {
        case RowFormat::Table:
            printTable(out, columns, rows);
            break;
        case RowFormat::Tsv:
            for (const QVariantList& row : rows)
                out << cellsOf(row).join(u'\t') << '\n';
            break;
        case RowFormat::Json: {
            QJsonArray array;
            for (const QVariantList& row : rows) {
                QJsonObject object;
                for (qsizetype c = 0; c < columns.size() && c < row.size(); ++c)
                    object.insert(columns[c], QJsonValue::fromVariant(row[c]));
                array.append(object);
            }
            out << QJsonDocument(array).toJson(QJsonDocument::Indented);
            break;
        }
    }
    out.flush();
}

}  // namespace etq::cli

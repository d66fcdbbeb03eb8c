// etiquon-cli scan-ranges, doc-types, list-docs, include-docs, exclude-docs, include-lines,
// exclude-lines and set-copies: the scan range window, the document type grid and the document
// line selection window without windows.
#include <QTextStream>
#include <optional>

#include "app/cli_command.h"
#include "db/file_names.h"
#include "dialogs/bound_grid_model.h"
#include "dialogs/doc_line_selection.h"
#include "dialogs/doc_types.h"
#include "import/scan_ranges.h"
#include "jet/vb.h"
#include "platform/failure.h"

namespace etq::cli {

namespace {

using S = DocLineSelection;

int usage(const char* text) {
    printError(QStringLiteral("usage: etiquon-cli %1 [--setting-id N]").arg(text));
    return 2;
}

// The arguments of a command on a database folder: --db DIR and the rest, in order.
struct FolderArgs {
    QString folder;
    QStringList rest;
};
std::optional<FolderArgs> folderArgs(const QStringList& arguments) {
    QStringList args = arguments;
    takeCommonOptions(args);  // the database folder is the same for every SettingID
    FolderArgs parsed{takeOption(args, "--db"), args};
    if (parsed.folder.isEmpty()) return std::nullopt;
    return parsed;
}

QString yesNo(const QVariant& flag) {
    return !flag.isNull() && flag.toBool() ? QStringLiteral("yes") : QStringLiteral("no");
}

// A document as the commands name it: its document file and number, "1/101".
QString documentName(const DocumentKey& key) {
    return QStringLiteral("%1/%2").arg(key.wizFileId).arg(key.number);
}

std::optional<DocumentKey> parseDocument(const QString& text) {
    const QStringList parts = text.split(u'/');
    if (parts.size() != 2) return std::nullopt;
    bool file = false, number = false;
    const DocumentKey key{parts[0].toInt(&file), parts[1].toInt(&number)};
    if (!file || !number) return std::nullopt;
    return key;
}

// The documents of the last document import in the database folder, opened for a command.
class Documents {
  public:
    explicit Documents(const QString& folder) { selection_.openDocuments(folder); }
    DocLineSelection& selection() { return selection_; }

    // The row of the document named `text`; throws when there is no such document.
    int row(const QString& text) const {
        const std::optional<DocumentKey> key = parseDocument(text);
        if (!key)
            throw BadSetting(QStringLiteral("'%1' names no document: write the document file and "
                                            "the document's number, as in 1/101")
                                 .arg(text));
        const int found = selection_.findDocument(*key);
        if (found < 0) throw BadSetting(QStringLiteral("no document %1 was imported").arg(text));
        return found;
    }
    // The row of line `text` of the document shown; throws when it is not listed.
    int lineRow(const QString& text) const {
        bool ok = false;
        const int lineNum = text.toInt(&ok);
        const int found = ok ? selection_.findLine(lineNum) : -1;
        if (found < 0)
            throw BadSetting(
                QStringLiteral("document %1 has no line %2 whose item is known")
                    .arg(documentName(selection_.documentAt(selection_.currentDocument())), text));
        return found;
    }

  private:
    BoundGridModel documents_, lines_;
    DocLineSelection selection_{documents_, lines_};
};

void listLines(QTextStream& out, DocLineSelection& selection) {
    for (int row = 0; row < selection.lineCount(); ++row) {
        QStringList cells;
        for (int column = S::kLineNumColumn; column < S::kLineIncludeColumn; ++column)
            cells << vb::toText(selection.lineCell(row, column));
        cells << yesNo(selection.lineCell(row, S::kLineIncludeColumn));
        out << "  " << cells.join(u'\t') << '\n';
    }
}

int includeDocuments(const QStringList& arguments, bool include) {
    const char* text = include ? "include-docs --db DIR (--all | DOC...)"
                               : "exclude-docs --db DIR (--all | DOC...)";
    std::optional<FolderArgs> parsed = folderArgs(arguments);
    if (!parsed) return usage(text);
    const bool all = takeFlag(parsed->rest, "--all");
    if (all == !parsed->rest.isEmpty()) return usage(text);
    return runReporting([&] {
        Documents documents(parsed->folder);
        DocLineSelection& selection = documents.selection();
        if (all) selection.includeAllDocuments(include);
        for (const QString& name : parsed->rest)
            selection.includeDocument(documents.row(name), include);
        if (!selection.lastError().isEmpty()) throw Failure(selection.lastError());
    });
}

int includeLines(const QStringList& arguments, bool include) {
    const char* text = include ? "include-lines --db DIR DOC (--all | LINE...)"
                               : "exclude-lines --db DIR DOC (--all | LINE...)";
    std::optional<FolderArgs> parsed = folderArgs(arguments);
    if (!parsed) return usage(text);
    const bool all = takeFlag(parsed->rest, "--all");
    if (parsed->rest.isEmpty() || all == (parsed->rest.size() > 1)) return usage(text);
    return runReporting([&] {
        Documents documents(parsed->folder);
        DocLineSelection& selection = documents.selection();
        selection.showLines(documents.row(parsed->rest.takeFirst()));
        if (all) selection.includeAllLines(include);
        for (const QString& line : parsed->rest)
            selection.includeLine(documents.lineRow(line), include);
        if (!selection.lastError().isEmpty()) throw Failure(selection.lastError());
    });
}

// "1,2,5" or "all" of the document types there are; nothing when a number is no type number.
std::optional<QList<qint16>> typeList(const QString& text, const QList<DocTypeRow>& types) {
    QList<qint16> list;
    if (text == u"all") {
        for (const DocTypeRow& type : types)
            list << type.type;
        return list;
    }
    for (const QString& part : text.split(u',')) {
        bool ok = false;
        list << part.trimmed().toShort(&ok);
        if (!ok) return std::nullopt;
    }
    return list;
}

}  // namespace

int runScanRanges(const QStringList& arguments) {
    std::optional<FolderArgs> parsed = folderArgs(arguments);
    if (!parsed) return usage("scan-ranges --db DIR [--reset]");
    const bool reset = takeFlag(parsed->rest, "--reset");
    if (!parsed->rest.isEmpty()) return usage("scan-ranges --db DIR [--reset]");
    const QString docDb = db::inFolder(parsed->folder, db::kDocDatabaseFile);
    return runReporting([&] {
        if (reset) resetScanRanges(docDb);
        QTextStream out(stdout);
        for (const ScanRangeRow& row : readScanRanges(docDb))
            out << row.lastRecord << '\t' << row.nextStart << '\t' << row.description << '\n';
    });
}

int runDocTypes(const QStringList& arguments) {
    const char* text =
        "doc-types --db DIR [--scan TYPES] [--no-scan TYPES] [--drafts TYPES] [--no-drafts TYPES]";
    std::optional<FolderArgs> parsed = folderArgs(arguments);
    if (!parsed) return usage(text);
    struct Change {
        const char* option;
        bool scanFlag;
        bool value;
        QString types;
    } changes[] = {{"--scan", true, true, {}},
                   {"--no-scan", true, false, {}},
                   {"--drafts", false, true, {}},
                   {"--no-drafts", false, false, {}}};
    for (Change& change : changes)
        change.types = takeOption(parsed->rest, change.option);
    if (!parsed->rest.isEmpty()) return usage(text);
    const QString docDb = db::inFolder(parsed->folder, db::kDocDatabaseFile);
    return runReporting([&] {
        for (const Change& change : changes) {
            if (change.types.isEmpty()) continue;
            const std::optional<QList<qint16>> types = typeList(change.types, readDocTypes(docDb));
            if (!types)
                throw BadSetting(QStringLiteral("%1 takes document type numbers such as 1,2,5 or "
                                                "all, not '%2'")
                                     .arg(change.option, change.types));
            for (qint16 type : *types)
                setDocTypeFlags(docDb, type,
                                change.scanFlag ? std::optional(change.value) : std::nullopt,
                                change.scanFlag ? std::nullopt : std::optional(change.value));
        }
        QTextStream out(stdout);
        for (const DocTypeRow& type : readDocTypes(docDb))
            out << type.type << '\t' << "scan " << yesNo(type.scan) << '\t' << "drafts "
                << yesNo(type.drafts) << '\t' << type.description << '\n';
    });
}

int runListDocs(const QStringList& arguments) {
    std::optional<FolderArgs> parsed = folderArgs(arguments);
    if (!parsed) return usage("list-docs --db DIR [--lines] [DOC...]");
    const bool withLines = takeFlag(parsed->rest, "--lines");
    return runReporting([&] {
        Documents documents(parsed->folder);
        DocLineSelection& selection = documents.selection();
        QList<int> rows;
        for (const QString& name : parsed->rest)
            rows << documents.row(name);
        if (parsed->rest.isEmpty())
            for (int row = 0; row < selection.documentCount(); ++row)
                rows << row;
        QTextStream out(stdout);
        for (int row : rows) {
            QStringList cells{documentName(selection.documentAt(row))};
            for (int column = S::kDocTypeColumn; column <= S::kCardNameColumn; ++column) {
                const QVariant value = selection.documentCell(row, column);
                cells << (column == S::kDocIncludeColumn ? yesNo(value) : vb::toText(value));
            }
            out << cells.join(u'\t') << '\n';
            if (!withLines) continue;
            selection.showLines(row);
            listLines(out, selection);
        }
    });
}

int runIncludeDocs(const QStringList& arguments) {
    return includeDocuments(arguments, true);
}

int runExcludeDocs(const QStringList& arguments) {
    return includeDocuments(arguments, false);
}

int runIncludeLines(const QStringList& arguments) {
    return includeLines(arguments, true);
}

int runExcludeLines(const QStringList& arguments) {
    return includeLines(arguments, false);
}

int runSetCopies(const QStringList& arguments) {
    const char* text = "set-copies --db DIR DOC LINE COPIES";
    std::optional<FolderArgs> parsed = folderArgs(arguments);
    if (!parsed || parsed->rest.size() != 3) return usage(text);
    bool numeric = false;
    const int copies = parsed->rest[2].toInt(&numeric);
    if (!numeric) return usage(text);
    return runReporting([&] {
        Documents documents(parsed->folder);
        DocLineSelection& selection = documents.selection();
        selection.showLines(documents.row(parsed->rest[0]));
        selection.setCopies(documents.lineRow(parsed->rest[1]), copies);
    });
}

}  // namespace etq::cli

#include "dialogs/doc_line_selection.h"

#include "db/file_names.h"
#include "dialogs/bound_grid_model.h"
#include "dialogs/doc_lines_query.h"
#include "jet/error.h"
#include "jet/vb.h"

namespace etq {

namespace {

const QString kDocumentsQuery = QStringLiteral("qSelectDocHeaders");

}  // namespace

DocLineSelection::DocLineSelection(BoundGridModel& documents, BoundGridModel& lines)
    : documents_(documents), lines_(lines) {}

void DocLineSelection::openDocuments(const QString& databaseFolder) {
    const QString workDb = db::inFolder(databaseFolder, db::kWorkDatabaseFile);
    documents_.setDatabaseName(workDb);
    lines_.setDatabaseName(workDb);
    lines_.close();
    currentDocument_ = -1;
    documents_.setRecordSource(kDocumentsQuery);
    documents_.refresh();
}

void DocLineSelection::showLines(int row) {
    const bool listed = row >= 0 && row < documentCount();
    currentDocument_ = listed ? row : -1;
    if (!listed) {
        lines_.close();
        return;
    }
    lines_.setRecordSource(BuildDocLinesQuery(vb::toText(documentCell(row, kWizFileColumn)),
                                              vb::toText(documentCell(row, kNumberColumn))));
    lines_.refresh();
}

int DocLineSelection::documentCount() const {
    return documents_.rowCount();
}

int DocLineSelection::lineCount() const {
    return lines_.rowCount();
}

QVariant DocLineSelection::documentCell(int row, int column) const {
    return documents_.cell(row, modelColumn(column));
}

QVariant DocLineSelection::lineCell(int row, int column) const {
    return lines_.cell(row, modelColumn(column));
}

DocumentKey DocLineSelection::documentAt(int row) const {
    return {vb::toLong(documentCell(row, kWizFileColumn)).value_or(0),
            vb::toLong(documentCell(row, kNumberColumn)).value_or(0)};
}

int DocLineSelection::findDocument(const DocumentKey& key) const {
    for (int row = 0; row < documentCount(); ++row)
        if (documentAt(row) == key) return row;
    return -1;
}

int DocLineSelection::findLine(int lineNum) const {
    for (int row = 0; row < lineCount(); ++row)
        if (vb::toLong(lineCell(row, kLineNumColumn)) == lineNum) return row;
    return -1;
}

void DocLineSelection::writeAll(BoundGridModel& grid, int gridColumn, bool value) {
    for (int row = 0; row < grid.rowCount(); ++row) {
        try {
            grid.writeCell(row, modelColumn(gridColumn), value);
        } catch (const jet::JetError& e) {
            lastError_ = e.description();
        }
    }
}

void DocLineSelection::includeAllDocuments(bool include) {
    writeAll(documents_, kDocIncludeColumn, include);
}

void DocLineSelection::includeAllLines(bool include) {
    writeAll(lines_, kLineIncludeColumn, include);
}

void DocLineSelection::includeDocument(int row, bool include) {
    documents_.writeCell(row, modelColumn(kDocIncludeColumn), include);
}

void DocLineSelection::includeLine(int row, bool include) {
    lines_.writeCell(row, modelColumn(kLineIncludeColumn), include);
}

void DocLineSelection::setCopies(int row, const QVariant& copies) {
    lines_.writeCell(row, modelColumn(kCopiesColumn), copies);
}

}  // namespace etq

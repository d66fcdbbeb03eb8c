#pragma once

#include <QString>
#include <QVariant>

namespace etq {

class BoundGridModel;

// A document as the working database keys it: its host document file and its number there.
struct DocumentKey {
    qint32 wizFileId = 0;
    qint32 number = 0;
    bool operator==(const DocumentKey&) const = default;
};

// What the document line selection window does with its two grids, without the window: the
// documents of the last document import (qSelectDocHeaders of the working database) in one
// bound grid, the lines of the current document (BuildDocLinesQuery) in the other. Every
// print flag and every copies value is written straight to tTempDocHeaders and tTempDocLines.
// The window's buttons and the command line both call it.
class DocLineSelection {
  public:
    // Columns of the document grid, as the window counts them (column 0 is the fixed column).
    static constexpr int kDocTypeColumn = 1;
    static constexpr int kReferenceColumn = 2;
    static constexpr int kDateColumn = 3;
    static constexpr int kAccountColumn = 4;
    static constexpr int kDocIncludeColumn = 5;
    static constexpr int kCardNameColumn = 6;
    static constexpr int kWizFileColumn = 7;  // hidden
    static constexpr int kNumberColumn = 8;   // hidden
    // Columns of the line grid.
    static constexpr int kLineNumColumn = 1;
    static constexpr int kItemKeyColumn = 2;
    static constexpr int kItemNameColumn = 3;
    static constexpr int kQuantityColumn = 4;
    static constexpr int kWarehouseColumn = 5;
    static constexpr int kCopiesColumn = 6;
    static constexpr int kLineIncludeColumn = 7;

    DocLineSelection(BoundGridModel& documents, BoundGridModel& lines);

    // Lists the documents of the working database in the database folder. Throws
    // jet::JetError when it cannot be opened; the grids are then empty.
    void openDocuments(const QString& databaseFolder);
    // Lists the lines of the document in row `row` of the document grid; with no such row
    // (no document imported) the line grid is empty. Throws jet::JetError when the lines
    // cannot be read; the line grid is then empty.
    void showLines(int row);
    int currentDocument() const { return currentDocument_; }

    int documentCount() const;
    int lineCount() const;
    DocumentKey documentAt(int row) const;
    // The row of a document, of a line of the current document; -1 when not listed.
    int findDocument(const DocumentKey& key) const;
    int findLine(int lineNum) const;

    // A cell as the grid shows it.
    QVariant documentCell(int row, int column) const;
    QVariant lineCell(int row, int column) const;

    // Every document listed, every line of the current document: included (true) or not. A
    // row the engine refuses is passed over (lastError() keeps its word).
    void includeAllDocuments(bool include);
    void includeAllLines(bool include);
    // One document, one line of the current document; the copies of one line. Throw
    // jet::JetError when the engine refuses (copies beyond a 16-bit number, say).
    void includeDocument(int row, bool include);
    void includeLine(int row, bool include);
    void setCopies(int row, const QVariant& copies);

    const QString& lastError() const { return lastError_; }

  private:
    static int modelColumn(int gridColumn) { return gridColumn - 1; }
    void writeAll(BoundGridModel& grid, int gridColumn, bool value);

    BoundGridModel& documents_;
    BoundGridModel& lines_;
    int currentDocument_ = -1;
    QString lastError_;
};

}  // namespace etq

#pragma once

// Where the incremental scan of each host document file stands, and what the scan range window
// does with it. The positions live in tWizFileRanges of the document database, one row per
// document file (WizFileID), and count records as a user counts them, from 1:
//
//   FromIndx  the number of the record the next scan starts at: the first record the last scan
//             did not read. 0 and 1 both mean the first record of the file.
//   LastIndx  the number of the last record the last complete scan went through, which is the
//             file's record count when it ended; 0 before any scan.
//
// A complete scan of a file of N records leaves LastIndx = N and FromIndx = N + 1, so the next
// scan starts with the first record the host appended since, and no record is ever skipped. (The
// component always stored these values; it read FromIndx back as a 0-based index and so never
// read record N + 1.) The window's column 3, "Next scan start", shows FromIndx as it is.
//
// The window functions take the path of the document database and open it for the call only.
// Failures throw (the engine's JetError); the reset passes over a row it cannot write.

#include <QList>
#include <QString>
#include <QVariant>

namespace etq {

// The 0-based index of the record a scan starts at, for the stored FromIndx and the file's
// record count now. A start beyond the end of the file means the host rebuilt or packed the file
// since the last scan: the scan starts with the first record again. A start just past the last
// record reads nothing, as nothing is new.
qint64 firstRecordToScan(qint64 nextStart, qint64 recordCount);

// What a complete scan of a file of `recordCount` records leaves in tWizFileRanges.
struct ScanPosition {
    qint64 lastRecord = 0;  // LastIndx
    qint64 nextStart = 0;   // FromIndx
};
ScanPosition positionAfterScan(qint64 recordCount);

// The columns of the scan range window, numbered as the window numbers them.
enum ScanRangeColumn { DescriptionColumn = 1, LastRecordColumn = 2, NextStartColumn = 3 };

// A row of qWizFileRanges as the window shows it; Null shows as an empty text or 0.
struct ScanRangeRow {
    QString description;    // tDocTypes.DocDesc
    qint64 lastRecord = 0;  // LastIndx
    qint64 nextStart = 0;   // FromIndx
    bool operator==(const ScanRangeRow&) const = default;
};

// The rows of qWizFileRanges in the query's order.
QList<ScanRangeRow> readScanRanges(const QString& docDbPath);

// An edit of the window: `value` into `column` of row `row` (0-based, in the query's order),
// written through the query to the table behind it. Throws JetError for a row the query does
// not have or a value the field cannot hold.
void writeScanRange(const QString& docDbPath, int row, ScanRangeColumn column,
                    const QVariant& value);

// The reset-all button of the window: every row of qWizFileRanges gets FromIndx 0, so that the
// next import reads every document file from its first record. A row that cannot be written is
// passed over (and logged under etiquon.import); the others are still reset. Returns the number
// of rows reset.
int resetScanRanges(const QString& docDbPath);

}  // namespace etq

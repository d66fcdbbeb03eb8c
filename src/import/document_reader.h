#pragma once

// The stock document reader: the documents of one document type, read from the host's document
// file into tTempDocHeaders and tTempDocLines of the working database, from the type's stored
// scan position on (scan_ranges.h says what tWizFileRanges holds).
//
// The file is the tWizFiles row's Filename with ".dbf" in the company folder, whatever the letter
// case of its name on disk, read at the fixed places of host::stockdoc. One document is one
// record per ten lines: the first record adds the header, every record its lines, numbered
// page x 10 + slot. A record is passed over when it is marked deleted, its status is "I", it is a
// draft and drafts are not wanted, its document date is blank, impossible or outside the date
// window, or its reference number is outside the from/to numbers. A blank or impossible due date
// gives Null. Header keys that are there already (the continuation records) are passed over.
//
// Progress: the step caption 45 ("Scanning documents"), the bar every fifth record, emptied at
// the start and at the end.
//
// Failures throw: the engine's JetError (3021 when the document database has no tWizFiles or
// tWizFileRanges row for the type), DbfError for a damaged file, HostValueError for a document
// number or page that is no number. The rows written before a failure stay, the scan position
// does not move.

#include <QDate>
#include <QString>

namespace etq {

class Context;
class Progress;

struct StockDocReadOptions {
    QString companyFolder;
    QString workDbPath;      // the working database (etiqondb.tmp), which links tWizFiles etc.
    qint16 wizFileType = 0;  // WizFileID of tWizFiles and DocType of tDocTypes
    QDate fromDate;          // the document date window, both ends included; a null date sets
    QDate toDate;            // no bound on its side
    bool includeDrafts = false;
    bool fastWay = false;    // Include of every new header (lines are always included)
    qint16 addressFrom = 1;  // accepted; the reader takes the address the document holds
    qint32 fromNumber = 0;   // reference number bounds, both included; 0 is no bound. A scan
    qint32 toNumber = 0;     // with a from number starts at the first record of the file
    // A scan limited by a to number leaves the scan position where it is. Set this when the to
    // number box holds anything, even a text that is no number (and so no bound).
    bool toNumberEntered = false;
    QString addressSeparator = QStringLiteral("\r\n");  // in place of each CR of an address
};

struct StockDocScan {
    // The file's record count after a completed scan; 0 when the file is missing or empty (no
    // rows written, the scan position unchanged).
    qint64 recordCount = 0;
    qint64 firstRecord = 0;  // 0-based index of the record the scan started at
    qint64 headers = 0;      // document headers added
    qint64 lines = 0;        // document lines added
};

// Reads the documents of options.wizFileType. The scan position moves on (to after the file's
// last record) when the scan completes, unless a to number limits it.
StockDocScan readStockDocuments(const StockDocReadOptions& options, Context& context,
                                Progress& progress);

}  // namespace etq

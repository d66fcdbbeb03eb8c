#pragma once

// The document import run: rebuilds the working database of the database folder, then reads the
// documents of every document type marked for scanning ("Select * From tDocTypes Where Include
// Or IncludeDraft", types whose Include is off passed over) from the host's document files, each
// from its stored scan position (document_reader.h), and, when asked, imports the items after
// each type that gave records.
//
// In order: the log database is made when the delivery log is used and has none; the temporary
// items database is made afresh; the working database is made afresh from the document and item
// databases (with the tStockLog link when the delivery log is used), so it holds this run's
// documents only. At the end the bar is full and the step is caption 38 ("Scan is finished").
//
// When the items step fails, the run asks caption 51 ("Continue anyway?", title caption 30,
// Yes/No, question icon) through the context's message sink; No stops the run at once, with the
// later types unread and no final step.
//
// Failures: a failure of a document file's reader does not stop the run. A missing file gives 0
// records without a word; any other failure is handed to readerFailed at once (so that the user
// hears of it before the next type is read) and kept in the type's entry of the result, the
// items step is skipped for that type and the run goes on with the next.
// Any other failure throws (the engine's JetError, or QuietFailure when a database could not be
// made: the routine that made it has told why) and ends the run, keeping what was written.

#include <QDate>
#include <QList>
#include <QString>
#include <exception>
#include <functional>

#include "import/document_reader.h"

namespace etq {

class Context;
class Progress;

struct DocImportOptions {
    QString dbFolder;       // the database folder (txtDBPath)
    QString companyFolder;  // the host company folder
    QDate fromDate;         // the document date window; a null date sets no bound on its side
    QDate toDate;
    bool useDeliveryLog = false;  // link the log database's tStockLog, making the file if needed
    bool readItems = false;       // run the items step after each type that gave records
    qint16 addressFrom = 1;       // passed to the reader
    // Between the lines of an address: CR LF, or a comma (cmbAddressSeperator shows "0" or not).
    // The run also makes it the context's separator, as the pages that follow use it.
    QString addressSeparator = QStringLiteral("\r\n");
    bool fastWay = false;   // new headers are included at once
    qint32 fromNumber = 0;  // reference number bounds for the reader; 0 is no bound
    qint32 toNumber = 0;
    bool toNumberEntered = false;
    // The items step: imports the items of the scanned documents into the item database through
    // the temporary items database of the folder. False when it failed. Needed with readItems.
    std::function<bool()> importItems;
    // Told of a reader's failure as soon as it happens, before the next type is read.
    std::function<void(qint16 docType, const std::exception_ptr& failure)> readerFailed;
};

// What became of one document type the run read.
struct DocTypeRead {
    qint16 docType = 0;
    StockDocScan scan;           // recordCount 0: nothing read (missing file, empty, failure)
    std::exception_ptr failure;  // the reader's failure, for the caller to report
    bool itemsImported = false;  // the items step ran and succeeded
};

struct DocImportResult {
    QList<DocTypeRead> types;  // in the order of the type query
    QString workDbPath;
    bool stopped = false;  // the user answered No to "Continue anyway?"
};

DocImportResult importDocuments(const DocImportOptions& options, Context& context,
                                Progress& progress);

}  // namespace etq

#pragma once

// The document road as the control runs it: the routines that read the tab of labels by
// documents, the settings of document reading and the reading-items tab into the options of the
// document import, and the control's own routines of those names, which report their failures
// as the window always has. The command line builds the same options from the stored settings
// through the same functions.

#include <QDate>
#include <QString>
#include <QVariant>

#include "import/document_import.h"

namespace etq {

class Context;
class ControlValues;
class Progress;
class Surface;

// The reference number bounds of txtFromDocNum and txtToDocNum: a trimmed numeric text gives
// its number, anything else 0 (no bound). A to number box that holds anything at all keeps the
// scan position where it is.
struct DocNumberBounds {
    qint32 from = 0;
    qint32 to = 0;
    bool toEntered = false;
};
DocNumberBounds readDocNumberBounds(const ControlValues& values);

// The whole run's options from the controls: the database folder txtDBPath, the context's
// company folder, the date window txtFromDate..txtToDate (day/month/year; an empty box sets no
// bound on its side), the reference number bounds, the delivery log (chkUseDeliverLog), the
// items step (chkReadDocItems), the address choices (cmbAddressFrom, cmbAddressSeperator: "0" a
// line break, anything else a comma) and the fast way (chkOnlyLine0 and chkUseFastWay both
// checked). The items step itself is left empty. Throws BadSetting for a date that cannot be
// read.
DocImportOptions readDocImportOptions(const ControlValues& values, const Context& context);

// Whether a document print reads the documents first: chkOnlyLine0 and chkUseFastWay checked.
bool printsTheFastWay(const ControlValues& values);

// The arguments the import run gives its items step.
struct ItemsByDocsArgs {
    QString companyFolder;  // WizPath
    QString tempDbPath;     // MyDBName: the temporary items database
    QVariant fromItemKey, toItemKey;
    qint16 useForeignName = 0;
    qint16 copies = 0;
    qint16 priceField = 1;
    bool importPackUnits = true;
    bool byDocs = true;
};

// The items step on any control values: the host's items of the reading-items tab's key range
// into the temporary items database (caption 46), their special prices when
// ChkImportAlterPrices is checked (48), then the merge into the item database (50). True when
// every step succeeded; a failure is reported (critical, caption 1, quiet ones logged) and gives
// false.
bool importItemsByDocs(const ControlValues& values, Context& context, Progress& progress,
                       const ItemsByDocsArgs& args);

// The document import run on any control values, with the items step above when chkReadDocItems
// is checked: a reader's failure is reported (critical, caption 1) as soon as it happens and the
// run goes on. Throws when the run cannot go on (the caller reports it).
DocImportResult runDocImport(const ControlValues& values, Context& context, Progress& progress);

// The control's routines.

// ReadStockMnhl: one document file's documents, with the bounds of txtFromDocNum and
// txtToDocNum and the address separator of the context. The file's record count after a
// completed scan; 0 for a missing or empty file (no word) or after a failure (shown).
qint32 ReadStockMnhl(Surface& surface, Context& context, const QString& compPath,
                     const QString& dbName, qint16 wizFileType, const QDate& fromDate,
                     const QDate& toDate, bool includeDraft, bool fastWay, qint16 addressFrom);

// ImportDocs: the document import run with the controls' values, its steps on Message1 and the
// progress bar. True when it reached its end; false when it stopped, after telling why where the
// window tells it.
bool ImportDocs(Surface& surface, Context& context);

// ImportItemsByDocs: the items step with the controls' values. fromItemKey, toItemKey,
// importPackUnits and byDocs are accepted and not used (the reading-items tab's key range
// rules).
bool ImportItemsByDocs(Surface& surface, Context& context, const QString& wizPath,
                       const QString& myDBName, const QVariant& fromItemKey,
                       const QVariant& toItemKey, qint16 useFName, qint16 copies, qint16 priceField,
                       bool importPackUnits, bool byDocs);

// cmdPrintDocButt: labels for the included lines of the included documents on the chosen route,
// the documents read first the fast way (printsTheFastWay). Returns the page's path, or empty
// text when nothing was printed (the reason was shown).
QString PrintDocLabels(Surface& surface, Context& context);

}  // namespace etq

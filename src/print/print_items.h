#pragma once

#include <QString>
#include <optional>

#include "print/label_page.h"
#include "print/label_software.h"

namespace etq {

class Context;
class Progress;

// What a print button does: the item print (query type 1) or, with the label query's type set
// to document-line labels, the document print.
struct ItemPrintOptions {
    QString databaseFolder;
    qint16 kind = kBuiltInPage;  // the label software kind of the chosen route
    // The printer chosen in the printer list. The built-in page makes it the user's default,
    // which the browser prints to; gLabels prints on it. Nothing chosen: the default stays.
    std::optional<QString> printer;
    LabelPageInput page;  // its query's type says which labels
};

// The steps of a print before the labels: makes the working database when it is missing
// (item labels; document-line labels need the one a document import made, and a Failure says
// so when there is none) and, for the built-in page, makes the chosen printer the default.
// Returns the working database's path. Throws.
QString prepareItemPrint(const ItemPrintOptions& options);

// Labels for the marked items: prepareItemPrint, then the built-in print on the context's label
// definition (loaded first when the run has not yet). Returns what the run made;
// options.page.query.fieldChecks comes back with the cells' fields ticked. Throws on any failure.
BuiltInPrint printItemLabels(ItemPrintOptions& options, Context& context, Progress& progress);

// Labels of the query type the options give: prepareItemPrint, then the built-in print on the
// context's label definition, as printItemLabels.
BuiltInPrint printLabels(ItemPrintOptions& options, Context& context, Progress& progress);

}  // namespace etq

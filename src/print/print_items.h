#pragma once

#include <QString>
#include <optional>

#include "print/label_page.h"
#include "print/label_software.h"

namespace etq {

class Context;
class Progress;

// What the item print does.
struct ItemPrintOptions {
    QString databaseFolder;
    qint16 kind = kBuiltInPage;  // the label software kind of the chosen route
    // The printer chosen for the built-in page; it becomes the user's default, which the
    // browser prints to. Nothing chosen: the default stays.
    std::optional<QString> printer;
    LabelPageInput page;  // its query's type is that of item labels
};

// The steps of the item print before the labels: makes the working database when it is
// missing, refuses a route that cannot be driven here (only the built-in page can, yet) and
// makes the chosen printer the default. Returns the working database's path. Throws.
QString prepareItemPrint(const ItemPrintOptions& options);

// Labels for the marked items: prepareItemPrint, then the built-in print on the context's label
// definition (loaded first when the run has not yet). Returns what the run made;
// options.page.query.fieldChecks comes back with the cells' fields ticked. Throws on any failure.
BuiltInPrint printItemLabels(ItemPrintOptions& options, Context& context, Progress& progress);

}  // namespace etq

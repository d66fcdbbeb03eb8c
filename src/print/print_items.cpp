#include "print/print_items.h"

#include <QFileInfo>

#include "db/file_names.h"
#include "db/local_databases.h"
#include "platform/context.h"
#include "platform/failure.h"
#include "platform/printers.h"
#include "print/label_definition.h"

namespace etq {

QString prepareItemPrint(const ItemPrintOptions& options) {
    const QString& folder = options.databaseFolder;
    const QString workDb = db::inFolder(folder, db::kWorkDatabaseFile);
    if (!QFileInfo::exists(workDb))
        db::CreateDocDatabase(db::inFolder(folder, db::kDocDatabaseFile),
                              db::inFolder(folder, db::kItemDatabaseFile), workDb, {});
    if (options.kind != kBuiltInPage)
        throw Failure(
            QStringLiteral(
                "No label software can be driven on this system (kind %1): choose \"Direct\" to print on the built-in label page")
                .arg(options.kind));
    if (options.printer) setDefaultPrinter(*options.printer);
    return workDb;
}

BuiltInPrint printItemLabels(ItemPrintOptions& options, Context& context, Progress& progress) {
    const QString workDb = prepareItemPrint(options);
    options.page.query.queryType = ItemLabels;
    return printBuiltInLabels(workDb, options.page, loadedLabelDefinition(context), progress);
}

}  // namespace etq

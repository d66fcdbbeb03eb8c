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
    if (!QFileInfo::exists(workDb) && options.page.query.queryType != ItemLabels)
        throw Failure(
            QStringLiteral("%1 holds no imported documents (no %2): read the documents first")
                .arg(folder, db::kWorkDatabaseFile));
    if (!QFileInfo::exists(workDb))
        db::CreateDocDatabase(db::inFolder(folder, db::kDocDatabaseFile),
                              db::inFolder(folder, db::kItemDatabaseFile), workDb, {});
    if (options.kind == kBuiltInPage && options.printer) setDefaultPrinter(*options.printer);
    return workDb;
}

BuiltInPrint printItemLabels(ItemPrintOptions& options, Context& context, Progress& progress) {
    options.page.query.queryType = ItemLabels;
    return printLabels(options, context, progress);
}

BuiltInPrint printLabels(ItemPrintOptions& options, Context& context, Progress& progress) {
    const QString workDb = prepareItemPrint(options);
    return printBuiltInLabels(workDb, options.page, loadedLabelDefinition(context), progress);
}

}  // namespace etq

#include "import/item_import.h"

#include <QFileInfo>

#include "db/file_names.h"
#include "db/local_databases.h"
#include "import/host_lists.h"
#include "platform/context.h"
#include "platform/folder_lock.h"
#include "platform/progress.h"

namespace etq {

void importItems(const ItemImportOptions& options, const Context& context, Progress& progress) {
    const QString& folder = options.databaseFolder;
    const FolderLock lock(folder);  // one run at a time rebuilds the folder's files
    const QString itemDb = db::inFolder(folder, db::kItemDatabaseFile);
    const auto showStep = [&](int caption) { progress.step(context.caption(caption)); };

    // A missing item database, or the wish to start afresh, makes a new, empty one.
    if (!QFileInfo::exists(itemDb) || options.clean) db::CreateItemDatabaseWithAccounts(itemDb);

    const QString docDb = db::inFolder(folder, db::kDocDatabaseFile);
    const QString workDb = db::inFolder(folder, db::kWorkDatabaseFile);
    const QString tempDb =
        db::CreateTempItemDatabase(db::inFolder(folder, db::kTempItemDatabaseFile), itemDb);
    db::CleanItemTables(itemDb, options.clean, options.specialPrices, context, progress);

    showStep(31);
    ItemReadOptions items = options.items;
    items.companyFolder = options.companyFolder;
    items.databasePath = tempDb;
    readHostItems(items, progress);

    showStep(32);
    readHostCurrencies(options.companyFolder, docDb, progress);

    if (options.specialPrices) {
        showStep(34);
        readHostSpecialPrices(options.companyFolder, tempDb, progress);
    }

    showStep(36);
    db::MergeTempItems(tempDb);

    if (!QFileInfo::exists(workDb)) {
        showStep(37);
        db::CreateDocDatabase(docDb, itemDb, workDb, {});
    }

    progress.fill();
    showStep(38);
}

}  // namespace etq

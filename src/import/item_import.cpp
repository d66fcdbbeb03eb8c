#include "import/item_import.h"

#include <QFileInfo>

#include "db/file_names.h"
#include "db/local_databases.h"
#include "import/connection.h"
#include "import/host_lists.h"
#include "import/host_reading.h"
#include "import/item_reader.h"
#include "jet/error.h"
#include "jet/vb.h"
#include "shell/captions.h"
#include "shell/surface.h"

namespace etq {

namespace {

using hostread::isChecked;

void showStep(const Surface& surface, int caption) {
    surface.control(QStringLiteral("Message1")).setCaption(GetCaption(caption));
}

QString text(const Surface& surface, const QString& name) {
    return surface.control(name).text();
}

// The copies every imported item gets: txtCopies as a 16-bit whole number.
qint16 copiesOf(const Surface& surface) {
    const QString copies = text(surface, QStringLiteral("txtCopies"));
    if (const auto number = vb::toInteger(copies)) return *number;
    jet::fail(jet::err::kTypeMismatch,
              QStringLiteral("The copies \"%1\" are not a whole number from -32768 to 32767.")
                  .arg(copies));
}

// The price entry that gives the items their price: the number behind the chosen price list.
qint16 priceFieldOf(const Surface& surface) {
    if (const auto number =
            hostread::selectedNumber(surface.control(QStringLiteral("cmbPriceField"))))
        return *number;
    jet::fail(jet::err::kInvalidArgument,
              QStringLiteral("No price list is chosen in cmbPriceField."));
}

// The run between its first and its last step; false where a step stops it.
bool runSteps(const Surface& surface) {
    const QString company = companyFolder();
    const qint16 priceField = priceFieldOf(surface);
    const QString folder = text(surface, QStringLiteral("txtDBPath"));
    const QString itemDb = db::inFolder(folder, db::kItemDatabaseFile);
    const bool clean = isChecked(surface, QStringLiteral("ChkClean"));

    // A missing item database, or the wish to start afresh, makes a new, empty one.
    if (!QFileInfo::exists(itemDb) || clean) {
        if (db::CreateItemDatabaseWithAccounts(itemDb).isEmpty()) return false;
    }

    const QString docDb = db::inFolder(folder, db::kDocDatabaseFile);
    const QString workDb = db::inFolder(folder, db::kWorkDatabaseFile);
    const QString tempDb =
        db::CreateTempItemDatabase(db::inFolder(folder, db::kTempItemDatabaseFile), itemDb);
    if (tempDb.isEmpty()) return false;

    const bool foreignNames = surface.control(QStringLiteral("CmbItemNameType")).listIndex() == 1;
    CleanTables(surface, itemDb);

    const QString fromKey = text(surface, QStringLiteral("txtFromItemKey"));
    const QString toKey = text(surface, QStringLiteral("txtToItemKey"));
    showStep(surface, 31);
    if (!ReadItemMNHL(surface, company, tempDb, fromKey, toKey, foreignNames ? -1 : 0,
                      copiesOf(surface), priceField, true, false,
                      isChecked(surface, QStringLiteral("chkReadPriceList"))))
        return false;

    showStep(surface, 32);
    if (!ReadCoinsMNHL(surface, company, docDb)) return false;

    if (isChecked(surface, QStringLiteral("ChkImportAlterPrices"))) {
        showStep(surface, 34);
        if (!ReadSpecialPriceMNHL(surface, company, tempDb, fromKey, toKey)) return false;
    }

    showStep(surface, 36);
    db::MergeTempItems(tempDb);

    if (!QFileInfo::exists(workDb)) {
        showStep(surface, 37);
        if (db::CreateDocDatabase(docDb, itemDb, workDb, {}).isEmpty()) return false;
    }

    ProgressBar(surface).fill();
    showStep(surface, 38);
    return true;
}

}  // namespace

void CleanTables(const Surface& surface, const QString& itemDbPath) {
    db::CleanItemTables(itemDbPath, isChecked(surface, QStringLiteral("ChkClean")),
                        isChecked(surface, QStringLiteral("ChkImportAlterPrices")),
                        [&surface](const QString& message) {
                            surface.control(QStringLiteral("Message1")).setCaption(message);
                        });
}

bool ImportItems(const Surface& surface) {
    try {
        return runSteps(surface);
    } catch (const std::exception& e) {
        hostread::reportFailure(e);
        return false;
    }
}

}  // namespace etq

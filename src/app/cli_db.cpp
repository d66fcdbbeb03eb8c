// etiquon-cli init-db and upgrade: the database folder as a first run needs it.
#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QTextStream>
#include <optional>

#include "app/cli_command.h"
#include "db/delivered_database.h"
#include "db/file_names.h"
#include "db/local_databases.h"
#include "db/schemas.h"
#include "jet/database.h"
#include "platform/folder_lock.h"

namespace etq::cli {

namespace {

enum class Found { Missing, Usable, Unusable };

// A file that is there but cannot be used as it stands (damaged, not ours, or without tables
// that a run killed while making it never wrote) is replaced; a copy of it is kept as
// NAME.damaged, so nothing of it is lost.
std::optional<Found> examine(const QString& path, const QStringList& tables, const char* what) {
    if (!QFileInfo::exists(path)) return Found::Missing;
    const QString why = db::whyUnusable(path, tables);
    QTextStream out(stdout);
    if (why.isEmpty()) {
        out << "kept the " << what << ' ' << path << Qt::endl;
        return Found::Usable;
    }
    const QString aside = path + ".damaged";
    QFile::remove(aside);
    if (!QFile::copy(path, aside)) {
        printError(QString("%1; cannot keep a copy of it as %2").arg(why, aside));
        return std::nullopt;
    }
    out << "replacing the " << what << ' ' << path << " (kept as " << aside << "): " << why
        << Qt::endl;
    return Found::Unusable;
}

QStringList deliveredTables() {
    try {
        return jet::Database::open(db::deliveredDocumentDatabase()).tableNames();
    } catch (const jet::JetError&) {
        return {};  // the installation below says what is wrong with it
    }
}

QStringList workTables() {
    QStringList tables{db::schema::tempDocHeaders().name, db::schema::tempDocLines().name,
                       db::schema::transports().name};
    for (const db::schema::Link& link : db::schema::workLinks())
        tables << QString::fromLatin1(link.table);
    return tables;
}

// Puts a copy of the delivered document database at `path`, whole or not at all.
bool installDelivered(const QString& path) {
    const QString delivered = db::deliveredDocumentDatabase();
    if (delivered.isEmpty()) {
        printError(
            QString(
                "the delivered document database %1 is not installed beside the program nor in its share/etiquon folder")
                .arg(db::kDocDatabaseFile));
        return false;
    }
    try {
        jet::StagedDatabase copy = jet::StagedDatabase::copyOf(delivered, path);
        QFile::setPermissions(copy.stagedPath(), QFile::ReadOwner | QFile::WriteOwner |
                                                     QFile::ReadGroup | QFile::ReadOther);
        copy.commit();
        return true;
    } catch (const jet::JetError& e) {
        printError(QString("cannot install the delivered document database %1 as %2: %3")
                       .arg(delivered, path, e.description()));
        return false;
    }
}

bool prepareFolder(const QString& folder) {
    if (!QDir().mkpath(folder)) {
        printError(QString("cannot make the database folder %1").arg(folder));
        return false;
    }
    const QFileInfo info(folder);
    if (!info.isDir() || !info.isWritable()) {
        printError(QString("the database folder %1 is not writable").arg(folder));
        return false;
    }
    return true;
}

}  // namespace

int runInitDb(const QStringList& arguments) {
    QStringList args = arguments;
    takeCommonOptions(args);  // the database folder is the same for every SettingID
    const QString folder = takeOption(args, "--db");
    if (folder.isEmpty() || !args.isEmpty()) {
        printError("usage: etiquon-cli init-db --db DIR");
        return 2;
    }
    if (!prepareFolder(folder)) return 1;
    std::optional<FolderLock> lock;
    if (runReporting([&] { lock.emplace(folder); })) return 1;
    QTextStream out(stdout);
    const QString docDb = db::inFolder(folder, db::kDocDatabaseFile);
    const QString itemDb = db::inFolder(folder, db::kItemDatabaseFile);
    const QString workDb = db::inFolder(folder, db::kWorkDatabaseFile);

    const std::optional<Found> doc = examine(docDb, deliveredTables(), "document database");
    if (!doc) return 1;
    if (*doc != Found::Usable) {
        if (!installDelivered(docDb)) return 1;
        out << "installed the document database " << docDb << Qt::endl;
    }

    const std::optional<Found> items = examine(itemDb, db::itemTableNames(), "item database");
    if (!items) return 1;
    if (*items != Found::Usable) {
        if (runReporting([&] { db::CreateItemDatabaseWithAccounts(itemDb); })) return 1;
        out << "created the item database " << itemDb << Qt::endl;
    }

    const std::optional<Found> work = examine(workDb, workTables(), "working database");
    if (!work) return 1;
    if (*work != Found::Usable) {
        if (runReporting([&] { db::CreateDocDatabase(docDb, itemDb, workDb, {}); })) return 1;
        out << "created the working database " << workDb << Qt::endl;
    }
    return 0;
}

int runUpgrade(const QStringList& arguments) {
    QStringList args = arguments;
    takeCommonOptions(args);
    const QString folder = takeOption(args, "--db");
    if (folder.isEmpty() || !args.isEmpty()) {
        printError("usage: etiquon-cli upgrade --db DIR");
        return 2;
    }
    const int status = runReporting([&] { db::UpgradeItemDatabase(folder); });
    QTextStream(stdout) << (status == 0 ? "Upgrade successfull" : "Upgrade failed") << Qt::endl;
    return status;
}

}  // namespace etq::cli

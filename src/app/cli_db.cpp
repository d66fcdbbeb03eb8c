// etiquon-cli init-db and upgrade: the database folder as a first run needs it.
#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QTextStream>

#include "app/cli_command.h"
#include "db/delivered_database.h"
#include "db/file_names.h"
#include "db/local_databases.h"
#include "jet/database.h"

namespace etq::cli {

namespace {

// An existing file must be one of ours and readable; a damaged one stops the preparation.
bool checkExisting(const QString& path) {
    try {
        jet::Database::open(path);
        return true;
    } catch (const jet::JetError& e) {
        printError(
            QString("%1 is damaged or not a database of Etiquon: %2").arg(path, e.description()));
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
    QTextStream out(stdout);
    const QString docDb = db::inFolder(folder, db::kDocDatabaseFile);
    const QString itemDb = db::inFolder(folder, db::kItemDatabaseFile);
    const QString workDb = db::inFolder(folder, db::kWorkDatabaseFile);

    if (QFileInfo::exists(docDb)) {
        if (!checkExisting(docDb)) return 1;
        out << "kept the document database " << docDb << Qt::endl;
    } else {
        const QString delivered = db::deliveredDocumentDatabase();
        if (delivered.isEmpty()) {
            printError(
                QString(
                    "the delivered document database %1 is not installed beside the program nor in its share/etiquon folder")
                    .arg(db::kDocDatabaseFile));
            return 1;
        }
        if (!QFile::copy(delivered, docDb)) {
            printError(QString("cannot install the delivered document database %1 as %2")
                           .arg(delivered, docDb));
            return 1;
        }
        QFile::setPermissions(
            docDb, QFile::ReadOwner | QFile::WriteOwner | QFile::ReadGroup | QFile::ReadOther);
        out << "installed the document database " << docDb << Qt::endl;
    }

    if (QFileInfo::exists(itemDb)) {
        if (!checkExisting(itemDb)) return 1;
        out << "kept the item database " << itemDb << Qt::endl;
    } else {
        if (runReporting([&] {
                db::CreateItemDatabase(itemDb);
                db::AddAccountTables(itemDb);
            }))
            return 1;
        out << "created the item database " << itemDb << Qt::endl;
    }

    if (QFileInfo::exists(workDb)) {
        if (!checkExisting(workDb)) return 1;
        out << "kept the working database " << workDb << Qt::endl;
    } else {
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

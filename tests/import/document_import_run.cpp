// document-import-run COMPANY DBFOLDER: makes DBFOLDER as a first run finds it (the delivered
// document database with every document type marked for scanning, drafts included, and an empty
// item database), runs the document import on the company folder, and leaves beside the working
// database an empty one, peer.tmp, for another reader to fill, so that document_dbfread_check.py
// can compare what each wrote. Prints what each type gave.
#include <QCoreApplication>
#include <QDir>
#include <QFile>
#include <QTextStream>

#include "db/delivered_database.h"
#include "db/file_names.h"
#include "db/local_databases.h"
#include "import/document_import.h"
#include "jet/database.h"
#include "platform/context.h"
#include "platform/failure.h"
#include "platform/progress.h"

namespace db = etq::db;

int main(int argc, char** argv) {
    QCoreApplication app(argc, argv);
    QTextStream out(stdout), err(stderr);
    if (app.arguments().size() != 3) {
        err << "usage: document-import-run COMPANY DBFOLDER\n";
        return 2;
    }
    const QString company = app.arguments()[1], folder = app.arguments()[2];
    auto path = [&](const QString& name) { return db::inFolder(folder, name); };
    try {
        QDir().mkpath(folder);
        if (!QFile::copy(db::deliveredDocumentDatabase(), path(db::kDocDatabaseFile))) return 1;
        db::CreateItemDatabase(path(db::kItemDatabaseFile));
        db::AddAccountTables(path(db::kItemDatabaseFile));
        QFile::setPermissions(path(db::kDocDatabaseFile), QFile::ReadOwner | QFile::WriteOwner);
        etq::jet::Database::open(path(db::kDocDatabaseFile))
            .execute("UPDATE tDocTypes SET Include = True, IncludeDraft = True",
                     etq::jet::Database::FailOnError);

        etq::DocImportOptions options;
        options.dbFolder = folder;
        options.companyFolder = company;
        etq::Context context;
        etq::NoProgress progress;
        const etq::DocImportResult result = etq::importDocuments(options, context, progress);
        for (const etq::DocTypeRead& read : result.types) {
            if (read.failure) std::rethrow_exception(read.failure);
            out << "type " << read.docType << ": " << read.scan.recordCount << " records, "
                << read.scan.headers << " documents, " << read.scan.lines << " lines\n";
        }
        if (db::CreateDocDatabase(path(db::kDocDatabaseFile), path(db::kItemDatabaseFile),
                                  path("peer.tmp"), {})
                .isEmpty())
            return 1;
    } catch (const std::exception& e) {
        err << etq::describe(e) << "\n";
        return 1;
    }
    return 0;
}

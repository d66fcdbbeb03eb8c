// build-document-db DEFINITION.json OUT.kdb: makes the delivered document database.
#include <QCoreApplication>
#include <QTextStream>
#include <exception>

#include "db/delivered_database.h"
#include "jet/error.h"

int main(int argc, char** argv) {
    QCoreApplication app(argc, argv);
    if (argc != 3) {
        QTextStream(stderr) << "usage: build-document-db DEFINITION.json OUT.kdb\n";
        return 2;
    }
    try {
        etq::db::buildDocumentDatabase(QString::fromLocal8Bit(argv[1]),
                                       QString::fromLocal8Bit(argv[2]));
    } catch (const etq::jet::JetError& e) {
        QTextStream(stderr) << "build-document-db: " << e.description() << "\n";
        return 1;
    } catch (const std::exception& e) {
        QTextStream(stderr) << "build-document-db: " << e.what() << "\n";
        return 1;
    }
    return 0;
}

#pragma once

#include <QString>

namespace etq::db {

// Makes the delivered document database from its definition (samples/etiquon_kdb.json): its
// tables, rows and saved queries. The component never runs this; the build does. Throws
// JetError, or std::runtime_error for a definition it cannot read.
void buildDocumentDatabase(const QString& definitionFile, const QString& outPath);

// Where the delivered file is found: in $ETIQUON_DATA_DIR, beside the running program, or in
// share/etiquon of the tree the program is installed in. Empty text when it is nowhere.
QString deliveredDocumentDatabase();

}  // namespace etq::db

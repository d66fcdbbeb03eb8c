#pragma once

#include <QString>

namespace etq::db {

// Makes the delivered document database from its definition (samples/etiquon_kdb.json): its
// tables, rows and saved queries. The component never runs this; the build does. Throws
// JetError, or std::runtime_error for a definition it cannot read.
void buildDocumentDatabase(const QString& definitionFile, const QString& outPath);

// Where the delivered file is found: next to the running program, else the build's copy.
QString deliveredDocumentDatabase();

}  // namespace etq::db

#pragma once

#include <QString>

#include "print/label_definition.h"

namespace etq {

class Surface;

// The page file inside the print folder.
inline const QString kLabelPageFile = QStringLiteral("etiqon1.htm");

// Writes the built-in label page `fileName` for the records of the label query (built from the
// label tab of `surface` with the query type and order) on the database `dbName`: a grid of
// PageRows x PageCols labels per sheet, each label a table of the cells in use, every record
// repeated for its copies. A record with no copies takes no position. Ticks ChkFldSend of the
// cells' fields, so that the query has their columns. The page refers to the barcode bitmaps
// by BmpName. Throws (jet::JetError, std::runtime_error) on any failure; the file written so
// far stays.
void CreateLabFile(Surface& surface, const QString& fileName, const QString& dbName,
                   quint8 queryType, quint8 orderBy,
                   LabelDefinition& definition = labelDefinition());

// The whole built-in print run: empties the print folder, makes the barcode bitmaps of every
// barcode cell, writes the page and shows it in the browser. Any failure is shown in a message
// box titled "תקלה" and ends the run. Returns the page's path, or empty text after a failure.
QString PrintBuiltInLabels(Surface& surface, const QString& dbName, quint8 queryType,
                           LabelDefinition& definition = labelDefinition());

}  // namespace etq

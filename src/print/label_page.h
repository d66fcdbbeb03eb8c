#pragma once

#include <QString>
#include <QStringList>

#include "print/label_definition.h"
#include "print/label_query.h"

namespace etq {

class Progress;

// The page file inside the print folder.
inline const QString kLabelPageFile = QStringLiteral("etiqon1.htm");

// Throws BadSetting for a grid of no labels or of more than a sheet can hold.
void requirePrintableGrid(const DirectLabelDef& page);

// What a label page shows besides the label definition: the label query's settings and the
// number format of prices (blank: "0.00").
struct LabelPageInput {
    LabelQueryInput query;
    QString priceFormat;
};

// Writes the built-in label page `fileName` for the records of the label query on the
// database `dbName`: a grid of PageRows x PageCols labels per sheet, each label a table of the
// cells in use, every record repeated for its copies. A record with no copies takes no
// position. Ticks the fields of the cells in input.query.fieldChecks, so that the query has
// their columns (the window shows them ticked). The page refers to the barcode bitmaps by
// BmpName. Throws (jet::JetError, std::runtime_error) on any failure; the file written so far
// stays.
void writeLabelPage(const QString& fileName, const QString& dbName, LabelPageInput& input,
                    LabelDefinition& definition, Progress& progress);

// What the built-in print run made: the page, and a line for each record whose value the
// barcode's symbology cannot encode (those labels show no barcode).
struct BuiltInPrint {
    QString pagePath;
    QStringList refusedBarcodes;
};

// The whole built-in print run: ticks the cells' fields (so that its queries have every column
// the cells show), makes the barcode bitmaps of every barcode cell in a print folder of its own
// and writes the page. Showing the page is the caller's. Throws on any failure.
BuiltInPrint printBuiltInLabels(const QString& dbName, LabelPageInput& input,
                                LabelDefinition& definition, Progress& progress);

}  // namespace etq

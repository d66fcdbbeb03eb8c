#pragma once

#include <QString>
#include <QStringList>
#include <vector>

#include "print/label_definition.h"

namespace etq {

class BarcodeImage;
struct BarcodeVector;

// "B", the field slot as at least two digits, the record number (1 = first record of the label
// query) as at least five digits, ".BMP": B0400001.BMP for slot 4, record 1.
QString BmpName(int fldId, qint32 recordNo);

// The barcode library's bar type code for the designer's list index in BarType, and whether
// the index asks for full-ASCII Code 39. An index outside the list is passed as it is.
struct BarTypeMapping {
    int libraryCode;
    bool fullAscii;
};
BarTypeMapping mapBarType(qint16 barType);

// What barcode runs made.
struct BarcodeRun {
    qint32 records = 0;   // records of the query, each with its record number
    qint32 bitmaps = 0;   // bitmaps written
    QStringList refused;  // one line per record whose value the symbology cannot encode
};

// The bitmaps one barcode cell needs: the mapped barcode setting and, for every record whose
// column holds a value, the bitmap's name and the text it encodes.
struct BarcodeBatch {
    struct Bitmap {
        QString name;  // BmpName
        QString text;
    };
    QString folder;
    LabelBarDef barDef;  // the bar type mapped to the library's code
    qint32 records = 0;
    std::vector<Bitmap> bitmaps;
};

// Reads the cell's column of every record of `sql` on the database `dbName` and makes the
// batch. Throws jet::JetError when the database, the query or the column fails.
BarcodeBatch collectBarcodes(const QString& folder, const QString& fieldName, int fldId,
                             const QString& dbName, const QString& sql, LabelBarDef barDef);

// Writes the batches' bitmaps with `threads` library instances working side by side (each on
// its own share of the bitmaps). A text the symbology cannot encode gets no bitmap and a line
// in `refused`, in record order.
BarcodeRun writeBarcodes(const std::vector<BarcodeBatch>& batches, int threads = 1);

// Writes one bitmap per record of `sql` (opened on the database `dbName`) whose column
// `fieldName` holds a value, into `folder` under BmpName(fldId, record number), with one library
// instance. `barDef` is the cell's own copy of the barcode setting; its bar type is mapped here.
// The text encoded is the value cut to LeftLen characters (when above 0), after LeftPrefix.
// Database failures throw jet::JetError.
BarcodeRun MakeBarcodeImages(const QString& folder, const QString& fieldName, int fldId,
                             const QString& dbName, const QString& sql, LabelBarDef barDef);

// The cell's copy of the barcode setting with the designer's bar type turned into the library's
// code (and full ASCII for "CODE-39 Ascii"), as every barcode cell's symbols are made.
LabelBarDef mappedBarDef(LabelBarDef barDef);

// The same symbol as WriteBarcodeBitmap would write, as shapes for drawing (BarcodeVector), with
// `barDef` already mapped. False when the library refuses; the reason is in instance.lastError().
bool MakeBarcodeVector(const QString& text, LabelBarDef& barDef, BarcodeImage& instance,
                       BarcodeVector& out);

// Sets up the library instance from `barDef` for `text` and writes the bitmap `fileName`. A
// narrow bar or ratio of 0 or less becomes 0.01 or 2.2, in barDef too. False when the library
// refuses; the reason is in instance.lastError().
bool WriteBarcodeBitmap(const QString& text, const QString& fileName, LabelBarDef& barDef,
                        BarcodeImage& instance);

}  // namespace etq

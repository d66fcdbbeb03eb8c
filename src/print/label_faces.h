#pragma once

// What each label of the built-in definition shows, worked out in one place for the HTML page,
// the PDF and the designer's preview: every cell's text, or the text its barcode encodes, from a
// record of the label query; and the walk over the query's records that gives each label
// position its record, copy by copy.

#include <QString>
#include <QVariant>
#include <QVariantHash>
#include <array>

#include "print/label_definition.h"
#include "print/label_query.h"

namespace etq {

namespace jet {
class Recordset;
}

inline constexpr quint8 kTextCell = 0;
inline constexpr quint8 kBarcodeCell = 1;

// One label's content.
struct LabelFace {
    qint32 recordNo = 0;  // 1 = the query's first record, as the barcode bitmaps count
    // By cell: a text cell's shown text; a barcode cell's encoded text (empty: no barcode).
    std::array<QString, kLabelCellCount> texts;
};

// Gives every cell in use its query column and price flag, and ticks its field in `fieldChecks`
// so that the label query selects the column. Throws std::runtime_error when a cell in use shows
// no field slot.
void prepareCells(std::array<bool, kLabelFieldCount>& fieldChecks, LabelDefinition& def);

// The price format of the label tab, trimmed; "0.00" when blank.
QString priceFormatOf(const QString& given);

// A text cell's text for a value: empty for Null; a price formatted with the price format, a
// blank and the record's currency sign; then the prefix and a blank before it; cut to
// maxTextLen characters when that is above 0 (the prefix counts).
QString cellText(const LabelCell& cell, bool isPrice, const QVariant& value, const QVariant& sign,
                 const QString& priceFormat, qint16 maxTextLen);

// The text a barcode encodes for a value: cut to LeftLen characters when that is above 0, then
// LeftPrefix before it. Empty for Null or empty text (no barcode).
QString barcodeText(const QVariant& value, const LabelBarDef& bar);

// The face of one record given by column (the preview's record): a column it lacks reads as
// Null, and a cell in use without a field shows nothing.
LabelFace faceOf(const LabelDefinition& def, const QVariantHash& record,
                 const QString& priceFormat);

// Walks the records of an open label query position by position: a record fills as many
// positions as its Copies (Null counts 0), a record without copies none but still takes its
// record number. The cells must have been prepared (prepareCells). Throws std::runtime_error
// when the query lacks a column the cells show.
class LabelRecords {
  public:
    LabelRecords(jet::Recordset& rs, const LabelDefinition& def, const QString& priceFormat);

    // The copies of all records: the number of labels. Reads the query through.
    qint64 totalCopies();
    // Back to the first record, ready for next().
    void start();
    // The face of the next position, valid until the call after; nullptr when no record is
    // left.
    const LabelFace* next();
    // The number of the record the next position shows.
    qint32 recordNo() const { return recordNo_; }

  private:
    void enter();
    void fill(LabelFace& face) const;

    jet::Recordset& rs_;
    const LabelDefinition& def_;
    QString priceFormat_;
    int copiesColumn_ = -1;
    int signColumn_ = -1;
    std::array<int, kLabelCellCount> columns_{};
    qint32 recordNo_ = 1;
    qint32 copy_ = 0;
    qint32 copies_ = 0;
    std::array<LabelFace, 2> faces_;  // the position's face, and the next record's
    int current_ = 0;
};

// The record the designer's preview shows: the first record of the item label query on the
// working database of `databaseFolder` with every field's column, or, when there is no such
// database or no marked item, a sample item of the same columns. Never throws.
QVariantHash labelPreviewRecord(const QString& databaseFolder, LabelQueryInput query);
QVariantHash sampleLabelRecord();

}  // namespace etq

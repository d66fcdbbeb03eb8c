#pragma once

// Draws labels of the built-in definition with QPainter: the PDF's labels and the designer's
// preview are drawn by this one piece of code. A label is laid out as the label page lays out
// its table: the rows of the cells in use stacked and centred in the label, each text in its
// cell's font, alignment and direction, barcodes as vectors from the barcode library (sharp at
// any resolution), borders around the cells that have them.
//
// Lengths of the definition map to the page as a browser prints them: points for fonts and
// heights, CSS pixels (1/96 inch) for the label margins and the barcode's given size. A barcode
// without a given size has the size its narrow bar and height say (inches); one wider than its
// label is narrowed to fit. Works in the device's own units, so fonts are measured on the device
// they are drawn on.

#include <QRectF>
#include <QStringList>
#include <memory>

#include "print/label_faces.h"
#include "print/label_sheets.h"

class QPainter;
class QPaintDevice;

namespace etq {

class BarcodeImage;
struct BarcodeVector;

class LabelDrawing {
  public:
    // Labels of `def` on `device` (not owned; it must outlive the drawing).
    LabelDrawing(const LabelDefinition& def, const QPaintDevice& device);
    ~LabelDrawing();
    LabelDrawing(const LabelDrawing&) = delete;
    LabelDrawing& operator=(const LabelDrawing&) = delete;

    // Device units in a millimetre.
    double unitsPerMm() const { return unitsPerMm_; }

    // Draws `face` into the label `area` (device units), nothing outside it. Copies of one
    // record drawn one after the other are laid out once.
    void draw(QPainter& painter, const QRectF& area, const LabelFace& face);
    // A thin outline of the label's shape, as a sheet has it cut.
    void drawOutline(QPainter& painter, const QRectF& area, LabelSheet::Shape shape,
                     double cornerMm) const;

    // One line for each record whose barcode the symbology cannot encode (no barcode drawn).
    const QStringList& refusedBarcodes() const { return refused_; }

  private:
    struct Layout;
    void layOut(const LabelFace& face, double width);
    void drawBarcode(QPainter& painter, const QRectF& target, const BarcodeVector& vector) const;

    const LabelDefinition& def_;
    const QPaintDevice& device_;
    double unitsPerMm_;
    std::unique_ptr<Layout> layout_;
    LabelBarDef bar_;  // mapped to the library's bar type
    std::unique_ptr<BarcodeImage> instance_;
    QStringList refused_;
};

}  // namespace etq

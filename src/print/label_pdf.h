#pragma once

// The built-in labels as a PDF drawn here with Qt, with no browser: the same records, copies,
// cells and texts as the label page (label_faces.h), each label drawn by LabelDrawing, on the
// paper of the chosen printer (A4 when it cannot be told) or of the chosen label sheet product.
// Without a product, the grid of PageCols x PageRows divides the whole paper and fills from the
// top right corner, row by row, as the page's right-to-left table does; with one, every label
// lies where the product has it. Geometry is exact: the page is the paper's size to the
// hundredth of a millimetre, without margins.
//
// The header keeps to Qt Core: the library that draws (etiquon_print_pdf) links Qt Gui, and a
// program that calls it needs a QGuiApplication (the offscreen platform will do).

#include <QPointF>
#include <QSizeF>
#include <QString>
#include <QStringList>
#include <optional>
#include <vector>

#include "print/label_page.h"
#include "print/label_sheets.h"

namespace etq {

class Progress;

// Where the labels lie on every page, in millimetres.
struct PdfLayout {
    QSizeF paper;
    QString paperName;  // "A4", ... for the viewer's information; empty for a size of its own
    QSizeF label;
    std::vector<QPointF> positions;  // each label's top left corner, in the order they fill
    LabelSheet::Shape shape = LabelSheet::Shape::Rectangle;
    double corner = 0;
};

// PageCols x PageRows equal labels over the whole paper. Throws std::runtime_error unless both
// are above 0.
PdfLayout gridLayout(QSizeF paper, qint16 rows, qint16 columns);
PdfLayout sheetLayout(const LabelSheet& sheet);

// The size of a paper CUPS names ("A4", "Letter", "w288h432" in points); nothing for a name it
// does not know.
std::optional<QSizeF> paperSize(const QString& cupsName);
// The paper the printer (empty: the default printer) prints on; A4 when CUPS cannot tell.
QSizeF printerPaperSize(const QString& printer);

// What a PDF run made.
struct PdfLabels {
    QString path;
    qint64 labels = 0;
    int pages = 0;
    QStringList refusedBarcodes;  // records whose barcode the symbology cannot encode
};

// Writes the labels of the label query on `dbName` to `fileName` (replaced). Ticks the cells'
// fields in input.query, as the page does. An empty query gives one empty page. With `outlines`
// every label's outline is drawn, to check a sheet's alignment on plain paper. Throws on any
// failure (jet::JetError, std::runtime_error, Failure).
PdfLabels writeLabelPdf(const QString& fileName, const QString& dbName, LabelPageInput& input,
                        LabelDefinition& def, const PdfLayout& layout, bool outlines,
                        Progress& progress);

// Where the PDF goes and who prints it.
struct PdfDestination {
    std::optional<QString> file;  // written here; otherwise into the print run's own folder
    bool send = false;            // then sent to the printer with lp (not when it has no label)
    // The chosen printer, whose paper the grid divides; empty: the default printer when
    // sending, and A4 paper otherwise.
    QString printer;
    bool outlines = false;
};

// The whole direct print: the layout (the definition's sheet product, or the grid on the
// printer's paper), the PDF, and the printer. Throws Failure when the chosen product is not in
// the installed catalogue or CUPS refuses the job, and as writeLabelPdf does.
PdfLabels printLabelsPdf(const QString& dbName, LabelPageInput& input, LabelDefinition& def,
                         const PdfDestination& destination, Progress& progress);

// The PDF file of a print run, beside the page's name in the print folder.
inline const QString kLabelPdfFile = QStringLiteral("etiqon1.pdf");

}  // namespace etq

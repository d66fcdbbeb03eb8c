#include "print/label_pdf.h"

#include <QFile>
#include <QPageSize>
#include <QPainter>
#include <QPdfWriter>
#include <QRegularExpression>
#include <stdexcept>

#include "jet/database.h"
#include "jet/recordset.h"
#include "platform/failure.h"
#include "platform/log.h"
#include "platform/print_folder.h"
#include "platform/printers.h"
#include "platform/progress.h"
#include "platform/user_paths.h"
#include "print/label_drawing.h"
#include "print/label_faces.h"

namespace etq {

namespace {

constexpr int kResolution = 1200;  // dots per inch of the PDF's coordinates
constexpr double kMmPerPoint = 25.4 / 72.0;
const QSizeF kA4(210, 297);

[[noreturn]] void failWith(const QString& message) {
    throw std::runtime_error(message.toStdString());
}

QPageSize exactPageSize(const PdfLayout& layout) {
    return QPageSize(layout.paper, QPageSize::Millimeter, layout.paperName, QPageSize::ExactMatch);
}

// `value` written in exactly `width` characters, as many decimals as fit.
QByteArray numberOfWidth(double value, qsizetype width) {
    QByteArray text = QByteArray::number(value, 'f', 0);
    const qsizetype decimals = width - text.size() - 1;
    if (decimals > 0) text = QByteArray::number(value, 'f', int(decimals));
    return text.size() == width ? text : QByteArray();
}

// Qt 6.4 keeps a page's size in whole points and writes 210 x 297 mm as 595 x 842. The labels
// are drawn against the whole-point page's top edge (see below), and the file's page boxes then
// get the exact size, written in as many characters as Qt's so that the file's offsets stay.
void writeExactPageSize(const QString& fileName, QSizeF whole, QSizeF exact) {
    QFile file(fileName);
    if (!file.open(QIODevice::ReadWrite)) failWith(QStringLiteral("Cannot read %1").arg(fileName));
    QByteArray bytes = file.readAll();
    const QByteArray width = QByteArray::number(whole.width(), 'f', 6);
    const QByteArray height = QByteArray::number(whole.height(), 'f', 6);
    const QByteArray box = "/MediaBox [0 0 " + width + ' ' + height + ']';
    const QByteArray exactBox = "/MediaBox [0 0 " + numberOfWidth(exact.width(), width.size()) +
                                ' ' + numberOfWidth(exact.height(), height.size()) + ']';
    if (exactBox.size() != box.size() || !bytes.contains(box)) {
        qCInfo(log::print) << "PDF page size left in whole points:" << box;
        return;
    }
    bytes.replace(box, exactBox);
    if (!file.seek(0) || file.write(bytes) != bytes.size())
        failWith(QStringLiteral("Cannot write %1").arg(fileName));
}

}  // namespace

PdfLayout gridLayout(QSizeF paper, qint16 rows, qint16 columns) {
    if (rows <= 0 || columns <= 0)
        failWith(QStringLiteral("The label page has %1 rows and %2 columns; both must be above 0")
                     .arg(rows)
                     .arg(columns));
    PdfLayout layout;
    layout.paper = paper;
    layout.label = QSizeF(paper.width() / columns, paper.height() / rows);
    for (int row = 0; row < rows; ++row)
        for (int column = columns - 1; column >= 0; --column)
            layout.positions.emplace_back(column * layout.label.width(),
                                          row * layout.label.height());
    return layout;
}

PdfLayout sheetLayout(const LabelSheet& sheet) {
    return {sheet.paper, sheet.paperName, sheet.label, sheet.positions, sheet.shape, sheet.corner};
}

std::optional<QSizeF> paperSize(const QString& cupsName) {
    static const QRegularExpression custom(QStringLiteral(R"(^w(\d+(?:\.\d+)?)h(\d+(?:\.\d+)?)$)"));
    if (const QRegularExpressionMatch m = custom.match(cupsName); m.hasMatch())
        return QSizeF(m.captured(1).toDouble() * kMmPerPoint,
                      m.captured(2).toDouble() * kMmPerPoint);
    for (int id = 0; id <= int(QPageSize::LastPageSize); ++id) {
        const auto pageId = QPageSize::PageSizeId(id);
        if (QPageSize::key(pageId).compare(cupsName, Qt::CaseInsensitive) == 0)
            return QPageSize::size(pageId, QPageSize::Millimeter);
    }
    return std::nullopt;
}

QSizeF printerPaperSize(const QString& printer) {
    try {
        const QString name = printerPaper(printer);
        if (const std::optional<QSizeF> size = paperSize(name)) return *size;
        qCInfo(log::print) << "printer" << printer << "has paper" << name << "; printing on A4";
    } catch (const Failure& e) {
        qCInfo(log::print) << "no paper size from CUPS; printing on A4:" << e.description();
    }
    return kA4;
}

PdfLabels writeLabelPdf(const QString& fileName, const QString& dbName, LabelPageInput& input,
                        LabelDefinition& def, const PdfLayout& layout, bool outlines,
                        Progress& progress) {
    if (layout.positions.empty()) failWith(QStringLiteral("The label sheet has no labels"));
    prepareCells(input.query.fieldChecks, def);
    jet::Database db = jet::Database::open(dbName);
    jet::Recordset rs = db.openRecordset(BuildLabelQuery(input.query));
    std::optional<LabelRecords> records;
    qint64 total = 0;
    if (!(rs.bof() && rs.eof())) {
        records.emplace(rs, def, input.priceFormat);
        total = records->totalCopies();
        records->start();
    }

    if (QFile::exists(fileName) && !QFile::remove(fileName))
        failWith(QStringLiteral("Cannot delete %1").arg(fileName));
    QPdfWriter writer(fileName);
    writer.setResolution(kResolution);
    writer.setCreator(QStringLiteral("Etiquon"));
    writer.setTitle(QStringLiteral("מדבקות פריטים"));
    writer.setPageSize(exactPageSize(layout));
    writer.setPageMargins(QMarginsF(0, 0, 0, 0), QPageLayout::Millimeter);
    QPainter painter;
    if (!painter.begin(&writer)) failWith(QStringLiteral("Cannot write %1").arg(fileName));

    LabelDrawing drawing(def, writer);
    const double mm = drawing.unitsPerMm();
    // Qt maps the top of the page to its whole-point height: the labels move down by the part
    // of a point that the exact page lacks, so that they lie exactly on it.
    const QSizeF wholePoints = exactPageSize(layout).sizePoints();
    const QSizeF exactPoints = layout.paper / kMmPerPoint;
    painter.translate(0, (wholePoints.height() - exactPoints.height()) * kResolution / 72.0);
    const QSizeF label = layout.label * mm;
    PdfLabels result{fileName, 0, 0, {}};
    progress.clear();
    // One page even when there is no label, so that the file is a document.
    do {
        if (result.pages > 0) writer.newPage();
        ++result.pages;
        for (const QPointF& position : layout.positions) {
            const QRectF area(position * mm, label);
            const LabelFace* face = records ? records->next() : nullptr;
            if (outlines) drawing.drawOutline(painter, area, layout.shape, layout.corner);
            if (!face && !outlines) break;
            if (!face) continue;
            drawing.draw(painter, area, *face);
            ++result.labels;
        }
        progress.show(result.labels, total);
    } while (result.labels < total);
    if (!painter.end()) failWith(QStringLiteral("Cannot write %1").arg(fileName));
    writeExactPageSize(fileName, wholePoints, exactPoints);
    progress.clear();
    result.refusedBarcodes = drawing.refusedBarcodes();
    return result;
}

PdfLabels printLabelsPdf(const QString& dbName, LabelPageInput& input, LabelDefinition& def,
                         const PdfDestination& destination, Progress& progress) {
    PdfLayout layout;
    if (!def.page.SheetBrand.isEmpty() || !def.page.SheetPart.isEmpty()) {
        const LabelSheet* sheet =
            SheetCatalogue::installed().find(def.page.SheetBrand, def.page.SheetPart);
        if (!sheet)
            throw Failure(
                QStringLiteral(
                    "The label sheet %1 %2 is not in the catalogue of label sheets (%3): install glabels-data, or choose another sheet in the designer")
                    .arg(def.page.SheetBrand, def.page.SheetPart,
                         SheetCatalogue::installedFolder()));
        layout = sheetLayout(*sheet);
    } else {
        // A printer chosen, or the default one a job goes to, says the paper; A4 otherwise.
        const bool printer = !destination.printer.isEmpty() || destination.send;
        layout = gridLayout(printer ? printerPaperSize(destination.printer) : kA4,
                            def.page.PageRows, def.page.PageCols);
    }

    std::optional<PrintRunFolder> run;
    QString file;
    if (destination.file) {
        file = *destination.file;
    } else {
        run.emplace();
        file = joinPath(run->path(), kLabelPdfFile);
    }
    PdfLabels result =
        writeLabelPdf(file, dbName, input, def, layout, destination.outlines, progress);
    if (destination.send && result.labels > 0)
        sendToPrinter(file, destination.printer.isEmpty() ? std::nullopt
                                                          : std::optional(destination.printer));
    return result;
}

}  // namespace etq

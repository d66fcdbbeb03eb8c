#include "print/label_drawing.h"

#include <QFontMetricsF>
#include <QPaintDevice>
#include <QPainter>
#include <QTextLayout>
#include <algorithm>
#include <optional>

#include "platform/barcode_image.h"
#include "print/barcode_images.h"

namespace etq {

namespace {

constexpr double kMmPerPoint = 25.4 / 72.0;
constexpr double kMmPerPixel = 25.4 / 96.0;  // a CSS pixel
// The label's table as a browser lays it out: the table's padding of 1, the default spacing of
// 2 between its cells and the default padding of 1 inside them, in CSS pixels.
constexpr double kTablePaddingPx = 1;
constexpr double kCellSpacingPx = 2;
constexpr double kCellPaddingPx = 1;
constexpr double kOutlineMm = 0.1;

// The faces of the designer's font list, with the fonts that stand in for them here (culmus
// has David and Miriam; "Arial (Hebrew)" is the system's sans face).
QStringList fontFamilies(quint8 font) {
    switch (font) {
        case 0:
            return {QStringLiteral("Arial"), QStringLiteral("Liberation Sans"),
                    QStringLiteral("DejaVu Sans")};
        case 1:
            return {QStringLiteral("David"), QStringLiteral("David CLM"),
                    QStringLiteral("DejaVu Sans")};
        case 2:
            return {QStringLiteral("Miriam"), QStringLiteral("Miriam CLM"),
                    QStringLiteral("DejaVu Sans")};
        default:
            return {QStringLiteral("DejaVu Sans")};
    }
}

QFont cellFont(const LabelCell& cell) {
    QFont font;
    font.setFamilies(fontFamilies(cell.Font));
    font.setPointSizeF(cell.FontSize);
    // "Bolder" than the page's normal text is bold.
    font.setWeight(cell.FontWeight == 1 || cell.FontWeight == 2 ? QFont::Bold : QFont::Normal);
    font.setItalic(cell.FontItalic);
    font.setUnderline(cell.FontUL);
    return font;
}

// A cell's direction: 0 left to right, 1 right to left; any other value keeps the label
// table's right to left.
bool rightToLeft(const LabelCell& cell) {
    return cell.Direction != 0;
}

// Where a content of `width` starts in a cell's content box of `box` width: right, centre or
// left (0, 1, 2); any other value starts at the start of the cell's direction.
double alignedX(const LabelCell& cell, double box, double width) {
    const quint8 align = cell.Align <= 2 ? cell.Align : (rightToLeft(cell) ? 0 : 2);
    if (align == 0) return box - width;
    if (align == 1) return (box - width) / 2;
    return 0;
}

}  // namespace

struct LabelDrawing::Layout {
    struct Row {
        int cell = 0;
        double width = 0;   // the content's own width
        double height = 0;  // the row's content height
        double contentHeight = 0;
        std::unique_ptr<QTextLayout> text;
        std::optional<BarcodeVector> barcode;
        QSizeF barcodeSize;
    };
    qint32 recordNo = -1;
    double forWidth = -1;
    std::vector<Row> rows;
    double inner = 0;  // the cells' content width
    double block = 0;  // the table's height
};

LabelDrawing::LabelDrawing(const LabelDefinition& def, const QPaintDevice& device)
    : def_(def),
      device_(device),
      unitsPerMm_(device.logicalDpiY() / 25.4),
      layout_(std::make_unique<Layout>()),
      bar_(mappedBarDef(def.bar)),
      instance_(std::make_unique<BarcodeImage>()) {}

LabelDrawing::~LabelDrawing() = default;

void LabelDrawing::layOut(const LabelFace& face, double width) {
    Layout& l = *layout_;
    l.recordNo = face.recordNo;
    l.forWidth = width;
    l.rows.clear();
    const double px = kMmPerPixel * unitsPerMm_;
    const double around = (kTablePaddingPx + kCellSpacingPx + kCellPaddingPx) * px;
    const double available = std::max(0.0, width - 2 * around);

    for (int i = 0; i < kLabelCellCount; ++i) {
        const LabelCell& cell = def_.cells[size_t(i)];
        if (!cell.UseCell || (cell.ViewType != kTextCell && cell.ViewType != kBarcodeCell))
            continue;
        Layout::Row row;
        row.cell = i;
        const QString& text = face.texts[size_t(i)];
        if (cell.ViewType == kTextCell && !text.isEmpty() && cell.FontSize > 0) {
            row.text = std::make_unique<QTextLayout>(text, cellFont(cell), &device_);
            QTextOption option;
            option.setTextDirection(rightToLeft(cell) ? Qt::RightToLeft : Qt::LeftToRight);
            // Each line is placed by hand once the table's width is known.
            option.setAlignment(Qt::AlignLeft | Qt::AlignAbsolute);
            option.setWrapMode(QTextOption::WrapAtWordBoundaryOrAnywhere);
            row.text->setTextOption(option);
            row.text->beginLayout();
            for (QTextLine line = row.text->createLine(); line.isValid();
                 line = row.text->createLine()) {
                line.setLineWidth(available);
                line.setPosition(QPointF(0, row.contentHeight));
                row.contentHeight += line.height();
                row.width = std::max(row.width, line.naturalTextWidth());
            }
            row.text->endLayout();
        } else if (cell.ViewType == kBarcodeCell) {
            if (def_.bar.BarType >= 0 && !text.isEmpty()) {
                BarcodeVector vector;
                if (MakeBarcodeVector(text, bar_, *instance_, vector))
                    row.barcode = std::move(vector);
                else
                    refused_.append(QStringLiteral("Record %1: %2")
                                        .arg(face.recordNo)
                                        .arg(instance_->lastError()));
            }
            QSizeF size(def_.bar.UserResoX * px, def_.bar.UserResoY * px);
            if (row.barcode) {
                if (def_.bar.UserResoX <= 0) size.setWidth(row.barcode->size.width() * unitsPerMm_);
                if (def_.bar.UserResoY <= 0)
                    size.setHeight(row.barcode->size.height() * unitsPerMm_);
            }
            size = size.expandedTo(QSizeF(0, 0));
            if (size.width() > available && size.width() > 0) size *= available / size.width();
            row.barcodeSize = size;
            row.width = size.width();
            row.contentHeight = size.height();
        }
        row.height = std::max(row.contentHeight,
                              cell.Height > 0 ? cell.Height * kMmPerPoint * unitsPerMm_ : 0.0);
        l.rows.push_back(std::move(row));
    }

    l.inner = 0;
    for (const Layout::Row& row : l.rows)
        l.inner = std::max(l.inner, std::min(row.width, available));
    l.block = 2 * kTablePaddingPx * px + kCellSpacingPx * px;
    for (Layout::Row& row : l.rows) {
        l.block += row.height + (2 * kCellPaddingPx + kCellSpacingPx) * px;
        if (!row.text) continue;
        const LabelCell& cell = def_.cells[size_t(row.cell)];
        for (int n = 0; n < row.text->lineCount(); ++n) {
            QTextLine line = row.text->lineAt(n);
            line.setPosition(
                QPointF(alignedX(cell, l.inner, line.naturalTextWidth()), line.position().y()));
        }
    }
}

void LabelDrawing::draw(QPainter& painter, const QRectF& area, const LabelFace& face) {
    if (layout_->recordNo != face.recordNo || layout_->forWidth != area.width())
        layOut(face, area.width());
    const Layout& l = *layout_;
    const double px = kMmPerPixel * unitsPerMm_;
    const double margins = (def_.page.LabTop + def_.page.LabBottom) * px;
    const double outer = l.inner + 2 * (kTablePaddingPx + kCellSpacingPx + kCellPaddingPx) * px;

    painter.save();
    painter.setClipRect(area, Qt::IntersectClip);
    painter.setPen(QPen(Qt::black, px));
    painter.setBrush(Qt::NoBrush);
    const double cellX =
        area.left() + (area.width() - outer) / 2 + (kTablePaddingPx + kCellSpacingPx) * px;
    double y = area.top() + (area.height() - l.block - margins) / 2 + def_.page.LabTop * px +
               (kTablePaddingPx + kCellSpacingPx) * px;
    for (const Layout::Row& row : l.rows) {
        const LabelCell& cell = def_.cells[size_t(row.cell)];
        const QRectF box(cellX, y, l.inner + 2 * kCellPaddingPx * px,
                         row.height + 2 * kCellPaddingPx * px);
        const QPointF content(
            box.left() + kCellPaddingPx * px,
            box.top() + kCellPaddingPx * px + (row.height - row.contentHeight) / 2);
        if (row.text) {
            row.text->draw(&painter, content);
        } else if (row.barcode) {
            drawBarcode(
                painter,
                QRectF(content + QPointF(alignedX(cell, l.inner, row.width), 0), row.barcodeSize),
                *row.barcode);
        }
        if (cell.Border) painter.drawRect(box);
        y += box.height() + kCellSpacingPx * px;
    }
    painter.restore();
}

void LabelDrawing::drawBarcode(QPainter& painter, const QRectF& target,
                               const BarcodeVector& vector) const {
    if (vector.size.isEmpty() || target.isEmpty()) return;
    const double sx = target.width() / vector.size.width();
    const double sy = target.height() / vector.size.height();
    for (const QRectF& bar : vector.bars)
        painter.fillRect(QRectF(target.left() + bar.left() * sx, target.top() + bar.top() * sy,
                                bar.width() * sx, bar.height() * sy),
                         Qt::black);
    // The digits keep their shape when the symbol is stretched: their size follows its height.
    for (const BarcodeVector::Text& text : vector.texts) {
        QFont font(QStringLiteral("DejaVu Sans"));
        font.setPixelSize(std::max(1, int(std::lround(text.size * sy))));
        const double width = QFontMetricsF(font, &device_).horizontalAdvance(text.text);
        double x = target.left() + text.baseline.x() * sx;
        if (text.align == BarcodeVector::Text::Centre) x -= width / 2;
        if (text.align == BarcodeVector::Text::Right) x -= width;
        painter.setFont(font);
        painter.drawText(QPointF(x, target.top() + text.baseline.y() * sy), text.text);
    }
}

void LabelDrawing::drawOutline(QPainter& painter, const QRectF& area, LabelSheet::Shape shape,
                               double cornerMm) const {
    painter.save();
    painter.setPen(QPen(Qt::black, kOutlineMm * unitsPerMm_));
    painter.setBrush(Qt::NoBrush);
    if (shape == LabelSheet::Shape::Rectangle) {
        const double r = cornerMm * unitsPerMm_;
        if (r > 0)
            painter.drawRoundedRect(area, r, r);
        else
            painter.drawRect(area);
    } else {
        painter.drawEllipse(area);
    }
    painter.restore();
}

}  // namespace etq

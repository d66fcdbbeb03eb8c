#include "dialogs/label_preview.h"

#include <QPainter>
#include <cmath>

#include "print/label_drawing.h"

namespace etq {

namespace {

constexpr int kSide = 320;  // the preview's square, in pixels
constexpr int kMargin = 4;

}  // namespace

LabelPreview::LabelPreview(QWidget* parent) : QWidget(parent) {
    setObjectName(QStringLiteral("picPreview"));
    setMinimumSize(kSide + 2 * kMargin, kSide + 2 * kMargin);
}

QSize LabelPreview::sizeHint() const {
    return {kSide + 2 * kMargin, kSide + 2 * kMargin};
}

void LabelPreview::showLabel(const LabelDefinition& def, const LabelFace& face, QSizeF label,
                             LabelSheet::Shape shape, double corner) {
    if (label.width() <= 0 || label.height() <= 0) label = QSizeF(50, 30);
    const double perMm = kSide / std::max(label.width(), label.height());
    image_ = QImage(int(std::ceil(label.width() * perMm)) + 1,
                    int(std::ceil(label.height() * perMm)) + 1, QImage::Format_RGB32);
    // The image's resolution is what turns the definition's points and millimetres into pixels.
    image_.setDotsPerMeterX(int(std::lround(perMm * 1000)));
    image_.setDotsPerMeterY(int(std::lround(perMm * 1000)));
    image_.fill(Qt::white);
    QPainter painter(&image_);
    painter.setRenderHint(QPainter::Antialiasing);
    LabelDrawing drawing(def, image_);
    const QRectF area(0, 0, label.width() * drawing.unitsPerMm(),
                      label.height() * drawing.unitsPerMm());
    drawing.drawOutline(painter, area, shape, corner);
    drawing.draw(painter, area, face);
    painter.end();
    ++redraws_;
    update();
}

void LabelPreview::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    painter.fillRect(rect(), palette().window());
    if (image_.isNull()) return;
    const QPoint corner((width() - image_.width()) / 2, (height() - image_.height()) / 2);
    painter.drawImage(corner, image_);
}

}  // namespace etq

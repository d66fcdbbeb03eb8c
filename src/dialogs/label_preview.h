#pragma once

#include <QImage>
#include <QWidget>

#include "print/label_faces.h"
#include "print/label_sheets.h"

namespace etq {

// The label designer's preview: one label drawn by the code that draws the printed labels
// (LabelDrawing), with its outline, at the largest size the widget's square holds.
class LabelPreview : public QWidget {
  public:
    explicit LabelPreview(QWidget* parent = nullptr);

    // Draws `face` as `def` lays it out on a label of `label` millimetres.
    void showLabel(const LabelDefinition& def, const LabelFace& face, QSizeF label,
                   LabelSheet::Shape shape = LabelSheet::Shape::Rectangle, double corner = 0);

    const QImage& image() const { return image_; }
    // How many times the label was drawn.
    int redraws() const { return redraws_; }
    QSize sizeHint() const override;

  protected:
    void paintEvent(QPaintEvent* event) override;

  private:
    QImage image_;
    int redraws_ = 0;
};

}  // namespace etq

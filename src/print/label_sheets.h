#pragma once

// The label sheet products of gLabels' catalogue (Debian's glabels-data installs it): one XML
// file per family of makers, each <Template brand part size> giving the paper, one label shape
// (<Label-rectangle width height>, <Label-round radius>, <Label-ellipse width height>,
// <Label-cd radius>) and the layouts of its labels (<Layout nx ny x0 y0 dx dy>: nx x ny labels,
// the first at x0, y0 from the sheet's top left corner, dx and dy apart). Lengths carry their
// unit (pt, in, mm, cm, pc; a bare number is in points). A template with equiv="part" is sold
// under another part number: it has that part's geometry. Everything here is in millimetres.

#include <QPointF>
#include <QSizeF>
#include <QString>
#include <optional>
#include <vector>

namespace etq {

struct LabelSheet {
    enum class Shape { Rectangle, Round, Ellipse, Cd };

    QString brand;
    QString part;
    QString description;
    QString paperName;  // "A4", "US-Letter", ...; empty for a size of the product's own
    QSizeF paper;
    Shape shape = Shape::Rectangle;
    double corner = 0;  // a rectangle's corner radius
    QSizeF label;
    // The top left corner of every label, in the order labels fill a sheet: the top row first,
    // each row from right to left, as the label page fills its grid.
    std::vector<QPointF> positions;
    // How many distinct places across and down the labels take: what the page's grid of
    // PageCols x PageRows stands for.
    int columns = 0;
    int rows = 0;

    // "Avery 7160".
    QString name() const { return brand + u' ' + part; }
};

class SheetCatalogue {
  public:
    // Reads every template file of the folder; a file that cannot be read or parsed is passed
    // over (logged), as is a template without a size or labels.
    explicit SheetCatalogue(const QString& folder);

    // The catalogue installed on this machine, read once: the folder of $ETIQUON_SHEET_TEMPLATES,
    // or glabels-data's /usr/share/libglabels-3.0/templates. Empty when neither exists.
    static const SheetCatalogue& installed();
    static QString installedFolder();

    const std::vector<LabelSheet>& sheets() const { return sheets_; }

    // The sheets whose maker and part number hold every word of `text`, in any letter case, by
    // maker and part; all of them for blank text.
    std::vector<const LabelSheet*> search(const QString& text) const;
    // The sheet of this maker and part number, or nullptr.
    const LabelSheet* find(const QString& brand, const QString& part) const;

  private:
    std::vector<LabelSheet> sheets_;
};

// A length of the catalogue in millimetres ("21.2" points, "5mm", "0.5in"); nothing when the
// text is no length.
std::optional<double> sheetLength(QStringView text);

}  // namespace etq

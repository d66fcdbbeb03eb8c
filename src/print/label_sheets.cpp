#include "print/label_sheets.h"

#include <QDir>
#include <QFile>
#include <QHash>
#include <QXmlStreamReader>
#include <algorithm>
#include <cmath>
#include <map>
#include <set>

#include "platform/log.h"

namespace etq {

using namespace Qt::StringLiterals;

namespace {

constexpr double kMmPerPoint = 25.4 / 72.0;
const QString kInstalledFolder = QStringLiteral("/usr/share/libglabels-3.0/templates");

struct Unit {
    QStringView name;
    double mm;
};
constexpr Unit kUnits[] = {
    {u"pt", kMmPerPoint}, {u"in", 25.4}, {u"mm", 1.0}, {u"cm", 10.0}, {u"pc", 12 * kMmPerPoint},
};

// A template as the file gives it, before an equivalent part takes another's geometry.
struct Template {
    LabelSheet sheet;
    QString equiv;
    QString size;
};

double lengthOr(const QXmlStreamAttributes& attributes, QLatin1StringView name,
                double fallback = 0) {
    return sheetLength(attributes.value(name)).value_or(fallback);
}

// Positions a hundredth of a millimetre apart are one place.
qint64 place(double mm) {
    return qint64(std::llround(mm * 100));
}

// Orders the labels as the page fills them and counts the places they take.
void arrange(LabelSheet& sheet) {
    std::sort(sheet.positions.begin(), sheet.positions.end(), [](QPointF a, QPointF b) {
        if (place(a.y()) != place(b.y())) return place(a.y()) < place(b.y());
        return place(a.x()) > place(b.x());
    });
    std::set<qint64> across, down;
    for (QPointF p : sheet.positions) {
        across.insert(place(p.x()));
        down.insert(place(p.y()));
    }
    sheet.columns = int(across.size());
    sheet.rows = int(down.size());
}

void readLabel(QXmlStreamReader& xml, LabelSheet& sheet) {
    const QStringView kind = xml.name();
    const QXmlStreamAttributes a = xml.attributes();
    if (kind == u"Label-rectangle") {
        sheet.shape = LabelSheet::Shape::Rectangle;
        sheet.label = QSizeF(lengthOr(a, "width"_L1), lengthOr(a, "height"_L1));
        sheet.corner = lengthOr(a, "round"_L1);
    } else if (kind == u"Label-ellipse") {
        sheet.shape = LabelSheet::Shape::Ellipse;
        sheet.label = QSizeF(lengthOr(a, "width"_L1), lengthOr(a, "height"_L1));
    } else {
        const double diameter = 2 * lengthOr(a, "radius"_L1);
        sheet.shape = kind == u"Label-cd" ? LabelSheet::Shape::Cd : LabelSheet::Shape::Round;
        sheet.label = QSizeF(lengthOr(a, "width"_L1, diameter), lengthOr(a, "height"_L1, diameter));
    }
    while (xml.readNextStartElement()) {
        if (xml.name() == u"Layout") {
            const QXmlStreamAttributes l = xml.attributes();
            const int nx = l.value("nx"_L1).toInt();
            const int ny = l.value("ny"_L1).toInt();
            const double x0 = lengthOr(l, "x0"_L1), y0 = lengthOr(l, "y0"_L1);
            const double dx = lengthOr(l, "dx"_L1), dy = lengthOr(l, "dy"_L1);
            for (int iy = 0; iy < ny; ++iy)
                for (int ix = 0; ix < nx; ++ix)
                    sheet.positions.emplace_back(x0 + ix * dx, y0 + iy * dy);
        }
        xml.skipCurrentElement();
    }
}

Template readTemplate(QXmlStreamReader& xml) {
    const QXmlStreamAttributes a = xml.attributes();
    Template t;
    t.sheet.brand = a.value("brand"_L1).toString();
    t.sheet.part = a.value("part"_L1).toString();
    t.sheet.description = a.hasAttribute("_description"_L1) ? a.value("_description"_L1).toString()
                                                            : a.value("description"_L1).toString();
    t.equiv = a.value("equiv"_L1).toString();
    t.size = a.value("size"_L1).toString();
    t.sheet.paper = QSizeF(lengthOr(a, "width"_L1), lengthOr(a, "height"_L1));
    while (xml.readNextStartElement()) {
        if (xml.name().startsWith(u"Label-"))
            readLabel(xml, t.sheet);
        else
            xml.skipCurrentElement();
    }
    return t;
}

QHash<QString, QSizeF> readPaperSizes(const QString& folder) {
    QHash<QString, QSizeF> sizes;
    QFile file(QDir(folder).filePath(QStringLiteral("paper-sizes.xml")));
    if (!file.open(QIODevice::ReadOnly)) return sizes;
    QXmlStreamReader xml(&file);
    while (!xml.atEnd()) {
        if (xml.readNext() == QXmlStreamReader::StartElement && xml.name() == u"Paper-size") {
            const QXmlStreamAttributes a = xml.attributes();
            sizes.insert(a.value("id"_L1).toString(),
                         QSizeF(lengthOr(a, "width"_L1), lengthOr(a, "height"_L1)));
        }
    }
    return sizes;
}

std::vector<Template> readTemplates(const QString& path) {
    std::vector<Template> templates;
    QFile file(path);
    if (!file.open(QIODevice::ReadOnly)) {
        qCInfo(log::print) << "label sheets: cannot read" << path;
        return templates;
    }
    QXmlStreamReader xml(&file);
    while (!xml.atEnd()) {
        if (xml.readNext() == QXmlStreamReader::StartElement && xml.name() == u"Template")
            templates.push_back(readTemplate(xml));
    }
    if (xml.hasError()) {
        qCInfo(log::print) << "label sheets: passed over" << path << xml.errorString();
        templates.clear();
    }
    return templates;
}

QString key(const QString& brand, const QString& part) {
    return brand.toCaseFolded() + u'\n' + part.toCaseFolded();
}

}  // namespace

std::optional<double> sheetLength(QStringView text) {
    text = text.trimmed();
    double factor = kMmPerPoint;
    for (const Unit& unit : kUnits) {
        if (text.endsWith(unit.name)) {
            factor = unit.mm;
            text = text.chopped(unit.name.size()).trimmed();
            break;
        }
    }
    bool ok = false;
    const double number = text.toDouble(&ok);
    if (!ok || !std::isfinite(number)) return std::nullopt;
    return number * factor;
}

SheetCatalogue::SheetCatalogue(const QString& folder) {
    const QHash<QString, QSizeF> papers = readPaperSizes(folder);
    std::vector<Template> templates;
    for (const QString& name :
         QDir(folder).entryList({QStringLiteral("*.xml")}, QDir::Files, QDir::Name)) {
        std::vector<Template> read = readTemplates(QDir(folder).filePath(name));
        std::move(read.begin(), read.end(), std::back_inserter(templates));
    }
    std::map<QString, const Template*> byPart;
    for (const Template& t : templates)
        if (t.equiv.isEmpty()) byPart.emplace(key(t.sheet.brand, t.sheet.part), &t);

    for (const Template& t : templates) {
        LabelSheet sheet = t.sheet;
        QString size = t.size;
        if (!t.equiv.isEmpty()) {
            const auto original = byPart.find(key(t.sheet.brand, t.equiv));
            if (original == byPart.end()) continue;
            sheet = original->second->sheet;
            sheet.part = t.sheet.part;
            if (!t.sheet.description.isEmpty()) sheet.description = t.sheet.description;
            size = original->second->size;
        }
        if (papers.contains(size)) {
            sheet.paperName = size;
            sheet.paper = papers.value(size);
        }
        if (sheet.paper.isEmpty() || sheet.label.isEmpty() || sheet.positions.empty()) continue;
        arrange(sheet);
        sheets_.push_back(std::move(sheet));
    }
    std::sort(sheets_.begin(), sheets_.end(), [](const LabelSheet& a, const LabelSheet& b) {
        return key(a.brand, a.part) < key(b.brand, b.part);
    });
}

QString SheetCatalogue::installedFolder() {
    const QString chosen = qEnvironmentVariable("ETIQUON_SHEET_TEMPLATES");
    return chosen.isEmpty() ? kInstalledFolder : chosen;
}

const SheetCatalogue& SheetCatalogue::installed() {
    static const SheetCatalogue catalogue(installedFolder());
    return catalogue;
}

std::vector<const LabelSheet*> SheetCatalogue::search(const QString& text) const {
    const QStringList words = text.simplified().split(u' ', Qt::SkipEmptyParts);
    std::vector<const LabelSheet*> found;
    for (const LabelSheet& sheet : sheets_) {
        const QString name = sheet.name();
        if (std::all_of(words.begin(), words.end(), [&](const QString& word) {
                return name.contains(word, Qt::CaseInsensitive);
            }))
            found.push_back(&sheet);
    }
    return found;
}

const LabelSheet* SheetCatalogue::find(const QString& brand, const QString& part) const {
    for (const LabelSheet& sheet : sheets_)
        if (sheet.brand.compare(brand, Qt::CaseInsensitive) == 0 &&
            sheet.part.compare(part, Qt::CaseInsensitive) == 0)
            return &sheet;
    return nullptr;
}

}  // namespace etq

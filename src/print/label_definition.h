#pragma once

#include <QString>
#include <array>

namespace etq {

class Context;
class SettingsStore;

// The built-in label: seven cells stacked in every label, one barcode setting shared by the
// barcode cells, and the page grid. Field names are the keys the settings store keeps them
// under. Before the first load every field is zero, false or empty; a load gives the defaults
// for keys the store lacks.

// One row of every label.
struct LabelCell {
    bool UseCell = false;
    qint16 FldID = 0;       // the label field slot shown; -1 none
    QString FieldName;      // set when the page is written: the query column of FldID
    quint8 ViewType = 0;    // 0 text, 1 barcode image
    quint8 Font = 0;        // 0 "Arial (Hebrew)", 1 "David", 2 "Miriam"
    quint8 FontSize = 0;    // points
    quint8 FontWeight = 0;  // 0 Normal, 1 Bolder, 2 Bold
    bool FontUL = false;
    bool FontItalic = false;
    quint8 Align = 0;      // 0 right, 1 centre, 2 left
    quint8 Direction = 0;  // 0 left to right, 1 right to left
    QString Prefix;
    bool IsPrice = false;  // set when the page is written: FldID is a price slot
    qint16 Height = 0;     // points; 0 or less automatic
    bool Border = false;

    bool operator==(const LabelCell&) const = default;
};

// The barcode setting of all barcode cells.
struct LabelBarDef {
    qint16 BarType = 0;  // index into the designer's list; negative: no barcode images
    QString LeftPrefix;
    qint16 LeftLen = 0;
    float DimX = 0;  // inches
    float WideBarRatio = 0;
    float BarHeight = 0;  // inches
    bool C128User = false;
    bool C39Ascii = false;
    qint16 UserResoX = 0;  // image width in the page, pixels; 0 or less not given
    qint16 UserResoY = 0;
    bool CheckDigit = false;
    bool ShowDesc = false;

    bool operator==(const LabelBarDef&) const = default;
};

// The page grid.
struct DirectLabelDef {
    qint16 PageRows = 0;
    qint16 PageCols = 0;
    bool PageAutoPrint = false;
    qint16 MaxTextLen = 0;
    qint16 LabTop = 0;
    qint16 LabBottom = 0;
    // The label sheet product chosen in the designer (label_sheets.h): the PDF places the labels
    // where it has them. Empty: the grid divides the page.
    QString SheetBrand;
    QString SheetPart;

    bool operator==(const DirectLabelDef&) const = default;
};

inline constexpr int kLabelCellCount = 7;

// The densest grid a sheet can hold: 100 rows and 40 columns of labels leave about 3 mm by
// 5 mm a label on A4, below the smallest labels sold on sheets. A larger grid is a setting gone
// wrong, and would write a page of gigabytes for a handful of labels.
inline constexpr int kMaxPageRows = 100;
inline constexpr int kMaxPageCols = 40;

struct LabelDefinition {
    std::array<LabelCell, kLabelCellCount> cells;
    LabelBarDef bar;
    DirectLabelDef page;
    // Set by the first load or save: the definition in memory is the user's from then on.
    bool loaded = false;

    bool operator==(const LabelDefinition&) const = default;
};

enum LabelDefAction : quint8 { SaveLabelDef = 1, LoadLabelDef = 2 };

// Writes (1) the definition to the settings store of `application`, or reads it
// (2): the cell sections 0LabelDef to 6LabelDef, then "LabelBar" only while BarType is not
// negative, then "DirectLabel". A value that does not convert to its field's type leaves the
// field as it was; nothing is reported.
void GetSetLabelDef(quint8 action, const QString& application, LabelDefinition& definition);

// The run's definition, loaded from the store first unless this run has loaded (or saved) it
// already: the designer's changes since then stay. Every use of the built-in label goes
// through here, so a route chosen after start-up does not print an empty definition.
LabelDefinition& loadedLabelDefinition(Context& context);

// Takes a text into a field as a load does: numbers ("True" and "False" as -1 and 0), whole
// fields rounded half to even; false, leaving the field as it was, when the text does not
// convert or a whole number does not fit.
bool labelValueFromText(const QString& text, bool& value);
bool labelValueFromText(const QString& text, quint8& value);
bool labelValueFromText(const QString& text, qint16& value);
bool labelValueFromText(const QString& text, float& value);
bool labelValueFromText(const QString& text, QString& value);
// A field's value as a save writes it: booleans "-1" and "0", single-precision numbers with the
// seven digits they hold (0.01 as "0.01"), "True" and "False" in a text as "-1" and "0".
QString labelValueText(bool value);
QString labelValueText(quint8 value);
QString labelValueText(qint16 value);
QString labelValueText(float value);
QString labelValueText(const QString& value);

// Moves one value. Writing stores the value as text, booleans as "-1" and "0". Reading takes
// the stored text (or `defaultText`) into the field; "True" and "False" read as -1 and 0.
void GetSetLabelValue(quint8 action, SettingsStore& store, const QString& section,
                      const QString& key, bool& value, const QString& defaultText);
void GetSetLabelValue(quint8 action, SettingsStore& store, const QString& section,
                      const QString& key, quint8& value, const QString& defaultText);
void GetSetLabelValue(quint8 action, SettingsStore& store, const QString& section,
                      const QString& key, qint16& value, const QString& defaultText);
void GetSetLabelValue(quint8 action, SettingsStore& store, const QString& section,
                      const QString& key, float& value, const QString& defaultText);
void GetSetLabelValue(quint8 action, SettingsStore& store, const QString& section,
                      const QString& key, QString& value, const QString& defaultText);

}  // namespace etq

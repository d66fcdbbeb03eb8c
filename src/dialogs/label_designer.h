#pragma once

// What the label designer frmLabDef knows without its window: which of its controls moves which
// field of the built-in label definition, the fixed items of its drop-down lists, how a
// control's value becomes its field's value and back, and the field list it takes from the
// control's label field slots.

#include <QString>
#include <QStringList>
#include <span>
#include <variant>

#include "print/label_definition.h"
#include "surface/surface.h"

namespace etq {

// A field of the definition: a member of a cell, of the barcode setting or of the page.
using DesignerField =
    std::variant<bool LabelCell::*, quint8 LabelCell::*, qint16 LabelCell::*, QString LabelCell::*,
                 bool LabelBarDef::*, qint16 LabelBarDef::*, float LabelBarDef::*,
                 QString LabelBarDef::*, bool DirectLabelDef::*, qint16 DirectLabelDef::*>;

// One control of the designer and the field it moves. The cell controls are arrays with one
// element per cell (index = cell), the others single controls.
struct DesignerControl {
    QStringView name;
    ControlKind kind;  // CheckBox, ComboBox or TextBox
    DesignerField field;
    QStringView hebrew;  // what the window calls the field
    QStringView english;
    QStringView items = {};  // a drop-down list's fixed items, "a;b;c"; empty: filled otherwise
    QStringView englishItems = {};
};

// The thirteen cell controls (chkXCell to ChkBorder) and the sixteen controls of the barcode
// and the page (cmbXBarType to txtLabBottom), in the order GetSetFormLabDefs moves them.
std::span<const DesignerControl> designerCellControls();
std::span<const DesignerControl> designerSharedControls();
const DesignerControl* findDesignerControl(QStringView name);

// The field's value as its control shows it: a number for lists and check boxes (booleans as
// -1 and 0), text for text boxes. `cell` is ignored for the shared controls.
int designerValue(const DesignerControl& control, const LabelDefinition& def, int cell);
QString designerText(const DesignerControl& control, const LabelDefinition& def, int cell);
// And back: a list's index or a check box's value 1 (true) or 0 (false); a text box's text,
// converted to the field's type (false, leaving the field, when it does not convert).
void setDesignerValue(const DesignerControl& control, LabelDefinition& def, int cell, int value);
bool setDesignerText(const DesignerControl& control, LabelDefinition& def, int cell,
                     const QString& text);

// The message for a text its field cannot take, naming the control, its cell and its field.
// `language` as the run's: 1 English, else Hebrew.
QString designerValueProblem(const DesignerControl& control, int cell, const QString& text,
                             qint16 language);

// FillXFld's items: the captions of the control's LblFldDesc array, element by element.
QStringList labelFieldCaptions(const Surface& card);

// The items of a list with fixed items, in the run's language.
QStringList designerItems(const DesignerControl& control, qint16 language);

}  // namespace etq

#include "dialogs/label_designer.h"

#include <limits>

namespace etq {

namespace {

using K = ControlKind;

constexpr DesignerControl kCellControls[] = {
    {u"chkXCell", K::CheckBox, &LabelCell::UseCell, u"בשימוש", u"In use"},
    {u"cmbXFld", K::ComboBox, &LabelCell::FldID, u"שדה", u"Field"},
    {u"cmbVType", K::ComboBox, &LabelCell::ViewType, u"תצוגה", u"Shown as", u"טקסט:;ברקוד",
     u"Text:;Barcode"},
    {u"CmbFont", K::ComboBox, &LabelCell::Font, u"גופן", u"Font", u"Arial;David;Miriam",
     u"Arial;David;Miriam"},
    {u"txtFontSize", K::TextBox, &LabelCell::FontSize, u"גודל", u"Size"},
    {u"CmbWeight", K::ComboBox, &LabelCell::FontWeight, u"משקל", u"Weight", u"רגיל;מודגש;עבה",
     u"Normal;Bolder;Bold"},
    {u"ChkUL", K::CheckBox, &LabelCell::FontUL, u"קו תחתי", u"Underline"},
    {u"ChkItalic", K::CheckBox, &LabelCell::FontItalic, u"נטוי", u"Italic"},
    {u"CmbAlign", K::ComboBox, &LabelCell::Align, u"יישור", u"Alignment", u"ימין;מרכז;שמאל",
     u"Right;Centre;Left"},
    {u"CmbDirection", K::ComboBox, &LabelCell::Direction, u"כיוון", u"Direction", u"משמאל;מימין",
     u"Left to right;Right to left"},
    {u"txtPrefix", K::TextBox, &LabelCell::Prefix, u"קידומת", u"Prefix"},
    {u"txtHeight", K::TextBox, &LabelCell::Height, u"גובה", u"Height"},
    {u"ChkBorder", K::CheckBox, &LabelCell::Border, u"מסגרת", u"Border"},
};

constexpr QStringView kBarTypes =
    u"CODE-39;CODE-39 Ascii;CODE-128;CODE-128A;CODE-128B;EAN-8;EAN-13;Interleaved 2 of 5";

constexpr DesignerControl kSharedControls[] = {
    {u"cmbXBarType", K::ComboBox, &LabelBarDef::BarType, u"סוג ברקוד:", u"Barcode type:", kBarTypes,
     kBarTypes},
    {u"txtXBarH", K::TextBox, &LabelBarDef::BarHeight, u"גובה הברקוד:", u"Bar height:"},
    {u"txtXBarLeftLen", K::TextBox, &LabelBarDef::LeftLen, u"מס' תוים משמאל:",
     u"Characters from the left:"},
    {u"txtXLeftPrefix", K::TextBox, &LabelBarDef::LeftPrefix, u"קידומת משמאל:",
     u"Prefix on the left:"},
    {u"txtUserResoX", K::TextBox, &LabelBarDef::UserResoX, u"רוחב בנק':", u"Width in points:"},
    {u"txtUserResoY", K::TextBox, &LabelBarDef::UserResoY, u"גובה בנקודות:", u"Height in points:"},
    {u"chkCDigit", K::CheckBox, &LabelBarDef::CheckDigit, u"ספרת ביקורת?", u"Check digit?"},
    {u"ChkShowDesc", K::CheckBox, &LabelBarDef::ShowDesc, u"הצג גם כטקסט?", u"Show as text too?"},
    {u"txtDimX", K::TextBox, &LabelBarDef::DimX, u"עובי קו:", u"Narrow bar:"},
    {u"txtWideBarRatio", K::TextBox, &LabelBarDef::WideBarRatio, u"יחס עובי:", u"Wide ratio:"},
    {u"txtCols", K::TextBox, &DirectLabelDef::PageCols, u"מדבקות בכל שורה", u"Labels in each row"},
    {u"txtRows", K::TextBox, &DirectLabelDef::PageRows, u"שורות", u"Rows"},
    {u"chkOpenPrintDlg", K::CheckBox, &DirectLabelDef::PageAutoPrint,
     u"פתיחה אוטומטית של חלון בחירת מדפסת בהצגת המדבקות?",
     u"Open the print dialog when the labels are shown?"},
    {u"txtMaxTextLen", K::TextBox, &DirectLabelDef::MaxTextLen, u"מספר תוים מקסימלי לטקסט:",
     u"Most characters of a text:"},
    {u"txtLabTop", K::TextBox, &DirectLabelDef::LabTop, u"עליונים:", u"Top:"},
    {u"txtLabBottom", K::TextBox, &DirectLabelDef::LabBottom, u"תחתונים:", u"Bottom:"},
};

// The part of the definition a member belongs to (const when the definition is).
template <class Def, class T>
auto& partOf(Def& def, int cell, T LabelCell::*) {
    return def.cells[size_t(cell)];
}
template <class Def, class T>
auto& partOf(Def& def, int, T LabelBarDef::*) {
    return def.bar;
}
template <class Def, class T>
auto& partOf(Def& def, int, T DirectLabelDef::*) {
    return def.page;
}

// Calls `work` with a reference to the control's field.
template <class Def, class Work>
auto withField(const DesignerControl& control, Def& def, int cell, Work&& work) {
    return std::visit([&](auto member) { return work(partOf(def, cell, member).*member); },
                      control.field);
}

int numberOf(bool value) {
    return value ? -1 : 0;
}
template <class T>
int numberOf(T value) {
    if constexpr (std::is_arithmetic_v<T>)
        return int(value);
    else
        return 0;
}

// What a whole field takes, for the message.
template <class T>
QString expected(qint16 language) {
    if constexpr (std::is_same_v<T, float>) {
        return language > 0 ? QStringLiteral("a number") : QStringLiteral("מספר");
    } else {
        const auto low = qint64(std::numeric_limits<T>::min());
        const auto high = qint64(std::numeric_limits<T>::max());
        return (language > 0 ? QStringLiteral("a whole number from %1 to %2")
                             : QStringLiteral("מספר שלם מ-%1 עד %2"))
            .arg(low)
            .arg(high);
    }
}

QString fieldName(const DesignerControl& control, qint16 language) {
    QString name = (language > 0 ? control.english : control.hebrew).toString();
    while (name.endsWith(u':') || name.endsWith(u'?'))
        name.chop(1);
    return name;
}

bool isCellControl(const DesignerControl& control) {
    return &control >= std::begin(kCellControls) && &control < std::end(kCellControls);
}

}  // namespace

std::span<const DesignerControl> designerCellControls() {
    return kCellControls;
}

std::span<const DesignerControl> designerSharedControls() {
    return kSharedControls;
}

const DesignerControl* findDesignerControl(QStringView name) {
    for (std::span<const DesignerControl> table :
         {designerCellControls(), designerSharedControls()})
        for (const DesignerControl& c : table)
            if (c.name == name) return &c;
    return nullptr;
}

int designerValue(const DesignerControl& control, const LabelDefinition& def, int cell) {
    return withField(control, def, cell, [](const auto& field) { return numberOf(field); });
}

QString designerText(const DesignerControl& control, const LabelDefinition& def, int cell) {
    return withField(control, def, cell, [](const auto& field) {
        if constexpr (std::is_same_v<std::decay_t<decltype(field)>, QString>)
            return field;
        else
            return labelValueText(field);
    });
}

void setDesignerValue(const DesignerControl& control, LabelDefinition& def, int cell, int value) {
    withField(control, def, cell, [&](auto& field) {
        using T = std::decay_t<decltype(field)>;
        if constexpr (std::is_same_v<T, bool>)
            field = value == 1;
        else if constexpr (std::is_arithmetic_v<T>)
            field = T(value);
    });
}

bool setDesignerText(const DesignerControl& control, LabelDefinition& def, int cell,
                     const QString& text) {
    return withField(control, def, cell,
                     [&](auto& field) { return labelValueFromText(text, field); });
}

QString designerValueProblem(const DesignerControl& control, int cell, const QString& text,
                             qint16 language) {
    const LabelDefinition scratch;
    const QString what = withField(control, scratch, 0, [&](const auto& field) {
        using T = std::decay_t<decltype(field)>;
        if constexpr (std::is_arithmetic_v<T> && !std::is_same_v<T, bool>)
            return expected<T>(language);
        else
            return QString();
    });
    const QString name = isCellControl(control)
                             ? QStringLiteral("%1(%2)").arg(control.name).arg(cell)
                             : control.name.toString();
    const QString place = isCellControl(control) ? (language > 0 ? QStringLiteral("Row %1, %2")
                                                                 : QStringLiteral("שורה %1, %2"))
                                                       .arg(cell + 1)
                                                       .arg(fieldName(control, language))
                                                 : fieldName(control, language);
    return (language > 0 ? QStringLiteral("%1 (%2): \"%3\" is not %4")
                         : QStringLiteral("%1 (%2): \"%3\" אינו %4"))
        .arg(place, name, text, what);
}

QStringList labelFieldCaptions(const Surface& card) {
    QStringList captions;
    const int count = card.elementCount(QStringLiteral("LblFldDesc"));
    for (int j = 0; j < count; ++j)
        captions << card.control(QStringLiteral("LblFldDesc"), j).caption();
    return captions;
}

QStringList designerItems(const DesignerControl& control, qint16 language) {
    const QStringView items = language > 0 ? control.englishItems : control.items;
    if (items.isEmpty()) return {};
    return items.toString().split(u';');
}

}  // namespace etq

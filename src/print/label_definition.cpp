#include "print/label_definition.h"

#include <limits>
#include <optional>
#include <variant>

#include "jet/vb.h"
#include "platform/context.h"
#include "platform/settings_store.h"

namespace etq {

namespace {

// One stored field of a part of the definition: its key, the member it moves and the value a
// load gives when the store has none.
template <class Part>
struct Key {
    using Member =
        std::variant<bool Part::*, quint8 Part::*, qint16 Part::*, float Part::*, QString Part::*>;
    QStringView key;
    Member member;
    QStringView defaultText;
};

// In the order of reading and writing.
const Key<LabelCell> kCellKeys[] = {
    {u"UseCell", &LabelCell::UseCell, u"False"},
    {u"FldID", &LabelCell::FldID, u"-1"},
    {u"ViewType", &LabelCell::ViewType, u"0"},
    {u"Align", &LabelCell::Align, u"1"},
    {u"Font", &LabelCell::Font, u"0"},
    {u"FontSize", &LabelCell::FontSize, u"9"},
    {u"FontWeight", &LabelCell::FontWeight, u"0"},
    {u"FontUL", &LabelCell::FontUL, u"False"},
    {u"FontItalic", &LabelCell::FontItalic, u"False"},
    {u"Direction", &LabelCell::Direction, u"1"},
    {u"Prefix", &LabelCell::Prefix, u""},
    {u"Height", &LabelCell::Height, u"0"},
    {u"Border", &LabelCell::Border, u"False"},
};

const Key<LabelBarDef> kBarKeys[] = {
    {u"BarType", &LabelBarDef::BarType, u"0"},
    {u"BarHeight", &LabelBarDef::BarHeight, u"0.4"},
    {u"C128User", &LabelBarDef::C128User, u"False"},
    {u"C39Ascii", &LabelBarDef::C39Ascii, u"False"},
    {u"DimX", &LabelBarDef::DimX, u"0.01"},
    {u"LeftLen", &LabelBarDef::LeftLen, u"0"},
    {u"LeftPrefix", &LabelBarDef::LeftPrefix, u""},
    {u"UserResoX", &LabelBarDef::UserResoX, u"100"},
    {u"UserResoY", &LabelBarDef::UserResoY, u"50"},
    {u"WideBarRatio", &LabelBarDef::WideBarRatio, u"2.2"},
    {u"CheckDigit", &LabelBarDef::CheckDigit, u"True"},
    {u"ShowDesc", &LabelBarDef::ShowDesc, u"False"},
};

const Key<DirectLabelDef> kPageKeys[] = {
    {u"PageCols", &DirectLabelDef::PageCols, u"4"},
    {u"PageRows", &DirectLabelDef::PageRows, u"6"},
    {u"PageAutoPrint", &DirectLabelDef::PageAutoPrint, u"False"},
    {u"MaxTextLen", &DirectLabelDef::MaxTextLen, u"0"},
    {u"LabTop", &DirectLabelDef::LabTop, u"0"},
    {u"LabBottom", &DirectLabelDef::LabBottom, u"0"},
    {u"SheetBrand", &DirectLabelDef::SheetBrand, u""},
    {u"SheetPart", &DirectLabelDef::SheetPart, u""},
};

template <class Part, size_t N>
void moveSection(quint8 action, SettingsStore& store, const QString& section, Part& part,
                 const Key<Part> (&keys)[N]) {
    for (const Key<Part>& k : keys) {
        std::visit(
            [&](auto member) {
                GetSetLabelValue(action, store, section, k.key.toString(), part.*member,
                                 k.defaultText.toString());
            },
            k.member);
    }
}

// A stored "True" or "False" stands for -1 or 0 in any numeric field.
std::optional<double> storedNumber(const QString& text) {
    if (text == u"True") return -1.0;
    if (text == u"False") return 0.0;
    return vb::toNumber(text);
}

// Whole numbers take the stored text as CInt does; out of the field's range leaves it.
template <class Whole>
bool readWhole(const QString& text, Whole& value) {
    const std::optional<double> number = storedNumber(text);
    if (!number) return false;
    const qint64 whole = vb::roundHalfEven(*number);
    if (whole < std::numeric_limits<Whole>::min() || whole > std::numeric_limits<Whole>::max())
        return false;
    value = Whole(whole);
    return true;
}

template <class T>
void moveValue(quint8 action, SettingsStore& store, const QString& section, const QString& key,
               T& value, const QString& defaultText) {
    if (action == SaveLabelDef) {
        store.write(section, key, labelValueText(value));
    } else if (action == LoadLabelDef) {
        labelValueFromText(store.read(section, key, defaultText), value);
    }
}

}  // namespace

}  // namespace etq

// The context holds the definition; its type is this layer's, so the context's accessor is
// defined here.
etq::LabelDefinition& etq::Context::labelDefinition() {
    if (!labelDefinition_) labelDefinition_ = std::make_shared<LabelDefinition>();
    return *labelDefinition_;
}

namespace etq {

bool labelValueFromText(const QString& text, bool& value) {
    const std::optional<double> number = storedNumber(text);
    if (number) value = *number != 0;
    return number.has_value();
}
bool labelValueFromText(const QString& text, quint8& value) {
    return readWhole(text, value);
}
bool labelValueFromText(const QString& text, qint16& value) {
    return readWhole(text, value);
}
bool labelValueFromText(const QString& text, float& value) {
    const std::optional<double> number = storedNumber(text);
    if (number) value = float(*number);
    return number.has_value();
}
bool labelValueFromText(const QString& text, QString& value) {
    value = labelValueText(text);
    return true;
}

QString labelValueText(bool value) {
    return value ? QStringLiteral("-1") : QStringLiteral("0");
}
QString labelValueText(quint8 value) {
    return QString::number(value);
}
QString labelValueText(qint16 value) {
    return QString::number(value);
}
// Single-precision values keep the seven digits they hold: 0.01 is stored as "0.01".
QString labelValueText(float value) {
    return QString::number(double(value), 'g', 7);
}
QString labelValueText(const QString& value) {
    if (value == u"True") return QStringLiteral("-1");
    if (value == u"False") return QStringLiteral("0");
    return value;
}

LabelDefinition& loadedLabelDefinition(Context& context) {
    LabelDefinition& definition = context.labelDefinition();
    if (!definition.loaded) GetSetLabelDef(LoadLabelDef, context.applicationName, definition);
    return definition;
}

void GetSetLabelValue(quint8 action, SettingsStore& store, const QString& section,
                      const QString& key, bool& value, const QString& defaultText) {
    moveValue(action, store, section, key, value, defaultText);
}
void GetSetLabelValue(quint8 action, SettingsStore& store, const QString& section,
                      const QString& key, quint8& value, const QString& defaultText) {
    moveValue(action, store, section, key, value, defaultText);
}
void GetSetLabelValue(quint8 action, SettingsStore& store, const QString& section,
                      const QString& key, qint16& value, const QString& defaultText) {
    moveValue(action, store, section, key, value, defaultText);
}
void GetSetLabelValue(quint8 action, SettingsStore& store, const QString& section,
                      const QString& key, float& value, const QString& defaultText) {
    moveValue(action, store, section, key, value, defaultText);
}
void GetSetLabelValue(quint8 action, SettingsStore& store, const QString& section,
                      const QString& key, QString& value, const QString& defaultText) {
    moveValue(action, store, section, key, value, defaultText);
}

void GetSetLabelDef(quint8 action, const QString& application, LabelDefinition& definition) {
    SettingsStore store(application);
    for (int i = 0; i < kLabelCellCount; ++i)
        moveSection(action, store, QString::number(i) + QStringLiteral("LabelDef"),
                    definition.cells[size_t(i)], kCellKeys);
    // A negative bar type turns barcodes off for good: the section is neither read nor written.
    if (definition.bar.BarType >= 0)
        moveSection(action, store, QStringLiteral("LabelBar"), definition.bar, kBarKeys);
    moveSection(action, store, QStringLiteral("DirectLabel"), definition.page, kPageKeys);
    store.sync();
    if (action == SaveLabelDef || action == LoadLabelDef) definition.loaded = true;
}

}  // namespace etq

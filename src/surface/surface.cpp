#include "surface/surface.h"

namespace etq {

namespace {

bool hasText(ControlKind kind) {
    return kind == ControlKind::TextBox || kind == ControlKind::ComboBox;
}

bool hasCaption(ControlKind kind) {
    switch (kind) {
        case ControlKind::Label:
        case ControlKind::CommandButton:
        case ControlKind::CheckBox:
        case ControlKind::OptionButton:
        case ControlKind::Frame:
            return true;
        default:
            return false;
    }
}

}  // namespace

std::optional<int> checkStateOf(const QVariant& value) {
    if (value.typeId() == QMetaType::Bool) return std::nullopt;  // True is -1: no check state
    bool ok = false;
    const int state = value.toString().trimmed().toInt(&ok);
    if (!ok || state < 0 || state > 2) return std::nullopt;
    return state;
}

std::optional<bool> optionStateOf(const QVariant& value) {
    if (value.typeId() == QMetaType::Bool) return value.toBool();
    const QString text = value.toString().trimmed();
    if (text.compare(u"True", Qt::CaseInsensitive) == 0) return true;
    if (text.compare(u"False", Qt::CaseInsensitive) == 0) return false;
    bool ok = false;
    const double number = text.toDouble(&ok);
    if (!ok) return std::nullopt;
    return number != 0;
}

SurfaceError::SurfaceError(const QString& message) : std::runtime_error(message.toStdString()) {}

void ControlRef::require(bool has, const char* property) const {
    if (!has) throw SurfaceError(QStringLiteral("%1 has no property %2").arg(name_, property));
}

QString ControlRef::text() const {
    require(hasText(kind()), "Text");
    if (kind() == ControlKind::ComboBox) {
        const int i = control_->listIndex();
        return i >= 0 ? control_->itemText(i) : QString();
    }
    return control_->text();
}

void ControlRef::setText(const QString& text) const {
    require(hasText(kind()), "Text");
    if (kind() != ControlKind::ComboBox) {
        control_->setText(text);
        return;
    }
    for (int i = 0; i < control_->listCount(); ++i) {
        if (control_->itemText(i) == text) {
            control_->setListIndex(i);
            return;
        }
    }
    throw SurfaceError(QStringLiteral("%1 has no entry \"%2\"").arg(name_, text));
}

QVariant ControlRef::value() const {
    require(kind() == ControlKind::CheckBox || kind() == ControlKind::OptionButton, "Value");
    if (kind() == ControlKind::OptionButton) return control_->state() != 0;
    return control_->state();
}

void ControlRef::setValue(const QVariant& value) const {
    require(kind() == ControlKind::CheckBox || kind() == ControlKind::OptionButton, "Value");
    const std::optional<int> state = kind() == ControlKind::CheckBox
                                         ? checkStateOf(value)
                                         : std::optional<int>(optionStateOf(value));
    if (!state)
        throw SurfaceError(
            QStringLiteral("%1 cannot take the value \"%2\"").arg(name_, value.toString()));
    control_->setState(*state);
}

QString ControlRef::valueText() const {
    const QVariant v = value();
    if (v.typeId() == QMetaType::Bool)
        return v.toBool() ? QStringLiteral("True") : QStringLiteral("False");
    return QString::number(v.toInt());
}

int ControlRef::listIndex() const {
    require(kind() == ControlKind::ComboBox, "ListIndex");
    return control_->listIndex();
}

void ControlRef::setListIndex(int index) const {
    require(kind() == ControlKind::ComboBox, "ListIndex");
    if (index < -1 || index >= control_->listCount())
        throw SurfaceError(QStringLiteral("%1 has no list position %2 (it holds %3 entries)")
                               .arg(name_)
                               .arg(index)
                               .arg(control_->listCount()));
    control_->setListIndex(index);
}

int ControlRef::listCount() const {
    require(kind() == ControlKind::ComboBox, "ListCount");
    return control_->listCount();
}

int ControlRef::checkedListPosition(int i) const {
    require(kind() == ControlKind::ComboBox, "List");
    if (i < 0 || i >= control_->listCount())
        throw SurfaceError(QStringLiteral("%1 has no list position %2").arg(name_).arg(i));
    return i;
}

QString ControlRef::listItem(int i) const {
    return control_->itemText(checkedListPosition(i));
}

int ControlRef::itemData(int i) const {
    return control_->itemData(checkedListPosition(i));
}

int ControlRef::selectedItemData() const {
    return itemData(listIndex());
}

void ControlRef::clearList() const {
    require(kind() == ControlKind::ComboBox, "Clear");
    control_->clearList();
}

void ControlRef::addItem(const QString& text, int data) const {
    require(kind() == ControlKind::ComboBox, "AddItem");
    control_->addItem(text, data);
}

int ControlRef::currentTab() const {
    require(kind() == ControlKind::TabStrip, "Tab");
    return control_->currentTab();
}

void ControlRef::setCurrentTab(int tab) const {
    require(kind() == ControlKind::TabStrip, "Tab");
    if (tab < 0 || tab >= control_->tabCount())
        throw SurfaceError(QStringLiteral("%1 has no tab %2").arg(name_).arg(tab));
    control_->setCurrentTab(tab);
}

QString ControlRef::caption() const {
    require(hasCaption(kind()), "Caption");
    return control_->caption();
}

void ControlRef::setCaption(const QString& caption) const {
    require(hasCaption(kind()), "Caption");
    control_->setCaption(caption);
}

void ControlRef::setWidth(int width) const {
    if (width < 0) throw SurfaceError(QStringLiteral("%1 cannot be %2 wide").arg(name_).arg(width));
    control_->setWidth(width);
}

ControlRef Surface::control(const QString& name, int index) const {
    Control* c = find(name, index);
    if (!c)
        throw SurfaceError(
            QStringLiteral("the surface has no control %1").arg(elementName(name, index)));
    return ControlRef(c, elementName(name, index));
}

bool Surface::hasControl(const QString& name, int index) const {
    return find(name, index) != nullptr;
}

void Surface::notifyChanged(const QString& name, int index) const {
    if (changeListener_) changeListener_(name, index);
}

QString elementName(const QString& name, int index) {
    return index < 0 ? name : QStringLiteral("%1(%2)").arg(name).arg(index);
}

std::pair<QString, int> splitElementName(const QString& fullName) {
    const qsizetype open = fullName.indexOf(u'(');
    if (open < 0 || !fullName.endsWith(u')')) return {fullName, -1};
    bool ok = false;
    const int index = fullName.mid(open + 1, fullName.size() - open - 2).toInt(&ok);
    if (!ok || index < 0) return {fullName, -1};
    return {fullName.left(open), index};
}

}  // namespace etq

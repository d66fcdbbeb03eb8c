#include "surface/control_values.h"

#include "platform/settings_keys.h"
#include "platform/settings_store.h"
#include "surface/surface.h"
#include "surface/surface_controls.h"

namespace etq {

QString SurfaceValues::text(const QString& name, int index) const {
    return surface_.control(name, index).text();
}

int SurfaceValues::value(const QString& name, int index) const {
    return surface_.control(name, index).value().toInt();
}

int SurfaceValues::listIndex(const QString& name) const {
    return surface_.control(name).listIndex();
}

std::optional<int> SurfaceValues::selectedItemData(const QString& name) const {
    const ControlRef combo = surface_.control(name);
    if (combo.listIndex() < 0) return std::nullopt;
    return combo.selectedItemData();
}

namespace {

ControlKind kindOf(const QString& name, int index) {
    const ControlSpec* spec = findControlSpec(name, index);
    if (!spec) throw SurfaceError(QStringLiteral("The surface has no control %1").arg(name));
    return spec->kind;
}

// The position of the entry whose text is `text`; -1 when the list has none.
int positionOfText(const EntryList& list, const QString& text) {
    for (int i = 0; i < list.size(); ++i)
        if (list[i].text == text) return i;
    return -1;
}

}  // namespace

StoredValues::StoredValues(const QString& application) : application_(application) {}

void StoredValues::setList(const QString& combo, const EntryList& entries) {
    lists_.insert(combo, entries);
}

void StoredValues::choose(const QString& control, const QString& value, int index) {
    chosen_.insert(elementName(control, index), value);
}

QString StoredValues::stored(const SettingKey& key, int element) const {
    const auto chosen = chosen_.constFind(elementName(key.control.toString(), element));
    if (chosen != chosen_.constEnd()) return *chosen;
    const QString name = key.perElement ? elementKey(key, element) : key.key.toString();
    return readSetting(application_, key.section.toString(), name, defaultValue(key));
}

EntryList StoredValues::listOf(const QString& combo) const {
    if (lists_.contains(combo)) return lists_.value(combo);
    EntryList list;
    for (const DesignList& design : designLists()) {
        if (design.control != combo) continue;
        for (const QString& item : design.items.toString().split(u';'))
            list.append({item, 0});
    }
    return list;
}

QString StoredValues::text(const QString& name, int index) const {
    if (kindOf(name, index) == ControlKind::ComboBox) {
        const int position = listIndex(name);
        return position >= 0 ? listOf(name)[position].text : QString();
    }
    const SettingKey* key = findSettingKeyOfControl(name, index);
    return key && key->kind == TransferKind::Text ? stored(*key, index) : QString();
}

int StoredValues::value(const QString& name, int index) const {
    if (kindOf(name, index) == ControlKind::CheckBox) {
        const SettingKey* key = findSettingKeyOfControl(name, index);
        if (!key || key->kind != TransferKind::Value) return 0;
        return checkStateOf(stored(*key, index)).value_or(0);
    }
    // The options of a frame are loaded one after another: each one set selects itself and
    // clears the others, each one cleared clears itself.
    const ControlSpec* spec = findControlSpec(name, index);
    const ControlSpec* selected = nullptr;
    for (const SettingKey& key : settingKeys()) {
        const ControlSpec* option = findControlSpec(key.control, key.index);
        if (!option || option->kind != ControlKind::OptionButton ||
            option->container != spec->container)
            continue;
        const std::optional<bool> state = optionStateOf(stored(key, key.index));
        if (state && *state) selected = option;
        if (state && !*state && selected == option) selected = nullptr;
    }
    return selected == spec ? 1 : 0;
}

int StoredValues::listIndex(const QString& name) const {
    const SettingKey* key = findSettingKeyOfControl(name);
    if (!key) return -1;
    const EntryList list = listOf(name);
    // A printer is kept by its name.
    if (key->kind == TransferKind::Text) return positionOfText(list, stored(*key, -1));
    bool ok = false;
    const int position = stored(*key, -1).trimmed().toInt(&ok);
    return ok && position >= 0 && position < list.size() ? position : -1;
}

std::optional<int> StoredValues::selectedItemData(const QString& name) const {
    const int position = listIndex(name);
    if (position < 0) return std::nullopt;
    return listOf(name)[position].data;
}

}  // namespace etq

#include "surface/settings_groups.h"

#include "platform/log.h"
#include "platform/settings_store.h"

namespace etq {

namespace {

bool isGroup(quint8 group) {
    return (group >= 1 && group <= 6) || group == 11 || group == 12;
}

// Moves one key and skips it when its control is missing or refuses the value.
void moveKey(const Surface& surface, SettingsStore& store, quint8 action, const SettingKey& entry,
             const QString& key, int index) {
    try {
        GetSetParam(action, store, entry.section.toString(), key,
                    surface.control(entry.control.toString(), index), entry.kind,
                    defaultValue(entry));
    } catch (const SurfaceError& e) {
        qCDebug(log::settings) << "skipped" << entry.section << key << ":" << e.message();
    }
}

}  // namespace

void GetSetParams(const Surface& surface, const QString& application, quint8 group, quint8 action) {
    if (!isGroup(group)) return;
    SettingsStore store(application);
    for (const SettingKey& entry : settingKeys()) {
        if (entry.group != group) continue;
        if (!entry.perElement) {
            moveKey(surface, store, action, entry, entry.key.toString(), entry.index);
            continue;
        }
        const int count = surface.elementCount(entry.control.toString());
        for (int i = 0; i < count; ++i)
            moveKey(surface, store, action, entry, elementKey(entry, i), i);
    }
    // The visit reports nothing; a store that cannot be written loses the values.
    store.sync();
}

void GetSetParam(quint8 action, SettingsStore& store, const QString& section, const QString& key,
                 const ControlRef& control, TransferKind kind, const QString& fallback) {
    if (action == SaveSettings) {
        switch (kind) {
            case TransferKind::Text:
                store.write(section, key, control.text());
                break;
            case TransferKind::ListIndex:
                store.write(section, key, QString::number(control.listIndex()));
                break;
            case TransferKind::Value:
                store.write(section, key, control.valueText());
                break;
        }
    } else if (action == LoadSettings) {
        const QString value = store.read(section, key, fallback);
        switch (kind) {
            case TransferKind::Text:
                control.setText(value);
                break;
            case TransferKind::ListIndex: {
                bool ok = false;
                const int index = value.trimmed().toInt(&ok);
                if (!ok)
                    throw SurfaceError(QStringLiteral("%1: \"%2\" is no list position")
                                           .arg(control.name(), value));
                control.setListIndex(index);
                break;
            }
            case TransferKind::Value:
                control.setValue(value);
                break;
        }
    }
}

}  // namespace etq

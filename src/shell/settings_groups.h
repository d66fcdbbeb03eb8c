#pragma once

#include <QString>
#include <QStringView>
#include <span>

#include "shell/surface.h"

namespace etq {

class SettingsStore;

// How a key's value moves between the store and its control.
enum class TransferKind {
    Text = 1,       // Text
    ListIndex = 2,  // ListIndex, as decimal text (-1 for none)
    Value = 3,      // Value: check state "0"/"1"/"2", option state "True"/"False"
};

// Defaults that name a place on disk: they follow the user's folders.
enum class PathDefault { None, DataFolder, HomeLabelFile };

// One key of the settings store: its group, section and key, the control it is copied to and
// from (with the element index for arrays), how, and its value when the store holds none.
// A key of a control array with `perElement` stands for one key per element: the key text
// followed by the element index as two digits ("FldSend00" to "FldSend40").
struct SettingKey {
    int group;  // 1-6 and 11-12; 0 for the Params section, which belongs to no group
    QStringView section;
    QStringView key;
    QStringView control;
    int index;
    bool perElement;
    TransferKind kind;
    QStringView defaultText;
    PathDefault pathDefault = PathDefault::None;
};

// Every key, in the order the groups visit them.
std::span<const SettingKey> settingKeys();

// The key's value when the store holds none.
QString defaultValue(const SettingKey& key);

// The table entry of a stored key (for "FldSend07" the FldSend entry, with *element 7);
// nullptr when the table has no such key.
const SettingKey* findSettingKey(QStringView section, QStringView key, int* element = nullptr);

// The default of a key of the table; empty text for a key the table lacks.
QString settingDefault(QStringView section, QStringView key);

enum SettingsAction : quint8 { SaveSettings = 1, LoadSettings = 2 };

// Saves (action 1) or loads (action 2) a settings group between the store of the current
// application name and the surface's controls. A key whose control is missing or cannot take
// the value is skipped; the next key goes on.
void GetSetParams(const Surface& surface, quint8 group, quint8 action);

// Moves one value: action 1 writes the control's property of the kind as text, action 2
// reads the stored value (or the default) into it. Other actions do nothing. Throws
// SurfaceError when the control cannot give or take the value.
void GetSetParam(quint8 action, SettingsStore& store, const QString& section, const QString& key,
                 const ControlRef& control, TransferKind kind, const QString& fallback);

}  // namespace etq

#pragma once

#include <QString>
#include <QStringView>
#include <span>

namespace etq {

// The keys of the settings store, as data: for each, its group, section and key, the control
// of the surface (or a dialog) whose state it keeps, how the value moves, and its value when
// the store holds none. The settings groups, the command line's settings and the defaults of a
// new run all walk this one table.

// How a key's value moves between the store and its control.
enum class TransferKind {
    Text = 1,       // Text
    ListIndex = 2,  // ListIndex, as decimal text (-1 for none)
    Value = 3,      // Value: check state "0"/"1"/"2", option state "True"/"False"
};

// Defaults that name a place on disk: they follow the user's folders.
enum class PathDefault { None, DataFolder, HomeLabelFile };

// A key of a control array with `elements` above 0 stands for one key per element: the key
// text followed by the element index as two digits ("FldSend00" to "FldSend40").
struct SettingKey {
    int group;  // 1-6 and 11-12; 0 for the Params section, which belongs to no group
    QStringView section;
    QStringView key;
    QStringView control;
    int index;  // element of a control array, -1 for a single control
    bool perElement;
    TransferKind kind;
    QStringView defaultText;
    PathDefault pathDefault = PathDefault::None;
    int elements = 0;  // with perElement: how many elements the array has
};

// Every key, in the order the groups visit them.
std::span<const SettingKey> settingKeys();

// The key's value when the store holds none.
QString defaultValue(const SettingKey& key);

// The table entry of a stored key (for "FldSend07" the FldSend entry, with *element 7);
// nullptr when the table has no such key.
const SettingKey* findSettingKey(QStringView section, QStringView key, int* element = nullptr);

// The entry whose control is `control` (element `index` of an array); nullptr when none.
const SettingKey* findSettingKeyOfControl(QStringView control, int index = -1);

// The default of a key of the table; empty text for a key the table lacks.
QString settingDefault(QStringView section, QStringView key);

// The stored key of element `element` of a per-element entry: "FldSend07".
QString elementKey(const SettingKey& entry, int element);

}  // namespace etq

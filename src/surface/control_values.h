#pragma once

#include <QHash>
#include <QString>
#include <optional>

#include "platform/list_entry.h"

namespace etq {

class Surface;
struct SettingKey;

// The state of the controls a routine reads, by name (and index for control arrays). Two
// sources give it: the surface itself, and the settings store's keys for those controls, as
// the window would show them right after loading them. So one adapter builds a run's options
// for the window and for the command line alike, and both do the same with the same settings.
// A control that has no state here reads as a new one: empty text, 0, no selection.
class ControlValues {
  public:
    virtual ~ControlValues() = default;

    // Text box: its text. Combo box: the selected entry's text, empty for none.
    virtual QString text(const QString& name, int index = -1) const = 0;
    // Check box: 0 clear, 1 checked, 2 grey. Option button: 1 selected, 0 not.
    virtual int value(const QString& name, int index = -1) const = 0;
    // Combo box: the selected position, -1 for none.
    virtual int listIndex(const QString& name) const = 0;
    // Combo box: the item data of the selected entry; nothing when none is selected.
    virtual std::optional<int> selectedItemData(const QString& name) const = 0;

    bool isChecked(const QString& name, int index = -1) const { return value(name, index) == 1; }
};

// The controls of a surface as they stand.
class SurfaceValues : public ControlValues {
  public:
    explicit SurfaceValues(const Surface& surface) : surface_(surface) {}

    QString text(const QString& name, int index = -1) const override;
    int value(const QString& name, int index = -1) const override;
    int listIndex(const QString& name) const override;
    std::optional<int> selectedItemData(const QString& name) const override;

  private:
    const Surface& surface_;
};

// The controls as the window shows them after start-up has loaded the stored settings of
// `application`: each control's key, or its default. The lists of combo boxes are the fixed
// lists of the design and those given with setList (the host's price lists, the printers); a
// stored position or printer name the list lacks selects nothing, as the window skips it.
// Option buttons of one frame exclude each other, the last one loaded winning.
class StoredValues : public ControlValues {
  public:
    explicit StoredValues(const QString& application);

    void setList(const QString& combo, const EntryList& entries);
    EntryList list(const QString& combo) const { return listOf(combo); }
    // Takes `value` as if the store held it for the control's key (a command line's option),
    // in the store's own form: a text, a list position, "1"/"0" or "True"/"False".
    void choose(const QString& control, const QString& value, int index = -1);

    QString text(const QString& name, int index = -1) const override;
    int value(const QString& name, int index = -1) const override;
    int listIndex(const QString& name) const override;
    std::optional<int> selectedItemData(const QString& name) const override;

  private:
    QString stored(const SettingKey& key, int element) const;
    EntryList listOf(const QString& combo) const;

    QString application_;
    QHash<QString, EntryList> lists_;
    QHash<QString, QString> chosen_;  // by element name, "OptOLE(3)"
};

}  // namespace etq

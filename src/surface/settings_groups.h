#pragma once

#include <QString>

#include "platform/settings_keys.h"
#include "surface/surface.h"

namespace etq {

class SettingsStore;

enum SettingsAction : quint8 { SaveSettings = 1, LoadSettings = 2 };

// Saves (action 1) or loads (action 2) a settings group between the store of the application
// name and the surface's controls. A key whose control is missing or cannot take
// the value is skipped; the next key goes on.
void GetSetParams(const Surface& surface, const QString& application, quint8 group, quint8 action);

// Moves one value: action 1 writes the control's property of the kind as text, action 2
// reads the stored value (or the default) into it. Other actions do nothing. Throws
// SurfaceError when the control cannot give or take the value.
void GetSetParam(quint8 action, SettingsStore& store, const QString& section, const QString& key,
                 const ControlRef& control, TransferKind kind, const QString& fallback);

}  // namespace etq

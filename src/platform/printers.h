#pragma once

#include <QString>
#include <QStringList>

namespace etq {

// The installed printers: the CUPS destinations of this machine, by name. Throws Failure with
// the reason when CUPS cannot be asked.
QStringList installedPrinters();

// Makes `name` the user's default printer (lpoptions -d). Throws Failure with the reason when
// CUPS refuses.
void setDefaultPrinter(const QString& name);

}  // namespace etq

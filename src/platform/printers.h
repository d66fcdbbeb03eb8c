#pragma once

#include <QString>
#include <QStringList>

namespace etq {

// The installed printers: the CUPS destinations of this machine, by name. Empty, with the
// reason in `error`, when CUPS cannot be asked.
QStringList installedPrinters(QString* error = nullptr);

// Makes `name` the user's default printer (lpoptions -d). False, with the reason in `error`,
// when CUPS refuses.
bool setDefaultPrinter(const QString& name, QString* error = nullptr);

}  // namespace etq

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

// The paper the printer `name` (empty: the user's default printer) prints on by default, as CUPS
// names it in its PageSize option: "A4", "Letter", "w288h432"... Throws Failure with the reason
// when CUPS cannot be asked; empty text when the printer has no such option.
QString printerPaper(const QString& name);

// Sends a file to the printer `name` (empty: the user's default printer) with lp. Throws
// Failure with CUPS's reason when it refuses the job.
void sendToPrinter(const QString& file, const QString& name);

}  // namespace etq

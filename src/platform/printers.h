#pragma once

#include <QByteArray>
#include <QString>
#include <QStringList>
#include <optional>

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

// Sends a file to the CUPS printer `printer` with lp, or to the CUPS default when none is named.
// Throws Failure with CUPS's reason when it refuses.
void sendToPrinter(const QString& file, const std::optional<QString>& printer);

// What a program of the print routes (a CUPS client, a label tool) wrote.
struct ToolOutput {
    QByteArray out;
    QByteArray err;
};

// Runs such a program to its end. Throws Failure with the reason (its own words on stderr) when
// it cannot start, outlasts timeoutMs or ends with a failure.
ToolOutput runPrintTool(const QString& program, const QStringList& args, int timeoutMs);

}  // namespace etq

#include "platform/printers.h"

#include <QProcess>

namespace etq {

namespace {

constexpr int kWaitMs = 10000;

// Runs a CUPS client program; its standard output, or nothing with the reason in `error`.
bool runCups(const QString& program, const QStringList& args, QByteArray* output, QString* error) {
    QProcess process;
    process.start(program, args);
    if (!process.waitForStarted(kWaitMs)) {
        if (error) *error = QStringLiteral("cannot run %1: %2").arg(program, process.errorString());
        return false;
    }
    if (!process.waitForFinished(kWaitMs)) {
        process.kill();
        process.waitForFinished();
        if (error) *error = QStringLiteral("%1 did not answer").arg(program);
        return false;
    }
    if (process.exitStatus() != QProcess::NormalExit || process.exitCode() != 0) {
        if (error)
            *error = QStringLiteral("%1: %2").arg(
                program, QString::fromLocal8Bit(process.readAllStandardError()).trimmed());
        return false;
    }
    if (output) *output = process.readAllStandardOutput();
    return true;
}

}  // namespace

QStringList installedPrinters(QString* error) {
    QByteArray output;
    if (!runCups(QStringLiteral("lpstat"), {QStringLiteral("-e")}, &output, error)) return {};
    QStringList printers;
    for (const QByteArray& line : output.split('\n')) {
        const QString name = QString::fromLocal8Bit(line).trimmed();
        if (!name.isEmpty()) printers.append(name);
    }
    return printers;
}

bool setDefaultPrinter(const QString& name, QString* error) {
    return runCups(QStringLiteral("lpoptions"), {QStringLiteral("-d"), name}, nullptr, error);
}

}  // namespace etq

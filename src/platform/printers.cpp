#include "platform/printers.h"

#include <QProcess>

#include "platform/failure.h"

namespace etq {

namespace {

constexpr int kWaitMs = 10000;

// Runs a CUPS client program and gives its standard output; throws Failure with the reason.
QByteArray runCups(const QString& program, const QStringList& args) {
    return runPrintTool(program, args, kWaitMs).out;
}

}  // namespace

ToolOutput runPrintTool(const QString& program, const QStringList& args, int timeoutMs) {
    QProcess process;
    process.start(program, args);
    if (!process.waitForStarted(timeoutMs))
        throw Failure(QStringLiteral("cannot run %1: %2").arg(program, process.errorString()));
    if (!process.waitForFinished(timeoutMs)) {
        process.kill();
        process.waitForFinished();
        throw Failure(QStringLiteral("%1 did not answer").arg(program));
    }
    ToolOutput output{process.readAllStandardOutput(), process.readAllStandardError()};
    if (process.exitStatus() != QProcess::NormalExit || process.exitCode() != 0)
        throw Failure(
            QStringLiteral("%1: %2").arg(program, QString::fromLocal8Bit(output.err).trimmed()));
    return output;
}

QStringList installedPrinters() {
    const QByteArray output = runCups(QStringLiteral("lpstat"), {QStringLiteral("-e")});
    QStringList printers;
    for (const QByteArray& line : output.split('\n')) {
        const QString name = QString::fromLocal8Bit(line).trimmed();
        if (!name.isEmpty()) printers.append(name);
    }
    return printers;
}

void setDefaultPrinter(const QString& name) {
    runCups(QStringLiteral("lpoptions"), {QStringLiteral("-d"), name});
}

// lpoptions -l lists one option a line, "PageSize/Media Size: Letter *A4 Legal", the default
// marked with a star.
QString printerPaper(const QString& name) {
    QStringList args;
    if (!name.isEmpty()) args << QStringLiteral("-p") << name;
    args << QStringLiteral("-l");
    const QByteArray output = runCups(QStringLiteral("lpoptions"), args);
    for (const QByteArray& line : output.split('\n')) {
        if (!line.startsWith("PageSize/") && !line.startsWith("PageSize:")) continue;
        const qsizetype colon = line.indexOf(':');
        for (const QByteArray& choice : line.mid(colon + 1).split(' '))
            if (choice.startsWith('*')) return QString::fromLocal8Bit(choice.mid(1));
    }
    return {};
}

void sendToPrinter(const QString& file, const std::optional<QString>& printer) {
    QStringList args;
    if (printer) args << QStringLiteral("-d") << *printer;
    args << QStringLiteral("--") << file;
    runCups(QStringLiteral("lp"), args);
}

}  // namespace etq

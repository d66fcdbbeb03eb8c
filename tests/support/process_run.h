#pragma once

#include <QProcess>
#include <QString>
#include <QStringList>

namespace etq::test {

// What a program run by a test said and how it ended.
struct ProcessResult {
    int exitCode = -1;  // -1 when it crashed or did not finish
    QString out;
    QString err;
};

inline ProcessResult runProcess(
    const QString& program, const QStringList& args,
    const QProcessEnvironment& env = QProcessEnvironment::systemEnvironment()) {
    constexpr int kTimeoutMs = 180000;
    QProcess process;
    process.setProcessEnvironment(env);
    process.start(program, args);
    ProcessResult result;
    if (!process.waitForFinished(kTimeoutMs)) {
        process.kill();
        process.waitForFinished();
        result.err = program + " did not finish";
        return result;
    }
    result.exitCode = process.exitStatus() == QProcess::NormalExit ? process.exitCode() : -1;
    result.out = QString::fromUtf8(process.readAllStandardOutput());
    result.err = QString::fromUtf8(process.readAllStandardError());
    return result;
}

}  // namespace etq::test

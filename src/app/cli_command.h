#pragma once

#include <QString>
#include <QStringList>
#include <functional>

namespace etq {
class Context;
}

namespace etq::cli {

// One subcommand of etiquon-cli. `run` gets the arguments after the subcommand's name and
// returns the process exit code.
struct Command {
    const char* name;
    const char* usage;    // arguments, for --help
    const char* summary;  // one line, for --help
    int (*run)(const QStringList& args);
};

// The options every subcommand shares.
struct CommonOptions {
    QString settingId;  // the hosting page's SettingID: selects the settings store
};

// Removes the shared options from args and returns them.
CommonOptions takeCommonOptions(QStringList& args);

// Removes "--name VALUE" (or "--name=VALUE") from args and returns VALUE; empty when absent.
QString takeOption(QStringList& args, const QString& name);
// Removes "--name" from args; true when it was there.
bool takeFlag(QStringList& args, const QString& name);

// Prints a message on stderr, prefixed with the program name.
void printError(const QString& message);

// Starts a command's context as the window starts its own: the application name of the
// SettingID, and the language and connection parameters from that settings store.
void startContext(Context& context, const QString& settingId);

// Runs a command's work: 0 when it ran to its end; a failure is one line on stderr, also one the
// window passes over without a word, and gives 1.
int runReporting(const std::function<void()>& work);

}  // namespace etq::cli

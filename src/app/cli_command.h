#pragma once

#include <QString>
#include <QStringList>
#include <functional>
#include <optional>

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

// Where a print command's labels go instead of the route's own output: --output FILE writes
// them to a PDF file, --printer NAME sends them to that CUPS printer (lp); both may be given.
// Every print command and route takes them from here.
struct PrintDestination {
    std::optional<QString> output;
    std::optional<QString> printer;
    bool given() const { return output || printer; }
};

// Removes --output and --printer (with their values) from args and returns them.
PrintDestination takePrintDestination(QStringList& args);

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

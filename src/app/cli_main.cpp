// etiquon-cli: the component's work without windows, for scripts, tests and the demo.
#include <QCoreApplication>
#include <QGuiApplication>
#include <QRegularExpression>
#include <QTextStream>
#include <algorithm>
#include <cstdio>
#include <cstring>
#include <memory>
#include <span>

#include "app/cli_command.h"
#include "app/cli_editors.h"
#include "card/card_controller.h"
#include "import/connection.h"
#include "platform/context.h"
#include "platform/failure.h"
#include "platform/settings_store.h"

namespace etq::cli {

CommonOptions takeCommonOptions(QStringList& args) {
    CommonOptions options;
    for (qsizetype i = 0; i < args.size();) {
        if (args[i] == "--setting-id" && i + 1 < args.size()) {
            options.settingId = args[i + 1];
            args.remove(i, 2);
        } else if (args[i].startsWith("--setting-id=")) {
            options.settingId = args[i].mid(int(sizeof("--setting-id=")) - 1);
            args.remove(i);
        } else {
            ++i;
        }
    }
    return options;
}

QString takeOption(QStringList& args, const QString& name) {
    for (qsizetype i = 0; i < args.size(); ++i) {
        if (args[i] == name && i + 1 < args.size()) {
            const QString value = args[i + 1];
            args.remove(i, 2);
            return value;
        }
        if (args[i].startsWith(name + "=")) {
            const QString value = args[i].mid(name.size() + 1);
            args.remove(i);
            return value;
        }
    }
    return {};
}

bool takeFlag(QStringList& args, const QString& name) {
    return args.removeAll(name) > 0;
}

void printError(const QString& message) {
    QTextStream(stderr) << "etiquon-cli: " << message << Qt::endl;
}

void startContext(Context& context, const QString& settingId) {
    context.applicationName = applicationNameFor(settingId);
    loadLanguage(context);
    GetConnParams(context);
}

int runReporting(const std::function<void()>& work) {
    try {
        work();
        return 0;
    } catch (const std::exception& e) {
        printError(describe(e));
        return 1;
    }
}

int runConfig(const QStringList& args);       // cli_config.cpp
int runInitDb(const QStringList& args);       // cli_db.cpp
int runUpgrade(const QStringList& args);      // cli_db.cpp
int runImportItems(const QStringList& args);  // cli_import.cpp
int runMarkItems(const QStringList& args);    // cli_print.cpp
int runPrintItems(const QStringList& args);   // cli_print.cpp

// The document road.
int runImportDocs(const QStringList& args);  // cli_import.cpp
int runPrintDocs(const QStringList& args);   // cli_print.cpp
int runScanRanges(const QStringList& args);  // cli_docs.cpp, as the rest
int runDocTypes(const QStringList& args);
int runListDocs(const QStringList& args);
int runIncludeDocs(const QStringList& args);
int runExcludeDocs(const QStringList& args);
int runIncludeLines(const QStringList& args);
int runExcludeLines(const QStringList& args);
int runSetCopies(const QStringList& args);

namespace {

const Command kCommands[] = {
    {"version", "", "print the version",
     [](const QStringList&) {
         QTextStream(stdout) << "etiquon-cli " << ETIQUON_VERSION << Qt::endl;
         return 0;
     }},
    {"config", "list | get SECTION KEY | set SECTION KEY VALUE",
     "read and write the settings of the control", runConfig},
    {"init-db", "--db DIR", "prepare a database folder for a first run", runInitDb},
    {"upgrade", "--db DIR", "add the account tables to an older item database", runUpgrade},
    {"import-items",
     "--company DIR --db DIR [--clean] [--price-field N] [--from KEY] [--to KEY] [--price-lists] [--special-prices] [--foreign-names] [--copies N]",
     "read the host's items, prices and currencies into the item database", runImportItems},
    {"mark-items", "--db DIR (--all | --none | KEY...) [--copies N]",
     "mark items for printing and set their copies", runMarkItems},
    {"print-items", "--db DIR [--open] [--output FILE] [--printer NAME] [--outlines]",
     "print the marked items' labels; prints the page's (or the PDFs') paths", runPrintItems},
    {"import-docs",
     "--company DIR --db DIR [--from-date DD/MM/YYYY] [--to-date DD/MM/YYYY] [--from-num N] [--to-num N] [--read-items] [--fast]",
     "read the host's stock documents of the types to scan into the working database",
     runImportDocs},
    {"doc-types", "--db DIR [--scan TYPES] [--no-scan TYPES] [--drafts TYPES] [--no-drafts TYPES]",
     "show and choose the document types read, and their drafts (TYPES: 1,2,5 or all)",
     runDocTypes},
    {"scan-ranges", "--db DIR [--reset]",
     "show where each document file's next scan starts; --reset starts them all anew",
     runScanRanges},
    {"list-docs", "--db DIR [--lines] [DOC...]",
     "list the imported documents (DOC: file/number, as 1/101), with their lines", runListDocs},
    {"include-docs", "--db DIR (--all | DOC...)", "choose documents for printing", runIncludeDocs},
    {"exclude-docs", "--db DIR (--all | DOC...)", "leave documents out of printing",
     runExcludeDocs},
    {"include-lines", "--db DIR DOC (--all | LINE...)", "choose lines of a document for printing",
     runIncludeLines},
    {"exclude-lines", "--db DIR DOC (--all | LINE...)", "leave lines of a document out of printing",
     runExcludeLines},
    {"set-copies", "--db DIR DOC LINE COPIES", "set the label copies of a document line",
     runSetCopies},
    {"print-docs", "--db DIR [--open] [--output FILE] [--printer NAME] [--outlines]",
     "print the included document lines' labels; prints the page's (or the PDFs') paths",
     runPrintDocs},
    {"items", kItemsUsage, "list the items of the item database, one a line, key first", runItems},
    {"items", kItemsChangeUsage, "add an item, or change the given fields of one", runItems},
    {"items", kItemsRemoveUsage, "delete items", runItems},
    {"alt-keys", kAltKeysUsage, "list the alternate item keys and barcodes of accounts",
     runAltKeys},
    {"alt-keys", kAltKeysChangeUsage, "add an account's alternate key, or change one", runAltKeys},
    {"alt-keys", kAltKeysRemoveUsage, "delete an account's alternate key", runAltKeys},
    {"accounts", kAccountsUsage, "list the accounts' price lists and label files", runAccounts},
    {"accounts", kAccountsChangeUsage, "add an account definition, or change one", runAccounts},
    {"accounts", kAccountsRemoveUsage, "delete account definitions", runAccounts},
    {"price-lists", kSourceListUsage, "list the price lists of the SQL Server source",
     runPriceLists},
    {"carriers", kSourceListUsage, "list the carriers of the SQL Server source", runCarriers},
};

void printHelp() {
    QTextStream out(stdout);
    out << "Usage: etiquon-cli [--setting-id N] COMMAND [ARGS]\n"
           "       etiquon-cli --help | --version\n\n"
           "Etiquon prints labels for the items and stock documents of a Hebrew accounting\n"
           "package. This program does the component's work without windows.\n\nCommands:\n";
    for (const Command& c : kCommands) {
        const QString head = QString("  %1 %2").arg(c.name, c.usage).trimmed();
        out << "  " << head.leftJustified(44) << " " << c.summary << "\n";
    }
    out << "\nOptions:\n  --setting-id N   use the settings of the hosting page with this SettingID\n";
}

}  // namespace
}  // namespace etq::cli

int main(int argc, char** argv) {
    using namespace etq::cli;
    // A command that may draw the labels' PDF needs Qt's fonts, which only a GUI application
    // has; the program never shows a window, so the offscreen platform serves without a display.
    const bool draws = std::any_of(argv + 1, argv + argc, [](const char* arg) {
        return std::strcmp(arg, "print-items") == 0 || std::strcmp(arg, "print-docs") == 0;
    });
    std::unique_ptr<QCoreApplication> application;
    if (draws) {
        if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM")) qputenv("QT_QPA_PLATFORM", "offscreen");
        application = std::make_unique<QGuiApplication>(argc, argv);
    } else {
        application = std::make_unique<QCoreApplication>(argc, argv);
    }
    QCoreApplication& app = *application;
    QCoreApplication::setApplicationName("etiquon-cli");
    QCoreApplication::setApplicationVersion(ETIQUON_VERSION);

    QStringList args = app.arguments().mid(1);
    if (args.isEmpty() || args.first() == "--help" || args.first() == "-h") {
        printHelp();
        return args.isEmpty() ? 2 : 0;
    }
    if (args.first() == "--version") args.first() = "version";

    // The shared options may stand before the command's name too.
    QStringList rest = args;
    const CommonOptions common = takeCommonOptions(rest);
    // A hosting page's SettingID that is no number selects the plain settings; on the command
    // line it is a mistake to be told.
    if (args.contains("--setting-id") ||
        !args.filter(QRegularExpression("^--setting-id=")).isEmpty()) {
        if (etq::applicationNameFor(common.settingId) == etq::applicationNameFor({})) {
            printError(
                QString("--setting-id takes the number of a hosting page's settings, not '%1'")
                    .arg(common.settingId));
            return 2;
        }
    }
    if (rest.isEmpty()) {
        printHelp();
        return 2;
    }
    const QString name = rest.first();
    for (const Command& c : kCommands) {
        if (name == c.name) {
            args.removeOne(name);
            return c.run(args);
        }
    }
    printError(QString("unknown command '%1' (try --help)").arg(name));
    return 2;
}

// etiquon-cli: the component's work without windows, for scripts, tests and the demo.
#include <QCoreApplication>
#include <QTextStream>
#include <cstdio>
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
    {"print-items", "--db DIR [--open]", "print the marked items' labels; prints the page's path",
     runPrintItems},
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
    QCoreApplication app(argc, argv);
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
    takeCommonOptions(rest);
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

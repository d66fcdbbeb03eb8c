// etiquon-cli config: reads and writes the settings store the control uses.
#include <QTextStream>

#include "app/cli_command.h"
#include "platform/settings_keys.h"
#include "platform/settings_store.h"

namespace etq::cli {

namespace {

// Every key of the settings table, with the keys of control arrays spelled out.
QList<std::pair<QString, QString>> tableKeys() {
    QList<std::pair<QString, QString>> keys;
    for (const SettingKey& entry : settingKeys()) {
        if (!entry.perElement) {
            keys.append({entry.section.toString(), entry.key.toString()});
            continue;
        }
        for (int i = 0; i < entry.elements; ++i)
            keys.append({entry.section.toString(), elementKey(entry, i)});
    }
    return keys;
}

QString defaultOf(const QString& section, const QString& key) {
    int element = -1;
    const SettingKey* entry = findSettingKey(section, key, &element);
    return entry ? defaultValue(*entry) : QString();
}

// Stored values as "Section/Key=value"; keys the store lacks show their default after "# ".
int listSettings(const SettingsStore& store) {
    QTextStream out(stdout);
    QList<std::pair<QString, QString>> keys = tableKeys();
    for (const QString& section : store.sections())
        for (const QString& key : store.keys(section))
            if (!keys.contains(std::pair(section, key))) keys.append({section, key});
    for (const auto& [section, key] : keys) {
        const bool stored = store.contains(section, key);
        const QString value = store.read(section, key, defaultOf(section, key));
        out << (stored ? "" : "# ") << section << '/' << key << '=' << value << '\n';
    }
    return 0;
}

int getSetting(const SettingsStore& store, const QString& section, const QString& key) {
    if (!store.contains(section, key) && !findSettingKey(section, key)) {
        printError(QStringLiteral("no setting %1/%2 in %3").arg(section, key, store.filePath()));
        return 1;
    }
    QTextStream(stdout) << store.read(section, key, defaultOf(section, key)) << Qt::endl;
    return 0;
}

int setSetting(SettingsStore& store, const QString& section, const QString& key,
               const QString& value) {
    if (section.trimmed().isEmpty() || key.trimmed().isEmpty()) {
        printError("config set takes a section and a key that are not empty");
        return 2;
    }
    store.write(section, key, value);
    QString error;
    if (!store.sync(&error)) {
        printError(error);
        return 1;
    }
    return 0;
}

int usage() {
    printError(QStringLiteral(
        "usage: config list | get SECTION KEY | set SECTION KEY VALUE [--setting-id N]"));
    return 2;
}

}  // namespace

int runConfig(const QStringList& arguments) {
    QStringList args = arguments;
    const CommonOptions options = takeCommonOptions(args);
    if (args.isEmpty()) return usage();
    const QString action = args.takeFirst();
    SettingsStore store(applicationNameFor(options.settingId));
    if (action == u"list" && args.isEmpty()) return listSettings(store);
    if (action == u"get" && args.size() == 2) return getSetting(store, args[0], args[1]);
    if (action == u"set" && args.size() == 3) return setSetting(store, args[0], args[1], args[2]);
    return usage();
}

}  // namespace etq::cli

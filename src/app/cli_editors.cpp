// etiquon-cli items, alt-keys and accounts: the item, alternate key and account editors without
// windows, with the windows' record sources (filters and orders); price-lists and carriers: the
// lists the SQL Server source gives.
#include "app/cli_editors.h"

#include <QTextStream>
#include <functional>
#include <span>

#include "app/cli_command.h"
#include "app/cli_table.h"
#include "dialogs/bound_grid_model.h"
#include "dialogs/table_editors.h"
#include "import/sql_source.h"
#include "jet/vb.h"
#include "platform/context.h"
#include "platform/failure.h"
#include "platform/settings_keys.h"
#include "platform/settings_store.h"
#include "platform/user_paths.h"

namespace etq::cli {

namespace {

// A column that a flag of add and set writes, and what its text must be.
enum class ValueKind { Text, Number, Whole };
struct FieldFlag {
    const char* flag;
    int column;  // as the window counts its grid's columns
    ValueKind kind;
};

// One editor's table as add, set and remove reach its rows.
struct EditorTable {
    const char* command;  // "items"
    const char* what;     // "item", for messages
    int keyCount;         // positional keys of one row
    const char* changeUsage;
    const char* removeUsage;
    std::span<const FieldFlag> fields;
    // The record source of the row with these keys.
    std::function<QString(const QStringList& keys)> rowSource;
    // A new row's values before its flags: its keys and what the window's add gives it.
    std::function<QList<std::pair<int, QVariant>>(const QStringList& keys)> newRow;
};

constexpr FieldFlag kItemFields[] = {
    {"--name", 2, ValueKind::Text},
    {"--unit", 3, ValueKind::Text},
    {"--barcode", 4, ValueKind::Text},
    {"--price", 5, ValueKind::Number},
};
constexpr FieldFlag kAltKeyFields[] = {
    {"--alt-num", 3, ValueKind::Text},
    {"--alt-bar", 4, ValueKind::Text},
};
constexpr FieldFlag kAccountFields[] = {
    {"--price-list", AccountDefEditor::kPriceListColumn, ValueKind::Whole},
    {"--label", AccountDefEditor::kLabelColumn, ValueKind::Text},
};

const EditorTable kItems{"items",
                         "item",
                         1,
                         kItemsChangeUsage,
                         kItemsRemoveUsage,
                         kItemFields,
                         [](const QStringList& keys) {
                             ItemsFilter one;
                             one.key = keys[0];
                             return BuildEditItemsQuery(one);
                         },
                         [](const QStringList& keys) {
                             return QList<std::pair<int, QVariant>>{{1, keys[0]}};
                         }};
const EditorTable kAltKeys{
    "alt-keys",
    "alternate key",
    2,
    kAltKeysChangeUsage,
    kAltKeysRemoveUsage,
    kAltKeyFields,
    [](const QStringList& keys) {
        return BuildAlterKeysQuery({.searches = {{0, keys[0]}, {1, keys[1]}}});
    },
    [](const QStringList& keys) {
        return QList<std::pair<int, QVariant>>{{1, keys[0]}, {2, keys[1]}};
    }};
const EditorTable kAccounts{"accounts",
                            "account",
                            1,
                            kAccountsChangeUsage,
                            kAccountsRemoveUsage,
                            kAccountFields,
                            [](const QStringList& keys) { return BuildAccountDefQuery(keys[0]); },
                            [](const QStringList& keys) {
                                return QList<std::pair<int, QVariant>>{
                                    {1, keys[0]},
                                    {AccountDefEditor::kLabelColumn, defaultLabelFile()}};
                            }};

int usage(const char* command, const char* line) {
    printError(QStringLiteral("usage: etiquon-cli %1 %2")
                   .arg(QLatin1String(command), QLatin1String(line)));
    return 2;
}

bool hasOption(const QStringList& args, const QString& name) {
    for (const QString& arg : args)
        if (arg == name || arg.startsWith(name + u'=')) return true;
    return false;
}

bool anyOption(const QStringList& args) {
    for (const QString& arg : args)
        if (arg.startsWith(QStringLiteral("--"))) return true;
    return false;
}

// The position of `name` among the choices, -1 when it is none of them (reported).
int choice(const QString& flag, const QString& name, const QStringList& choices) {
    const int at = int(choices.indexOf(name));
    if (at < 0)
        printError(QStringLiteral("%1 takes %2, not '%3'").arg(flag, choices.join(u'|'), name));
    return at;
}

// A list position the window would load from its settings group.
int storedPosition(const QString& application, QStringView section, QStringView key) {
    const QString stored =
        readSetting(application, section.toString(), key.toString(), settingDefault(section, key));
    bool ok = false;
    const int position = stored.trimmed().toInt(&ok);
    return ok ? position : -1;
}

// The value a flag's text gives its column: an empty text is Null, as the grid makes it.
std::optional<QVariant> valueOf(const FieldFlag& field, const QString& text) {
    if (text.isEmpty()) return QVariant();
    if (field.kind == ValueKind::Text) return text;
    if (field.kind == ValueKind::Number) {
        if (const std::optional<double> number = vb::toNumber(text)) return *number;
    } else if (const std::optional<qint16> whole = vb::toInteger(text)) {
        if (QString::number(*whole) == text.trimmed()) return int(*whole);
    }
    printError(QStringLiteral("%1 takes a %2, not '%3'")
                   .arg(QLatin1String(field.flag),
                        field.kind == ValueKind::Number ? QStringLiteral("number")
                                                        : QStringLiteral("whole number"),
                        text));
    return std::nullopt;
}

// The rows the editor shows under their field names.
void printGrid(EditorGrid& editor, RowFormat format) {
    QStringList columns;
    for (int c = 0; c < editor.grid().columnCount(); ++c)
        columns << editor.grid().recordset().fieldName(c);
    QList<QVariantList> rows;
    for (int row = 0; row < editor.rowCount(); ++row) {
        QVariantList values;
        for (int column = 1; column <= columns.size(); ++column)
            values << editor.value(row, column);
        rows << values;
    }
    printRows(columns, rows, format);
}

// Shows the editor's rows of the folder's item database, as `show` chooses them, and prints them.
template <class Editor, class Show>
int listRows(const QString& folder, RowFormat format, Show show) {
    return runReporting([&] {
        BoundGridModel grid;
        Editor editor(grid);
        editor.setDatabaseFolder(folder);
        show(editor);
        printGrid(editor, format);
    });
}

// add, set or remove on one editor's table.
int changeRows(const EditorTable& table, const QString& action, QStringList args) {
    const bool remove = action == u"remove";
    const char* line = remove ? table.removeUsage : table.changeUsage;
    const QString folder = takeOption(args, QStringLiteral("--db"));
    QList<std::pair<int, QVariant>> values;
    for (const FieldFlag& field : table.fields) {
        const QString flag = QLatin1String(field.flag);
        if (remove || !hasOption(args, flag)) continue;
        const std::optional<QVariant> value = valueOf(field, takeOption(args, flag));
        if (!value) return 2;
        values.append({field.column, *value});
    }
    const bool manyRows = remove && table.keyCount == 1;
    if (folder.isEmpty() || anyOption(args) || args.isEmpty() ||
        (!manyRows && args.size() != table.keyCount) || (action == u"set" && values.isEmpty()))
        return usage(table.command, line);

    return runReporting([&] {
        BoundGridModel grid;
        EditorGrid editor(grid);
        editor.setDatabaseFolder(folder);
        const qsizetype rows = manyRows ? args.size() : 1;
        for (qsizetype r = 0; r < rows; ++r) {
            const QStringList keys = manyRows ? QStringList{args[r]} : args;
            editor.show(table.rowSource(keys));
            if (action == u"add") {
                editor.addRecord(table.newRow(keys) + values);
                continue;
            }
            if (editor.rowCount() == 0)
                throw Failure(
                    QStringLiteral("no %1 %2 in %3")
                        .arg(QLatin1String(table.what), keys.join(u' '), grid.databaseName()));
            if (remove) {
                editor.deleteRow(0);
                continue;
            }
            for (const auto& [column, value] : values)
                editor.write(0, column, value);
        }
    });
}

// Runs add, set or remove when the first argument names one; else nothing.
std::optional<int> runChange(const EditorTable& table, QStringList& args) {
    if (args.isEmpty()) return std::nullopt;
    const QString action = args.first();
    if (action != u"add" && action != u"set" && action != u"remove") return std::nullopt;
    args.removeFirst();
    return changeRows(table, action, args);
}

int listItems(QStringList args, const CommonOptions& common) {
    const QString folder = takeOption(args, QStringLiteral("--db"));
    const QString searchBy = takeOption(args, QStringLiteral("--search-by"));
    const QString search = takeOption(args, QStringLiteral("--search"));
    const QString sortBy = takeOption(args, QStringLiteral("--sort-by"));
    const bool descending = takeFlag(args, QStringLiteral("--desc"));
    const std::optional<RowFormat> format = takeFormat(args);
    if (!format) return 2;
    if (folder.isEmpty() || !args.isEmpty()) return usage(kItems.command, kItemsUsage);

    const QStringList columns = {"key", "name", "barcode"};
    Context context;
    startContext(context, common.settingId);
    const QString& app = context.applicationName;
    ItemsFilter filter;
    filter.searchBy = searchBy.isEmpty() ? storedPosition(app, u"EditItems", u"ItmSearchBy")
                                         : choice("--search-by", searchBy, columns);
    filter.search = search;
    filter.sortBy = sortBy.isEmpty() ? storedPosition(app, u"EditItems", u"ItmSortBy")
                                     : choice("--sort-by", sortBy, columns);
    filter.sortOrder = descending ? 1 : storedPosition(app, u"EditItems", u"ItmSortOrder");
    if ((!searchBy.isEmpty() && filter.searchBy < 0) || (!sortBy.isEmpty() && filter.sortBy < 0))
        return 2;
    return listRows<ItemEditor>(folder, *format, [&](ItemEditor& e) { e.show(filter); });
}

int listAltKeys(QStringList args, const CommonOptions& common) {
    const QString folder = takeOption(args, QStringLiteral("--db"));
    AlterKeysFilter filter;
    const char* const searches[] = {"--account", "--item", "--alt-num", "--alt-bar"};
    for (int column = 0; column < 4; ++column) {
        const QString value = takeOption(args, QLatin1String(searches[column]));
        if (!value.isEmpty()) filter.searches.append({column, value});
    }
    const QString sortBy = takeOption(args, QStringLiteral("--sort-by"));
    const bool descending = takeFlag(args, QStringLiteral("--desc"));
    const std::optional<RowFormat> format = takeFormat(args);
    if (!format) return 2;
    if (folder.isEmpty() || !args.isEmpty()) return usage(kAltKeys.command, kAltKeysUsage);

    Context context;
    startContext(context, common.settingId);
    const QString& app = context.applicationName;
    filter.sortBy = sortBy.isEmpty()
                        ? storedPosition(app, u"AlterItems", u"AltSortBy")
                        : choice("--sort-by", sortBy, {"account", "item", "alt-num", "alt-bar"});
    if (!sortBy.isEmpty() && filter.sortBy < 0) return 2;
    filter.sortOrder = descending ? 1 : storedPosition(app, u"AlterItems", u"AltSortOrder");
    return listRows<AlterKeyEditor>(folder, *format, [&](AlterKeyEditor& e) { e.show(filter); });
}

int listAccounts(QStringList args) {
    const QString folder = takeOption(args, QStringLiteral("--db"));
    const std::optional<RowFormat> format = takeFormat(args);
    if (!format) return 2;
    if (folder.isEmpty() || !args.isEmpty()) return usage(kAccounts.command, kAccountsUsage);
    return listRows<AccountDefEditor>(folder, *format, [](AccountDefEditor& e) { e.show(); });
}

// A list of the SQL Server source under its two column names.
int printSourceList(QStringList args, const char* command, const QStringList& columns,
                    std::optional<EntryList> (*read)(const ConnParams&)) {
    const CommonOptions common = takeCommonOptions(args);
    const std::optional<RowFormat> format = takeFormat(args);
    if (!format) return 2;
    if (!args.isEmpty()) return usage(command, kSourceListUsage);
    Context context;
    startContext(context, common.settingId);
    return runReporting([&] {
        QList<QVariantList> rows;
        for (const ListEntry& entry : read(context.connection).value_or(EntryList()))
            rows.append({entry.data, entry.text});
        printRows(columns, rows, *format);
    });
}

}  // namespace

int runItems(const QStringList& arguments) {
    QStringList args = arguments;
    const CommonOptions common = takeCommonOptions(args);
    if (const std::optional<int> changed = runChange(kItems, args)) return *changed;
    return listItems(args, common);
}

int runAltKeys(const QStringList& arguments) {
    QStringList args = arguments;
    const CommonOptions common = takeCommonOptions(args);
    if (const std::optional<int> changed = runChange(kAltKeys, args)) return *changed;
    return listAltKeys(args, common);
}

int runAccounts(const QStringList& arguments) {
    QStringList args = arguments;
    takeCommonOptions(args);
    if (const std::optional<int> changed = runChange(kAccounts, args)) return *changed;
    return listAccounts(args);
}

int runPriceLists(const QStringList& args) {
    return printSourceList(args, "price-lists", {"ListNum", "ListName"}, ReadPriceLists);
}

int runCarriers(const QStringList& args) {
    return printSourceList(args, "carriers", {"TrnspCode", "TrnspName"}, ReadCarriers);
}

}  // namespace etq::cli

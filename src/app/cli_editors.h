#pragma once

#include <QStringList>

// etiquon-cli's commands for the item, alternate key and account editors and for the lists of
// the SQL Server source: their usage lines (for --help and usage errors) and their runs.
namespace etq::cli {

inline constexpr const char* kItemsUsage =
    "--db DIR [--search-by key|name|barcode] [--search TEXT] [--sort-by key|name|barcode] [--desc] [--format table|tsv|json]";
inline constexpr const char* kItemsChangeUsage =
    "add|set --db DIR KEY [--name TEXT] [--unit TEXT] [--barcode TEXT] [--price N]";
inline constexpr const char* kItemsRemoveUsage = "remove --db DIR KEY...";
inline constexpr const char* kAltKeysUsage =
    "--db DIR [--account KEY] [--item KEY] [--alt-num TEXT] [--alt-bar TEXT] [--sort-by account|item|alt-num|alt-bar] [--desc] [--format table|tsv|json]";
inline constexpr const char* kAltKeysChangeUsage =
    "add|set --db DIR ACCOUNT ITEM [--alt-num TEXT] [--alt-bar TEXT]";
inline constexpr const char* kAltKeysRemoveUsage = "remove --db DIR ACCOUNT ITEM";
inline constexpr const char* kAccountsUsage = "--db DIR [--format table|tsv|json]";
inline constexpr const char* kAccountsChangeUsage =
    "add|set --db DIR ACCOUNT [--price-list N] [--label FILE]";
inline constexpr const char* kAccountsRemoveUsage = "remove --db DIR ACCOUNT...";
inline constexpr const char* kSourceListUsage = "[--format table|tsv|json]";

int runItems(const QStringList& args);
int runAltKeys(const QStringList& args);
int runAccounts(const QStringList& args);
int runPriceLists(const QStringList& args);
int runCarriers(const QStringList& args);

}  // namespace etq::cli

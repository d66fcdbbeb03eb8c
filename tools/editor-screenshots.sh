#!/usr/bin/env bash
# Pictures of the item, alternate key and account editors into docs/screenshots (or the folder
# given): frmEditItems.png, frmAlterItems.png, frmAccDef.png. The demo company's items fill the
# item database; a few alternate keys and accounts are added with etiquon-cli; the price lists
# come from a small SQLite file read through SQLite's ODBC driver, standing in for SQL Server.
set -euo pipefail
cd "$(dirname "$0")/.."
tools/build.sh etiquon-cli document_database make-demo-company editor-screenshots >/dev/null
build="${ETIQUON_BUILD_DIR:-build}"
out="${1:-docs/screenshots}"
cli="$build/src/app/etiquon-cli"

scratch="$(mktemp -d)"
trap 'rm -rf "$scratch"' EXIT
mkdir -p "$scratch/config" "$scratch/runtime"
chmod 700 "$scratch/runtime"
export XDG_CONFIG_HOME="$scratch/config" XDG_RUNTIME_DIR="$scratch/runtime"

"$build/samples/make-demo-company" "$scratch/company" >/dev/null
"$cli" init-db --db "$scratch/db" >/dev/null
"$cli" import-items --company "$scratch/company" --db "$scratch/db" </dev/null >/dev/null
for row in "10001 10000 A-5501 7290011000017" "10001 10002 A-5502 7290011000024" \
           "10001 10003 A-5503 7290011000031" "20002 10000 SH-100 7290022000016" \
           "20002 10004 SH-104 7290022000047"; do
    read -r account item num bar <<<"$row"
    "$cli" alt-keys add --db "$scratch/db" "$account" "$item" --alt-num "$num" --alt-bar "$bar"
done
"$cli" accounts add --db "$scratch/db" 10001 --price-list 1 --label "$HOME/labels/shelf.lbl"
"$cli" accounts add --db "$scratch/db" 20002 --price-list 2 --label "$HOME/labels/chain.lbl"
"$cli" accounts add --db "$scratch/db" 00000000

sqlite3 "$scratch/host.db" "CREATE TABLE OPLN (ListNum INTEGER, ListName TEXT);
    INSERT INTO OPLN VALUES (1, 'מחירון בסיס'), (2, 'מחירון רשתות'), (3, 'סיטונאי');"
"$cli" config set Params ConnDriver SQLite3
"$cli" config set Params ConnDataBase "$scratch/host.db"

xvfb-run -a "$build/tests/dialogs/editor-screenshots" "$scratch/db" "$out"
echo "screenshots: frmEditItems, frmAlterItems, frmAccDef in $out"

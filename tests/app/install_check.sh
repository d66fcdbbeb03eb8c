#!/usr/bin/env bash
# The installed tree works on its own: `cmake --install` under a new prefix, then the installed
# etiquon-cli prepares a database folder from the delivered document database it finds there.
set -euo pipefail
build="$1"
prefix=$(mktemp -d)
trap 'rm -rf "$prefix"' EXIT
unset ETIQUON_DATA_DIR
cmake --install "$build" --prefix "$prefix" >/dev/null
test -x "$prefix/bin/etiquon" && test -x "$prefix/bin/etiquon-cli"
test -f "$prefix/share/etiquon/etiquon.kdb"
# From another working folder, so that nothing is found beside the build.
cd /
said=$("$prefix/bin/etiquon-cli" init-db --db "$prefix/db")
grep -q "installed the document database" <<<"$said"
test -f "$prefix/db/etiquon.kdb" && test -f "$prefix/db/etqnitm.kdb"
# No path of the build is written into the programs' data (debug information may name it).
for program in etiquon etiquon-cli; do
    objcopy -O binary --only-section=.rodata "$prefix/bin/$program" "$prefix/rodata"
    if grep -q -a "$build" "$prefix/rodata"; then
        echo "$program holds the build path $build" >&2
        exit 1
    fi
done
echo "installed tree works: $prefix"

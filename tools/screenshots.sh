#!/usr/bin/env bash
# Pictures of the eight tabs of the control, as a new user sees them (default settings), into
# docs/screenshots/tab-0.png .. tab-7.png, and of the label designer's three tabs with the demo's
# label (designer-0.png .. designer-2.png). Runs the window under a virtual X display.
set -euo pipefail
cd "$(dirname "$0")/.."
tools/build.sh etiquon etiquon-cli document_database make-demo-company editor-screenshots
build="${ETIQUON_BUILD_DIR:-build}"
out="${1:-docs/screenshots}"

# A settings folder of its own, so the pictures show the defaults; paths show the user's own.
scratch="$(mktemp -d)"
trap 'rm -rf "$scratch"' EXIT
mkdir -p "$scratch/config" "$scratch/runtime" "$scratch/share"
chmod 700 "$scratch/runtime"
export XDG_CONFIG_HOME="$scratch/config" XDG_RUNTIME_DIR="$scratch/runtime" XDG_DATA_HOME="$scratch/share"
# The default database folder, prepared as a first run leaves it: tab 6 lists its document types.
"$build/src/app/etiquon-cli" init-db --db "$XDG_DATA_HOME/Etiquon" >/dev/null
xvfb-run -a "$build/src/app/etiquon" --screenshots "$out"

# The label designer with the demo's label, its preview showing the demo's first marked item.
CI=1 ETIQUON_DEMO_DIR="$scratch/demo" tools/demo.sh --no-build >/dev/null
"$build/src/app/etiquon-cli" --setting-id 90 config set GeneralParams DBPath "$scratch/demo/db"
xvfb-run -a "$build/src/app/etiquon" --setting-id 90 --screenshots "$scratch/demo-pictures"
cp "$scratch"/demo-pictures/designer-*.png "$out"/
tools/editor-screenshots.sh "$out"
echo "screenshots: $(ls "$out"/*.png | wc -l) pictures in $out"

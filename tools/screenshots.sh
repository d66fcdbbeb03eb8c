#!/usr/bin/env bash
# Pictures of the eight tabs of the control, as a new user sees them (default settings), into
# docs/screenshots/tab-0.png .. tab-7.png. Runs the window under a virtual X display.
set -euo pipefail
cd "$(dirname "$0")/.."
tools/build.sh etiquon
build="${ETIQUON_BUILD_DIR:-build}"
out="${1:-docs/screenshots}"

# A settings folder of its own, so the pictures show the defaults; paths show the user's own.
scratch="$(mktemp -d)"
trap 'rm -rf "$scratch"' EXIT
mkdir -p "$scratch/config" "$scratch/runtime"
chmod 700 "$scratch/runtime"
XDG_CONFIG_HOME="$scratch/config" XDG_RUNTIME_DIR="$scratch/runtime" \
    xvfb-run -a "$build/src/app/etiquon" --screenshots "$out"
echo "screenshots: $(ls "$out"/tab-*.png | wc -l) pictures in $out"

#!/usr/bin/env bash
# Configures and builds Etiquon into build/ (or $ETIQUON_BUILD_DIR).
set -euo pipefail
cd "$(dirname "$0")/.."
build="${ETIQUON_BUILD_DIR:-build}"
if [ ! -f "$build/build.ninja" ]; then
    cmake -S . -B "$build" -G Ninja -DCMAKE_BUILD_TYPE=RelWithDebInfo >/dev/null
fi
cmake --build "$build" -- -j"$(nproc)" "$@"

#!/usr/bin/env bash
# Builds Etiquon and runs every test.
set -euo pipefail
cd "$(dirname "$0")/.."
tools/build.sh
ctest --test-dir "${ETIQUON_BUILD_DIR:-build}" --output-on-failure -j"$(nproc)"

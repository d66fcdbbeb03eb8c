#!/usr/bin/env bash
# The main job on the bundled demo company.
set -euo pipefail
cd "$(dirname "$0")/.."
tools/build.sh
build="${ETIQUON_BUILD_DIR:-build}"
"$build/src/app/etiquon-cli" --version

#!/usr/bin/env bash
# Builds the demo company generator and writes the demo host company folder.
#   tools/make-demo.sh [OUTDIR] [--items N] [--seed S]   (OUTDIR defaults to <build>/demo-company)
set -euo pipefail
cd "$(dirname "$0")/.."
build="${ETIQUON_BUILD_DIR:-build}"
tools/build.sh make-demo-company >/dev/null
out="${1:-$build/demo-company}"
[ $# -gt 0 ] && shift
"$build/samples/make-demo-company" "$out" "$@"
echo "$out"

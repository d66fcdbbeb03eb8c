#!/usr/bin/env bash
# Builds Etiquon and runs every test.
#   tools/test.sh              the normal build in build/ (or $ETIQUON_BUILD_DIR)
#   tools/test.sh --sanitize   the whole suite built with AddressSanitizer and
#                              UndefinedBehaviorSanitizer in build-asan/: slower, for before a
#                              release or after a change to memory handling; not part of CI
set -euo pipefail
cd "$(dirname "$0")/.."
if [ "${1:-}" = "--sanitize" ]; then
    build="${ETIQUON_ASAN_BUILD_DIR:-build-asan}"
    if [ ! -f "$build/build.ninja" ]; then
        cmake -S . -B "$build" -G Ninja -DCMAKE_BUILD_TYPE=RelWithDebInfo \
            -DETIQUON_SANITIZE=ON >/dev/null
    fi
    cmake --build "$build" -- -j"$(nproc)"
    export ASAN_OPTIONS="detect_leaks=1:abort_on_error=1"
    export UBSAN_OPTIONS="print_stacktrace=1:halt_on_error=1"
    ctest --test-dir "$build" --output-on-failure -j"$(nproc)" --timeout 1800
    exit
fi
tools/build.sh
ctest --test-dir "${ETIQUON_BUILD_DIR:-build}" --output-on-failure -j"$(nproc)"

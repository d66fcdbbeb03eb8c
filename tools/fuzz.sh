#!/usr/bin/env bash
# Builds the libFuzzer targets with clang into build-fuzz/ (or $ETIQUON_FUZZ_BUILD_DIR) and runs
# each for SECONDS (default 60) on a copy of its seed corpus; what a run finds is kept in
# <build>/findings/<target>/ and fails the script.
#   tools/fuzz.sh [SECONDS] [TARGET...]
set -euo pipefail
cd "$(dirname "$0")/.."
seconds="${1:-60}"
shift || true
targets=("$@")
[ ${#targets[@]} -gt 0 ] || targets=(dbf_file_fuzz sql_translator_fuzz)
build="${ETIQUON_FUZZ_BUILD_DIR:-build-fuzz}"

if [ ! -f "$build/build.ninja" ]; then
    CC=clang CXX=clang++ cmake -S . -B "$build" -G Ninja -DCMAKE_BUILD_TYPE=RelWithDebInfo \
        -DETIQUON_FUZZ=ON -DBUILD_TESTING=OFF >/dev/null
fi
cmake --build "$build" --target "${targets[@]}" -- -j"$(nproc)" >/dev/null

symbolizer=/usr/lib/llvm-14/bin/llvm-symbolizer
[ -x "$symbolizer" ] && export ASAN_SYMBOLIZER_PATH="$symbolizer"
export UBSAN_OPTIONS="print_stacktrace=1:halt_on_error=1"
passed=0
failed=0
for target in "${targets[@]}"; do
    corpus="$build/corpus/$target"
    findings="$build/findings/$target"
    mkdir -p "$corpus" "$findings"
    cp -n fuzz/corpus/"${target%_fuzz}"/* "$corpus"/ 2>/dev/null || true
    echo "fuzz: $target for ${seconds}s"
    if ! "$build/fuzz/$target" -max_total_time="$seconds" -max_len=8192 -timeout=10 \
        -rss_limit_mb=2048 -print_final_stats=1 -artifact_prefix="$findings/" "$corpus" \
        >"$build/$target.log" 2>&1; then
        failed=$((failed + 1))
        echo "fuzz: $target found a fault; see $build/$target.log and $findings/" >&2
    else
        passed=$((passed + 1))
    fi
    grep -E '^stat::number_of_executed_units' "$build/$target.log" || true
done
echo "fuzz: $passed passed, $failed failed"
[ "$failed" -eq 0 ]

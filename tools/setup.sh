#!/usr/bin/env bash
# Installs what a Debian 12 machine lacks to build, run and test Etiquon.
# Quiet and quick when everything is already there.
set -euo pipefail

packages=(
    # build (Qt's CMake modules look for some of their parts with pkg-config)
    g++ cmake ninja-build pkg-config clang-format
    # libraries
    qt6-base-dev libgl-dev libsqlite3-dev libzint-dev zlib1g-dev
    # the host's SQL Server database over ODBC: unixODBC's driver manager and FreeTDS's driver;
    # SQLite's ODBC driver stands in for the server in the tests
    unixodbc-dev tdsodbc libsqliteodbc
    # tests and benchmarks: GoogleTest, and the independent tools the tests check against
    libgtest-dev sqlite3 zint zbar-tools python3 python3-dbfread
    # printed grids read back from their PDF files
    poppler-utils
    # dBASE files as other tools write them, for the reader's tests
    python3-dbf shapelib
    # fuzzing (tools/fuzz.sh): clang with libFuzzer's runtime, and a symbolizer for its reports
    clang libclang-rt-14-dev llvm-14
    # desktop stand-ins: printers, Hebrew fonts, a display for screenshots, a browser
    cups-client culmus fonts-dejavu-core xvfb xauth chromium
    # the gLabels route (glabels-3-batch; pdfunite joins its PDFs), label sheet products
    # (gLabels' catalogue), and poppler's pdftoppm and pdftotext, with which the tests read
    # PDFs back
    glabels glabels-data poppler-utils
)

missing=()
for p in "${packages[@]}"; do
    if ! dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q 'install ok installed'; then
        missing+=("$p")
    fi
done
[ ${#missing[@]} -eq 0 ] && exit 0

sudo=""
[ "$(id -u)" -ne 0 ] && sudo="sudo"
echo "setup: installing ${missing[*]}"
export DEBIAN_FRONTEND=noninteractive
$sudo apt-get update -qq
$sudo apt-get install -y -qq --no-install-recommends "${missing[@]}" >/dev/null

#!/usr/bin/env bash
# The main job on the bundled demo company: write the demo company folder, prepare a database
# folder, import the company's items, mark a dozen of them with two copies each, and print their
# labels on the built-in label page. The last line names the page; on a desktop it opens in the
# browser.
#   tools/demo.sh [--no-build] [--documents] [--screenshot FILE] [--pdf-picture FILE]
# --documents prints labels for the lines of the company's delivery notes instead: it reads the
# documents, chooses two of them and some of their lines, and prints a label for every copy of
# every line chosen.
# --pdf-picture also draws the labels as a PDF without a browser (<work>/labels.pdf) and turns
# its page into a picture.
# The demo keeps its settings under SettingID 90 (~/.config/Etiquon/Etiquon90.ini; 91 with
# --documents) and its files in <build>/demo (or $ETIQUON_DEMO_DIR); the page lies in the user's
# private print folder.
set -euo pipefail
cd "$(dirname "$0")/.."
build="${ETIQUON_BUILD_DIR:-build}"
work="${ETIQUON_DEMO_DIR:-$build/demo}"
screenshot=""
pdf_picture=""
no_build=""
documents=""
while [ $# -gt 0 ]; do
    case "$1" in
        --no-build) no_build=1 ;;
        --documents) documents=1 ;;
        --screenshot) screenshot="$2"; shift ;;
        --pdf-picture) pdf_picture="$2"; shift ;;
        *) echo "usage: tools/demo.sh [--no-build] [--documents] [--screenshot FILE] [--pdf-picture FILE]" >&2; exit 2 ;;
    esac
    shift
done

[ -n "$no_build" ] || tools/build.sh etiquon-cli make-demo-company document_database >/dev/null
cli="$build/src/app/etiquon-cli"
demo=(--setting-id 90)
[ -z "$documents" ] || demo=(--setting-id 91)

rm -rf "$work/company" "$work/db"
"$build/samples/make-demo-company" "$work/company" >/dev/null
"$cli" init-db --db "$work/db"
"$cli" "${demo[@]}" import-items --company "$work/company" --db "$work/db" </dev/null
echo

# The built-in label: the item's name, its EAN-13 barcode with its digits, and its price; an A4
# sheet of 4 x 6 labels in item order.
settings=(
    "GeneralParams OptOLE3 True" "GeneralParams OptPrinter0 True" "GeneralParams OptPrinter1 False"
    "0LabelDef UseCell True" "0LabelDef FldID 1" "0LabelDef FontWeight 2" "0LabelDef FontSize 11"
    "1LabelDef UseCell True" "1LabelDef FldID 4" "1LabelDef ViewType 1"
    "2LabelDef UseCell True" "2LabelDef FldID 6" "2LabelDef FontSize 12" "2LabelDef Prefix מחיר:"
    "LabelBar BarType 6" "LabelBar ShowDesc True" "LabelBar UserResoX 0" "LabelBar UserResoY 0"
)
# Document lines: the customer, the item's name, its EAN-13 barcode and the delivery note's
# number; a thermal printer's order, the last line of the last document first.
[ -z "$documents" ] || settings=(
    "GeneralParams OptOLE3 True" "GeneralParams OptPrinter0 False" "GeneralParams OptPrinter1 True"
    "0LabelDef UseCell True" "0LabelDef FldID 15" "0LabelDef FontWeight 2" "0LabelDef FontSize 11"
    "1LabelDef UseCell True" "1LabelDef FldID 1" "1LabelDef FontSize 10"
    "2LabelDef UseCell True" "2LabelDef FldID 4" "2LabelDef ViewType 1"
    "3LabelDef UseCell True" "3LabelDef FldID 10" "3LabelDef FontSize 10" "3LabelDef Prefix ת.מ:"
    "LabelBar BarType 6" "LabelBar ShowDesc True" "LabelBar UserResoX 0" "LabelBar UserResoY 0"
)
for setting in "${settings[@]}"; do
    # shellcheck disable=SC2086
    "$cli" "${demo[@]}" config set $setting
done

open=()
[ -n "${DISPLAY:-}${WAYLAND_DISPLAY:-}" ] && [ -z "${CI:-}" ] && open=(--open)
if [ -z "$documents" ]; then
    "$cli" "${demo[@]}" mark-items --db "$work/db" --none >/dev/null
    "$cli" "${demo[@]}" mark-items --db "$work/db" --copies 2 \
        10000 10001 10002 10003 10004 KT-1005 10006 10007 10008 10009 10010 10011
    page="$("$cli" "${demo[@]}" print-items --db "$work/db" "${open[@]}" | tail -n 1)"
else
    # The delivery notes of 2025 on: two of them, and of the second three lines: 0.69 units (one
    # label), none (no label) and eleven cartons, four labels for them. A label per unit
    # delivered, but three for the fifteen boxes of the first line of the first.
    "$cli" "${demo[@]}" doc-types --db "$work/db" --no-scan 2 >/dev/null
    "$cli" "${demo[@]}" import-docs --company "$work/company" --db "$work/db" \
        --from-date 01/01/2025 --to-date 31/12/2030
    "$cli" "${demo[@]}" exclude-docs --db "$work/db" --all
    "$cli" "${demo[@]}" include-docs --db "$work/db" 1/101 1/102
    "$cli" "${demo[@]}" exclude-lines --db "$work/db" 1/102 --all
    "$cli" "${demo[@]}" include-lines --db "$work/db" 1/102 4 8 10
    "$cli" "${demo[@]}" set-copies --db "$work/db" 1/102 4 4
    "$cli" "${demo[@]}" set-copies --db "$work/db" 1/101 1 3
    "$cli" "${demo[@]}" list-docs --db "$work/db" --lines 1/101 1/102
    page="$("$cli" "${demo[@]}" print-docs --db "$work/db" "${open[@]}" | tail -n 1)"
fi

if [ -n "$screenshot" ]; then
    profile="$(mktemp -d)"
    chromium --headless --no-sandbox --disable-gpu --disable-quic --no-first-run \
        --disable-background-networking --disable-component-update --disable-sync \
        --user-data-dir="$profile" --hide-scrollbars --window-size=1000,1414 \
        --screenshot="$(realpath -m "$screenshot")" "file://$page" 2>/dev/null
    rm -rf "$profile"
    echo "screenshot: $screenshot"
fi
if [ -n "$pdf_picture" ]; then
    print=print-items
    [ -z "$documents" ] || print=print-docs
    "$cli" "${demo[@]}" "$print" --db "$work/db" --output "$work/labels.pdf" >/dev/null
    pdftoppm -r 70 -png -singlefile "$work/labels.pdf" "${pdf_picture%.png}"
    echo "PDF: $work/labels.pdf, its page: $pdf_picture"
fi
echo "The label page: $page"

#!/usr/bin/env bash
# The application that docs/first-application.md writes step by step: its files are taken from the page, built against
# an installation, and used as the page says.
#
#   FirstApplicationTest.sh CMAKE BUILD_DIR PAGE COMPILER
set -euo pipefail
. "$(dirname "$0")/../Desktop.sh"
cmake=$1 build=$2 page=$3 compiler=$4
host="$work/host" installed="$work/tarvex" out="$work/out"
key='Software\Tarvex\Marks\Settings'

# A line that ends with `NAME`: begins a file; its text is the indented block below.
mkdir "$host"
awk -v folder="$host" '
    /`[A-Za-z]+[.][a-z]+`:$/ { split($0, parts, "`"); name = parts[2]; next }
    name && /^    / { print substr($0, 5) > (folder "/" name); begun = name; next }
    name && /^$/ { if (begun == name) print "" > (folder "/" name); next }
    { name = "" }' "$page"
"$cmake" --install "$build" --prefix "$installed" >"$work/log" &&
    "$cmake" -S "$host" -B "$out" -G Ninja -DCMAKE_CXX_COMPILER="$compiler" -DCMAKE_PREFIX_PATH="$installed" \
        -DCMAKE_BUILD_TYPE=Debug >>"$work/log" 2>&1 &&
    "$cmake" --build "$out" >>"$work/log" 2>&1 || {
    cat "$work/log"
    fail "the application of the page is built"
}
"$(dirname "$0")/../../../scripts/checks/runpath" "$installed" "$out" >"$work/log" || {
    cat "$work/log"
    fail "neither the installation nor the application looks for libraries in the current folder"
}
"$out/marks" -smoketest || fail "its smoke test passes"

sheet="$work/sheet.mks"
: >"$sheet"
begin "sheet.mks - Tarvex Marks" "$out/marks" "$sheet"
stored() {
    [ "$(stat -c %s "$sheet")" -eq "$1" ]
}
# mark DISTANCE: clicks at a distance from the corner of the main window.
mark() {
    local X=0 Y=0
    eval "$(xdotool getwindowgeometry --shell "$main" | grep -E '^(X|Y)=')"
    xdotool mousemove $((X + $1)) $((Y + $1)) click 1
}
kept() {
    [ "$("$installed/bin/tvxsettings" get "$key" MarkSize)" = "$1" ]
}

mark 150
xdotool key --clearmodifiers ctrl+s
await "a click leaves a mark, Ctrl+S saves it" stored 14
xdotool key --clearmodifiers F2
await "F2 asks for the size" titled "^Size of the Marks$"
focus '^Size of the Marks$' key --clearmodifiers ctrl+a
xdotool type 51
xdotool key Return
await "51 pixels are too many" titled "^Tarvex Marks$"
focus '^Tarvex Marks$' key Return
await "the reason goes" untitled "^Tarvex Marks$"
focus '^Size of the Marks$' key --clearmodifiers ctrl+a
xdotool type 30
xdotool key Return
await "30 pixels are kept" kept 30
await "the dialog goes" untitled "^Size of the Marks$"

xdotool windowactivate --sync "$main"
mark 180
xdotool key --clearmodifiers alt+F4
await "closing with changes asks" titled "^Tarvex Marks$"
focus '^Tarvex Marks$' key y
await "Yes saves and ends" ended "$process"
stored 26 || fail "both marks are in the file"

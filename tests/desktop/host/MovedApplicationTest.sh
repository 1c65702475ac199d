#!/usr/bin/env bash
# A host in the way of old ones, moved by docs/moving-an-application.md: it is built against an installation with its
# build file alone, and used.
#
#   MovedApplicationTest.sh CMAKE BUILD_DIR COMPILER
set -euo pipefail
. "$(dirname "$0")/../Desktop.sh"
cmake=$1 build=$2 compiler=$3
host="$work/host" installed="$work/tarvex" out="$work/out"
# Lines end as on the system that old sources come from.
cp -r "$(dirname "$0")" "$host"
find "$host" -name '*.h' -o -name '*.cpp' -o -name '*.rc*' | xargs sed -i 's/$/\r/'

"$cmake" --install "$build" --prefix "$installed" >"$work/log" &&
    "$cmake" -S "$host" -B "$out" -G Ninja -DCMAKE_CXX_COMPILER="$compiler" -DCMAKE_PREFIX_PATH="$installed" \
        -DCMAKE_BUILD_TYPE=Debug >>"$work/log" 2>&1 &&
    "$cmake" --build "$out" >>"$work/log" 2>&1 || {
    cat "$work/log"
    fail "the sources compile as they are"
}

sheet="$work/sheet.ldg"
: >"$sheet"
begin "^sheet.ldg - Ledger$" "$out/ledger" "$sheet"
# holds TEXT: saves, and looks for a line of the sheet.
holds() {
    xdotool key --clearmodifiers ctrl+s
    grep -aF "$1" "$sheet"
}
# answered TITLE KEY...: waits for a window, presses keys in it and sees it go.
answered() {
    local title=$1
    shift
    await "$title appears" titled "$title"
    focus "$title" key --clearmodifiers "$@"
    await "$title goes" untitled "$title"
    xdotool windowactivate --sync "$main"
}

xdotool type "first line"
xdotool key Return
await "what is typed becomes a line" holds "first line"
xdotool key --clearmodifiers ctrl+F1
answered "^About Ledger$" Return
xdotool key --clearmodifiers ctrl+p
answered "^Ledger$" Return
xdotool key --clearmodifiers F8
await "the options appear" titled "^Ledger Options$"
focus '^Ledger Options$'
xdotool type Penny
answered "^Ledger Options$" Tab Down Return
await "the dialog's answers arrive" holds "name Penny, currency 1"
xdotool key --clearmodifiers F6
answered "^Font$" Return
await "the font dialog answers" holds "font of 12 points"
xdotool key --clearmodifiers F7
answered "^Colour$" Return
await "the colour dialog answers" holds "colour 000080"
xdotool key --clearmodifiers F9
answered "^Names$" Return
await "all names have been called" holds "system: "
! grep -aF WRONG "$sheet" || fail "every name does what it says"
xdotool key --clearmodifiers alt+F4
await "it ends" ended "$process"

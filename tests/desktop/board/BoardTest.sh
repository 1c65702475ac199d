#!/usr/bin/env bash
# The sample application as a user meets it under a window manager: opening a file by its name, drawing, saving,
# closing with unsaved changes.
#
#   BoardTest.sh BOARD DRAWING
set -euo pipefail
program=$1
work=$(mktemp -d "${TMPDIR:-/tmp}/board.XXXXXX")
trap 'rm -rf "$work"' EXIT
file="$work/plan with blanks.brd"
cp "$2" "$file"
limit=30

fail() {
    echo "FAIL: $1" >&2
    exit 1
}
# until DESCRIPTION COMMAND...: waits for the command to succeed.
until_() {
    local what=$1 end=$((SECONDS + limit))
    shift
    until "$@" >/dev/null 2>&1; do
        [ $SECONDS -lt $end ] || fail "$what"
    done
}
window() {
    xdotool search --onlyvisible --name "$1" | tail -n 1
}
titled() {
    [ -n "$(window "$1")" ]
}
untitled() {
    [ -z "$(window "$1")" ]
}
ended() {
    ! kill -0 "$process"
}
sum() {
    sha256sum <"$file"
}
changed() {
    [ "$(sum)" != "$before" ]
}
start() {
    "$program" "$@" &
    process=$!
    until_ "the window appears with the file's name" titled "plan with blanks.brd - Tarvex Board"
    main=$(window "plan with blanks.brd - Tarvex Board")
    xdotool windowactivate --sync "$main"
}
draw() {
    local X=0 Y=0 WIDTH=0 HEIGHT=0
    eval "$(xdotool getwindowgeometry --shell "$main" | grep -E '^(X|Y|WIDTH|HEIGHT)=')"
    xdotool key --clearmodifiers ctrl+2
    xdotool mousemove $((X + 150)) $((Y + 200)) mousedown 1 mousemove $((X + 200)) $((Y + 240)) \
        mousemove $((X + 260)) $((Y + 280)) mouseup 1
}

before=$(sum)
start "$file"
draw
xdotool key --clearmodifiers ctrl+s
until_ "Ctrl+S saves" changed
[ "$(grep -c '^rectangle' "$file")" -eq $(($(grep -c '^rectangle' "$2") + 1)) ] || fail "the rectangle is in the file"
xdotool key --clearmodifiers alt+F4
until_ "a saved drawing closes without a question" ended

before=$(sum)
start "$file"
draw
xdotool key --clearmodifiers alt+F4
until_ "closing with changes asks" titled "^Tarvex Board$"
xdotool windowactivate --sync "$(window '^Tarvex Board$')" key Escape
until_ "Esc takes the question away" untitled "^Tarvex Board$"
ended && fail "Esc keeps the application"
xdotool windowactivate --sync "$main" key --clearmodifiers alt+F4
until_ "closing asks again" titled "^Tarvex Board$"
xdotool windowactivate --sync "$(window '^Tarvex Board$')" key n
until_ "No ends the application" ended
changed && fail "No leaves the file as it was"
exit 0

#!/usr/bin/env bash
# Tools > Run Command of the sample application as a user meets it: the output appears while the program runs, Stop
# ends it, and closing the window of a program ends the program.
#
#   RunCommandTest.sh BOARD
set -euo pipefail
program=$1
limit=30
work=$(mktemp -d "${TMPDIR:-/tmp}/board.XXXXXX")
board=''
stop() {
    if [ -n "$board" ]; then kill "$board" 2>/dev/null || true; fi
    rm -rf "$work"
}
trap stop EXIT

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
gone() {
    ! kill -0 "$1"
}
# Asks for a command as a user does.
run() {
    xdotool windowactivate --sync "$main" key --clearmodifiers alt+t
    xdotool key Return
    until_ "the question appears" titled "^Run Command$"
    xdotool windowactivate --sync "$(window '^Run Command$')"
    xdotool key --clearmodifiers ctrl+a
    xdotool type --clearmodifiers "$1"
    xdotool key Return
    until_ "the question is gone" untitled "^Run Command$"
}

"$program" &
board=$!
until_ "the board appears" titled "Tarvex Board"
main=$(window "Tarvex Board")

# The child tells its number and goes on when it is let to.
cat >"$work/talk" <<TALK
#!/bin/sh
echo \$\$ >$work/id
echo first line
cat $work/gate
exec sleep 1000
TALK
chmod +x "$work/talk"
mkfifo "$work/gate"
run "$work/talk"
until_ "the window of the program appears" titled "$work/talk"
output=$(window "$work/talk")
until_ "the program runs" test -s "$work/id"
child=$(cat "$work/id")
seq -f 'line %g' 20000 >"$work/gate"
xdotool windowactivate --sync "$output"
xdotool key --clearmodifiers alt+s
until_ "Stop ends the program" gone "$child"
titled "$work/talk" || fail "the output stays readable"
xdotool windowactivate --sync "$output" key Escape
until_ "Esc closes the window" untitled "$work/talk"

rm "$work/id"
run "$work/talk"
until_ "the program runs again" test -s "$work/id"
child=$(cat "$work/id")
until_ "its window appears" titled "$work/talk"
xdotool windowactivate --sync "$(window "$work/talk")" key Escape
until_ "closing the window ends the program" gone "$child"

run "$work/missing"
until_ "a program that is missing is told" titled "^Tarvex Board$"
xdotool key Return
kill -0 "$board" || fail "the board lives"

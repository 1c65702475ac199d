#!/usr/bin/env bash
# Tools > Run Command of the sample application as a user meets it: the output appears while the program runs, Stop
# ends it, and closing the window of a program ends the program.
#
#   RunCommandTest.sh BOARD
set -euo pipefail
. "$(dirname "$0")/../Desktop.sh"
program=$1

# Asks for a command as a user does: run TEXT [KEY...]
run() {
    xdotool windowactivate --sync "$main" key --clearmodifiers alt+t
    xdotool key Return
    await "the question appears" titled "^Run Command$"
    focus '^Run Command$'
    xdotool key --clearmodifiers ctrl+a
    xdotool type --clearmodifiers "$1"
    xdotool key --clearmodifiers "${@:2}" Return
    await "the question is gone" untitled "^Run Command$"
}

"$program" &
board=$!
processes=("$board")
await "the board appears" titled "Tarvex Board"
main=$found

# The child tells its number and goes on when it is let to.
cat >"$work/talk" <<TALK
#!/bin/sh
echo \$\$ >$work/id
echo first line
cat $work/gate
echo all but what fits into a pipe is read >$work/read
exec sleep 1000
TALK
chmod +x "$work/talk"
mkfifo "$work/gate"
run "$work/talk"
await "the window of the program appears" titled "$work/talk"
output=$found
await "the program runs" test -s "$work/id"
child=$(cat "$work/id")
seq -f 'line-%g' 30000 >"$work/gate"
await "the output is read" test -s "$work/read"
# The first line left of many is whole: pasted into a field of one line it names a file.
xdotool windowactivate --sync "$output" mousemove --window "$output" 100 60 click 1 key --clearmodifiers ctrl+a ctrl+c
run "touch $work/first-" ctrl+v
await "old lines are dropped whole" compgen -G "$work/first-line-[1-9]*"
focus '^touch' key Escape
await "the window of the second program closes" untitled "^touch"
xdotool windowactivate --sync "$output"
xdotool key --clearmodifiers alt+s
await "Stop ends the program" ended "$child"
titled "$work/talk" || fail "the output stays readable"
xdotool windowactivate --sync "$output" key Escape
await "Esc closes the window" untitled "$work/talk"

rm "$work/id"
run "$work/talk"
await "the program runs again" test -s "$work/id"
child=$(cat "$work/id")
await "its window appears" titled "$work/talk"
focus "$work/talk" key Escape
await "closing the window ends the program" ended "$child"

run "$work/missing"
await "a program that is missing is told" titled "^Tarvex Board$"
xprop -id "$(window '^Tarvex Board$')" _NET_WM_ICON | grep -q 'Icon (' || fail "the box has the application's icon"
xdotool key Return
! ended "$board" || fail "the board lives"

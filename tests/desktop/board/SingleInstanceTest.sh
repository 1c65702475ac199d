#!/usr/bin/env bash
# `board -single` as a user meets it: a second start shows the window of the first and ends, and nothing that a board
# leaves behind keeps the next one from starting.
#
#   SingleInstanceTest.sh BOARD TVXSETTINGS DRAWING
set -euo pipefail
. "$(dirname "$0")/../Desktop.sh"
program=$1 settings=$2
key='Software\Tarvex\board\FirstInstance'
for name in first second other; do
    cp "$3" "$work/$name.brd"
done

# start TITLE ARGUMENT...: starts a board whose window is to have the title; leaves $process and $shown.
start() {
    local title=$1
    shift
    "$program" "$@" &
    process=$!
    processes+=("$process")
    await "the window \"$title\" appears" titled "$title"
    shown=$found
    await "it becomes active" active "$shown"
}
# ends TEXT ARGUMENT...: a start that shows no window of its own.
ends() {
    local what=$1 second code=0
    shift
    "$program" "$@" &
    second=$!
    await "$what: it ends" ended "$second"
    wait "$second" || code=$?
    [ "$code" -eq 0 ] || fail "$what: it ends with $code"
    untitled second.brd || fail "$what: it shows a window"
}
record() {
    "$settings" get "$key" "$1"
}
records() {
    [ "$(record ProcessID) $(record WindowID)" = "$1" ]
}
minimized() {
    xprop -id "$1" WM_STATE | grep -q Iconic
}
close() { # WINDOW PROCESS
    xdotool windowactivate --sync "$1" key --clearmodifiers alt+F4
    await "the board closes" ended "$2"
}

start "first.brd - Tarvex Board" -single "$work/first.brd"
first=$process main=$shown
await "the first board is recorded" records "$first $main"
start "other.brd - Tarvex Board" "$work/other.brd"
other=$process
records "$first $main" || fail "a board without -single takes the record"
ends "a second start" -single "$work/second.brd"
await "the first board comes to the front" active "$main"
xdotool windowminimize "$main"
await "the first board is minimised" minimized "$main"
ends "a start while the first is minimised" -single "$work/second.brd"
await "the minimised board comes back" active "$main"
TVX_GUI_INSTANCECHECKING=0 start "second.brd - Tarvex Board" -single "$work/second.brd"
records "$first $main" || fail "a board that does not check takes the record"
close "$shown" "$process"
await "the other board is still there" titled "other.brd - Tarvex Board"
close "$found" "$other"
records "$first $main" || fail "closing another board clears the record"
"$settings" set "$key" WindowID 0
ends "a start while the first has no window yet" -single "$work/second.brd"

kill -KILL "$first"
await "the first board is gone" untitled first.brd
start "second.brd - Tarvex Board" -single "$work/second.brd"
await "the next board takes the place of one that crashed" records "$process $shown"
close "$shown" "$process"
records "0 0" || fail "closing the first board clears the record"

# Another process has got the number of a board that crashed.
sleep 1000 &
stranger=$!
processes+=("$stranger")
"$settings" set "$key" ProcessID "$stranger"
ends "a start while the recorded process runs" -single "$work/second.brd"
"$settings" set "$key" ProcessMark "$stranger $(cat /proc/sys/kernel/random/boot_id) 1"
start "second.brd - Tarvex Board" -single "$work/second.brd"
close "$shown" "$process"

# Two at once: either both find none and run, or one has seen the other. The record names one that runs.
"$program" -single "$work/first.brd" &
one=$!
"$program" -single "$work/first.brd" &
two=$!
processes+=("$one" "$two")
one_runs() {
    local named
    named=$(record ProcessID)
    [ "$(record WindowID)" != 0 ] && { [ "$named" = "$one" ] || [ "$named" = "$two" ]; } && ! ended "$named"
}
await "one of two is recorded with its window" one_runs
ends "a start after two at once" -single "$work/second.brd"

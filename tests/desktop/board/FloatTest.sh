#!/usr/bin/env bash
# A drawing gets a window of its own, is treated as windows are, and comes back, under a window manager.
#
#   FloatTest.sh BOARD DRAWING
set -euo pipefail
. "$(dirname "$0")/../Desktop.sh"
program=$1 drawing=$2

place() {
    xwininfo -id "$1" | awk '/Absolute upper-left X/{print "X="$4} /Absolute upper-left Y/{print "Y="$4}
        /Width:/{print "WIDTH="$2} /Height:/{print "HEIGHT="$2}'
}
# The window's place and size as "x y width height".
geometry() {
    local X=0 Y=0 WIDTH=0 HEIGHT=0
    eval "$(place "$1")"
    echo "$X $Y $WIDTH $HEIGHT"
}
geometry_is() {
    [ "$(geometry "$1")" = "$2" ]
}
not_at() {
    [ "$(geometry "$1")" != "$2" ]
}
floating() {
    found=$(xdotool search --onlyvisible --name '^plan.brd$' | tail -n 1)
    [ -n "$found" ]
}
docked() {
    [ -z "$(window '^plan.brd$')" ]
}
state() {
    xprop -id "$1" _NET_WM_STATE WM_STATE
}
state_has() {
    state "$1" | grep -q "$2"
}
state_lacks() {
    ! state_has "$1" "$2"
}
# drag DX DY FROM_X FROM_Y: with the left button from a point of the floating window, seen to move it.
drag() {
    local X=0 Y=0 WIDTH=0 HEIGHT=0 before
    eval "$(place "$outside")"
    before=$(geometry "$outside")
    xdotool mousemove $((X + $3)) $((Y + $4)) mousedown 1
    xdotool mousemove_relative -- $(($1 / 2)) $(($2 / 2)) sleep 0.1 mousemove_relative -- $(($1 / 2)) $(($2 / 2))
    await "the window follows the mouse" not_at "$outside" "$before"
    xdotool mouseup 1
}

begin 'plan.brd - ' "$program" -nosplash "$drawing"
xdotool key --clearmodifiers ctrl+shift+f
await "the drawing has a window of its own" floating
outside=$found
await "which is active" active "$outside"
wmctrl -l | grep -q ' plan.brd$' || fail "the task list knows the window"
xprop -id "$outside" WM_TRANSIENT_FOR | grep -q 'not found' || fail "the window stands for itself"

# By the caption and the border that it draws itself.
drag 80 60 200 15
before=$(geometry "$outside")
read -r _ _ width height <<<"$before"
drag 60 40 $((width - 2)) $((height - 2))
before=$(geometry "$outside")
eval "$(place "$outside")"
xdotool mousemove $((X + 200)) $((Y + 15)) click --repeat 2 --delay 80 1
await "a double click maximises it" state_has "$outside" MAXIMIZED_VERT
eval "$(place "$outside")"
xdotool mousemove $((X + 200)) $((Y + 10)) click --repeat 2 --delay 80 1
await "another one restores it" state_lacks "$outside" MAXIMIZED_VERT
await "to where it was" geometry_is "$outside" "$before"
xdotool windowminimize "$outside"
await "it is iconified" state_has "$outside" 'Iconic'
wmctrl -i -a "$outside"
await "and comes back" state_lacks "$outside" 'Iconic'
await "as the active window" active "$outside"

# Its keys are those of drawings, and those of the main window act in it.
xdotool key --clearmodifiers ctrl+n
await "Ctrl+N begins a drawing in the main window" titled '^Drawing1 - '
wmctrl -i -a "$outside"
await "the drawing's window is active again" active "$outside"

# Dialogs stand over it and leave it active.
xdotool key --clearmodifiers ctrl+o
focus '^Open$' key Escape
await "the drawing's window is active after the dialog" active "$outside"

# The button in its caption: left of three others.
eval "$(place "$outside")"
xdotool mousemove $((X + WIDTH - 74)) $((Y + 16)) sleep 0.2 click 1
await "its button docks it" docked
await "the main window shows it" titled '^plan.brd - '
xdotool key --clearmodifiers ctrl+shift+f
await "it floats again" floating
outside=$found
await "where it was" geometry_is "$outside" "$before"

# Commands that are found by typing are those of the window that the user works in.
xdotool key --clearmodifiers ctrl+alt+p
focus '^Commands$' type 'win flo'
xdotool key Return
await "Float in the palette docks the drawing" docked

wmctrl -i -a "$main"
await "the main window is active" active "$main"
xdotool key --clearmodifiers alt+F4
await "the application ends with its windows" ended "$process"

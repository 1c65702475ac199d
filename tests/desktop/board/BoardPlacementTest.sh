#!/usr/bin/env bash
# The sample application comes up where it stood, with its tool bar as it was, under a window manager.
#
#   BoardPlacementTest.sh BOARD TVXSETTINGS DRAWING
set -euo pipefail
. "$(dirname "$0")/../Desktop.sh"
program=$1 settings=$2 drawing=$3
key='Software\Tarvex\Board'

main=
find_main() {
    main=$(xdotool search --onlyvisible --name '^[^ ]*plan.brd - ' | tail -n 1)
    [ -n "$main" ]
}
# The place and size inside the borders, as variables.
inside() {
    xwininfo -id "$main" | awk '/Absolute upper-left X/{print "X="$4} /Absolute upper-left Y/{print "Y="$4}
        /Width:/{print "WIDTH="$2} /Height:/{print "HEIGHT="$2}'
}
# The frame with its borders as "x,y,width,height", as the display server and the window manager have it.
frame() {
    local X=0 Y=0 WIDTH=0 HEIGHT=0 left right top bottom
    eval "$(inside)"
    IFS=', ' read -r left right top bottom < <(xprop -id "$main" _NET_FRAME_EXTENTS | sed 's/.*= //')
    echo "$((X - left)),$((Y - top)),$((WIDTH + left + right)),$((HEIGHT + top + bottom))"
}
frame_is() {
    [ "$(frame)" = "$1" ]
}
moved() {
    local at
    at=$(frame)
    [[ $at == 1[12]?,*,70?,5* ]]
}
maximized() {
    xprop -id "$main" _NET_WM_STATE | grep -q MAXIMIZED_VERT.*MAXIMIZED_HORZ
}
restored() {
    ! maximized
}
start() {
    "$program" "$drawing" &
    process=$!
    processes=("$process")
    await "the window appears" find_main
    xdotool windowactivate --sync "$main"
}
close() {
    xdotool windowactivate --sync "$main" key --clearmodifiers alt+F4
    await "the application ends" ended "$process"
}
bar() {
    "$settings" get "$key\\ControlBar-Bar0" "$1"
}
# bar_is TEXT ENTRY VALUE: what the last close has kept of the tool bar.
bar_is() {
    [ "$(bar "$2")" = "$3" ] || fail "$1: $2 is $(bar "$2") instead of $3"
}

start
wmctrl -i -r "$main" -e 0,120,90,700,500
await "the window manager moves the frame" moved
place=$(frame)
close
for time in 1 2 3; do
    start
    await "start $time: the frame is where it was" frame_is "$place"
    close
done

start
wmctrl -i -r "$main" -b add,maximized_vert,maximized_horz
await "the window manager maximises" maximized
close
start
await "it comes up maximised" maximized
close
start
await "it comes up maximised again" maximized
wmctrl -i -r "$main" -b remove,maximized_vert,maximized_horz
await "it is restored" restored
await "it goes back to where it was before" frame_is "$place"
close

# drag_bar X Y: takes the tool bar's grip, at its left end below caption and menu, to a point inside the frame.
drag_bar() {
    local X=0 Y=0 WIDTH=0 HEIGHT=0 i
    eval "$(inside)"
    xdotool mousemove $((X + 10)) $((Y + 62)) mousedown 1
    for i in 1 2 3 4 5 6; do
        xdotool mousemove $((X + 10 + ($1 - 10) * i / 6)) $((Y + 62 + ($2 - 62) * i / 6))
    done
    xdotool mouseup 1
}
start
drag_bar 8 250
close
bar_is "the tool bar was dragged to the left" MRUDockID 59420
start
close
bar_is "it comes back at the left" MRUDockID 59420
"$settings" set "$key\\ControlBar-Bar0" MRUDockID 59422
start
close
bar_is "it comes back at the bottom" MRUDockID 59422

"$settings" set "$key\\ControlBar-Bar0" MRUDockID 59419
start
drag_bar 300 300
await "the main window keeps the keyboard" active "$main"
close
bar_is "the tool bar was dragged out" Floating 1
x=$(bar XPos) y=$(bar YPos)
start
close
bar_is "it comes back floating" Floating 1
bar_is "where it was" XPos "$x"
bar_is "where it was" YPos "$y"

# The place of the floating bar's window, as variables.
floating() {
    eval "$(xwininfo -name Toolbar | awk '/Absolute upper-left X/{print "X="$4} /Absolute upper-left Y/{print "Y="$4}
        /Width:/{print "WIDTH="$2}')"
}
start
await "it has a window of its own, with its name" titled '^Toolbar$'
X=0 Y=0 WIDTH=0
floating
xdotool mousemove $((X + WIDTH - 12)) $((Y + 10)) click 1
await "the button in its caption closes it" untitled '^Toolbar$'
active "$main" || fail "the main window keeps the keyboard"
xdotool key --clearmodifiers alt+v
xdotool key --clearmodifiers t
await "the menu brings it back" titled '^Toolbar$'
floating
fromX=$((X + 60)) fromY=$((Y + 10))
eval "$(inside)"
xdotool mousemove $fromX $fromY mousedown 1
for i in 1 2 3 4 5 6; do
    xdotool mousemove $((fromX + (X + 8 - fromX) * i / 6)) $((fromY + (Y + 250 - fromY) * i / 6))
done
xdotool mouseup 1
await "it docks where its caption was dragged to" untitled '^Toolbar$'
close
bar_is "it was docked at the left" MRUDockID 59420
"$settings" set "$key\\ControlBar-Bar0" MRUDockID 59419

start
xdotool key --clearmodifiers alt+v
xdotool key --clearmodifiers t
close
bar_is "the tool bar was hidden" Visible 0
start
close
bar_is "it stays hidden" Visible 0

"$settings" set "$key\\Settings" WindowPlacement "0,1,-1,-1,-1,-1,4000,3000,4600,3500,1280,800"
start
await "a frame off the screen comes back to it" frame_is 680,300,600,500
close
"$settings" set "$key\\Settings" WindowPlacement "damaged"
"$settings" set "$key\\ControlBar-Summary" Bars "many"
start
close
exit 0

#!/usr/bin/env bash
# A guided tour of the sample application "board", for a display that nobody watches: drives it as a user would and
# leaves pictures with an index page.
#
#   scripts/with-display.sh scripts/tour.sh PROGRAM PICTURES_DIR [ARGUMENT...]
#
# The arguments are the drawings to open instead of those that come with the program. Needs xdotool and ImageMagick.
set -euo pipefail

if [ $# -lt 2 ]; then
    echo "usage: scripts/tour.sh PROGRAM PICTURES_DIR [ARGUMENT...]" >&2
    exit 2
fi
program=$(realpath "$1")
mkdir -p "$2"
pictures=$(realpath "$2")
shift 2
root=$(cd "$(dirname "$0")/.." && pwd)
limit=30 # seconds that anything may take

work=$(mktemp -d "${TMPDIR:-/tmp}/tvx-tour.XXXXXX")
process='' number=0
stop() {
    if [ -n "$process" ]; then kill "$process" 2>/dev/null || true; fi
    rm -rf "$work"
}
trap stop EXIT
export HOME="$work/home" XDG_RUNTIME_DIR="$work"
mkdir -p "$HOME"

fail() {
    import -window root "$pictures/failed.png" 2>/dev/null || true
    echo "tour: $1 (see $pictures/failed.png)" >&2
    exit 1
}

# The tour changes drawings, so it works with copies.
drawings=("$@")
if [ ${#drawings[@]} -eq 0 ]; then
    cp "$root"/samples/board/drawings/*.brd "$work/"
    drawings=("$work/bench.brd" "$work/gearbox.brd")
fi

start() {
    "$program" "$@" &
    process=$!
}

# Waits for a window whose title matches $1, gives it the keyboard and leaves its number in $window.
window=''
await() {
    window=$(timeout "$limit" xdotool search --sync --onlyvisible --name "$1" | tail -n 1) || fail "no window \"$1\""
    timeout "$limit" xdotool windowactivate --sync "$window" || fail "window \"$1\" does not become active"
}

# Answers boxes with Enter until the program has ended: several faults are shown one after the other.
answer() {
    local end=$((SECONDS + limit))
    while kill -0 "$process" 2>/dev/null; do
        [ $SECONDS -lt $end ] || fail "the program does not end"
        window=$(xdotool search --onlyvisible --name 'Board' 2>/dev/null | tail -n 1) || true
        if [ -n "$window" ]; then xdotool windowactivate --sync "$window" key Return 2>/dev/null || true; fi
    done
    wait "$process" || true
    process=''
}

# Waits until the program has ended.
ended() {
    timeout "$limit" tail --pid="$process" -f /dev/null || fail "the program does not end"
    wait "$process" || true
    process=''
}

screen() {
    import -window root "$1"
    convert "$1" -depth 8 RGB:- | sha256sum
}

# picture NAME TEXT: waits until the screen shows something new and has come to rest, and keeps it.
shown=''
printf '<!doctype html>\n<html lang="en"><meta charset="utf-8"><title>Board: a guided tour</title>\n' >"$work/index.html"
printf '<style>body{font:16px/1.5 sans-serif;max-width:1000px;margin:2em auto;color:#222}img{max-width:100%%;border:1px solid #ccc}</style>\n' >>"$work/index.html"
printf '<h1>Board: a guided tour</h1>\n' >>"$work/index.html"
picture() {
    local before='' now file end=$((SECONDS + limit))
    number=$((number + 1))
    file=$(printf '%02d-%s.png' "$number" "$1")
    while now=$(screen "$pictures/$file"); [ "$now" != "$before" ] || [ "$now" = "$shown" ]; do
        [ $SECONDS -lt $end ] || fail "nothing new to see for \"$1\""
        before=$now
    done
    shown=$now
    printf '<h2>%d. %s</h2>\n<p><img src="%s" alt="%s"></p>\n' "$number" "$2" "$file" "$2" >>"$work/index.html"
}

# drag X1 Y1 X2 Y2: in percent of the main window. The release waits until the press has been seen to arrive: the display
# loses one now and then that comes while the window manager still holds the press.
drag() {
    local X=0 Y=0 WIDTH=0 HEIGHT=0 before end=$((SECONDS + limit))
    eval "$(xdotool getwindowgeometry --shell "$main" | grep -E '^(X|Y|WIDTH|HEIGHT)=')"
    at() { echo "$((X + WIDTH * $1 / 100)) $((Y + HEIGHT * $2 / 100))"; }
    # shellcheck disable=SC2046
    xdotool mousemove $(at "$1" "$2") mousedown 1
    before=$(screen "$work/drag.png")
    # shellcheck disable=SC2046
    xdotool mousemove $(at $((($1 + $3) / 2)) $((($2 + $4) / 2)))
    while [ "$(screen "$work/drag.png")" = "$before" ]; do
        [ $SECONDS -lt $end ] || fail "nothing follows the mouse"
    done
    # shellcheck disable=SC2046
    xdotool mousemove $(at "$3" "$4") mouseup 1
}

start "${drawings[@]}"
await ' - Tarvex Board$' # not the splash window, which has the name alone
main=$window
picture start "The board comes up behind its splash window, with the drawings that were named on its command line."

xdotool key --clearmodifiers alt+w
picture window-menu "The Window menu lists the open drawings."
xdotool key t
picture tiled "Window, Tile shows all drawings at once."

xdotool key --clearmodifiers ctrl+3
drag 62 62 82 86
picture draw "An ellipse was drawn with the mouse. It is selected: the handles change its size."

xdotool key --clearmodifiers ctrl+4
drag 60 60 84 88
picture line "A line across it."
xdotool key --clearmodifiers ctrl+z
picture undo "Undo took the line back."

xdotool key --clearmodifiers ctrl+shift+f
picture floating "Window, Float, or the button in its caption, gives a drawing a window of its own."
xdotool windowactivate --sync "$main" key --clearmodifiers alt+w
picture window-list "The Window menu lists it beside those that are docked; Dock All brings it back."
xdotool key d
picture docked "It is docked again."

xdotool key --clearmodifiers alt+d
picture menu "The Draw menu: tools, colours and fills."
xdotool key Escape Escape

xdotool key --clearmodifiers alt+h
picture help-menu "The Help menu."
xdotool key a
await 'About'
picture about "The About box."
xdotool key Return

again() {
    timeout "$limit" xdotool windowactivate --sync "$main" || fail "the main window does not become active"
}
again
xdotool key --clearmodifiers alt+h
xdotool key s
await '^Search Help$'
xdotool type Drawing
xdotool key Return
await '^Topics Found$'
picture topics "Help, Search found several pages about a keyword. The chosen one opens in the web browser."
xdotool key Escape
again
xdotool key --clearmodifiers alt+t
xdotool key w
await '^Web Browser$'
picture web-browser "Tools, Web Browser names another browser than the desktop's."
xdotool key Escape

again
xdotool key --clearmodifiers alt+t
xdotool key k
await '^Keyboard Accelerators$'
xdotool key --clearmodifiers alt+f
xdotool type undo
xdotool key Return
picture keyboard "Tools, Keyboard gives commands other keys."
xdotool key Escape

again
xdotool key --clearmodifiers ctrl+comma
await '^Preferences$'
picture preferences "Tools, Preferences shows what can be chosen, in pages that can be searched."
xdotool key Escape
again
xdotool key --clearmodifiers ctrl+alt+p
await '^Commands$'
xdotool type bf
picture palette "The command palette finds commands by words and first letters."
xdotool key Escape

again
xdotool key --clearmodifiers alt+t
xdotool key c
await '^Console - '
xdotool type --delay 2 'draw text 20 20 200 60 "From the console" size=20'
xdotool key Return
xdotool type --delay 2 'draw circle 10 10'
xdotool key Return
xdotool key --clearmodifiers ctrl+a
xdotool type '!dra'
picture console "Tools, Console: what the menus do can be typed, and recalled. A command that fails says what it expects."

again
xdotool key --clearmodifiers alt+t
xdotool key Return
await '^Run Command$'
xdotool key --clearmodifiers ctrl+a
xdotool type 'seq -f "Meshing part %g of 8" 8'
picture run-command "Tools, Run Command asks for a program to run."
xdotool key Return
await '^seq '
picture output "Its output appears in a window of its own, which tells how the program ended."
xdotool key Escape

again
xdotool key --clearmodifiers alt+F4
picture unsaved "Closing with changes asks first."
xdotool key --clearmodifiers n
ended

start -help
await 'Board'
picture usage "board -help shows the usage summary."
answer

start -grid many -bogus
await 'Board'
picture errors "A wrong command line is explained: one fault after the other, each with its reason. This is the first."
answer

printf 'board 1\nrectangle 10 10 90 60\ncircle 10 10 40\n' >"$work/damaged.brd"
start "$work/damaged.brd"
await 'Board'
picture damaged "A damaged drawing is refused with file, line and reason."
answer

mv "$work/index.html" "$pictures/index.html"

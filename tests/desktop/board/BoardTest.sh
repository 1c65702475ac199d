#!/usr/bin/env bash
# The sample application as a user meets it under a window manager: opening a file by its name, resting on the status
# bar, drawing, saving, closing with unsaved changes.
#
#   BoardTest.sh BOARD DRAWING
set -euo pipefail
. "$(dirname "$0")/../Desktop.sh"
program=$1
file="$work/plan with blanks.brd"
cp "$2" "$file"

sum() {
    sha256sum <"$file"
}
changed() {
    [ "$(sum)" != "$before" ]
}
start() {
    begin "plan with blanks.brd - Tarvex Board" "$program" "$@"
}
picture() {
    import -window "$main" rgb:- | sha256sum
}
repainted() {
    [ "$(picture)" != "$shown" ]
}
# The release waits until the press has been seen to arrive: the display loses one now and then that comes while the
# window manager still holds the press.
draw() {
    local X=0 Y=0 WIDTH=0 HEIGHT=0
    eval "$(xdotool getwindowgeometry --shell "$main" | grep -E '^(X|Y|WIDTH|HEIGHT)=')"
    xdotool key --clearmodifiers ctrl+2
    xdotool mousemove $((X + 150)) $((Y + 200)) mousedown 1
    shown=$(picture)
    xdotool mousemove $((X + 200)) $((Y + 240))
    await "a rectangle follows the mouse" repainted
    xdotool mousemove $((X + 260)) $((Y + 280)) mouseup 1
}
tip() {
    [ "$(xdotool search --onlyvisible --class '^board$' | wc -l)" -gt 1 ]
}
noTip() {
    ! tip
}
# Leaves the pointer on the field of the pointer's position in the status bar.
hover() {
    local WIDTH=0 HEIGHT=0
    eval "$(xdotool getwindowgeometry --shell "$main" | grep -E '^(WIDTH|HEIGHT)=')"
    xdotool mousemove --window "$main" $((WIDTH - 130)) $((HEIGHT - 11))
    xdotool mousemove --window "$main" $((WIDTH - 128)) $((HEIGHT - 11))
}

before=$(sum)
start "$file"
hover
await "a field of the status bar has a tip" tip
xdotool mousemove --window "$main" 200 200
await "the tip goes when the pointer leaves" noTip
draw
xdotool key --clearmodifiers ctrl+s
await "Ctrl+S saves" changed
[ "$(grep -c '^rectangle' "$file")" -eq $(($(grep -c '^rectangle' "$2") + 1)) ] || fail "the rectangle is in the file"
xdotool key --clearmodifiers alt+F4
await "a saved drawing closes without a question" ended "$process"

before=$(sum)
start "$file"
draw
xdotool key --clearmodifiers alt+F4
await "closing with changes asks" titled "^Tarvex Board$"
focus '^Tarvex Board$' key Escape
await "Esc takes the question away" untitled "^Tarvex Board$"
ended "$process" && fail "Esc keeps the application"
xdotool windowactivate --sync "$main" key --clearmodifiers alt+F4
await "closing asks again" titled "^Tarvex Board$"
focus '^Tarvex Board$' key n
await "No ends the application" ended "$process"
changed && fail "No leaves the file as it was"
exit 0

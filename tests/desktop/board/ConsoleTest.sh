#!/usr/bin/env bash
# Tools > Console of the sample application by real keys: commands draw and save, are recalled by number, beginning and
# search, copied to a clipboard that another program reads, and found again after a restart.
#
#   ConsoleTest.sh BOARD
set -euo pipefail
. "$(dirname "$0")/../Desktop.sh"
program=$1

press() {
    xdotool key --clearmodifiers "$@"
}
enter() {
    xdotool type --clearmodifiers "$1"
    press Return
}
console() {
    begin "Tarvex Board" "$program" -nosplash
    press alt+t
    press c
    await "the console is active" titled "^Console - Tarvex Board$"
}
# shapes FILE KIND COUNT: whether a drawing has been saved with so many of a kind.
shapes() {
    [ "$(grep -c "^$2" "$1")" = "$3" ]
}
copied() {
    [ "$(xclip -selection clipboard -o | tr -d '\r')" = "$1" ]
}

console
enter "draw line 1 2 3 4"
enter "draw ellipse 10 10 50 50"
enter "!!"
enter "!1"
enter "!DRA"
enter "save $work/a.brd"
await "the drawing is saved" test -s "$work/a.brd"
shapes "$work/a.brd" line 3 || fail "a command was recalled by number and by its beginning"
shapes "$work/a.brd" ellipse 2 || fail "the last command was recalled"
# The first command, what was told about it, and the second one.
press Tab Home shift+Down shift+Down ctrl+c
await "the selected commands are on the clipboard" copied "draw line 1 2 3 4
draw ellipse 10 10 50 50"
press alt+F4
await "the application ends" ended "$process"

console
press ctrl+r
xdotool type --clearmodifiers "ell"
press Return
enter "save $work/b.brd"
await "the second drawing is saved" test -s "$work/b.brd"
shapes "$work/b.brd" ellipse 1 || fail "a command of the last start was found"
enter "new"
enter "draw line 5 6 7 8"
enter "save $work/c.brd"
await "the keyboard stays in the console when a drawing is begun" test -s "$work/c.brd"
enter "close"
enter "draw ellipse 1 2 3 4"
enter "save $work/d.brd"
await "the drawing before is worked with again" test -s "$work/d.brd"
shapes "$work/d.brd" ellipse 2 || fail "it is the second drawing"
enter "draw nothing"
press Escape
press alt+F4
await "the application ends" ended "$process"
exit 0

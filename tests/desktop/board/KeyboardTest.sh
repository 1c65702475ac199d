#!/usr/bin/env bash
# Tools > Keyboard and Tools > Command Palette of the sample application as a user without a mouse meets them: keys are
# changed for drawings that are open, for later ones and for none, and stay changed after a restart.
#
#   KeyboardTest.sh BOARD
set -euo pipefail
. "$(dirname "$0")/../Desktop.sh"
program=$1

press() {
    xdotool key --clearmodifiers "$@"
}
# appears TITLE PURPOSE: waits for a window and gives it the keyboard.
appears() {
    await "$2" titled "$1"
    focus "$1"
}
# runs PURPOSE KEY...: whether the keys open the question for a command; it is closed again.
runs() {
    press "${@:2}"
    appears "^Run Command$" "$1"
    press Escape
    await "the question is gone" untitled "^Run Command$"
    xdotool windowactivate --sync "$main"
}
keyboard() {
    press alt+t
    press k
    appears "^Keyboard Accelerators$" "the dialog appears"
}
# filter WORDS: selects the only command that has them.
filter() {
    press alt+f ctrl+a
    xdotool type --clearmodifiers "$1"
    press Return
}
accept() {
    press Return
    await "the dialog is gone" untitled "^Keyboard Accelerators$"
    xdotool windowactivate --sync "$main"
}
start() {
    begin "Tarvex Board" "$program" -nosplash
}

start
keyboard
filter "run command"
press alt+s F7 F7 space # Specify, the key twice, Assign
filter "palette"
press alt+u Home Down alt+r # Current Keys, Remove
accept
runs "the new key works" F7
runs "the removed key does nothing" ctrl+alt+p F7
titled "^Commands$" && fail "the palette has no key any more"
press ctrl+n
runs "the key works in a later drawing" F7
press ctrl+F4 ctrl+F4
press alt+f Escape Escape
runs "the key works without a drawing, after a menu" F7
press alt+t
press c
xdotool type --clearmodifiers "xnew"
press Home Delete Return
xdotool type --clearmodifiers "save $work/typed.brd"
press Return
await "Delete is no command in the console" test -s "$work/typed.brd"
xdotool type --clearmodifiers "save $work/other.brd"
press Return
await "there are two recent files" test -s "$work/other.brd"
press alt+f Escape Escape
keyboard
filter "typed.brd"
press alt+s F8 F8 space alt+c
accept
press alt+F4
await "the application ends" ended "$process"

start
press F8
await "a recent file has a key after a restart" titled "typed.brd - Tarvex Board"
runs "the key works after a restart" F7
runs "the removed key stays removed" ctrl+alt+p F7
press alt+t
press p
appears "^Commands$" "the palette opens from the menu"
xdotool type --clearmodifiers "rc"
runs "the palette runs a command by its first letters" Return
keyboard
press alt+t # Reset
accept
press ctrl+alt+p
appears "^Commands$" "the palette has its own key again"
press Escape
await "Esc closes the palette" untitled "^Commands$"
exit 0

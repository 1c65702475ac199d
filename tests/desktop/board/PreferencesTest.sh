#!/usr/bin/env bash
# Tools > Preferences of the sample applications as a user without a mouse meets them: a page is found by a word, a wrong
# number is explained and not left, Apply shows in the drawing at once, OK stores what was chosen on all pages, Cancel
# asks, and what was applied is there after a restart and is the other application's too where the family shares it.
#
#   PreferencesTest.sh BOARD NOTES TVXSETTINGS
set -euo pipefail
. "$(dirname "$0")/../Desktop.sh"
board=$1 notes=$2 settings=$3

press() {
    xdotool key --clearmodifiers "$@"
}
preferences() {
    xdotool windowactivate --sync "$main" key --clearmodifiers ctrl+comma
    focus "^Preferences$"
    sheet=$found
}
gone() {
    await "the preferences are gone" untitled "^Preferences$"
}
# asked: whether the question about changes, which has the sheet's title, has the keyboard.
asked() {
    local now
    now=$(xdotool getactivewindow)
    [ "$now" != "$sheet" ] && [ "$(xdotool getwindowname "$now")" = Preferences ]
}
# page WORDS: finds a page by words, and goes on to the tree.
page() {
    press ctrl+f ctrl+a
    xdotool type --clearmodifiers "$1"
    press Return Tab
}
copied() {
    [ "$(xclip -o -selection clipboard | tr -d '\r')" = "$1" ]
}
# copies TEXT: whether that is what is selected.
copies() {
    press ctrl+c
    copied "$1"
}
differs() {
    ! cmp -s "$1" <(import -window "$main" png:-)
}

begin "Tarvex Board" "$board" -nosplash
preferences
page "grid points"
press alt+i ctrl+a
xdotool type 5000
press alt+a
focus "^Tarvex Board$" key Return # the message about the bounds
xdotool windowactivate --sync "$sheet" key --clearmodifiers ctrl+f Escape alt+c Down # all pages; to the next one
focus "^Tarvex Board$" key Return                                                    # the same message
xdotool windowactivate --sync "$sheet"
await "the wrong number is still there, with the keyboard" copies 5000
xdotool type 60
import -window "$main" png:- >"$work/before.png"
press alt+a
await "the drawing shows the new grid" differs "$work/before.png"
xdotool windowactivate --sync "$sheet" key --clearmodifiers alt+w # hides the grid
press Escape
await "Cancel asks about changes" asked
press n
await "the question is gone" active "$sheet"
press Escape
await "Cancel asks again" asked
press y
gone
preferences
page "web browser"
press alt+w ctrl+a
xdotool type "browse %1"
page "online"
press alt+l
xdotool type "http://example.invalid"
press Return
gone
xdotool windowactivate --sync "$main" key alt+F4
await "the application ends" ended "$process"

[ "$("$settings" get 'Software\Tarvex\Common' Browser)" = "browse %1" ] || fail "the page before is stored as well"

# comesUpWith DISTANCE REASON [OPTION...]: whether the board has that distance of the grid after a start. OK changes
# nothing then.
comesUpWith() {
    begin "Tarvex Board" "$board" -nosplash "${@:3}"
    preferences
    page "grid points"
    press alt+i ctrl+a ctrl+c
    await "$2" copied "$1"
    press Return
    gone
    xdotool windowactivate --sync "$main" key alt+F4
    await "the application ends" ended "$process"
}
comesUpWith 25 "the distance of this run" -grid 25
comesUpWith 60 "the distance was kept"

begin "Tarvex Notes" "$notes" -nosplash
preferences
page "online"
press alt+l ctrl+a ctrl+c
await "the family shares where help is" copied "http://example.invalid/"
press Escape
gone
xdotool windowactivate --sync "$main" key alt+F4
await "Notes ends" ended "$process"

#!/usr/bin/env bash
# The sample application with one text at a time, as a user has it: begin, type, save under a name, end, go on where it
# was; undo, find, other files, one instance, help.
#
#   NotesTest.sh NOTES TVXSETTINGS
set -euo pipefail
. "$(dirname "$0")/../Desktop.sh"
program=$1 settings=$2
cd "$work"

press() {
    xdotool key --clearmodifiers "$@"
}
holds() { # FILE TEXT, which printf writes
    [ "$(cat "$1")" = "$(printf "$2")" ]
}
moved() {
    [ "$(xwininfo -id "$main" | awk '/Absolute upper-left X/{print $4}')" -ge "$1" ]
}
place() {
    xwininfo -id "$main" | grep -E 'Absolute|Width|Height'
}
placed() {
    [ "$(place)" = "$1" ]
}
end() {
    focus ".txt - Tarvex Notes$" key --clearmodifiers alt+F4
    await "Notes ends" ended "$process"
}

begin "^Untitled - Tarvex Notes$" "$program" -single
xdotool type "first line"
press Return
xdotool type "second"
wmctrl -i -r "$main" -e 0,130,90,520,400
await "the window manager moves the window" moved 130
press ctrl+s
focus "Save As"
xdotool type "$work/list.txt"
press Return
await "the text is saved under its name" titled "^list.txt - Tarvex Notes$"
holds list.txt 'first line\nsecond' || fail "the file holds $(cat list.txt)"
before=$(place)

# A second start of the same kind shows this one.
"$program" -single -nosplash other.txt
active "$main" || fail "the running Notes is shown"
end

# Where it was, and with the text. What is not changed stays as it is in the file, byte for byte.
printf '\xef\xbb\xbfold\xe9\r\nfirst line\rthird\n' >list.txt
begin "^list.txt - Tarvex Notes$" "$program" -nosplash list.txt
await "it comes up where it was" placed "$before"
press ctrl+Home
xdotool type "X"
press ctrl+f
focus "^Find$"
xdotool type "LINE"
press Return
await "the words are found" untitled "^Find$"
xdotool type "row"
press ctrl+z ctrl+z ctrl+z ctrl+y ctrl+y ctrl+y
press ctrl+s
await "the change alone is written" holds list.txt '\xef\xbb\xbfXold\xe9\r\nfirst row\rthird'

# Undone back to what was saved there is nothing to ask for; a refused answer keeps the text.
xdotool type "s"
press alt+F4
focus "^Tarvex Notes$" key Escape
await "the question goes" untitled "^Tarvex Notes$"
await "it stays" titled "^list.txt - Tarvex Notes$"
press ctrl+z
printf 'not mine' >list.txt
press ctrl+s
focus "^Tarvex Notes$"
press Return
await "the question goes" untitled "^Tarvex Notes$"
holds list.txt 'not mine' || fail "what another program has written stays until the user wants it replaced"
press ctrl+s
focus "^Tarvex Notes$" key alt+y
await "the text replaces it" holds list.txt '\xef\xbb\xbfXold\xe9\r\nfirst row\rthird'
printf 'PNG\0\1' >picture.png
press ctrl+o
focus "^Open$"
xdotool type "$work/picture.png"
press Return
focus "^Tarvex Notes$"
press Return
await "the message goes" untitled "^Tarvex Notes$"
await "a file that is no text leaves the present one" titled "^list.txt - Tarvex Notes$"
end
"$settings" get 'Software\Tarvex\Notes\Recent File List' File1 | grep -q 'list\.txt$' || fail "the recent file"

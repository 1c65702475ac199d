#!/usr/bin/env bash
# Help of the sample application, from real key presses to what the desktop's browser and PDF viewer are started with.
#
#   HelpTest.sh BOARD DRAWING
set -euo pipefail
. "$(dirname "$0")/../Desktop.sh"
program=$1 drawing=$2
documents=$(realpath "$TARVEX")/doc/usenglish

# stand_in NAME CODE TYPE: a program that the desktop opens documents of a type with. It writes down what it was given.
stand_in() {
    printf '#!/bin/sh\nprintf "%%s\\n" "$@" >%s/%s.new\n/usr/bin/env >%s/%s.env\n/bin/mv %s/%s.new %s/%s.arguments\n' \
        "$work" "$1" "$work" "$1" "$work" "$1" "$work" "$1" >"$work/$1"
    chmod +x "$work/$1"
    printf '[Desktop Entry]\nType=Application\nName=%s\nExec=%s --from-desktop %s\nMimeType=%s;\n' \
        "$1" "$work/$1" "$2" "$3" >"$XDG_DATA_HOME/applications/$1.desktop"
}
mkdir -p "$XDG_DATA_HOME/applications" "$XDG_CONFIG_HOME"
stand_in browser %u text/html
stand_in evince %U application/pdf
printf '[Default Applications]\ntext/html=browser.desktop\napplication/pdf=evince.desktop\n' \
    >"$XDG_CONFIG_HOME/mimeapps.list"

# opened WHAT PROGRAM ARGUMENT...: waits until a program was started, with these arguments behind the first.
opened() {
    local what=$1 name=$2 expected
    shift 2
    await "$what: $name is started" test -e "$work/$name.arguments"
    expected=$(printf '%s\n' --from-desktop "$@")
    [ "$(cat "$work/$name.arguments")" = "$expected" ] || fail "$what: $name got $(cat "$work/$name.arguments")"
    rm "$work/$name.arguments"
}
press() {
    xdotool key --clearmodifiers "$@"
}

# What this process was started with is not for the browser.
export DESKTOP_STARTUP_ID=old_TIME1 XDG_ACTIVATION_TOKEN=old
# No programs of the machine's own.
begin "plan.brd - Tarvex Board" env PATH="$work" XDG_DATA_DIRS="$work" "$program" -nosplash "$drawing"
press F1
opened "the drawing" browser "file://$documents/board/drawing.html"
id=$(sed -n 's/^DESKTOP_STARTUP_ID=//p' "$work/browser.env")
[[ $id == *_TIME[1-9]* && $id != *_TIME1 ]] || fail "the browser got the start-up id \"$id\""
! grep -q '^XDG_ACTIVATION_TOKEN=' "$work/browser.env" || fail "the browser got the token of another start"

press ctrl+o
await "the file dialog appears" titled '^Open$'
focus '^Open$'
press F1
opened "a file dialog" browser "file://$documents/board/files.html#open"
press Escape
await "the file dialog is gone" untitled '^Open$'
xdotool windowactivate --sync "$main"

press alt+t
press Return
await "Run Command appears" titled '^Run Command$'
focus '^Run Command$'
press F1
opened "a dialog" browser "file://$documents/shared/query.html"
press alt+h
opened "its Help button" browser "file://$documents/board/run.html"
press Escape
await "Run Command is gone" untitled '^Run Command$'

xdotool windowactivate --sync "$main"
press alt+d Down F1
opened "a highlighted menu item" browser "file://$documents/board/drawing.html#rectangle"
press alt+h c
opened "Help > Contents" browser "file://$documents/board/index.html"

press alt+h s
await "the search appears" titled '^Search Help$'
focus '^Search Help$'
xdotool type dRAWING # letter case does not matter
press Return
await "several topics are offered" titled '^Topics Found$'
focus '^Topics Found$'
press Down Down Return
opened "the third topic by its letters" browser "file://$documents/board/files.html"

xdotool windowactivate --sync "$main"
press shift+F1
xdotool mousemove --window "$main" 300 300 click 1
opened "help mode" browser "file://$documents/board/drawing.html"
press alt+h a
await "the About box appears" titled '^About'
focus '^About'
press F1
opened "the About box" browser "file://$documents/shared/about.html"
press Escape
await "the About box is gone" untitled '^About'
xdotool windowactivate --sync "$main"
press alt+h m
opened "Help > Software Manuals" evince "$documents/manuals.pdf"

rm "$work/browser"
press F1
await "the failure is told" titled '^Tarvex Board$'
focus '^Tarvex Board$'
press F1 Return
await "one box has told it" untitled '^Tarvex Board$'

# So the user names another browser.
stand_in other %u text/html
xdotool windowactivate --sync "$main"
press alt+t w
await "the choice of a browser appears" titled '^Web Browser$'
focus '^Web Browser$'
press ctrl+a
xdotool type "$work/other --from-desktop %1"
press Return
await "the choice is made" untitled '^Web Browser$'
xdotool windowactivate --sync "$main"
press F1
opened "the browser that was named" other "file://$documents/board/drawing.html"
press alt+F4
await "the board ends" ended "$process"

# A message about a drawing has a page of its own.
echo junk >"$work/damaged.brd"
"$program" -nosplash "$work/damaged.brd" &
process=$!
processes=("$process")
await "the message about the drawing appears" titled '^Tarvex Board$'
focus '^Tarvex Board$'
press F1
opened "a damaged drawing" other "file://$documents/board/files.html#damaged"
press Return
await "the board without a drawing ends" ended "$process"

# Without an installation the board says so when help is asked for, and not before.
unset TARVEX
begin "plan.brd - Tarvex Board" "$program" "$drawing"
active "$main" || fail "nothing stands before the board"
press F1
await "the missing package is told" titled '^Tarvex Board$'
focus '^Tarvex Board$'
press Return
await "once" untitled '^Tarvex Board$'
xdotool windowactivate --sync "$main"
press alt+F4
await "the board without help ends" ended "$process"

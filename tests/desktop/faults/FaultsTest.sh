#!/usr/bin/env bash
# What a user sees when a handler of a host fails: the reasons in message boxes that stay until they are answered, and
# the end of the application with 1.
#
#   FaultsTest.sh HOST
set -euo pipefail
host=$1
work=$(mktemp -d "${TMPDIR:-/tmp}/faults.XXXXXX")
trap 'rm -rf "$work"' EXIT
limit=30
process=''

fail() {
    import -window root "${TVX_PICTURE:-$work/failed.png}" || true
    echo "FAIL: $1" >&2
    exit 1
}
until_() {
    local what=$1 end=$((SECONDS + limit))
    shift
    until "$@" >/dev/null 2>&1; do
        [ $SECONDS -lt $end ] || fail "$what"
    done
}
window() {
    xdotool search --onlyvisible --name "$1" 2>/dev/null | tail -n 1
}
shown() {
    [ -n "$(window "$1")" ]
}
ended() {
    ! kill -0 "$process"
}
boxOrEnd() {
    ended || shown '^Tarvex faulty$'
}
gone() {
    ended || [ "$(window '^Tarvex faulty$')" != "$1" ]
}

# expect BOXES PLACE HOW [KEY]: runs the host, presses the key, answers the boxes and counts them.
expect() {
    local boxes=$1 count=0 box code=0
    "$host" "$2" "$3" 2>"$work/said" &
    process=$!
    if [ -n "${4:-}" ]; then
        until_ "$2: the main window appears" shown '^Faulty$'
        xdotool windowactivate --sync "$(window '^Faulty$')" key --clearmodifiers "$4"
    fi
    until_ "$2 $3: a box or the end" boxOrEnd
    while ! ended 2>/dev/null; do
        box=$(window '^Tarvex faulty$')
        if [ -n "$box" ]; then
            count=$((count + 1))
            xdotool windowactivate --sync "$box" key Return
            until_ "$2 $3: box $count goes when it is answered" gone "$box"
        fi
    done
    wait "$process" || code=$?
    [ "$count" -eq "$boxes" ] || fail "$2 $3: $count boxes instead of $boxes"
    [ "$code" -eq 1 ] || fail "$2 $3: the host ended with $code"
    [ ! -s "$work/said" ] || fail "$2 $3: it said: $(cat "$work/said")"
}

# The reason and the fatal message; for what has no reason, the latter alone; nothing for the framework's own.
expect 2 command standard
expect 2 command port
expect 1 command number
expect 0 command framework
expect 2 timer standard
expect 2 paint port
expect 2 key standard a
expect 2 close standard alt+F4
expect 2 box standard
exit 0

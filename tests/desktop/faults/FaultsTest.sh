#!/usr/bin/env bash
# What a user sees when a handler of a host fails: the reasons in message boxes that stay until they are answered, and
# the end of the application with 1.
#
#   FaultsTest.sh HOST
set -euo pipefail
. "$(dirname "$0")/../Desktop.sh"
host=$1
process=''

boxOrEnd() {
    ended "$process" || titled '^Tarvex faulty$'
}
gone() {
    ended "$process" || [ "$(window '^Tarvex faulty$')" != "$1" ]
}

# expect BOXES PLACE HOW [KEY]: runs the host, presses the key, answers the boxes and counts them.
expect() {
    local boxes=$1 count=0 box code=0
    "$host" "$2" "$3" 2>"$work/said" &
    process=$!
    processes=("$process")
    if [ -n "${4:-}" ]; then
        await "$2: the main window appears" titled '^Faulty$'
        focus '^Faulty$' key --clearmodifiers "$4"
    fi
    await "$2 $3: a box or the end" boxOrEnd
    while ! ended "$process"; do
        box=$(window '^Tarvex faulty$')
        if [ -n "$box" ]; then
            count=$((count + 1))
            xdotool windowactivate --sync "$box" key Return
            await "$2 $3: box $count goes when it is answered" gone "$box"
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

#!/usr/bin/env bash
# The sample application where there is no display: what needs no window works, the rest says why it does not.
#
#   NoDisplayTest.sh BOARD DRAWING
set -uo pipefail
program=$1 drawing=$2

# expect EXIT-CODE TEXT ARGUMENT...: runs the program and looks for the text in what it says.
expect() {
    local code=$1 text=$2 said result
    shift 2
    said=$("$program" "$@" 2>&1)
    result=$?
    if [ "$result" -ne "$code" ] || [[ "$said" != *"$text"* ]]; then
        printf 'FAIL: board %s: exit code %s instead of %s, or "%s" not in:\n%s\n' "$*" "$result" "$code" "$text" "$said" >&2
        exit 1
    fi
}

expect 0 "" -smoketest
expect 0 "Usage: board" -help
expect 0 "Usage: board" /help
expect 2 "not a whole number" -grid many
expect 2 "Unknown option" -bogus
expect 2 "missing.cmd" -f missing.cmd
expect 1 "There is no display" "$drawing"
expect 1 "There is no display"
exit 0

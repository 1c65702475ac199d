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
[[ $("$program" -help 2>/dev/null) == Usage:*"-f <file>"* ]] || {
    echo "FAIL: what was asked for does not go to standard output" >&2
    exit 1
}
[ -z "$("$program" -bogus 2>/dev/null)" ] || {
    echo "FAIL: what is wrong goes to standard output" >&2
    exit 1
}

# A compositor that nobody runs, then one that takes connections but that the toolkit has no plug-in for.
export WAYLAND_DISPLAY=compositor
expect 1 "There is no display" "$drawing"
exec 9< <(exec perl -MIO::Socket::UNIX -e \
    '$s = IO::Socket::UNIX->new(Local => shift, Listen => 1) or die; $| = 1; print "listens\n"; sleep 50' \
    "$XDG_RUNTIME_DIR/$WAYLAND_DISPLAY")
trap "kill $!" EXIT
read -r _ <&9 || exit 1
plugins=(/usr/lib/*/qt6/plugins/platforms/libqwayland-generic.so)
[ -e "${plugins[0]}" ] || expect 1 "qt6-wayland" "$drawing"
exit 0

#!/usr/bin/env bash
# Runs a command on a private virtual display with a window manager, and ends both with it.
#
#   scripts/with-display.sh COMMAND [ARGUMENT...]
#
# The exit code is the command's. TVX_SCREEN gives the display's size and depth (1280x800x24). The command finds the
# window manager's process in TVX_WINDOW_MANAGER, to halt it as a busy machine would.
set -euo pipefail

if [ $# -eq 0 ]; then
    echo "usage: scripts/with-display.sh COMMAND [ARGUMENT...]" >&2
    exit 2
fi

work=$(mktemp -d "${TMPDIR:-/tmp}/tvx-display.XXXXXX")
server='' manager='' command=''

stop() {
    trap '' INT TERM HUP
    # The command has a process group of its own, so that what it started goes with it.
    if [ -n "$command" ]; then kill -TERM -- "-$command" 2>/dev/null || true; fi
    if [ -n "$manager" ]; then kill "$manager" 2>/dev/null || true; fi
    if [ -n "$server" ]; then
        kill "$server" 2>/dev/null || true
        wait "$server" 2>/dev/null || true
    fi
    rm -rf "$work"
}
trap stop EXIT
trap 'exit 130' INT
trap 'exit 143' TERM
trap 'exit 129' HUP

fail() {
    echo "with-display: $1" >&2
    cat "$work"/*.log >&2 || true
    exit 1
}

mkfifo "$work/number" "$work/managed"
exec 8<>"$work/number" 9<>"$work/managed"
# The server writes its number when it takes connections. It dies with this script even when that is killed.
setpriv --pdeathsig TERM Xvfb -displayfd 8 -screen 0 "${TVX_SCREEN:-1280x800x24}" -nolisten tcp -noreset \
    >"$work/server.log" 2>&1 9>&- &
server=$!
read -r -t 30 number <&8 || fail "the virtual display did not start"
export DISPLAY=":$number"
export QT_QPA_PLATFORM=xcb
unset WAYLAND_DISPLAY XAUTHORITY

# The window manager runs its start-up command when it manages windows.
openbox --sm-disable --startup "sh -c 'echo managed >\"$work/managed\"'" >"$work/manager.log" 2>&1 8>&- 9>&- &
manager=$!
read -r -t 30 _ <&9 || fail "the window manager did not start"
exec 8>&- 9>&-
export TVX_WINDOW_MANAGER=$manager

# Job control gives the command its own process group, its standard input and undisturbed signals.
set -m
"$@" &
command=$!
set +m
code=0
wait "$command" || code=$?
exit "$code"

# What the tests share that use an application as a user does, under a window manager. To be sourced.
#
# Leaves a folder for the test's files in $work, and ends the processes whose ids are in $processes when the test ends.
limit=30 # seconds that anything may take
work=$(mktemp -d "${TMPDIR:-/tmp}/desktop.XXXXXX")
processes=()
tidy() {
    [ ${#processes[@]} -eq 0 ] || kill "${processes[@]}" 2>/dev/null || true
    rm -rf "$work"
}
trap tidy EXIT

# fail REASON: ends the test, with a picture of the screen where TVX_PICTURE names a file for it.
fail() {
    [ -z "${TVX_PICTURE:-}" ] || import -window root "$TVX_PICTURE" || true
    echo "FAIL: $1, called from line ${BASH_LINENO[*]}; active: $(xdotool getactivewindow getwindowname 2>&1)" >&2
    wmctrl -lG >&2 || true
    exit 1
}
# await REASON COMMAND...: waits for the command to succeed.
await() {
    local what=$1 end=$((SECONDS + limit))
    shift
    until "$@" >/dev/null 2>&1; do
        [ $SECONDS -lt $end ] || fail "$what"
    done
}
# window PATTERN: the id of the visible window with such a title, nothing without one.
window() {
    # The search's exit code is 1 where there is none: an answer like another, not the end of a test under "set -e".
    { xdotool search --onlyvisible --name "$1" 2>/dev/null || true; } | tail -n 1
}
# titled PATTERN: whether there is such a window; leaves it in $found. A search fails where a window ends meanwhile, so a
# second one for the same window may answer nothing.
titled() {
    found=$(window "$1")
    [ -n "$found" ]
}
# focus PATTERN [key ...]: gives the keyboard to the window with such a title, and does there what xdotool is told to.
focus() {
    await "a window \"$1\" to give the keyboard to" titled "$1"
    xdotool windowactivate --sync "$found" "${@:2}"
}
untitled() {
    [ -z "$(window "$1")" ]
}
# begin TITLE COMMAND...: starts a program and gives its window the keyboard; they are in $process and $main then.
begin() {
    local title=$1
    shift
    "$@" &
    process=$!
    processes=("$process")
    focus "$title"
    main=$found
}
# ended PROCESS
ended() {
    ! kill -0 "$1" 2>/dev/null
}
# active WINDOW: whether it is the window manager's active one.
active() {
    [ "$(xdotool getactivewindow 2>/dev/null)" = "$1" ]
}

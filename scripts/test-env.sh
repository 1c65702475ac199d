#!/usr/bin/env bash
# Runs one test program in an environment of its own: nothing of the user's is read or written, and the installation is
# that of the samples.
#
#   scripts/test-env.sh LABEL PROGRAM [ARGUMENT...]     LABEL: unit, ui, desktop, fuzz
#
# Desktop tests get a private display with a window manager, ui tests the toolkit's offscreen one, others none.
set -euo pipefail

label=$1
shift
home=$(mktemp -d "${TMPDIR:-/tmp}/tvx-test.XXXXXX")
trap 'rm -rf "$home"' EXIT
mkdir -m 700 "$home/run" "$home/tmp"

for name in ${!XDG_@} ${!TVX_@} ${!LC_@} ${!LANG@} ${!QT_@} ${!DBUS_@} ${!DESKTOP_@} ${!WAYLAND_@} \
    ${!DISPLAY@} ${!TARVEX@} ${!MYTARVEX@}; do
    [ "$name" = TVX_SCREEN ] || [ "$name" = TVX_PICTURE ] || unset "$name"
done
export HOME="$home" TMPDIR="$home/tmp" LC_ALL=C.UTF-8
export XDG_CONFIG_HOME="$home/.config" XDG_DATA_HOME="$home/.local/share" XDG_STATE_HOME="$home/.local/state"
export XDG_CACHE_HOME="$home/.cache" XDG_RUNTIME_DIR="$home/run" XDG_CONFIG_DIRS="$home/etc/xdg"
export LSAN_OPTIONS="suppressions=$(dirname "$(readlink -f "$0")")/leaks.supp:print_suppressions=0"
root=$(cd "$(dirname "$0")/.." && pwd)
export TARVEX="$root/samples/installation"
export QT_STYLE_OVERRIDE=Fusion QT_FONT_DPI=96 QT_SCALE_FACTOR=1

runner=()
case "$label" in
ui) export QT_QPA_PLATFORM=offscreen ;;
desktop)
    # Listing the tests of a program needs no display.
    case " $* " in
    *" --gtest_list_tests "*) ;;
    *) runner=("$(dirname "$0")/with-display.sh") ;;
    esac
    ;;
esac
"${runner[@]}" "$@"

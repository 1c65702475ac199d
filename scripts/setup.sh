#!/usr/bin/env bash
# Installs what this project needs from Debian 12's own packages, and only what is missing.
#
#   scripts/setup.sh GROUP...     groups: build, wayland, display, tour, test, bench, check, fuzz, coverage
#
# Runs as root or through sudo, and never asks. Installs nothing where nothing is missing.
# TVX_SKIP_SETUP=1 skips it, for systems with other package names.
set -euo pipefail

# group, package, what it is for
packages() {
    cat <<'LIST'
build    g++              C++20 compiler
build    cmake            configures the build from CMakePresets.json
build    ninja-build      runs the build
build    ccache           keeps compiled objects between builds
build    pkg-config       finds SQLite, xcb-ewmh and GLib
build    qt6-base-dev     real windows, text input and drawing behind the layer
build    libsqlite3-dev   the settings store
build    libxcb1-dev      talks to the window manager
build    libxcb-ewmh-dev  raises windows of other processes
build    libglib2.0-dev   the desktop's own reader of mimeapps.list
build    llvm             llvm-rc compiles resource scripts
wayland  qt6-wayland      the toolkit's plug-in for Wayland sessions
display  xvfb             a display where there is none
display  openbox          the window manager on that display
display  fonts-dejavu-core  the font that tests and pictures are laid out with
display  fonts-sawarabi-gothic  Japanese texts in tests and pictures; the smallest font with all of them
display  qt6-translations-l10n  the toolkit's own texts in other languages
tour     xdotool          keys and clicks of the guided tour
tour     wmctrl           finds and activates windows in the guided tour
tour     imagemagick      takes the pictures of the guided tour
test     libgtest-dev     the test programs' framework
test     xdotool          keys and clicks in desktop tests
test     wmctrl           asks the window manager in desktop tests
test     x11-xkb-utils    setxkbmap gives the display other keyboard layouts in desktop tests
test     xclip            reads the clipboard as another program in desktop tests
test     x11-utils        xprop reads window properties in desktop tests
test     imagemagick      pictures of the display in desktop tests
bench    libbenchmark-dev the benchmark programs' framework
bench    libglib2.0-dev   a peer of wildcards and help maps
bench    libreadline-dev  a peer of the console's history
check    git              lists the files to check
check    python3          the include, documentation and wording checks
check    clang-format-19  the format check; other versions format differently
check    clang-tidy-19    the lint check; older ones cannot parse the standard library's ranges
fuzz     clang-19         compiles with sanitizers; older ones cannot parse the standard library's ranges
fuzz     libclang-rt-19-dev  sanitizers and fuzzing engine of that compiler
coverage gcovr            tells which lines the tests ran
LIST
}

say() {
    printf 'set-up: %s\n' "$*"
}

if [ "${TVX_SKIP_SETUP:-0}" = 1 ]; then
    say "skipped, TVX_SKIP_SETUP is 1"
    exit 0
fi
if [ $# -eq 0 ]; then
    echo "usage: scripts/setup.sh GROUP...   groups: $(packages | awk '{print $1}' | uniq | paste -sd' ')" >&2
    exit 2
fi
for group in "$@"; do
    if ! packages | grep -q "^$group "; then
        echo "set-up: unknown group \"$group\"" >&2
        exit 2
    fi
done
if ! command -v dpkg-query >/dev/null; then
    echo "set-up: this is no Debian system. Install the equivalents of these, then set TVX_SKIP_SETUP=1:" >&2
    for group in "$@"; do packages | grep "^$group " >&2; done
    exit 1
fi

is_installed() {
    [ "$(dpkg-query -W -f='${db:Status-Status}' "$1" 2>/dev/null)" = installed ]
}

missing=()
declare -A seen=()
while read -r group package reason; do
    case " $* " in *" $group "*) ;; *) continue ;; esac
    if [ -n "${seen[$package]:-}" ] || is_installed "$package"; then continue; fi
    seen[$package]=1
    missing+=("$package")
    say "missing: $package ($reason)"
done < <(packages)

if [ ${#missing[@]} -eq 0 ]; then
    say "nothing missing for: $*"
    exit 0
fi

root=()
if [ "$(id -u)" -ne 0 ]; then
    if ! command -v sudo >/dev/null; then
        echo "set-up: neither root nor sudo here. Have somebody run: apt-get install ${missing[*]}" >&2
        exit 1
    fi
    root=(sudo)
    # Without a terminal nobody could type a password: fail at once instead of waiting for one.
    [ -t 0 ] || root=(sudo -n)
fi
apt() {
    "${root[@]}" env DEBIAN_FRONTEND=noninteractive apt-get -q -y -o Dpkg::Use-Pty=0 "$@" </dev/null
}
say "reading the package lists"
apt update >/dev/null
say "installing ${#missing[@]} packages: ${missing[*]}"
apt install --no-install-recommends "${missing[@]}"
say "done"

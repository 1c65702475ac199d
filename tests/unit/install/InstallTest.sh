#!/usr/bin/env bash
# An installed library is enough for a host: the sample application is built outside of this tree with what was installed,
# and runs, also after the installation was moved.
#
#   InstallTest.sh CMAKE BUILD_DIR SAMPLES_DIR COMPILER
set -euo pipefail
cmake=$1 build=$2 samples=$3 compiler=$4
work=$(mktemp -d "${TMPDIR:-/tmp}/install.XXXXXX")
trap 'rm -rf "$work"' EXIT

"$cmake" --install "$build" --prefix "$work/first" >"$work/log" || { cat "$work/log"; exit 1; }
mv "$work/first" "$work/moved"

mkdir -p "$work/host/samples"
cp -r "$samples/board" "$samples/family" "$work/host/samples"
cat >"$work/host/CMakeLists.txt" <<'TXT'
cmake_minimum_required(VERSION 3.25)
project(Host CXX)
find_package(Tarvex 1.0 REQUIRED)
add_subdirectory(samples/board)
TXT
"$cmake" -S "$work/host" -B "$work/out" -G Ninja -DCMAKE_CXX_COMPILER="$compiler" -DCMAKE_PREFIX_PATH="$work/moved" \
    -DCMAKE_BUILD_TYPE=Debug >"$work/log" 2>&1 && "$cmake" --build "$work/out" >>"$work/log" 2>&1 || {
    cat "$work/log"
    exit 1
}
"$work/out/samples/board/board" -smoketest
# The texts come from the host, the library and the layer, in the user's language.
code=0
said=$(LC_ALL=de_DE.UTF-8 "$work/out/samples/board/board" -grid many 2>&1) || code=$?
[ "$code" -eq 2 ] || { echo "FAIL: exit code $code of a wrong command line"; exit 1; }
[[ "$said" == *"Abstand der Rasterpunkte"* ]] || { echo "FAIL: not in German: $said"; exit 1; }

ldd "$work/out/samples/board/board" | grep -F "$work/moved/lib" >/dev/null || { echo "FAIL: not the installed library"; exit 1; }
module=$(find "$work/moved" -path '*/tarvex/uxtheme.so')
ldd "$module" | grep -F "$work/moved/lib" >/dev/null || { echo "FAIL: visual styles without the library"; exit 1; }
for tool in tvxsettings tvxopen helpmapcheck; do
    "$work/moved/bin/$tool" --help >/dev/null
    [ -s "$work/moved/share/man/man1/$tool.1" ] || { echo "FAIL: no manual page of $tool"; exit 1; }
done
# The desktop's viewer is called through the helper that was installed.
mkdir -p "$work/data/applications"
printf '[Desktop Entry]\nType=Application\nName=x\nExec=true %%f\nMimeType=application/pdf;\n' \
    >"$work/data/applications/x.desktop"
printf '[MIME Cache]\napplication/pdf=x.desktop;\n' >"$work/data/applications/mimeinfo.cache"
command=$(XDG_DATA_HOME="$work/data" "$work/moved/bin/tvxsettings" get \
    'HKCR\tarvex.desktop.application-pdf\shell\open\command' @)
[ "$command" = "$work/moved/bin/tvxopen --names true {} \"%1\"" ] || { echo "FAIL: answered $command"; exit 1; }
"$work/moved/bin/tvxopen" true /x.pdf

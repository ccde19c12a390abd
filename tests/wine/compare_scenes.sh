#!/bin/sh
# Draws the same scenes with the real graphics interface (under Wine) and in memory, and compares them pixel by pixel.
# compare_scenes.sh [ROUNDS]   Needs gdi_scenes of the preset win64 and compare_scenes of native-release.
# Ends with status 0 when no scene differs; pictures of those that do are left in build/scenes/differing.
set -eu
root=$(cd "$(dirname "$0")/../.." && pwd)
rounds=${1:-4}
out=$root/build/scenes
rm -rf "$out"
mkdir -p "$out/differing"
: "${WINEPREFIX:=$root/build/wineprefix}"
export WINEPREFIX WINEDEBUG=-all
display=
[ -n "${DISPLAY:-}" ] || display='xvfb-run -a'
# shellcheck disable=SC2086 -- a command and its option, or nothing
$display wine "$root/build/win64/tests/wine/gdi_scenes.exe" "Z:$out/real.bin" "$rounds" 2>"$out/wine.log" ||
  { cat "$out/wine.log" >&2; exit 2; }
"$root/build/native-release/tests/compare_scenes" "$out/real.bin" "$rounds" "$out/differing"

#!/bin/sh
# Draws the same scenes with the real graphics interface (under Wine) and in memory, and compares them.
# compare_scenes.sh [ROUNDS]   needs the presets win64 and native-release built: gdi_scenes and compare_scenes
set -eu
root=$(cd "$(dirname "$0")/../.." && pwd)
rounds=${1:-4}
out=$root/build/scenes
mkdir -p "$out/differing"
: "${WINEPREFIX:=$root/build/wineprefix}"
export WINEPREFIX WINEDEBUG=-all
xvfb-run -a wine "$root/build/win64/tests/wine/gdi_scenes.exe" "Z:$out/real.bin" "$rounds" 2>/dev/null
"$root/build/native-release/tests/compare_scenes" "$out/real.bin" "$rounds" "$out/differing"

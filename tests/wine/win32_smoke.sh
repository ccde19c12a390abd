#!/usr/bin/env bash
# The 32-bit control, called: registered, driven by a script, its type library read by a 32-bit program. Wine's 64-bit
# build runs 32-bit programs once it has their system libraries; these are fetched from the package archive into build/
# and installed nowhere. Pictures are not looked at: nothing can be drawn that way. Where the libraries cannot be had,
# one line says so and nothing is counted. Ends with "N passed, N failed". Runs inside a session with a display.
set -uo pipefail
root=$(cd "$(dirname "$0")/../.." && pwd)
: "${DISPLAY:?run inside xvfb-run}"
here=$root/tests/wine
place=$root/build/wine32
out=$place/out
passed=0
failed=0
mkdir -p "$place"
rm -rf "$out"
mkdir "$out"

finish() {
  printf '%d passed, %d failed\n' "$passed" "$failed"
  [ "$failed" -eq 0 ]
  exit
}
skip() {
  echo "skipped: the 32-bit control is not called: $1"
  finish
}
judge() {
  if [ "$1" -eq 0 ]; then echo "ok $2"; passed=$((passed + 1)); else echo "not ok $2"; failed=$((failed + 1)); fi
}
windows_path() { printf 'Z:%s' "${1//\//\\}"; }

# The libraries must be of the very version of the Wine that loads them.
version=$(dpkg-query --show --showformat '${Version}' libwine 2>/dev/null) || skip "Wine is not from a package"
libraries=$place/libwine-${version//[^0-9a-zA-Z.]/-}

# Package lists of their own, so that neither root nor a second architecture of the machine is needed.
archive() {
  local seconds=$1 private
  shift
  private=(-o APT::Architecture=i386 -o APT::Architectures=i386 -o Dir::State::lists="$place/lists"
    -o Dir::Cache="$place/cache" -o Debug::NoLocking=1 -o APT::Sandbox::User="$(id -un)"
    -o Acquire::Languages=none -o Acquire::Retries=1 -o Acquire::http::Timeout=20 -o Acquire::https::Timeout=20)
  (cd "$place" && timeout "$seconds" apt-get -q "${private[@]}" "$@") >>"$place/fetch.log" 2>&1
}

fetch() {
  rm -rf "$place"/{lists,cache,unpacked,fetch.log} "$place"/libwine_*.deb
  mkdir -p "$place/lists/partial" "$place/cache/archives/partial" "$place/unpacked"
  # One list that fails does not matter when the package is in another.
  archive 90 update
  archive 180 download "libwine=$version" || return 1
  dpkg-deb --fsys-tarfile "$place"/libwine_*.deb |
    tar -x -C "$place/unpacked" ./usr/lib/i386-linux-gnu/wine/i386-windows || return 1
  mv "$place/unpacked/usr/lib/i386-linux-gnu/wine" "$libraries"
  rm -rf "$place"/{lists,cache,unpacked} "$place"/libwine_*.deb
}

[ -d "$libraries" ] || fetch || skip "libwine $version for i386 cannot be had; see build/wine32/fetch.log"

export WINEDLLPATH=$libraries WINEPREFIX=$place/prefix WINEARCH=win64
export WINEDEBUG=-all WINEDLLOVERRIDES='mscoree,mshtml='
# A prefix with both halves is large and quickly made.
trap 'wineserver -k >/dev/null 2>&1; wineserver -w; rm -rf "$WINEPREFIX"' EXIT
system='C:\windows\syswow64'
script() { timeout 120 wine "$system\\cscript.exe" //nologo "$(windows_path "$out/$1")" "${@:2}" 2>&1 | tr -d '\r' >"$out/$1.txt"; }
register() { timeout 60 wine "$system\\regsvr32.exe" /s "$@" "$(windows_path "$root/build/win32/frontpanels.ocx")"; }

mkdir -p "$WINEPREFIX"
timeout 180 wine wineboot -i >/dev/null 2>&1
echo 'WScript.Echo "ready"' >"$out/ready.vbs"
script ready.vbs
grep -qx ready "$out/ready.vbs.txt" || skip "this Wine does not run 32-bit programs"

register
judge $? "the 32-bit library registers"
cat "$here/checks.vbs" "$here/late_bound.vbs" >"$out/late_bound.vbs"
script late_bound.vbs "$(windows_path "$out")" without-pictures
grep -E '^not ok ' "$out/late_bound.vbs.txt"
passed=$((passed + $(grep -cE '^ok ' "$out/late_bound.vbs.txt")))
failed=$((failed + $(grep -cE '^not ok ' "$out/late_bound.vbs.txt")))
tail -n 1 "$out/late_bound.vbs.txt" | grep -qx 'script finished'
judge $? "a 32-bit script host calls it to the end of the script"
timeout 60 wine "$root/build/win32/tests/wine/describe_library.exe" "$(windows_path "$root/build/win32/frontpanels.ocx")" 2>&1 |
  tr -d '\r' | diff "$here/frontpanels_library.txt" -
judge $? "a 32-bit program reads the published type library, places of members included"
register /u
judge $? "the 32-bit library unregisters"
script late_bound.vbs "$(windows_path "$out")" without-pictures
! grep -qE '^ok |finished' "$out/late_bound.vbs.txt"
judge $? "and is not found after that"
finish

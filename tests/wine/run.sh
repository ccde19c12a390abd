#!/usr/bin/env bash
# Everything that only Windows shows, in one session under Wine: the unit tests against its run-time library, the drawing
# seam pixel by pixel, the registered control driven by a script and by a container, the workbench, the undoing of the
# registration, the library side by side and unregistered, and what the finished files import and export. Needs the
# presets native-release, win64 and win32 built.
# Ends with "N passed, N failed".
set -uo pipefail
root=$(cd "$(dirname "$0")/../.." && pwd)

if [ "${FRONTPANELS_WINE_SESSION:-}" != yes ]; then
  # One display round the whole session: a server started without one leaves a desktop that no window can be made on.
  export FRONTPANELS_WINE_SESSION=yes WINEPREFIX="$root/build/wine" WINEDEBUG=-all WINEDLLOVERRIDES='mscoree,mshtml='
  wineserver -k >/dev/null 2>&1
  mkdir -p "$WINEPREFIX"
  exec xvfb-run -a -s '-screen 0 2560x1920x24' bash "$0" "$@"
fi

here=$root/tests/wine
library=$root/build/win64/frontpanels.ocx
out=$root/build/wine-tests
rm -rf "$out"
mkdir -p "$out"
passed=0
failed=0

ok() { echo "ok $*"; passed=$((passed + 1)); }
not_ok() { echo "not ok $*"; failed=$((failed + 1)); }
judge() { if [ "$1" -eq 0 ]; then ok "$2"; else not_ok "$2"; fi; }
windows_path() { printf 'Z:%s' "${1//\//\\}"; }
# Counts a part that ends with "N passed, N failed".
count() {
  local counts
  counts=$(grep -oE '^[0-9]+ passed, [0-9]+ failed' "$1" | tail -n 1)
  [ -n "$counts" ] || { not_ok "$2 ended without a result"; tail -n 5 "$1"; return; }
  # shellcheck disable=SC2086 -- the words of "N passed, N failed"
  set -- $counts
  passed=$((passed + $1))
  failed=$((failed + $3))
}

# Script hosts hide every failure behind status 0: what counts is the last line.
script() {
  cat "$here/checks.vbs" "$here/$1" >"$out/$1"
  timeout 120 wine cscript //nologo "$(windows_path "$out/$1")" "$(windows_path "$out")" >"$out/$1.txt" 2>&1
  tr -d '\r' <"$out/$1.txt" | grep -E '^(ok|not ok) '
  passed=$((passed + $(grep -cE '^ok ' "$out/$1.txt")))
  failed=$((failed + $(grep -cE '^not ok ' "$out/$1.txt")))
  tr -d '\r' <"$out/$1.txt" | tail -n 1 | grep -qx 'script finished'
  judge $? "$1 ran to its end"
}

programs=$root/build/win64/tests/wine
# program NAME EXECUTABLE ARGUMENTS...: a program that prints its checks and counts them.
program() {
  local name=$1 file=$2
  shift 2
  timeout 600 wine "$programs/$file.exe" "$@" 2>&1 </dev/null | tr -d '\r' >"$out/$name.log"
  grep -E '^(ok|not ok) ' "$out/$name.log"
  count "$out/$name.log" "$name"
}

unit_tests() {
  timeout 300 wine "$root/build/win64/tests/wine/cross_tests.exe" --gtest_brief=1 >"$out/cross_tests.txt" 2>&1
  judge $? "unit tests against the Windows run-time library ($(grep -oE '[0-9]+ tests from' "$out/cross_tests.txt" | head -n 1 | cut -d' ' -f1))"
  grep -E 'FAILED|Failure' "$out/cross_tests.txt"
}

# The fields of a panel, alone and in the registered control, at the usual scale and at a larger one, which programs
# learn with the session.
fields() {
  local dpi key='HKCU\Control Panel\Desktop' pictures=$root/build/screenshots
  mkdir -p "$pictures"
  rm -f "$pictures"/controls_*.png "$pictures"/panel_*.png "$pictures"/pilots_*.png "$pictures"/drawn_*.png
  for dpi in 144 96; do
    wine reg add "$key" /v LogPixels /t REG_DWORD /d "$dpi" /f >/dev/null 2>&1
    wineserver -k
    wineserver -w
    program "controls_$dpi" controls_test "$(windows_path "$pictures")"
    program "fields_$dpi" fields_test "$(windows_path "$pictures")"
    program "pilots_$dpi" pilots_test "$(windows_path "$pictures")"
    program "picture_$dpi" picture_test "$(windows_path "$pictures")"
    [ -s "$pictures/controls_$dpi.png" ] && [ -s "$pictures/panel_whole_$dpi.png" ] && [ -s "$pictures/pilots_four_1200_$dpi.png" ]
    judge $? "the fields are pictured at $dpi dots an inch"
  done
}

# As their first lines say.
examples() {
  local picture=$out/example_sweep.png peak
  timeout 120 wine cscript //nologo "$(windows_path "$root/examples/sweep.vbs")" "$(windows_path "$picture")" 2>/dev/null |
    tr -d '\r' | tail -n 1 | grep -q '^picture written: '
  judge $? "the example script comes to its end"
  peak=$(python3 "$here/peak_place.py" "$picture" "$picture")
  [ "${peak:-0}" -ge 388 ] && [ "$peak" -le 394 ]  # point 200 of 512
  judge $? "its picture has the carrier in its place: $peak thousandths"
  timeout 120 wine "$root/build/win64/tests/wine/example_container.exe" 5 2>/dev/null | tr -d '\r' | grep -qx '5 sweeps shown'
  judge $? "the example container shows five sweeps and ends"
  ! timeout 60 wine cscript //nologo "$(windows_path "$root/examples/sweep.vbs")" 2>/dev/null | grep -q 'picture written'
  judge $? "the example script wants the name of its picture"
}

# Everything that the machine knows about classes, as text.
export_classes() {
  wine reg export 'HKLM\Software\Classes' "$(windows_path "$out/$1.reg")" /y >/dev/null 2>&1
  iconv -f UTF-16 -t UTF-8 "$out/$1.reg" | tr -d '\r' >"$out/$1.txt"
}

# The library beside a program whose manifest names its assembly, while nothing is registered.
side_by_side() {
  local programs=$out/side_by_side
  mkdir -p "$programs"
  cp "$library" "$root/build/win64/FrontPanels.Controls.manifest" \
    "$root/build/win64/tests/wine/side_by_side_test.exe"{,.manifest} "$programs"
  program side_by_side side_by_side_test
}

# same_names WHAT KEY ATTRIBUTE MANIFEST: what the registration added under a key is what the manifest has after an
# attribute or an element.
same_names() {
  diff <(comm -13 <(sort "$out/before.txt") <(sort "$out/registered.txt") |
    sed -n "s/.*\\\\Software\\\\Classes\\\\$2\\]\$/\\1/p" | tr '[:lower:]' '[:upper:]' | sort) \
    <(grep -oE "[ <]($3)[^\"<]+" "$4" | sed 's/.*[">]//' | tr '[:lower:]' '[:upper:]' | sort)
  judge $? "$1"
}

assemblies() {
  local width architecture manifest version
  version=$(sed -n 's/^project(frontpanels VERSION \([0-9.]*\).*/\1.0/p' "$root/CMakeLists.txt")
  while read -r width architecture; do
    manifest=$root/build/win$width/FrontPanels.Controls.manifest
    same_names "the $width-bit assembly has the classes that are registered" \
      'CLSID\\\({[^}]*}\)\\InprocServer32' 'clsid="' "$manifest"
    same_names "under their names, of their version or of any" \
      '\(FrontPanels\.[^\\]*\)\\CLSID' 'progid="|progid>' "$manifest"
    same_names "and their interfaces" 'Interface\\\({[^}]*}\)\\ProxyStubClsid32' 'iid="' "$manifest"
    grep -qF "name=\"FrontPanels.Controls\" version=\"$version\" processorArchitecture=\"$architecture\"" "$manifest"
    judge $? "it is of version $version for $architecture"
  done <<<$'64 amd64\n32 x86'
}

# How a finished file is protected against faults of its own.
hardening() {
  "$1"-w64-mingw32-objdump -x "$2" | grep -oE 'HIGH_ENTROPY_VA|DYNAMIC_BASE|NX_COMPAT|large address aware|\.reloc' |
    LC_ALL=C sort -u | xargs
}

finished_files() {
  local tool file wanted strange names
  while read -r tool file wanted; do
    strange=$("$tool"-w64-mingw32-objdump -p "$root/build/$file" | sed -n 's/.*DLL Name: //p' | grep -vixE \
      '(advapi32|comctl32|comdlg32|gdi32|kernel32|msvcrt|ole32|oleacc|oleaut32|shell32|user32|windowscodecs)\.dll')
    [ -s "$root/build/$file" ] && [ -z "$strange" ]
    judge $? "$file imports system libraries only${strange:+: $strange}"
    [ "$(hardening "$tool" "$root/build/$file")" = "$wanted" ]
    judge $? "$file is hardened: $(hardening "$tool" "$root/build/$file")"
    [[ $file == *.ocx ]] || continue
    names=$("$tool"-w64-mingw32-objdump -p "$root/build/$file" | sed -n '/\[Ordinal\/Name Pointer\]/,/^$/s/.*\] *//p' | tail -n +2 | sort | tr '\n' ' ')
    [ "$names" = "DllCanUnloadNow DllGetClassObject DllInstall DllRegisterServer DllUnregisterServer " ]
    judge $? "$file exports its five functions undecorated: $names"
  done <<'TABLE'
x86_64 win64/frontpanels.ocx         .reloc DYNAMIC_BASE HIGH_ENTROPY_VA NX_COMPAT large address aware
x86_64 win64/workbench/workbench.exe .reloc DYNAMIC_BASE HIGH_ENTROPY_VA NX_COMPAT large address aware
i686   win32/frontpanels.ocx         .reloc DYNAMIC_BASE NX_COMPAT large address aware
i686   win32/workbench/workbench.exe .reloc DYNAMIC_BASE NX_COMPAT large address aware
TABLE
}

# For the current user alone; Wine keeps such classes but does not create them, so the keys are looked at.
for_one_user() {
  local key='HKCU\Software\Classes\FrontPanels.SpectrumView\CLSID' file
  file=$(windows_path "$library")
  timeout 60 wine regsvr32 /s /n /i:user "$file" && wine reg query "$key" >/dev/null 2>&1
  judge $? "registers for one user"
  timeout 60 wine regsvr32 /s /u /n /i:user "$file" && ! wine reg query "$key" >/dev/null 2>&1
  judge $? "unregisters for one user"
  ! timeout 60 wine regsvr32 /s /n /i:nobody "$file"
  judge $? "registers for nobody else"
}

# Names, numbers and places of all members, in both widths, as somebody has read and published them.
type_libraries() {
  local width
  for width in 64 32; do
    timeout 60 wine "$root/build/win64/tests/wine/describe_library.exe" \
      "$(windows_path "$root/build/win$width/frontpanels.ocx")" | tr -d '\r' >"$out/library$width.txt"
    diff "$here/frontpanels_library.txt" "$out/library$width.txt"
    judge $? "the type library of the $width-bit library is the published one"
  done
}

finished_files
timeout 180 wine wineboot -i >/dev/null 2>&1
# Wine does not always find it where Debian puts it: without it pictures of windows have letters on their buttons.
cp -n /usr/share/wine/fonts/marlett.ttf "$WINEPREFIX/drive_c/windows/Fonts/" 2>/dev/null
unit_tests
type_libraries
timeout 300 "$here/compare_scenes.sh" >"$out/scenes.txt" 2>&1
judge $? "the real and the raster graphics interface draw the same: $(tail -n 1 "$out/scenes.txt")"

timeout 60 wine regsvr32 /s /u "$(windows_path "$library")"
judge $? "unregistering what is not registered succeeds"
# In a new prefix the script host registers a library of its own when it first runs.
echo 'WScript.Echo "ready"' >"$out/ready.vbs"
timeout 60 wine cscript //nologo "$(windows_path "$out/ready.vbs")" >/dev/null 2>&1
export_classes before
timeout 60 wine regsvr32 /s "$(windows_path "$library")"
judge $? "the library registers"
export_classes registered
for name in SpectrumView SpectrumView.1 DataHub DataHub.1 Diagnostics Diagnostics.1 ResultBuffer ResultBuffer.1 \
  clsCellNameInfo clsCellNameInfo.1 Tarvex Tarvex.1; do
  grep -qF "Classes\\FrontPanels.$name\\CLSID]" "$out/registered.txt"
  judge $? "FrontPanels.$name is in the registry"
done
assemblies
script late_bound.vbs
script pilots.vbs
examples
program container container_test "$(windows_path "$out")"
program contract contract_test
program hosts hosts_test
program lives lives_test
program faults faults_test "$(windows_path "$root/build/win64/tests/wine/frontpanels_faults.ocx")"
program foreign_container contract_test atl atl.dll
program closed_loop closed_loop_test
program access access_test
fields
for part in workbench session; do
  bash "$here/$part.sh" >"$out/$part.txt" 2>&1
  grep -E '^(ok|not ok) ' "$out/$part.txt"
  count "$out/$part.txt" "the workbench's test ($part)"
done
timeout 60 wine regsvr32 /s /u "$(windows_path "$library")"
judge $? "the library unregisters"
export_classes undone
cmp -s "$out/before.txt" "$out/undone.txt"
judge $? "the registry is as it was before, key by key"
for_one_user
side_by_side
# Wine registers the type library of an interface that it has marshalled.
timeout 60 wine regsvr32 /s /u "$(windows_path "$library")"
wineserver -k >/dev/null 2>&1
timeout 900 bash "$here/win32_smoke.sh" >"$out/win32_smoke.txt" 2>&1
grep -E '^(ok|not ok|skipped)' "$out/win32_smoke.txt"
count "$out/win32_smoke.txt" "the 32-bit control"

printf '%d passed, %d failed\n' "$passed" "$failed"
[ "$failed" -eq 0 ]

#!/usr/bin/env bash
# What leaves the house: the installed library as a stranger finds it, and the ZIPs of both widths, file by file. Needs
# the presets native-release, win64 and win32 built. Ends with "N passed, N failed".
set -uo pipefail
root=$(cd "$(dirname "$0")/../.." && pwd)
here=$root/tests/package
out=$root/build/package
version=$(sed -n 's/^project(frontpanels VERSION \([0-9.]*\).*/\1/p' "$root/CMakeLists.txt")
passed=0
failed=0
rm -rf "$out"
mkdir -p "$out"
cd "$root" || exit 1

judge() {
  if [ "$1" -eq 0 ]; then echo "ok $2"; passed=$((passed + 1)); else echo "not ok $2"; failed=$((failed + 1)); fi
}

# Files of the project under folders, as far as a pattern goes: what a package must have without being told.
files_of() {
  local pattern=$1
  shift
  git ls-files --cached --others --exclude-standard -- "$@" | grep -E "$pattern"
}

# expected PLATFORM FOREIGN_ROOM RECORDINGS: the files of a package.
expected() {
  sed -n "s/^$1 *| *//p; s/^all *| *//p" "$here/files.txt"
  files_of '\.h$' platform framework traces painters entry spectrum pilot sources |
    grep -v "^platform/$2/" | sed 's|^|include/frontpanels/|'
  files_of . docs examples | sed 's|^|share/doc/frontpanels/|'
  files_of . recordings | sed "s|^|$3/|"
}

# same_files WHAT EXPECTED FOUND
same_files() {
  diff <(sort <<<"$2") <(sort <<<"$3")
  judge $? "$1"
}

# trial NAME PLACE OPTIONS...: a stranger's project is built with the package at a place.
trial() {
  local name=$1 place=$2
  shift 2
  cmake -S "$here" -B "$out/trial-$name" -G Ninja -Dfrontpanels_ROOT="$place" -DWANTED_VERSION="$version" "$@" \
    >"$out/trial-$name.log" 2>&1 && cmake --build "$out/trial-$name" >>"$out/trial-$name.log" 2>&1
}

installed_library() {
  local place=$out/moved
  cmake --install build/native-release --prefix "$out/first" >"$out/install.log" 2>&1
  mv "$out/first" "$place"
  same_files "the installed library has its files" "$(expected linux win32 share/frontpanels)" \
    "$(cd "$place" && find . -type f | sed 's|^\./||')"
  [ "$("$place/bin/fp-render" --version)" = "fp-render $version" ]
  judge $? "the installed fp-render is of version $version"
  trial native "$place" && "$out/trial-native/package_trial" >>"$out/trial-native.log" 2>&1
  judge $? "a stranger's project builds with it and draws: $(tail -n 1 "$out/trial-native.log")"
  ! trial other "$place" -DWANTED_VERSION="9.$version" && grep -q "version: $version\$" "$out/trial-other.log"
  judge $? "a project that wants another version is told the one that is there"
}

# archive WIDTH PROCESSOR
archive() {
  local width=$1 name=frontpanels-$version-win$1
  cpack --config "build/win$width/CPackConfig.cmake" -B "$out" >"$out/cpack$width.log" 2>&1
  same_files "$name.zip has its files" "$(expected windows raster bin)" \
    "$(cmake -E tar tf "$out/$name.zip" 2>/dev/null | grep -v '/$' | sed "s|^$name/||")"
  (cd "$out" && cmake -E tar xf "$name.zip")
  grep -qx "Front Panels $version, Windows, $width bit" "$out/$name/share/doc/frontpanels/PACKAGE.txt"
  judge $? "it says its version and width"
  python3 "$here/file_version.py" "$version" "$out/$name"/bin/{frontpanels.ocx,workbench.exe}
  judge $? "and so do the control and the workbench"
  trial "$width" "$out/$name" -DCMAKE_TOOLCHAIN_FILE="$root/cmake/mingw-$2.cmake" \
    -Dfrontpanels_DIR="$out/$name/lib/cmake/frontpanels"
  judge $? "a stranger's project is cross-built with it"
}

installed_library
archive 64 x86_64
archive 32 i686

printf '%d passed, %d failed\n' "$passed" "$failed"
[ "$failed" -eq 0 ]

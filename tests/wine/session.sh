#!/usr/bin/env bash
# A session of a user at the workbench: a simulated drive, a frequency typed in, markers, a peak, settings saved and
# restored by the next run, the pilot panel with a list of named cells, its bars sorted each way, exports, a capture
# recorded and played. A picture of each step is left in build/screenshots/session. Runs inside a session with a display,
# with WINEPREFIX set and the control registered. Ends with "N passed, N failed".
set -uo pipefail
root=$(cd "$(dirname "$0")/../.." && pwd)
: "${DISPLAY:?run inside xvfb-run}" "${WINEPREFIX:?the prefix to test in}"
export WINEDEBUG=-all WINEDLLOVERRIDES='mscoree,mshtml='

out=$root/build/session-test
pictures=$root/build/screenshots/session
rm -rf "$out" "$pictures"
mkdir -p "$out/exports" "$pictures"
passed=0
failed=0

ok() { echo "ok session: $*"; passed=$((passed + 1)); }
not_ok() { echo "not ok session: $*"; failed=$((failed + 1)); }
judge() { if [ "$1" -eq 0 ]; then ok "$2"; else not_ok "$2"; fi; }
windows_path() { printf 'Z:%s' "${1//\//\\}"; }

program=$(windows_path "$root/build/win64/workbench/workbench.exe")
teller=$(windows_path "$root/build/win64/tests/wine/tell_window.exe")
settings=$out/workbench.settings
exports=$out/exports
tell() { wine "$teller" FrontPanelsWorkbench "$@" 2>>"$out/teller.txt" || not_ok "the window can be told $*"; }

# Commands of the menu.
RECORD=1005; PICTURE=1006; VALUES=1007; REPORT=1008; WINDOW=1009
PILOTS=1102; STACKED=1111; SIDE_BY_SIDE=1110; MESSAGES=1114; CLOSE_PANEL=1113
SAVE=1601; IMPORT=1603; SAVE_SET_UP_2=1612; RESTORE_SET_UP_2=1622; SAVE_SET_UP_3=1613; RESTORE_SET_UP_3=1623; RIGHT_AREA=2900
STEP_BACK=1205
F7=118

# until_there COMMAND...: it succeeds within half a minute.
until_there() {
  local deadline=$((SECONDS + 30))
  until "$@" >/dev/null 2>&1; do
    [ "$SECONDS" -lt "$deadline" ] || return 1
    sleep 0.1
  done
}
newest() { find "$exports" -name "$1" -newer "$out/mark" -size +0 -print -quit | grep .; }
# export COMMAND PATTERN FILE: tells the workbench to export and takes what comes.
export_to() {
  touch -d '-1 second' "$out/mark"
  rm -f "$exports"/*
  tell "command:$1"
  until_there newest "$2" || { not_ok "$3 is exported"; return; }
  until_there pages_whole "$(newest "$2")"
  mv "$(newest "$2")" "$3"
}
# Pictures of the graphs are written by the control: a whole one ends with its last chunk.
pages_whole() { case $1 in *.png) tail -c 8 "$1" | grep -qa IEND ;; *) true ;; esac; }
step=0
picture() {
  step=$((step + 1))
  export_to "$WINDOW" 'window*.png' "$pictures/$(printf '%02d' "$step")-$1.png"
}
frame_now() {
  export_to "$VALUES" 'spectrum*.csv' "$out/now.csv" >/dev/null
  sed -n 's/^# frame: //p' "$out/now.csv" | tr -d '\r'
}
is_past() { [ "$(frame_now)" -gt "$1" ]; }
differ() { ! cmp -s "$1" "$2"; }
start() { # the workbench, played until frame 40 and paused there
  timeout 300 wine "$program" --settings "$(windows_path "$settings")" --exports "$(windows_path "$exports")" \
    --sweeps "${frames:-40}" "$@" 2>>"$out/said.txt" &
  workbench=$!
}
finish() {
  local status=0
  tell close
  wait "$workbench" || status=$?
  [ "$status" -eq 0 ]
  judge $? "$1: ends with 0 ($status)"
}
at_frame_40() { tell "command:$VALUES"; grep -qs '^# frame: 40' "$exports"/spectrum*.csv; }
played() {
  rm -f "$exports"/*
  until_there at_frame_40
  judge $? "$1: plays to frame 40"
}

# --- Sweeps as the panel asks for them
frames=4 start --simulate 3 --panels spectrum
until_there is_past 3
tell 'click:<Single>'
until_there is_past 4
judge $? "a single sweep is one: frame $(frame_now)"
tell 'click:<Cont.>'
until_there is_past 6
judge $? "continuous sweeps go on"
tell 'click:<Stop>'
stopped=$(frame_now)
[ "$(frame_now)" -eq "$stopped" ] && [ "$(grep -cE '^[0-9]' "$out/now.csv")" -eq 512 ]
judge $? "stopped at once, with a whole sweep: frame $stopped"
tell "command:$STEP_BACK"
until_there [ "$(frame_now)" -eq $((stopped - 1)) ]
judge $? "a step back is the frame before"
finish "the sweeps"
rm -f "$settings"

# --- A spectrum, its markers, and the next run
start --simulate 3 --panels spectrum
played "a simulated drive"
picture playing
tell 'type:<Span>=3M' 'type:<Center>=881.52M'
picture typed_frequency
tell "command:$SAVE_SET_UP_3"
export_to "$PICTURE" 'spectrum*.png' "$out/without.png"
tell 'click:Add' 'click:To Max'
picture marker_on_the_peak
tell "command:$RESTORE_SET_UP_3"
export_to "$PICTURE" 'spectrum*.png' "$out/without_again.png"
cmp -s "$out/without.png" "$out/without_again.png"
judge $? "a set-up without markers takes the markers away"
tell 'click:Add' 'click:To Max'
tell 'click:Delta'
picture delta_marker
export_to "$PICTURE" 'spectrum*.png' "$out/before.png"
tell "command:$SAVE" "command:$SAVE_SET_UP_2"
until_there grep -q '^\[spectrum set-up 2\]' "$settings"
judge $? "the set-up is in the settings file"
grep -qE '^13 = 881520000' "$settings" && grep -qE '^14 = 3000000' "$settings"
judge $? "with the frequency that was typed in"
tell 'click:<Uplink>'
export_to "$VALUES" 'spectrum*.csv' "$out/uplink.csv"
grep -q '^# Center frequency (Hz): 836520000' "$out/uplink.csv"
judge $? "the uplink of the channel is 45 MHz below: $(grep '^# Center' "$out/uplink.csv")"
tell 'click:<Channel>'
picture uplink_channel
tell "command:$RESTORE_SET_UP_2"
finish "the first run"

start
played "the next run, which knows the drive and the panel"
picture restored
export_to "$PICTURE" 'spectrum*.png' "$out/after.png"
cmp -s "$out/before.png" "$out/after.png"
judge $? "the graph looks as before, markers and all"
tell 'type:<Center>=900M'
export_to "$PICTURE" 'spectrum*.png' "$out/elsewhere.png"
differ "$out/elsewhere.png" "$out/after.png"
judge $? "another frequency looks otherwise"
tell "command:$RESTORE_SET_UP_2"
export_to "$PICTURE" 'spectrum*.png' "$out/set_up.png"
cmp -s "$out/before.png" "$out/set_up.png"
judge $? "the set-up brings the picture back"

# --- Pilots
tell "command:$PILOTS"
picture pilots_beside
export_to "$VALUES" 'pilots*.csv' "$out/pilots.csv"
strongest=$(awk -F, '/^# Set:/ { bars = /Top N/ } bars && NF == 8 && $1 ~ /^[0-9]/ { print int($1) }' "$out/pilots.csv" | head -n 5)
[ -n "$strongest" ]
judge $? "the exported values have the strongest pilots: "$strongest
{ printf '%s\n' $strongest | awk '{ print $1 ",Cell " NR }'; printf '7,Nowhere\n'; } >"$out/cells.txt"
tell "command:$IMPORT"
wine "$teller" '#32770' "file:$(windows_path "$out/cells.txt")" 2>>"$out/teller.txt"
judge $? "the dialog takes the list"
tell in:Pilots 'click:&User List' 'click:Cell Names'
picture imported_cells
tell "command:$SAVE_SET_UP_3" "command:$RESTORE_SET_UP_3" "command:$RESTORE_SET_UP_3"
export_to "$VALUES" 'pilots*.csv' "$out/twice.csv"
listed=$(awk -F, '/^# Set:/ { list = /User list/ } list && NF == 8 && $1 ~ /^[0-9]/' "$out/twice.csv" | wc -l)
[ "$listed" -eq "$(wc -l <"$out/cells.txt")" ]
judge $? "a set-up restored twice lists each cell once: $listed"
for order in X History 'Show Value' None Y; do
  tell in:Pilots "choose:$order"
  picture "sorted_by_${order// /_}"
done
tell in:Pilots 'click:Ascending'
picture ascending
tell in:Pilots 'choose:Delay (chips)'
picture with_delays
tell "command:$STACKED"
picture stacked
tell "command:$SIDE_BY_SIDE" "command:$RIGHT_AREA"
picture right_area_hidden
tell "command:$RIGHT_AREA"

# --- Exports and a capture
export_to "$REPORT" 'report*.html' "$out/report.html"
[ "$(grep -o '<img' "$out/report.html" | wc -l)" -eq 2 ]
judge $? "the report has both graphs"
export_to "$VALUES" 'pilots*.csv' "$out/pilots.csv"
grep -qE '^# .*881520000' "$out/pilots.csv"
judge $? "the exported pilots name their carrier"
tell "command:$RECORD" key:$F7 key:$F7 key:$F7 "command:$RECORD"
until_there grep -q '3 frames recorded' "$out/said.txt"
judge $? "three frames are recorded"
capture=$(ls "$exports"/*.fpcap)
mv "$capture" "$out/three.fpcap"
picture recorded
tell "command:$CLOSE_PANEL" "command:$MESSAGES"
picture messages
finish "the second run"

timeout 120 wine "$program" "$(windows_path "$out/three.fpcap")" --exit --screenshots "$(windows_path "$out/capture")" 2>"$out/capture.txt"
judge $? "the capture plays by itself"
[ "$(ls "$out/capture" | grep -c '^spectrum-')/$(ls "$out/capture" | grep -c '^pilots-')" = 3/3 ]
judge $? "three frames of both panels: $(ls "$out/capture" | tr '\n' ' ')"
[ ! -s "$out/capture.txt" ]
judge $? "without a word: $(cat "$out/capture.txt")"
head -c -5 "$out/three.fpcap" >"$out/cut.fpcap"
timeout 120 wine "$program" "$(windows_path "$out/cut.fpcap")" --exit --screenshots "$(windows_path "$out/cut")" 2>"$out/cut.txt"
grep -q 'cut.fpcap: cut short after frame 2' "$out/cut.txt"
judge $? "a cut capture says so: $(cat "$out/cut.txt")"

# --- Settings of another source
cp "$settings" "$out/other.settings"
timeout 120 wine "$program" "$(windows_path "$root/recordings/fm_band.csv")" --sweeps 1 --exit --settings "$(windows_path "$out/other.settings")" 2>"$out/other.txt"
grep -q '^tuned = false' "$out/other.settings" && ! grep -A 40 '^\[spectrum\]' "$out/other.settings" | grep -q '^13 = 881520000'
judge $? "another recording is not cut to the range of the drive: $(grep -A 40 '^\[spectrum\]' "$out/other.settings" | grep -m 1 '^13 = ')"
timeout 120 wine "$program" --simulate 5000000000 --sweeps 1 --exit --settings "$(windows_path "$out/seed.settings")" 2>"$out/seed.txt"
grep -q '^simulated drive = 5000000000' "$out/seed.settings"
judge $? "a seed is kept whole"

# --- Settings that cannot be used
head -c 200 "$settings" >"$out/damaged.settings"
timeout 120 wine "$program" --simulate 3 --sweeps 1 --exit --settings "$(windows_path "$out/damaged.settings")" 2>"$out/damaged.txt"
grep -q 'damaged.settings' "$out/damaged.txt" && [ -s "$out/damaged.settings.damaged-1" ] &&
  [ "$(stat -c %s "$out/damaged.settings.damaged-1")" -eq 200 ]
judge $? "a damaged settings file is named and kept: $(head -n 1 "$out/damaged.txt")"

cat "$out/teller.txt"
printf '%d passed, %d failed\n' "$passed" "$failed"
[ "$failed" -eq 0 ]

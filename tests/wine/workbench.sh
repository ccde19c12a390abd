#!/usr/bin/env bash
# The workbench, unattended: what it plays, what it leaves, and how it ends. Runs inside a session with a display and
# with WINEPREFIX set; takes the control's registration away for a moment. Ends with "N passed, N failed".
set -uo pipefail
root=$(cd "$(dirname "$0")/../.." && pwd)
: "${DISPLAY:?run inside xvfb-run}" "${WINEPREFIX:?the prefix to test in}"
export WINEDEBUG=-all WINEDLLOVERRIDES='mscoree,mshtml='

out=$root/build/workbench-test
rm -rf "$out"
mkdir -p "$out"
passed=0
failed=0

windows_path() { printf 'Z:%s' "${1//\//\\}"; }
program=$(windows_path "$root/build/win64/workbench/workbench.exe")
library=$(windows_path "$root/build/win64/frontpanels.ocx")

ok() { echo "ok $*"; passed=$((passed + 1)); }
not_ok() { echo "not ok $*"; failed=$((failed + 1)); }

# run NAME STATUS ARGUMENTS...: ends with that status; what it says is left in $out/NAME.txt.
run() {
  local name=$1 expected=$2 status=0
  shift 2
  timeout 120 wine "$program" "$@" --exit 2>"$out/$name.txt" || status=$?
  if [ "$status" -eq "$expected" ]; then ok "$name: ends with $expected"
  else not_ok "$name: ended with $status, not $expected"; sed 's/^/  /' "$out/$name.txt"; fi
}
says() {
  if grep -qF -- "$2" "$out/$1.txt"; then ok "$1: says \"$2\""; else not_ok "$1: does not say \"$2\""; fi
}
is_quiet() {
  if [ -s "$out/$1.txt" ]; then not_ok "$1: has something to say"; sed 's/^/  /' "$out/$1.txt"; else ok "$1: is quiet"; fi
}

wine regsvr32 /s "$library" || not_ok "the control can be registered"

# Three sweeps of two hops, a carrier in the first of them that moves; the name is not ASCII, and neither is the folder's.
recording="$out/Fünf Türme.csv"
for sweep in 1 2 3; do
  for hop in 0 1; do
    printf '2024-01-01, 12:00:0%d, %d, %d, 10000, 1' "$sweep" $((100000000 + hop * 1000000)) $((101000000 + hop * 1000000))
    for bin in $(seq 0 99); do
      if [ "$hop" -eq 0 ] && [ "$bin" -eq $((sweep * 20)) ]; then printf ', -20.5'; else printf ', -%d.%d' $((70 + bin % 7)) $((bin % 10)); fi
    done
    printf '\n'
  done
done >"$recording"
run plays 0 "$(windows_path "$recording")" --screenshots "$(windows_path "$out/Größe")"
is_quiet plays
judged=0
python3 "$root/tests/wine/judge_pictures.py" "$out/Größe" 3 >"$out/pictures.txt" || judged=$?
cat "$out/pictures.txt"
passed=$((passed + $(grep -c '^ok' "$out/pictures.txt")))
failed=$((failed + $(grep -c '^not ok' "$out/pictures.txt")))
# A judge that stumbles over a picture says nothing of the ones after it.
[ "$judged" -eq 0 ] || grep -q '^not ok' "$out/pictures.txt" || not_ok "the pictures could be judged"

run carried 0 --sweeps 2
is_quiet carried

{ cat "$recording"; echo 'not a row'; sed 's/12:00:0/12:00:1/' "$recording"; } >"$out/mixed.csv"
run mixed 0 "$(windows_path "$out/mixed.csv")"
says mixed 'mixed.csv: 1 row could not be read'
says mixed 'line 7: '

run missing 1 "$(windows_path "$out/nowhere.csv")"
says missing 'nowhere.csv: File not found'
: >"$out/empty.csv"
run empty 1 "$(windows_path "$out/empty.csv")"
says empty 'empty.csv: the file is empty'
head -c 3000 /dev/urandom >"$out/binary.csv"
run binary 1 "$(windows_path "$out/binary.csv")"
says binary 'binary.csv: not a recording of rtl_power or hackrf_sweep'
run no-folder 1 "$(windows_path "$recording")" --screenshots "$(windows_path "$recording")"
says no-folder 'Fünf Türme.csv'
run misspelt 2 --screenshot
says misspelt 'unknown option --screenshot'
run no-sweeps 2 --sweeps 0
says no-sweeps '--sweeps needs a number from 1'

# By hand: a user at the keys. The play stops by itself after its first sweep.
teller=$(windows_path "$root/build/win64/tests/wine/tell_window.exe")
F7=118
F8=119
SPECTRUM=1101
CLOSE_PANEL=1113
tell() { wine "$teller" "$@" 2>>"$out/teller.txt"; }
# leaves FILE WHAT: the file comes within half a minute.
leaves() {
  local deadline=$((SECONDS + 30))
  until [ -s "$hands/$1" ] || [ "$SECONDS" -ge "$deadline" ]; do sleep 0.1; done
  if [ -s "$hands/$1" ]; then ok "by hand: $2"; else not_ok "by hand: $2"; fi
}
# stands FILE PLACE WHAT: within half a minute the carrier comes to stand there, in thousandths of the graph.
stands() {
  local deadline=$((SECONDS + 30)) place=
  until [ "$((${place:-0} - $2))" -ge -6 ] && [ "$((${place:-0} - $2))" -le 6 ] || [ "$SECONDS" -ge "$deadline" ]; do
    place=$(python3 "$root/tests/wine/peak_place.py" "$hands/whole.png" "$hands/$1" 2>/dev/null) || sleep 0.1
  done
  if [ "$SECONDS" -lt "$deadline" ]; then ok "by hand: $3"; else not_ok "by hand: $3: the carrier stands at ${place:-no place}"; fi
}
hands=$out/hands
timeout 120 wine "$program" "$(windows_path "$recording")" --screenshots "$(windows_path "$hands")" --sweeps 1 \
  --settings "$(windows_path "$out/hands.settings")" &
workbench=$!
leaves spectrum-0001.png "plays as soon as it is open"
tell FrontPanelsWorkbench key:$F7
leaves spectrum-0002.png "F7 takes one sweep"

# 100 to 101.99 MHz; the carrier is at 100.2, 100.4 and 100.6 MHz.
cp "$hands/spectrum-0002.png" "$hands/whole.png"
tell FrontPanelsWorkbench 'type:<Center>=100.4M'
stands spectrum-0002.png 500 "a centre typed into the panel tunes to the carrier at once"
tell FrontPanelsWorkbench 'type:<Span>=800k'
tell FrontPanelsWorkbench 'click:<Single>'
stands spectrum-0003.png 750 "the next sweep is one of the range asked for"
tell FrontPanelsWorkbench 'click:<Single>'
stands spectrum-0001.png 250 "a single sweep at the end begins anew, in the same range"
tell FrontPanelsWorkbench key:$F8 'click:<Cont.>'
stands spectrum-0003.png 302 "begun anew it plays whole sweeps again"
rm "$hands"/*-0003.png

tell FrontPanelsWorkbench command:$CLOSE_PANEL key:$F8 key:$F7 key:$F7 key:$F7
leaves window-0003.png "steps without a panel"
[ ! -e "$hands/spectrum-0003.png" ] && ok "by hand: no panel, no picture of one" || not_ok "by hand: a picture of a closed panel"
tell FrontPanelsWorkbench command:$SPECTRUM key:$F8 key:$F7 key:$F7 key:$F7 key:$F7 key:$F7
leaves spectrum-0003.png "another panel shows what is played next"
tell FrontPanelsWorkbench close
status=0
wait "$workbench" || status=$?
[ "$status" -eq 0 ] && ok "by hand: closes" || not_ok "by hand: ended with $status"

timeout 120 wine "$program" "$(windows_path "$out/nowhere.csv")" --settings "$(windows_path "$out/alive.settings")" 2>"$out/alive.txt" &
workbench=$!
tell FrontPanelsWorkbench key:$F7 close
status=0
wait "$workbench" || status=$?
[ "$status" -eq 1 ] && ok "a missing recording: the program lives until it is closed" || not_ok "a missing recording: ended with $status"
says alive 'nowhere.csv: File not found'

wine regsvr32 /s /u "$library"
run unregistered 3
says unregistered 'FrontPanels.SpectrumView is not registered. Run: regsvr32 frontpanels.ocx'
wine regsvr32 /s "$library"

printf '%d passed, %d failed\n' "$passed" "$failed"
[ "$failed" -eq 0 ]

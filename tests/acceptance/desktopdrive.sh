#!/usr/bin/env bash
# Real windows on a screen of their own, driven by a real keyboard and mouse: start page, example,
# edit, undo, redo, preferences (dark, Italian), help, end. No window manager is needed.
#   desktopdrive.sh PROGRAM      exit code 77: skipped, what is missing is said
set -euo pipefail
program=$1
for tool in Xvfb xvfb-run xdotool; do
  command -v "$tool" > /dev/null || { echo "skipped: $tool is not installed"; exit 77; }
done
if [ "${2:-}" != inside ]; then
  exec xvfb-run -a -s "-screen 0 1400x900x24" "$0" "$program" inside
fi
home=$(mktemp -d)
trap 'kill "$pid" 2> /dev/null || true; rm -rf "$home"' EXIT
export HOME=$home XDG_CONFIG_HOME=$home/config XDG_RUNTIME_DIR=$home QT_QPA_PLATFORM=xcb
"$program" &
pid=$!

# fail MESSAGE
fail() { echo "failed: $1"; exit 1; }
# window TITLE: its number, once it is there
window() {
  for _ in $(seq 100); do
    xdotool search --onlyvisible --pid "$pid" --name "$1" 2> /dev/null | tail -1 | grep . && return
    sleep 0.2
  done
  fail "no window $1"
}
# titled WINDOW TITLE: waits for this title
titled() {
  for _ in $(seq 100); do
    [ "$(xdotool getwindowname "$1")" = "$2" ] && return
    sleep 0.2
  done
  fail "the title is $(xdotool getwindowname "$1"), not $2"
}
focus() { xdotool windowfocus "$1"; sleep 0.5; }

main=$(window qm_rps)
focus "$main"
sleep 2 # the cards of the examples
eval "$(xdotool getwindowgeometry --shell "$main")"
xdotool mousemove $((X + 380)) $((Y + 250)) click 1
titled "$main" "Untitled - qm_rps"
xdotool key ctrl+Insert
titled "$main" "Untitled* - qm_rps"
xdotool key ctrl+z
titled "$main" "Untitled - qm_rps"
xdotool key ctrl+y
titled "$main" "Untitled* - qm_rps"
xdotool key ctrl+z
titled "$main" "Untitled - qm_rps"
xdotool key ctrl+comma
preferences=$(window Preferences)
focus "$preferences"
xdotool key alt+c Down Down alt+l Down Return
sleep 1
focus "$main"
xdotool key F1
help=$(window Guida)
focus "$help"
xdotool key Escape
sleep 0.5
focus "$main"
xdotool key ctrl+q
wait "$pid" || fail "the program ended with $?"
grep -rqs "^language=it" "$home/config" || fail "the language is not kept"
grep -rqs "^theme=dark" "$home/config" || fail "the colours are not kept"
echo "driven from the start page to the end"

#!/usr/bin/env bash
# The controls as a user meets them: the demo of ControlsDemo.cpp under
# Xvfb with the SDL backend, driven by xdotool. The demo prints each outcome
# on a line of its own.
#   tests/e2e/controls.sh PATH/TO/controls_demo
set -euo pipefail

program="$(realpath "$1")"
source "$(dirname "$0")/session.sh"
start_session controls
log="$side/log"

# Say what the demo printed along with the failure.
fail() {
	echo "FAIL: $*" >&2
	echo "The demo said:" >&2
	cat "$log" >&2
	exit 1
}

# Waits for the demo to print line.
expect() {
	for _ in $(seq 100); do
		grep -qxF "$1" "$log" && return 0
		sleep 0.1
	done
	fail "no '$1'"
}

VARNEL_BACKEND=sdl "$program" >"$log" &
demo=$!
pids+=("$demo")
window="$(timeout 20 xdotool search --sync --onlyvisible --name '^Controls demo$' | head -n 1)" \
	|| fail "no demo window"
timeout 20 xdotool search --sync --onlyvisible --name '^Drop target$' >/dev/null || fail "no drop target"
xdotool windowfocus --sync "$window"
sleep 0.5

# The demo window's content starts at (40, 30) on the screen; the menu bar
# takes its first 20 rows and opens "Files" below its title, with items 17
# rows high from 3 rows down.
xdotool mousemove 55 40 click 1
sleep 0.5
xdotool mousemove 75 78 click 1
expect "menu Rename"

# A click in the upper part of the action view opens a pop-up menu under the
# pointer; a second click chooses its second item.
xdotool mousemove 140 70 click 1
sleep 0.5
xdotool mousemove 160 98 click 1
expect "popup message Second"
expect "popup returned Second"

# A press in its lower part starts a drag, dropped on the other window.
xdotool mousemove 90 120 mousedown 1
sleep 0.3
xdotool mousemove 200 120
sleep 0.2
xdotool mousemove 450 100
sleep 0.3
xdotool mouseup 1
expect "dropped move at 450,100"

# The button asks with an alert, which Enter answers with its last button.
xdotool mousemove 90 195 click 1
alert="$(timeout 20 xdotool search --sync --onlyvisible --name '^Question$' | head -n 1)" \
	|| fail "no alert"
xdotool windowfocus --sync "$alert" key Return
expect "alert answered Yes"

# Ctrl+Q chooses Quit.
xdotool windowfocus --sync "$window" key ctrl+q
for _ in $(seq 100); do
	kill -0 "$demo" 2>/dev/null || break
	sleep 0.1
done
kill -0 "$demo" 2>/dev/null && fail "the demo did not quit"
wait "$demo" || fail "the demo failed"
echo "ok"

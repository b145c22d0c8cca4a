#!/usr/bin/env bash
# The main window as a user meets it: the real program under Xvfb, driven by
# xdotool and checked by window titles, geometry and screen pixels.
#   tests/e2e/window.sh PATH/TO/varnel
set -euo pipefail

source "$(dirname "$0")/session.sh"
start_session window
# A copy of the program with no help page beside it.
mkdir -p "$side/bin"
cp "$1" "$side/bin/varnel"

VARNEL_BACKEND=sdl "$side/bin/varnel" &
program=$!
pids+=("$program")
window="$(timeout 20 xdotool search --sync --name '^Varnel' | head -n 1)" \
	|| fail "no main window"
xdotool windowfocus --sync "$window"
sleep 0.5

eval "$(xdotool getwindowgeometry --shell "$window")"
[[ "$X,$Y,$WIDTH,$HEIGHT" == "60,60,680,451" ]] \
	|| fail "window at $X,$Y size ${WIDTH}x$HEIGHT, not 60,60 680x451"
[[ "$(xdotool getwindowname "$window")" == "Varnel  (   /   )" ]] \
	|| fail "title '$(xdotool getwindowname "$window")'"

# A pixel of the screen, as "r,g,b".
pixel() {
	import -window root "$side/screen.png"
	convert "$side/screen.png" -format '%[fx:int(255*p{'"$1,$2"'}.r)],%[fx:int(255*p{'"$1,$2"'}.g)],%[fx:int(255*p{'"$1,$2"'}.b)]' info:
}
# The tree's frame starts at (0, 19) in the window: its border is green.
[[ "$(pixel 60 79)" == "0,120,80" ]] || fail "tree border is $(pixel 60 79)"
[[ "$(pixel 60 300)" == "0,120,80" ]] || fail "tree border is $(pixel 60 300)"
# The file list's frame, at (216, 19), is not focused: grey.
[[ "$(pixel 276 79)" == "205,205,205" ]] || fail "file list border is $(pixel 276 79)"

# The top-level windows on the screen, the menus' included.
windows() { xwininfo -root -children | grep -E '^ +0x' | sort; }

# Waits until a window titled title is shown (or gone, with "gone").
expect_window() {
	for _ in $(seq 50); do
		if windows | grep -qF "\"$1\""; then
			[[ "${2:-}" != gone ]] && return 0
		else
			[[ "${2:-}" == gone ]] && return 0
		fi
		sleep 0.1
	done
	fail "window '$1' not ${2:-shown}"
}

# The Files menu opens below its title, in a window of its own.
before="$(windows)"
xdotool mousemove 75 70 click 1
sleep 0.5
[[ "$(windows)" != "$before" ]] || fail "the Files menu did not open"
xdotool key Escape
sleep 0.3

# The Help menu's second item opens the About window; Enter closes it.
xdotool mousemove 120 70 click 1
sleep 0.5
xdotool key Down Down Return
expect_window "About Varnel..."
about="$(windows | grep -F '"About Varnel..."' | awk '{ print $1 }')"
xdotool windowfocus --sync "$about" key Return
expect_window "About Varnel..." gone

# Help with no page beside the program shows the alert; Enter dismisses it.
xdotool windowfocus --sync "$window"
before="$(windows)"
xdotool key ctrl+h
sleep 1
[[ "$(windows)" != "$before" ]] || fail "no alert for the missing help page"
xdotool key Return
sleep 0.5
[[ "$(windows)" == "$before" ]] || fail "the alert did not close"

# Ctrl+Q quits.
xdotool windowfocus --sync "$window" key ctrl+q
for _ in $(seq 50); do
	kill -0 "$program" 2>/dev/null || { echo "PASS"; exit 0; }
	sleep 0.1
done
fail "Ctrl+Q did not quit"

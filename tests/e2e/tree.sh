#!/usr/bin/env bash
# The folder tree as a user meets it: the real program under Xvfb on the
# machine's own volumes, driven by xdotool and checked by the window title
# and the file system.
#   tests/e2e/tree.sh PATH/TO/varnel
set -euo pipefail

program="$(realpath "$1")"
source "$(dirname "$0")/session.sh"
start_session tree
mkdir -p "$HOME/Desktop"
# The folder the test works in holds only target.
scratch="$(mktemp -d /tmp/varnel-e2e-XXXXXX)"
folders+=("$scratch")
target="$scratch/target"
mkdir -p "$target"

VARNEL_BACKEND=sdl "$program" &
pids+=($!)
window="$(timeout 20 xdotool search --sync --name '^Varnel' | head -n 1)" \
	|| fail "no main window"
xdotool windowfocus --sync "$window"

title() { xdotool getwindowname "$window"; }

# Waits for the title that shows folder.
expect_folder() {
	local wanted="Varnel  (   $1   )"
	for _ in $(seq 50); do
		[[ "$(title)" == "$wanted" ]] && return 0
		sleep 0.1
	done
	fail "title is '$(title)', not '$wanted'"
}

expect_entry() {
	for _ in $(seq 50); do
		[[ -e "$1" ]] && return 0
		sleep 0.1
	done
	fail "$1 is missing"
}

key() {
	xdotool windowfocus --sync "$window" key "$@"
	sleep 0.2
}

# Row i of level 1: the tree starts at (1, 20) in the window, rows 20 apart
# from 5, labels 57 in. Its box's centre is 30 in.
click_tree() {
	eval "$(xdotool getwindowgeometry --shell "$window")"
	xdotool mousemove "$((X + 1 + $1))" "$((Y + 20 + $2))" click 1
	sleep 0.3
}
label_of() { click_tree 60 "$((20 * $1 + 13))"; }
box_of() { click_tree 30 "$((20 * $1 + 12))"; }

# The subfolders of a folder, in the file system's order, links left out.
mapfile -t roots < <(python3 -c '
import os, sys
for e in os.scandir(sys.argv[1]):
    if e.is_dir(follow_symlinks=False): print(e.name)' /)
(( ${#roots[@]} >= 3 )) || fail "fewer than three folders in /"
row_of() {
	for i in "${!roots[@]}"; do
		[[ "${roots[$i]}" == "$1" ]] && { echo $((i + 1)); return; }
	done
	fail "no folder $1 in /"
}

# The boot volume first, selected and expanded, its folders in order.
expect_folder /
key Down
expect_folder "/${roots[0]}"
key Down
expect_folder "/${roots[1]}"
key Up
expect_folder "/${roots[0]}"
label_of 3
expect_folder "/${roots[2]}"

# A box expands without selecting; the first subfolder follows its row.
usr="$(row_of usr)"
box_of "$usr"
expect_folder "/${roots[2]}"
label_of "$usr"
expect_folder /usr
first_in_usr="$(python3 -c '
import os
print(next(e.name for e in os.scandir("/usr") if e.is_dir(follow_symlinks=False)))')"
key Down
expect_folder "/usr/$first_in_usr"
key Up Left

# Down to the scratch folder, as a user would: open /tmp, then step.
label_of "$(row_of tmp)"
expect_folder /tmp
key Right
for _ in $(seq 2000); do
	key Down
	case "$(title)" in
		"Varnel  (   $scratch   )") break ;;
		"Varnel  (   /tmp/"*) ;;
		*) fail "left /tmp before reaching $scratch" ;;
	esac
done
expect_folder "$scratch"
key Right Down
expect_folder "$target"

# New Folder, then the editor gives it its name; Escape keeps the first one.
key ctrl+n
expect_entry "$target/New Folder"
xdotool windowfocus --sync "$window" type --delay 50 "Renamed"
key Return
expect_entry "$target/Renamed"
[[ ! -e "$target/New Folder" ]] || fail "New Folder was not renamed"
# The editor took the focus with it; a click left of the rows gives it back.
click_tree 2 13
key ctrl+n
expect_entry "$target/New Folder"
key Escape
sleep 0.5
[[ -e "$target/New Folder" && ! -e "$target/New Folder 2" ]] \
	|| fail "Escape changed the new folder"
echo "PASS"

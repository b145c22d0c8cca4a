# Sourced by the end-to-end scripts: a private home and an X server of their
# own, gone with everything they started when the script ends.
#   start_session NAME   makes $side (a scratch folder holding the home),
#                        points HOME and the XDG folders there, and starts
#                        Xvfb on a free display, exported as DISPLAY.
# Add the pids of programs to stop to pids, and folders to remove to folders.

pids=()
folders=()

# The programs go before the X server they show on.
cleanup() {
	for ((i = ${#pids[@]} - 1; i >= 0; i--)); do
		kill "${pids[$i]}" 2>/dev/null || true
		wait "${pids[$i]}" 2>/dev/null || true
	done
	rm -rf "${folders[@]}"
}
trap cleanup EXIT

fail() {
	echo "FAIL: $*" >&2
	exit 1
}

start_session() {
	side="$(mktemp -d "/tmp/varnel-e2e-$1-XXXXXX")"
	folders+=("$side")
	export HOME="$side/home"
	export XDG_DATA_HOME="$HOME/.local/share" XDG_CONFIG_HOME="$HOME/.config"
	export XDG_CACHE_HOME="$HOME/.cache"
	mkdir -p "$HOME"
	Xvfb -displayfd 5 -screen 0 1024x768x24 -nolisten tcp 5>"$side/display" 2>/dev/null &
	pids+=($!)
	for _ in $(seq 100); do
		[[ -s "$side/display" ]] && break
		sleep 0.1
	done
	export DISPLAY=":$(head -n 1 "$side/display")"
}

# Sourced, inside dbus-run-session, by the scripts that run the game for a
# screen reader: a scratch folder ($work), a virtual screen ($DISPLAY) and the
# accessibility bus, all ended with the script, and fail().
#   source scripts/a11y-session.sh "<name failures are reported under>" [bus launcher options]
session_name=$1
shift
work=$(mktemp -d)
pids=()
cleanup() {
    for pid in "${pids[@]}"; do kill "$pid" 2>/dev/null || true; done
    wait 2>/dev/null || true
    rm -rf "$work"
}
trap cleanup EXIT
fail() { echo "$session_name: FAILED: $*" >&2; exit 1; }

Xvfb -displayfd 3 -screen 0 1024x768x24 -nolisten tcp 3>"$work/display" 2>"$work/xvfb.log" &
pids+=($!)
for _ in $(seq 100); do [ -s "$work/display" ] && break; sleep 0.05; done
[ -s "$work/display" ] || fail "Xvfb did not start: $(cat "$work/xvfb.log")"
export DISPLAY=":$(head -n1 "$work/display")"

/usr/libexec/at-spi-bus-launcher --launch-immediately --a11y=1 "$@" >"$work/bus.log" 2>&1 &
pids+=($!)
bus_address() { dbus-send --session --print-reply --dest=org.a11y.Bus /org/a11y/bus org.a11y.Bus.GetAddress > /dev/null 2>&1; }
for _ in $(seq 100); do bus_address && break; sleep 0.05; done
bus_address || fail "the accessibility bus did not start: $(cat "$work/bus.log")"

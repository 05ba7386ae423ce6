#!/usr/bin/env bash
# Plays one deal by keys with the Orca screen reader listening and prints what
# Orca said: the SPEECH OUTPUT lines of its debug log. Orca runs headless on a
# virtual screen with its own fresh settings; no sound device is needed.
# Not part of the test command: Orca is a large install and speaks slowly.
#
#   scripts/orca-deal.sh [path/to/vennick [log]]   (default build/check/vennick;
#                                                   the whole debug log is kept in log)
set -euo pipefail
cd "$(dirname "$0")/.."
game=$(realpath "${1:-build/check/vennick}")
log=${2:-}

if [ "${3:-}" != "--in-session" ]; then
    bash scripts/setup.sh xvfb xdotool dbus-daemon at-spi2-core python3-pyatspi orca
    # Orca will not start beside another Orca of the same user, and that one
    # is not ours to stop.
    if pgrep -u "$(id -u)" -f '/usr/bin/orca' > /dev/null; then
        echo "orca-deal: another Orca of this user is running; stop it first" >&2
        exit 1
    fi
    exec timeout --kill-after=5 180 dbus-run-session -- bash "$0" "$game" "$log" --in-session 3>&2 2>/dev/null
fi
exec 2>&3 3>&-

source scripts/a11y-session.sh "orca-deal" --screen-reader=1
mkdir "$work/orca"
orca -u "$work/orca" --debug-file "$work/orca.log" >"$work/orca.out" 2>&1 &
orca=$!
pids+=($orca)
# The game starts once Orca listens, with fresh settings.
XDG_CONFIG_HOME="$work/config" QT_QPA_PLATFORM=xcb /usr/bin/python3 tests/accessibility/play_deal.py "$game" \
    2>"$work/game.log" || fail "$(cat "$work/game.log")"
# Orca writes its log in blocks: all of it is there once Orca has ended.
kill "$orca"
for _ in $(seq 100); do kill -0 "$orca" 2>/dev/null || break; sleep 0.1; done
[ -z "$log" ] || cp "$work/orca.log" "$log"
grep -a "SPEECH OUTPUT" "$work/orca.log" | sed "s/^.*SPEECH OUTPUT: //; s/{'established': False}\$//; s/ *\$//"

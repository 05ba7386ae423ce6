#!/usr/bin/env bash
# Checks the game out of process as a screen reader sees it: a virtual screen
# (Xvfb), a session bus with the accessibility bus, the game on the xcb
# platform with fresh settings, and a pyatspi client
# (tests/accessibility/atspi_check.py). Bounded in time; every process it
# starts ends with it.
#
#   scripts/atspi-check.sh [path/to/vennick]      (default build/check/vennick)
set -euo pipefail
cd "$(dirname "$0")/.."
game=$(realpath "${1:-build/check/vennick}")

if [ "${2:-}" != "--in-session" ]; then
    need=()
    command -v Xvfb > /dev/null || need+=(xvfb)
    command -v xdotool > /dev/null || need+=(xdotool)
    command -v dbus-run-session > /dev/null || need+=(dbus-daemon)
    [ -x /usr/libexec/at-spi-bus-launcher ] || need+=(at-spi2-core)
    /usr/bin/python3 -c "import pyatspi" 2> /dev/null || need+=(python3-pyatspi)
    [ ${#need[@]} -eq 0 ] || bash scripts/setup.sh "${need[@]}"
    echo "== AT-SPI check"
    # The session bus's own complaints are left out; the check's go to fd 3.
    exec timeout --kill-after=5 60 dbus-run-session -- bash "$0" "$game" --in-session 3>&2 2>/dev/null
fi
exec 2>&3 3>&-

source scripts/a11y-session.sh "AT-SPI check"
QT_QPA_PLATFORM=xcb QT_LINUX_ACCESSIBILITY_ALWAYS_ON=1 XDG_CONFIG_HOME="$work/config" "$game" 2>"$work/game.log" &
pids+=($!)
timeout 40 /usr/bin/python3 tests/accessibility/atspi_check.py || fail "see above; the game said: $(cat "$work/game.log")"

#!/usr/bin/env bash
# Makes the README's screenshot from the real program: a game in progress on a
# virtual screen (Xvfb), played with the game's own keys (xdotool), grabbed and
# reduced to a small palette without dithering, so every pixel stays sharp.
#
#   scripts/screenshot.sh [output.png [screen size]]
#
# Defaults: resources/screenshot.png on a 1024x768 screen (scale 2). BUILD names
# the build folder (default build/release, built here when missing);
# QT_SCALE_FACTOR is passed on, to look at fractional display scaling; GRAB
# names a file for the unreduced grab as well, to measure its pixels.
set -euo pipefail
cd "$(dirname "$0")/.."
need=()
command -v Xvfb > /dev/null || need+=(xvfb)
command -v xdotool > /dev/null || need+=(xdotool)
command -v import > /dev/null || need+=(imagemagick)
bash scripts/setup.sh "${need[@]}"
out=${1:-resources/screenshot.png}
screen=${2:-1024x768}
build=${BUILD:-build/release}
if [ ! -x "$build/vennick" ]; then
    cmake -S . -B "$build" -G Ninja -DCMAKE_BUILD_TYPE=Release
    cmake --build "$build" --target vennick
fi

work=$(mktemp -d)
pids=()
cleanup() {
    for pid in "${pids[@]}"; do kill "$pid" 2>/dev/null || true; done
    rm -rf "$work"
}
trap cleanup EXIT

# Xvfb picks a free display and writes its number to the file.
Xvfb -displayfd 3 -screen 0 "${screen}x24" -nolisten tcp 3>"$work/display" 2>/dev/null &
pids+=($!)
for _ in $(seq 50); do [ -s "$work/display" ] && break; sleep 0.1; done
export DISPLAY=":$(head -n1 "$work/display")"

# Fresh settings: the default board and an empty tally, the user's own untouched.
XDG_CONFIG_HOME="$work/config" "$build/vennick" &
pids+=($!)
window=$(xdotool search --sync --onlyvisible --name '^Vennick$' | head -n1)
xdotool windowfocus --sync "$window"
sleep 1

# Deal, send the first two cards to the crib, then lay up to three cards in the play.
press() { xdotool key --delay 100 "$@"; sleep 1.5; }
press Return
press 1 2
press Return
press 1
press 2
press 3

import -window "$window" "$work/shot.png"
[ -z "${GRAB:-}" ] || cp "$work/shot.png" "$GRAB"
convert "$work/shot.png" +dither -colors 64 -strip "PNG8:$out"
echo "$out: $(identify -format '%wx%h' "$out"), $(stat -c %s "$out") bytes"

#!/usr/bin/env bash
# Builds a Release build of Vennick and starts the game.
set -euo pipefail
cd "$(dirname "$0")/.."
bash scripts/setup.sh
cmake -S . -B build/release -G Ninja -DCMAKE_BUILD_TYPE=Release
cmake --build build/release --target vennick
exec build/release/vennick "$@"

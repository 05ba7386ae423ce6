#!/usr/bin/env bash
# Builds with warnings as errors and runs the whole test suite, then builds and
# runs it again under AddressSanitizer and UndefinedBehaviorSanitizer.
set -euo pipefail
cd "$(dirname "$0")/.."
bash scripts/setup.sh
jobs=$(nproc)

cmake -S . -B build/sanitize -G Ninja -DCMAKE_BUILD_TYPE=Debug -DVENNICK_WERROR=ON -DVENNICK_SANITIZE=ON
cmake --build build/sanitize -j "$jobs"
echo "== Test suite under AddressSanitizer and UndefinedBehaviorSanitizer"
ctest --test-dir build/sanitize --output-on-failure -j "$jobs"

cmake -S . -B build/check -G Ninja -DCMAKE_BUILD_TYPE=RelWithDebInfo -DVENNICK_WERROR=ON
cmake --build build/check -j "$jobs"
echo "== Test suite"
ctest --test-dir build/check --output-on-failure -j "$jobs"
bash scripts/atspi-check.sh build/check/vennick

echo "== Installed desktop entry and AppStream metainfo"
prefix=$(mktemp -d)
trap 'rm -rf "$prefix"' EXIT
cmake --install build/check --prefix "$prefix" > /dev/null
desktop-file-validate "$prefix/share/applications/org.quorvan.Vennick.desktop"
appstreamcli validate --no-net "$prefix/share/metainfo/org.quorvan.Vennick.metainfo.xml"
for icon in "$prefix"/share/icons/hicolor/*/apps; do
    test -f "$icon/org.quorvan.Vennick.png"
done

bash scripts/check-package.sh

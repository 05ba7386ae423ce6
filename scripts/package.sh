#!/usr/bin/env bash
# Builds the Release program and the Debian package
# build/package/vennick_<version>_<arch>.deb with CPack, and checks it with
# lintian: any error or warning fails.
set -euo pipefail
cd "$(dirname "$0")/.."
# dpkg-dev: dpkg-shlibdeps and dpkg-buildflags; file: how CPack finds the binaries.
bash scripts/setup.sh dpkg-dev file lintian
build=build/package

# Debian's hardening flags (all of them); no debug information, as the binary is stripped.
export DEB_BUILD_MAINT_OPTIONS=hardening=+all DEB_CXXFLAGS_MAINT_STRIP=-g
# Only the program is built: CPack's install does not build everything first.
cmake -S . -B "$build" -G Ninja -DCMAKE_BUILD_TYPE=Release -DBUILD_TESTING=OFF -DCMAKE_SKIP_INSTALL_ALL_DEPENDENCY=ON \
    -DCMAKE_INSTALL_PREFIX=/usr -DCMAKE_INSTALL_BINDIR=games \
    -DCMAKE_CXX_FLAGS="$(dpkg-buildflags --get CPPFLAGS) $(dpkg-buildflags --get CXXFLAGS)" \
    -DCMAKE_EXE_LINKER_FLAGS="$(dpkg-buildflags --get LDFLAGS)" > /dev/null
cmake --build "$build" --target vennick
rm -f "$build"/vennick_*.deb
(cd "$build" && cpack > /dev/null)

deb=$(ls "$build"/vennick_*.deb)
echo "== lintian $deb"
lintian --fail-on error,warning "$deb"
echo "lintian: no errors, no warnings"

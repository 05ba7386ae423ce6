#!/usr/bin/env bash
# Makes the Debian package (scripts/package.sh, lintian included), installs it
# with apt-get as a player would, asks the installed program its version, finds
# its manual page, removes it and checks that none of its files is left behind.
set -euo pipefail
cd "$(dirname "$0")/.."
echo "== Debian package"
bash scripts/package.sh
deb=$(ls build/package/vennick_*.deb)
echo "$deb: $(stat -c %s "$deb") bytes"

if dpkg-query -W -f='${Status}' vennick 2>/dev/null | grep -q "install ok installed"; then
    echo "vennick is installed on this system; it is left as it is and the install is not checked"
    exit 0
fi
sudo=""
[ "$(id -u)" -eq 0 ] || sudo="sudo"

# The package's paths that are there without it: the shared folders (/usr/share, ...).
present() {
    dpkg-deb -c "$deb" | awk '{ print $6 }' | sed 's|^\.||; s|/$||' | while read -r path; do
        [ -z "$path" ] || [ ! -e "$path" ] || echo "$path"
    done
}
before=$(present)

remove() { $sudo apt-get remove -y -q vennick > /dev/null; }
trap remove EXIT
$sudo env DEBIAN_FRONTEND=noninteractive apt-get install -y -q --no-install-recommends "./$deb" > /dev/null
/usr/games/vennick --version
man -w 6 vennick
remove
trap - EXIT

if ! diff <(echo "$before") <(present); then
    echo "Left behind after apt-get remove vennick (>) or removed with it (<)" >&2
    exit 1
fi
echo "Installed, answered and removed without a trace"

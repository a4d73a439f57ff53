#!/usr/bin/env bash
# Builds pigmo_<version>_amd64.deb, installs it into this system with apt-get, uses it as a person
# would, and removes it again, with every package it pulled in: the system is left as it was.
# Run as root. Usage: scripts/deb-smoke.sh [BUILD_DIR] (default build/release)
set -euo pipefail
cd "$(dirname "$0")/.."
build=${1:-build/release}
export DEBIAN_FRONTEND=noninteractive

if dpkg-query -W -f='${Status}' pigmo 2>/dev/null | grep -q "install ok installed"; then
  echo "deb-smoke: pigmo is installed already; remove it first (apt-get purge pigmo)" >&2
  exit 1
fi

cmake -S . -B "$build" -DCMAKE_BUILD_TYPE=Release >/dev/null
cmake --build "$build" -j "$(nproc)"
rm -f "$build"/pigmo_*.deb
(cd "$build" && cpack -G DEB >/dev/null)
deb=$(realpath "$build"/pigmo_*_amd64.deb)
echo "deb-smoke: built $deb"
dpkg-deb --field "$deb" Depends
# Minimal images drop installed manuals, so the package itself is checked for them.
contents=$(dpkg-deb --contents "$deb")
for page in pigmo.1 pigmo-editor.1; do
  grep -q "/usr/share/man/man1/$page" <<<"$contents" || { echo "deb-smoke: $page is not in the package" >&2; exit 1; }
done

state=$(mktemp -d)
dpkg-query -W -f='${Package}\n' | sort >"$state/before"
cleanup() {
  apt-get purge -y -qq pigmo >/dev/null 2>&1 || true
  dpkg-query -W -f='${Package}\n' | sort >"$state/after"
  pulled=$(comm -13 "$state/before" "$state/after")
  if [ -n "$pulled" ]; then
    # shellcheck disable=SC2086
    apt-get purge -y -qq $pulled >/dev/null
    dpkg-query -W -f='${Package}\n' | sort >"$state/after"
  fi
  if ! cmp -s "$state/before" "$state/after"; then
    echo "deb-smoke: the installed packages differ from before:" >&2
    diff "$state/before" "$state/after" >&2 || true
    exit 1
  fi
  rm -rf "$state"
}
trap cleanup EXIT

apt-get install -y -qq "$deb" >/dev/null
work=$(mktemp -d)
cd "$work"
# Installed, the programs are on the path and find their palettes without help from the build tree.
run() { echo "\$ $*"; "$@"; }
run /usr/bin/pigmo --version
run /usr/bin/pigmo book >book.txt
head -n 4 book.txt
run /usr/bin/pigmo map new scene.json
run /usr/bin/pigmo map render scene.json -o preview.png --sphere
test -s preview.png
run /usr/bin/python3 -c "import pigmo; print(pigmo.lab_to_srgb((50, 0, 0)))"
cd /
rm -rf "$work"
echo "deb-smoke: passed"

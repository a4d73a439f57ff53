#!/usr/bin/env bash
# Rebuilds the shipped color books in this folder from the library's ISCC-NBS catalogue and the
# CIE test color samples of Debian's colord-data package.
set -euo pipefail
here="$(cd "$(dirname "$0")" && pwd)"
sp=/usr/share/colord/ref/CIE-TCS.sp
if [ ! -f "$sp" ]; then
  echo "Installing colord-data for $sp"
  DEBIAN_FRONTEND=noninteractive apt-get install -y -qq --no-install-recommends colord-data
fi
build="$here/../build/palettes-tool"
cmake -S "$here/.." -B "$build" -DCMAKE_BUILD_TYPE=Release -DPIGMO_BUILD_TESTS=OFF -DPIGMO_BUILD_BENCH=OFF >/dev/null
cmake --build "$build" --target pigmo_make_palettes -j "$(nproc)"
"$build/palettes/pigmo_make_palettes" "$sp" "$here"
echo "Wrote the books in $here"

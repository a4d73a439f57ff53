#!/usr/bin/env bash
# Installs the Debian 12 packages the build, the tests and the benchmarks need (run as root).
set -euo pipefail
packages=(build-essential cmake pkg-config clang libclang-rt-14-dev
  libgtest-dev libgmock-dev libbenchmark-dev liblcms2-dev
  libpugixml-dev libcli11-dev nlohmann-json3-dev libstb-dev libpng-dev
  libcairo2-dev fonts-liberation
  libgtk-4-dev xvfb xauth xdotool imagemagick
  help2man python3-numpy python3-pytest blender)
missing=()
for p in "${packages[@]}"; do
  dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q "install ok installed" || missing+=("$p")
done
if [ ${#missing[@]} -gt 0 ]; then
  echo "Installing: ${missing[*]}"
  export DEBIAN_FRONTEND=noninteractive
  apt-get update -qq
  apt-get install -y -qq --no-install-recommends "${missing[@]}"
fi

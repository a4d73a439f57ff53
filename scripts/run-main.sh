#!/usr/bin/env bash
# Installs what is missing, builds a Release copy, runs a few conversions, lists the default color book,
# then puts a Color Map with the default book in a scene, picks a color and renders its preview.
set -euo pipefail
cd "$(dirname "$0")/.."
bash scripts/install-deps.sh
cmake -S . -B build/release -DCMAKE_BUILD_TYPE=Release
cmake --build build/release -j "$(nproc)" --target pigmo_cli
pigmo=build/release/apps/cli/pigmo
out=build/main-job
mkdir -p "$out"
set -x
"$pigmo" translate lab srgb 100 0 0
"$pigmo" translate srgb lab 255 255 255
"$pigmo" translate lab lch 50 20 -30
"$pigmo" palettes
"$pigmo" book
"$pigmo" map new "$out/scene.json"
"$pigmo" map pick "$out/scene.json" 5
"$pigmo" map show "$out/scene.json"
"$pigmo" map render "$out/scene.json" -o "$out/preview.png" --sphere

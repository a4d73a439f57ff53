#!/usr/bin/env bash
# Installs what is missing, builds a Release copy, lists the palettes and the default color book, then
# puts a Color Map with the default book in a scene, picks a color, and renders its sample sphere and
# its editor panel.
set -euo pipefail
cd "$(dirname "$0")/.."
bash scripts/install-deps.sh
cmake -S . -B build/release -DCMAKE_BUILD_TYPE=Release
cmake --build build/release -j "$(nproc)" --target pigmo_cli
pigmo=build/release/apps/cli/pigmo
out=build/main-job
mkdir -p "$out"
set -x
"$pigmo" palettes
"$pigmo" book >"$out/book.txt"
head -n 12 "$out/book.txt"
"$pigmo" map new "$out/scene.json"
"$pigmo" map pick "$out/scene.json" 5
"$pigmo" map show "$out/scene.json"
"$pigmo" map render "$out/scene.json" -o "$out/preview.png" --sphere
"$pigmo" map rollout "$out/scene.json" -o "$out/panel.png"

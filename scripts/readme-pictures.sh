#!/usr/bin/env bash
# Makes the README's pictures from the shipped books: the editor panel and the sample sphere of a
# Color Map on the CIE test-color book with TCS08 picked. Usage: scripts/readme-pictures.sh [PIGMO]
set -euo pipefail
cd "$(dirname "$0")/.."
pigmo=${1:-build/release/apps/cli/pigmo}
scratch=$(mktemp -d)
trap 'rm -rf "$scratch"' EXIT
"$pigmo" map new "$scratch/scene.json" --book "palettes/Test Color Samples.cxf" --pick 7
"$pigmo" map rollout "$scratch/scene.json" -o docs/panel.png
"$pigmo" map render "$scratch/scene.json" -o docs/sphere.png --sphere --size 160

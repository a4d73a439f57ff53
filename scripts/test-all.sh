#!/usr/bin/env bash
# Installs what is missing, then builds and runs the whole suite twice:
# a Release build and a build with AddressSanitizer and UndefinedBehaviorSanitizer,
# with a bounded fuzz run between them.
set -euo pipefail
cd "$(dirname "$0")/.."
bash scripts/install-deps.sh
jobs=$(nproc)

cmake -S . -B build/release -DCMAKE_BUILD_TYPE=Release
cmake --build build/release -j "$jobs"
ctest --test-dir build/release --output-on-failure -j "$jobs"

# A short, bounded run of every fuzz target under AddressSanitizer and UndefinedBehaviorSanitizer.
bash scripts/fuzz-smoke.sh

export ASAN_OPTIONS=halt_on_error=1:detect_leaks=1
export UBSAN_OPTIONS=halt_on_error=1:print_stacktrace=1
cmake -S . -B build/sanitize -DCMAKE_BUILD_TYPE=Debug -DCMAKE_CXX_FLAGS_DEBUG="-g -O1" \
  -DPIGMO_SANITIZE=ON -DPIGMO_BUILD_BENCH=OFF
cmake --build build/sanitize -j "$jobs"
ctest --test-dir build/sanitize --output-on-failure -j "$jobs"

# The Debian package: built from the Release build, installed, tried and removed again.
bash scripts/deb-smoke.sh build/release

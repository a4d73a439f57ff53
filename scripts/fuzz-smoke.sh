#!/usr/bin/env bash
# Builds the libFuzzer targets with clang, AddressSanitizer and UndefinedBehaviorSanitizer and runs each
# one for a bounded time (FUZZ_SECONDS, default 60) from its seed corpus in tests/fuzz/corpus/<name>/.
# New inputs go to a scratch folder; the kept corpus only changes by hand.
set -euo pipefail
cd "$(dirname "$0")/.."
seconds=${FUZZ_SECONDS:-60}
build=build/fuzz
cmake -S . -B "$build" -DCMAKE_C_COMPILER=clang -DCMAKE_CXX_COMPILER=clang++ -DCMAKE_BUILD_TYPE=Debug \
  -DCMAKE_CXX_FLAGS_DEBUG="-g -O1" -DPIGMO_SANITIZE=ON -DPIGMO_BUILD_FUZZ=ON -DPIGMO_BUILD_BENCH=OFF
export ASAN_OPTIONS=halt_on_error=1:detect_leaks=1
export UBSAN_OPTIONS=halt_on_error=1:print_stacktrace=1
for corpus in tests/fuzz/corpus/*/; do
  name=$(basename "$corpus")
  cmake --build "$build" --target "fuzz_$name" -j "$(nproc)"
  scratch=$(mktemp -d)
  options=(-max_total_time="$seconds" -timeout=20 -rss_limit_mb=2560 -artifact_prefix="$build/fuzz_$name-")
  [ -f "tests/fuzz/$name.dict" ] && options+=(-dict="tests/fuzz/$name.dict")
  echo "Fuzzing $name for ${seconds}s"
  status=0
  log="$build/fuzz_$name.log"
  "$build/tests/fuzz/fuzz_$name" "${options[@]}" "$scratch" "$corpus" >"$log" 2>&1 || status=$?
  rm -rf "$scratch"
  if [ "$status" -ne 0 ]; then
    tail -n 60 "$log" >&2
    echo "fuzz_$name failed; the input is in $build/" >&2
    exit "$status"
  fi
  grep -E '^Done [0-9]+ runs' "$log" || true
done

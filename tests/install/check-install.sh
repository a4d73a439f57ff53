#!/usr/bin/env bash
# check-install.sh BUILD_DIR OUTSIDE_SOURCE CXX [CXXFLAGS]
# Installs BUILD_DIR into a scratch prefix, then builds and runs the outside program against that
# copy with pkg-config and with find_package(Pigmo); both must print the expected conversion.
set -euo pipefail
build=$1
source=$2
cxx=$3
flags=${4:-}
work=$(mktemp -d)
trap 'rm -rf "$work"' EXIT
prefix=$work/prefix
fail() { echo "install check: $*" >&2; exit 1; }

cmake --install "$build" --prefix "$prefix" >"$work/install.log" || { cat "$work/install.log" >&2; fail "cmake --install failed"; }
for f in lib/libpigmo.so bin/pigmo include/pigmo/bp.h include/pigmo/engine/ColorTranslator.h include/pigmo/engine/ColorSpaceStruct.h \
         lib/pkgconfig/pigmo.pc lib/cmake/Pigmo/PigmoConfig.cmake lib/python3/dist-packages/pigmo/__init__.py \
         share/pigmo/blender/pigmo_colormap/__init__.py share/pigmo/blender/pigmo_colormap/pigmo/__init__.py \
         share/pigmo/blender/pigmo_colormap.zip; do
  [ -e "$prefix/$f" ] || fail "$f is missing from the installed copy"
done

# Lab 100, 0, 0 (D50) to sRGB without adaptation, as the outside program prints it.
expected="0 255.00 252.27 220.85"
expect_output() {
  local got
  got=$("$1") || fail "$2: the program failed"
  [ "$got" = "$expected" ] || fail "$2: printed '$got', expected '$expected'"
}

export PKG_CONFIG_PATH=$prefix/lib/pkgconfig
# shellcheck disable=SC2046,SC2086  # the flags are word lists
"$cxx" -std=c++20 $flags "$source/main.cpp" $(pkg-config --cflags --libs pigmo) -o "$work/outside-pkgconfig" \
  || fail "the outside program does not build with pkg-config"
expect_output "$work/outside-pkgconfig" pkg-config

# The plain C interface from a C program: every export checked against known values.
# shellcheck disable=SC2046,SC2086
cc -std=c11 $flags "$(dirname "$0")/bp_exports.c" $(pkg-config --cflags --libs pigmo) -lm -o "$work/bp-exports" \
  || fail "the C program does not build against pigmo/bp.h"
"$work/bp-exports" >"$work/bp-exports.log" || { cat "$work/bp-exports.log" >&2; fail "the C program got wrong values"; }

cmake -S "$source" -B "$work/outside-cmake" -DCMAKE_PREFIX_PATH="$prefix" -DCMAKE_CXX_COMPILER="$cxx" \
  -DCMAKE_CXX_FLAGS="$flags" >"$work/cmake.log" 2>&1 || { cat "$work/cmake.log" >&2; fail "find_package(Pigmo) failed"; }
cmake --build "$work/outside-cmake" >"$work/build.log" 2>&1 || { cat "$work/build.log" >&2; fail "the outside program does not build with CMake"; }
expect_output "$work/outside-cmake/outside" find_package

got=$("$prefix/bin/pigmo" translate lab lch 50 0 -10) || fail "the installed pigmo failed"
[ "$got" = "50 10 270" ] || fail "the installed pigmo printed '$got'"
# The installed copy lists its own palettes however it is started: through PATH, or with a faked argv[0].
book="$(realpath "$prefix")/share/pigmo/Resources/System Palettes/ISCC-NBS Centroid Colors.cxf"
listed=$(env -u PIGMO_INSTALL_LOCATION PATH="$prefix/bin:$PATH" pigmo palettes) || fail "pigmo palettes failed"
[[ $listed == *"$book"* ]] || fail "pigmo started through PATH listed: $listed"
listed=$(env -u PIGMO_INSTALL_LOCATION bash -c 'exec -a /nowhere/bin/pigmo "$0" palettes' "$prefix/bin/pigmo") \
  || fail "pigmo palettes with a faked name failed"
[[ $listed == *"$book"* ]] || fail "pigmo started as /nowhere/bin/pigmo listed: $listed"

# The installed Python package loads the installed library by itself, with nothing pointing at it.
preload=""
# A sanitized library needs the sanitizer runtime, and the C++ runtime it follows exceptions in, loaded
# before Python starts.
[ -n "$flags" ] && preload="$("$cxx" -print-file-name=libasan.so) $("$cxx" -print-file-name=libstdc++.so)"
got=$(cd "$work" && env -u PIGMO_LIBRARY PYTHONPATH="$prefix/lib/python3/dist-packages" LD_PRELOAD="$preload" \
  ASAN_OPTIONS=detect_leaks=0 /usr/bin/python3 -c \
  'import pigmo; print(*(f"{v:.2f}" for v in pigmo.lab_to_srgb((50, 0, 0))), pigmo.palettes()[0].name)') \
  || fail "the installed Python package does not import"
[ "$got" = "128.20 117.56 102.04 ISCC-NBS Centroid Colors" ] || fail "the installed Python package printed '$got'"
echo "installed copy: pkg-config and find_package builds work, palettes found from the installation, Python package loads"

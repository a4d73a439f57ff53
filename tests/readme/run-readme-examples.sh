#!/usr/bin/env bash
# Installs the build into a scratch prefix and runs the README's examples against it.
# Usage: run-readme-examples.sh BUILD_DIR README
set -euo pipefail
prefix=$(mktemp -d)
trap 'rm -rf "$prefix"' EXIT
cmake --install "$1" --prefix "$prefix" >/dev/null
/usr/bin/python3 "$(dirname "$0")/readme_examples.py" "$2" "$prefix"

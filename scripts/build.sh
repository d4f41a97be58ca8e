#!/usr/bin/env bash
# Configures and builds braigrion into a build directory.
#   scripts/build.sh [BUILD_DIR] [extra cmake arguments...]
set -euo pipefail
here="$(cd "$(dirname "$0")/.." && pwd)"
dir="${1:-$here/build}"
shift || true
jobs="$(nproc 2>/dev/null || echo 2)"
launcher=()
# A compiler cache, where the machine has one, makes rebuilds in other
# build directories cheap.
command -v ccache >/dev/null 2>&1 && launcher=(-DCMAKE_CXX_COMPILER_LAUNCHER=ccache)
cmake -S "$here" -B "$dir" -G Ninja "${launcher[@]}" "$@" >/dev/null
cmake --build "$dir" -j "$jobs"

#!/usr/bin/env bash
# Installs what is needed, builds, and runs every test twice: once in a
# normal build and once under AddressSanitizer and UndefinedBehaviorSanitizer.
set -euo pipefail
here="$(cd "$(dirname "$0")/.." && pwd)"
jobs="$(nproc 2>/dev/null || echo 2)"
"$here/scripts/setup.sh" --tests

echo "== tests =="
"$here/scripts/build.sh" "$here/build-test" -DCMAKE_BUILD_TYPE=RelWithDebInfo
ctest --test-dir "$here/build-test" -j "$jobs" --output-on-failure

echo "== tests under ASan+UBSan =="
"$here/scripts/build.sh" "$here/build-asan" -DCMAKE_BUILD_TYPE=Debug -DBRAIGRION_SANITIZE=ON -DBRAIGRION_BENCH=OFF
ASAN_OPTIONS=detect_leaks=1:abort_on_error=1 UBSAN_OPTIONS=print_stacktrace=1:halt_on_error=1 \
  ctest --test-dir "$here/build-asan" -j "$jobs" --output-on-failure

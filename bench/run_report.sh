#!/usr/bin/env bash
# Report benchmark: generates a synthetic collection of N instances (with
# association instances between log records and devices), then times its
# load with the association links built and the whole HTML report of it
# (bench_report), for each N given.
#
#   bench/run_report.sh [N ...]          # default: 10000 100000 300000
#
# Environment: BUILD_DIR (default build-bench, configured Release when it
# does not exist yet), OUT_DIR (default bench/out).
# Target: the report within twice its load, peak memory within 1.5 times the
# file, and both linear in N.
set -euo pipefail

ROOT=$(cd "$(dirname "$0")/.." && pwd)
BUILD_DIR=${BUILD_DIR:-$ROOT/build-bench}
OUT_DIR=${OUT_DIR:-$ROOT/bench/out}
COUNTS=("$@")
[[ ${#COUNTS[@]} -gt 0 ]] || COUNTS=(10000 100000 300000)

if [[ ! -f $BUILD_DIR/CMakeCache.txt ]]; then
  cmake -S "$ROOT" -B "$BUILD_DIR" -G Ninja -DCMAKE_BUILD_TYPE=Release -DBRAIGRION_BENCH=ON >/dev/null
fi
cmake --build "$BUILD_DIR" -j2 --target gen_collection bench_report >/dev/null

mkdir -p "$OUT_DIR"
echo "date: $(date -u '+%Y-%m-%d %H:%M UTC'), nproc $(nproc), load average $(cut -d' ' -f1-3 /proc/loadavg)"
for n in "${COUNTS[@]}"; do
  file=$OUT_DIR/collection-disks-$n.xml
  [[ -s $file ]] || "$BUILD_DIR/bench/gen_collection" "$n" "$file" --disks >/dev/null
  cat "$file" >/dev/null  # warm the page cache
  echo "== $n instances"
  "$BUILD_DIR/bench/bench_report" "$file" | tee "$OUT_DIR/bench_report-$n.txt"
done

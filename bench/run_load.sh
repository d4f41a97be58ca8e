#!/usr/bin/env bash
# Load benchmark: builds the Release tools, generates a synthetic collection
# (1,000,000 instances unless told otherwise), times xmllint's streaming
# reader and expat alone on it as the floor of what reading the file costs,
# then loads it into the repository with bench_load.
#
#   bench/run_load.sh [N]
#
# Environment: BUILD_DIR (default build-bench), SEED (default the
# generator's), REGENERATE=1 to rewrite an existing file.
# Targets on one core: at least 100 MB/s and a peak resident size at most
# twice the file size.
set -euo pipefail

ROOT=$(cd "$(dirname "$0")/.." && pwd)
BUILD_DIR=${BUILD_DIR:-$ROOT/build-bench}
COUNT=${1:-1000000}
OUT_DIR=$ROOT/bench/out
FILE=$OUT_DIR/collection-$COUNT${SEED:+-seed$SEED}.xml

cmake -S "$ROOT" -B "$BUILD_DIR" -G Ninja -DCMAKE_BUILD_TYPE=Release >/dev/null
ninja -C "$BUILD_DIR" -j2 gen_collection read_floor bench_load >/dev/null

mkdir -p "$OUT_DIR"
if [[ ! -s $FILE || ${REGENERATE:-0} == 1 ]]; then
  echo "== generating $FILE"
  "$BUILD_DIR/bench/gen_collection" "$COUNT" "$FILE" ${SEED:+--seed "$SEED"}
fi

# Read the file once so that both runs below start from a warm page cache.
cat "$FILE" >/dev/null

echo "== machine"
echo "nproc: $(nproc)"
echo "cpu: $(grep -m1 'model name' /proc/cpuinfo | cut -d: -f2- | sed 's/^ *//')"
echo "date: $(date -u '+%Y-%m-%d %H:%M UTC')"

echo "== xmllint --stream --noout (reading floor)"
if command -v xmllint >/dev/null; then
  BYTES=$(stat -c %s "$FILE")
  /usr/bin/time -o "$OUT_DIR/xmllint-$COUNT.txt" -f '%e %M' xmllint --stream --noout "$FILE"
  read -r SECS KIB <"$OUT_DIR/xmllint-$COUNT.txt"
  echo "file size: $BYTES bytes"
  echo "wall time: $SECS s"
  awk -v b="$BYTES" -v s="$SECS" 'BEGIN { printf "throughput: %.1f MB/s\n", (s > 0 ? b / 1e6 / s : 0) }'
  echo "peak rss: $KIB KiB"
else
  echo "xmllint not installed; floor not measured"
fi

echo "== read_floor (expat alone, fed as the loader feeds it)"
"$BUILD_DIR/bench/read_floor" "$FILE"

echo "== bench_load"
"$BUILD_DIR/bench/bench_load" "$FILE" | tee "$OUT_DIR/bench_load-$COUNT.txt"

awk -F': ' '
  /^throughput:/ { split($2, a, " "); mbs = a[1] }
  /^peak rss \/ file size:/ { ratio = $2 }
  END {
    printf "== targets\n"
    printf "throughput %.1f MB/s (target >= 100): %s\n", mbs, (mbs >= 100 ? "met" : "MISSED")
    printf "peak memory %.2fx file size (target <= 2): %s\n", ratio, (ratio <= 2 ? "met" : "MISSED")
  }' "$OUT_DIR/bench_load-$COUNT.txt"

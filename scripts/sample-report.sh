#!/usr/bin/env bash
# The main job: installs what is needed, builds, and writes the HTML report
# of the bundled sample collection into ./sample-report/. The path of its
# index.html is the last line, and the only one, on standard output; what
# installing and building print goes to standard error, so that
# "$(./scripts/sample-report.sh)" is the path.
set -euo pipefail
here="$(cd "$(dirname "$0")/.." && pwd)"
"$here/scripts/setup.sh" >&2
"$here/scripts/build.sh" "$here/build" -DCMAKE_BUILD_TYPE=Release -DBRAIGRION_TESTS=OFF -DBRAIGRION_BENCH=OFF >&2
"$here/build/cli/braigrion" report "$here"/samples/linux-server/*.xml -o "$here/sample-report"

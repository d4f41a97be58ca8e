#!/usr/bin/env bash
# The main job: installs what is needed, builds, and writes the HTML report
# of the bundled sample collection into ./sample-report/, then prints the
# path of its index.html.
set -euo pipefail
here="$(cd "$(dirname "$0")/.." && pwd)"
"$here/scripts/setup.sh"
"$here/scripts/build.sh" "$here/build" -DCMAKE_BUILD_TYPE=Release -DBRAIGRION_TESTS=OFF -DBRAIGRION_BENCH=OFF
"$here/build/cli/braigrion" report "$here"/samples/linux-server/*.xml -o "$here/sample-report"

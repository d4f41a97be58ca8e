#!/usr/bin/env bash
# The main job: installs what is needed, builds, and runs braigrion on the
# bundled sample collection.
set -euo pipefail
here="$(cd "$(dirname "$0")/.." && pwd)"
"$here/scripts/setup.sh"
"$here/scripts/build.sh" "$here/build" -DCMAKE_BUILD_TYPE=Release -DBRAIGRION_TESTS=OFF -DBRAIGRION_BENCH=OFF
"$here/build/cli/braigrion" info "$here"/samples/linux-server/*.xml

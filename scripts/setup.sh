#!/usr/bin/env bash
# Installs the Debian packages that building and testing braigrion needs.
# Safe to run again: apt-get only installs what is missing.
#   scripts/setup.sh           what building needs
#   scripts/setup.sh --tests   also what the browser tests need: Chromium,
#                              Node.js, tidy and the npm packages of
#                              tests/browser
set -euo pipefail
here="$(cd "$(dirname "$0")/.." && pwd)"
tests=0
[ "${1:-}" = "--tests" ] && tests=1

packages=(
  build-essential cmake ninja-build pkg-config
  libboost-dev libexpat1-dev libcli11-dev
  libgtest-dev libgmock-dev googletest
  libxml2-utils
)

SUDO=""
if [ "$(id -u)" -ne 0 ]; then
  if command -v sudo >/dev/null 2>&1; then SUDO="sudo"; else
    echo "setup: not root and no sudo; install these packages by hand: ${packages[*]}" >&2
    exit 1
  fi
fi

export DEBIAN_FRONTEND=noninteractive
$SUDO apt-get update -qq
$SUDO apt-get install -y -qq --no-install-recommends "${packages[@]}" >/dev/null
echo "setup: build dependencies are installed"

if [ "$tests" -eq 1 ]; then
  # Chromium is the browser of the browser tests. Without it they report
  # themselves skipped, so a failure here is a warning, not an error.
  if ! command -v chromium >/dev/null 2>&1; then
    if ! $SUDO apt-get install -y -qq --no-install-recommends chromium fonts-dejavu-core >/dev/null; then
      echo "setup: warning: chromium could not be installed; the browser tests will be skipped" >&2
    fi
  fi
  # Node.js runs the browser tests; tidy checks the mark-up of every page.
  test_packages=()
  command -v node >/dev/null 2>&1 || test_packages+=(nodejs)
  command -v npm >/dev/null 2>&1 || test_packages+=(npm)
  command -v tidy >/dev/null 2>&1 || test_packages+=(tidy)
  if [ "${#test_packages[@]}" -gt 0 ]; then
    $SUDO apt-get install -y -qq --no-install-recommends "${test_packages[@]}" >/dev/null
  fi
  # The npm packages of the browser tests, installed again when any of the
  # dependencies of package.json is missing from node_modules.
  missing=$(cd "$here/tests/browser" && node -e '
    const fs = require("fs");
    const deps = Object.keys(require("./package.json").dependencies || {});
    console.log(deps.filter((d) => !fs.existsSync("node_modules/" + d + "/package.json")).join(" "));')
  if [ -n "$missing" ]; then
    echo "setup: installing the npm packages of the browser tests (missing: $missing)"
    (cd "$here/tests/browser" && npm ci --no-audit --no-fund --loglevel=error)
  fi
  echo "setup: test dependencies are installed"
fi

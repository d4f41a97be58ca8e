#!/usr/bin/env bash
# Installs the Debian packages that building and testing braigrion needs.
# Safe to run again: apt-get only installs what is missing.
set -euo pipefail

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

#!/usr/bin/env bash
# Makes sure the Debian packages the build needs are present; installs what is missing.
# Quick when everything is there. Sourced or run by demo.sh and test.sh.
set -euo pipefail

VELMAR_PACKAGES=(
  build-essential cmake ninja-build pkg-config ccache
  qt6-base-dev qt6-base-dev-tools libgl-dev libxcb1-dev libxkbcommon-dev
  libicu-dev libbenchmark-dev
  xvfb xauth fonts-liberation2 libxtst6 openbox x11-utils
)
# The Wayland test run (VELMAR_TEST_PLATFORM=wayland) needs a compositor and Qt's plugin.
if [ "${VELMAR_TEST_PLATFORM:-}" = "wayland" ]; then
  VELMAR_PACKAGES+=(weston qt6-wayland)
fi

missing=()
for p in "${VELMAR_PACKAGES[@]}"; do
  if ! dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q "install ok installed"; then
    missing+=("$p")
  fi
done

if [ ${#missing[@]} -eq 0 ]; then
  exit 0
fi

echo "velmar: installing missing packages: ${missing[*]}"
SUDO=""
if [ "$(id -u)" -ne 0 ]; then
  if command -v sudo >/dev/null 2>&1; then
    SUDO="sudo"
  else
    echo "velmar: error: these packages are missing and I am not root (no sudo either): ${missing[*]}" >&2
    echo "velmar: install them with: apt-get install ${missing[*]}" >&2
    exit 1
  fi
fi
if ! command -v apt-get >/dev/null 2>&1; then
  echo "velmar: error: apt-get not found; install by hand: ${missing[*]}" >&2
  exit 1
fi
export DEBIAN_FRONTEND=noninteractive
if ! { $SUDO apt-get update -qq && $SUDO apt-get install -y -qq --no-install-recommends "${missing[@]}"; } >/tmp/velmar-apt.log 2>&1; then
  echo "velmar: error: could not install: ${missing[*]}" >&2
  tail -n 20 /tmp/velmar-apt.log >&2
  exit 1
fi
echo "velmar: packages installed"

#!/usr/bin/env bash
# Makes sure the Debian packages the build needs are present; installs what is missing.
# Quick when everything is there. Run by demo.sh, test.sh and fuzz.sh.
#
#   scripts/deps.sh           the GCC build
#   scripts/deps.sh clang     also clang and its sanitizer and libFuzzer runtimes
#   scripts/deps.sh fuzz      the same (what a -DVELMAR_FUZZ=ON build needs)
#
# The clang packages are also added when CXX names clang or VELMAR_CMAKE_ARGS turns on
# VELMAR_FUZZ, so that `CXX=clang++ ./scripts/test.sh` works on a fresh machine.
set -euo pipefail

VELMAR_PACKAGES=(
  build-essential cmake ninja-build pkg-config ccache
  qt6-base-dev qt6-base-dev-tools libgl-dev libxcb1-dev libxkbcommon-dev
  libicu-dev libbenchmark-dev
  xvfb xauth fonts-liberation2 libxtst6 openbox x11-utils
)
# clang++ itself, the runtimes -fsanitize=address,undefined,fuzzer link against
# (libclang_rt.*: only recommended by clang, so not installed with it here), and
# llvm-symbolizer, without which a sanitizer report shows addresses instead of lines.
VELMAR_CLANG_PACKAGES=(clang libclang-rt-dev llvm)

want_clang=0
for arg in "$@"; do
  case "$arg" in
    clang | fuzz) want_clang=1 ;;
    *)
      echo "velmar: error: unknown argument '$arg' (expected: clang, fuzz)" >&2
      exit 2
      ;;
  esac
done
cxx="${CXX:-c++}"
case "$(basename "${cxx%% *}")" in clang*) want_clang=1 ;; esac
case " ${VELMAR_CMAKE_ARGS:-} " in *VELMAR_FUZZ=ON* | *VELMAR_FUZZ:BOOL=ON*) want_clang=1 ;; esac
if [ "$want_clang" -eq 1 ]; then
  VELMAR_PACKAGES+=("${VELMAR_CLANG_PACKAGES[@]}")
fi
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

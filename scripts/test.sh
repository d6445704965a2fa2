#!/usr/bin/env bash
# Builds everything and runs the whole test suite through CTest, under Xvfb when no
# display is set.
set -euo pipefail
root="$(cd "$(dirname "${BASH_SOURCE[0]}")/.." && pwd)"
source "$root/scripts/prepare.sh"
cmake --build "$build"
cd "$build"
jobs="${VELMAR_TEST_JOBS:-$(nproc)}"
if [ -n "${DISPLAY:-}" ]; then
  exec ctest --output-on-failure -j "$jobs" "$@"
fi
exec xvfb-run -a -s "-screen 0 1280x800x24" ctest --output-on-failure -j "$jobs" "$@"

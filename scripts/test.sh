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
# A server of the suite's own: it picks a free display itself, so runs side by side (or an
# xvfb-run elsewhere) cannot take each other's.
exec "$root/tests/run-on-own-display.sh" ctest --output-on-failure -j "$jobs" "$@"

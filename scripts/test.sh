#!/usr/bin/env bash
# Builds everything and runs the whole test suite through CTest, under Xvfb when no
# display is set. VELMAR_TEST_PLATFORM=wayland runs it under a private headless weston
# instead, with Qt's Wayland plugin; the tests that need X skip and say why.
set -euo pipefail
root="$(cd "$(dirname "${BASH_SOURCE[0]}")/.." && pwd)"
case "${VELMAR_TEST_PLATFORM:=x11}" in
  x11 | wayland) export VELMAR_TEST_PLATFORM ;;
  *)
    echo "velmar: error: VELMAR_TEST_PLATFORM is x11 or wayland, not '$VELMAR_TEST_PLATFORM'" >&2
    exit 2 ;;
esac
source "$root/scripts/prepare.sh"
cmake --build "$build"
cd "$build"
jobs="${VELMAR_TEST_JOBS:-$(nproc)}"
if [ "$VELMAR_TEST_PLATFORM" = wayland ]; then
  exec "$root/tests/run-on-own-compositor.sh" ctest --output-on-failure -j "$jobs" "$@"
fi
if [ -n "${DISPLAY:-}" ]; then
  exec ctest --output-on-failure -j "$jobs" "$@"
fi
# A server of the suite's own: it picks a free display itself, so runs side by side (or an
# xvfb-run elsewhere) cannot take each other's.
exec "$root/tests/run-on-own-display.sh" ctest --output-on-failure -j "$jobs" "$@"

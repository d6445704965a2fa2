#!/usr/bin/env bash
# Builds and runs the demo host program on the desktop (X11 or Wayland). Without one it
# runs under Xvfb and saves a screenshot instead.
set -euo pipefail
root="$(cd "$(dirname "${BASH_SOURCE[0]}")/.." && pwd)"
source "$root/scripts/prepare.sh"
cmake --build "$build" --target velmar-demo
demo="$build/examples/demo/velmar-demo"
# On a desktop (X11, or Wayland through Qt's wayland plugin) it runs there.
if [ -n "${DISPLAY:-}" ] || [ -n "${WAYLAND_DISPLAY:-}" ]; then
  exec "$demo" "$@"
fi
shot="$build/velmar-demo.png"
xvfb-run -a -s "-screen 0 1280x800x24" "$demo" --screenshot "$shot" "$@"
echo "velmar: no display; the demo ran under Xvfb and its screenshot is at $shot"

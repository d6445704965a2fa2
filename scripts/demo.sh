#!/usr/bin/env bash
# Builds and runs the demo host program. Without a display it runs under Xvfb and
# saves a screenshot instead.
set -euo pipefail
root="$(cd "$(dirname "${BASH_SOURCE[0]}")/.." && pwd)"
source "$root/scripts/prepare.sh"
cmake --build "$build" --target velmar-demo
demo="$build/examples/demo/velmar-demo"
if [ -n "${DISPLAY:-}" ]; then
  exec "$demo" "$@"
fi
shot="$build/velmar-demo.png"
xvfb-run -a -s "-screen 0 1280x800x24" "$demo" --screenshot "$shot" "$@"
echo "velmar: no display; the demo ran under Xvfb and its screenshot is at $shot"

#!/usr/bin/env bash
# Builds and runs the demo host program. Without a display it runs under Xvfb and
# saves a screenshot instead.
set -euo pipefail
root="$(cd "$(dirname "${BASH_SOURCE[0]}")/.." && pwd)"
"$root/scripts/deps.sh"
# Qt wants a private runtime directory; give it one rather than a warning per process.
if [ -z "${XDG_RUNTIME_DIR:-}" ]; then export XDG_RUNTIME_DIR="$(mktemp -d)"; fi
build="$("$root/scripts/configure.sh")"
cmake --build "$build" --target velmar-demo
demo="$build/examples/demo/velmar-demo"
if [ -n "${DISPLAY:-}" ]; then
  exec "$demo" "$@"
fi
shot="$build/velmar-demo.png"
xvfb-run -a -s "-screen 0 1280x800x24" "$demo" --screenshot "$shot" "$@"
echo "velmar: no display; the demo ran under Xvfb and its screenshot is at $shot"

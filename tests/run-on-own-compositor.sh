#!/usr/bin/env bash
# The Wayland twin of run-on-own-display.sh: runs one test (or the whole suite) under a
# private headless weston, with Qt's Wayland plugin and no X display at all. With --wm it
# stops at once with CTest's skip code: the window-manager runs are about an X window
# manager (openbox), and on Wayland the compositor is the window manager.
set -uo pipefail
if [ "${1:-}" = "--wm" ]; then
  echo "run-on-own-compositor: skipped: needs an X window manager (openbox); under Wayland the compositor places and stacks windows"
  exit 77
fi
if ! command -v weston >/dev/null 2>&1; then
  echo "run-on-own-compositor: weston is not installed (VELMAR_TEST_PLATFORM=wayland ./scripts/deps.sh)" >&2
  exit 1
fi
dir="$(mktemp -d)"
chmod 700 "$dir"
trap 'rm -rf "$dir"' EXIT
# A runtime directory of its own: the socket's name cannot clash with another run's.
export XDG_RUNTIME_DIR="$dir"
socket="velmar-$$"
weston --backend=headless-backend.so --socket="$socket" --width=1280 --height=800 \
  --idle-time=0 --no-config >"$dir/weston.log" 2>&1 &
weston=$!
for _ in $(seq 200); do
  [ -S "$dir/$socket" ] && break
  sleep 0.05
done
if [ ! -S "$dir/$socket" ]; then
  echo "run-on-own-compositor: weston did not start" >&2
  cat "$dir/weston.log" >&2
  kill "$weston" 2>/dev/null
  exit 1
fi
export WAYLAND_DISPLAY="$socket" QT_QPA_PLATFORM=wayland
unset DISPLAY
"$@"
rc=$?
# weston ends its own clients (the shell, the keyboard); one that is slow to go must not
# keep the test running.
kill "$weston" 2>/dev/null
for _ in $(seq 40); do
  kill -0 "$weston" 2>/dev/null || break
  sleep 0.05
done
kill -9 "$weston" 2>/dev/null
wait "$weston" 2>/dev/null
exit $rc

#!/usr/bin/env bash
# Runs one test (or the whole suite) on an X server of its own, and with --wm under a window manager (openbox),
# so that real input and the window manager's activation and stacking neither disturb nor
# are disturbed by the tests running beside it.
set -uo pipefail
# The suite's Wayland run (VELMAR_TEST_PLATFORM=wayland) gives each test a compositor instead.
if [ "${VELMAR_TEST_PLATFORM:-x11}" = "wayland" ]; then
  exec "$(dirname "${BASH_SOURCE[0]}")/run-on-own-compositor.sh" "$@"
fi
wm=0
if [ "${1:-}" = "--wm" ]; then
  wm=1
  shift
fi
dir="$(mktemp -d)"
trap 'rm -rf "$dir"' EXIT
# The server picks a free display itself and tells us which.
Xvfb -displayfd 3 -screen 0 1280x800x24 -nolisten tcp 3>"$dir/display" 2>"$dir/xvfb.log" &
xvfb=$!
for _ in $(seq 200); do
  [ -s "$dir/display" ] && break
  sleep 0.05
done
if [ ! -s "$dir/display" ]; then
  echo "run-on-own-display: Xvfb did not start" >&2
  cat "$dir/xvfb.log" >&2
  kill "$xvfb" 2>/dev/null
  exit 1
fi
export DISPLAY=":$(head -n1 "$dir/display")"
# X11 even where the session around us is a Wayland one.
export QT_QPA_PLATFORM=xcb
unset WAYLAND_DISPLAY
wmpid=""
if [ "$wm" = 1 ]; then
  openbox --sm-disable >"$dir/openbox.log" 2>&1 &
  wmpid=$!
  # openbox announces itself on the root window once it manages the screen.
  for _ in $(seq 100); do
    xprop -root _NET_SUPPORTING_WM_CHECK 2>/dev/null | grep -q "window id" && break
    sleep 0.05
  done
fi
"$@"
rc=$?
[ -n "$wmpid" ] && kill "$wmpid" 2>/dev/null
kill "$xvfb" 2>/dev/null
wait 2>/dev/null
exit $rc

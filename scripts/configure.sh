#!/usr/bin/env bash
# Configures the build tree (build/ unless VELMAR_BUILD_DIR says otherwise) once. CXX picks
# the compiler when the tree is configured; a tree already made with another compiler is
# refused rather than silently built with the old one.
set -euo pipefail
root="$(cd "$(dirname "${BASH_SOURCE[0]}")/.." && pwd)"
build="${VELMAR_BUILD_DIR:-$root/build}"
if [ -f "$build/build.ninja" ] && [ -n "${CXX:-}" ]; then
  wanted="$(command -v "${CXX%% *}" || true)"
  configured="$(sed -n 's/^CMAKE_CXX_COMPILER:[A-Z]*=//p' "$build/CMakeCache.txt" 2>/dev/null || true)"
  if [ -z "$wanted" ] || [ -z "$configured" ] ||
    [ "$(readlink -f "$wanted")" != "$(readlink -f "$configured")" ]; then
    echo "velmar: error: $build was configured with ${configured:-another compiler}, not CXX=$CXX;" \
      "give it a tree of its own with VELMAR_BUILD_DIR (for example build-clang) or remove $build" >&2
    exit 1
  fi
fi
if [ ! -f "$build/build.ninja" ]; then
  if ! cmake -S "$root" -B "$build" -G Ninja ${VELMAR_CMAKE_ARGS:-} >"$build.configure.log" 2>&1; then
    echo "velmar: error: CMake configuration failed; the log follows" >&2
    tail -n 40 "$build.configure.log" >&2
    exit 1
  fi
fi
echo "$build"

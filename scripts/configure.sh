#!/usr/bin/env bash
# Configures the build tree (build/ unless VELMAR_BUILD_DIR says otherwise) once.
set -euo pipefail
root="$(cd "$(dirname "${BASH_SOURCE[0]}")/.." && pwd)"
build="${VELMAR_BUILD_DIR:-$root/build}"
if [ ! -f "$build/build.ninja" ]; then
  if ! cmake -S "$root" -B "$build" -G Ninja ${VELMAR_CMAKE_ARGS:-} >"$build.configure.log" 2>&1; then
    echo "velmar: error: CMake configuration failed; the log follows" >&2
    tail -n 40 "$build.configure.log" >&2
    exit 1
  fi
fi
echo "$build"

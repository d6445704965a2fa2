#!/usr/bin/env bash
# Builds the Debian packages: a Release tree installed under /usr (build-package/ unless
# VELMAR_PACKAGE_BUILD_DIR says otherwise), packed by CPack into libvelmar<N> (the shared
# library) and libvelmar-dev (headers, CMake package, velmar.pc). Prints the package files.
set -euo pipefail
root="$(cd "$(dirname "${BASH_SOURCE[0]}")/.." && pwd)"
export VELMAR_BUILD_DIR="${VELMAR_PACKAGE_BUILD_DIR:-$root/build-package}"
export VELMAR_CMAKE_ARGS="-DCMAKE_BUILD_TYPE=Release -DCMAKE_INSTALL_PREFIX=/usr -DVELMAR_BUILD_TESTS=OFF -DVELMAR_BUILD_BENCH=OFF -DVELMAR_BUILD_EXAMPLES=OFF ${VELMAR_CMAKE_ARGS:-}"
source "$root/scripts/prepare.sh"
if ! command -v dpkg-shlibdeps >/dev/null 2>&1; then
  echo "velmar: error: dpkg-shlibdeps not found (apt-get install dpkg-dev)" >&2
  exit 1
fi
cmake --build "$build" --target Velmar
out="$build/packages"
rm -rf "$out"
(cd "$build" && cpack --config CPackConfig.cmake -B "$out" >"$out.log" 2>&1) || {
  echo "velmar: error: cpack failed; the log follows" >&2
  tail -n 40 "$out.log" >&2
  exit 1
}
for deb in "$out"/*.deb; do
  echo "$deb"
  dpkg-deb -f "$deb" Package Version Depends | sed 's/^/  /'
done

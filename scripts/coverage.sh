#!/usr/bin/env bash
# Measures how much of the library the test suite runs: builds a Debug tree with --coverage
# (build-coverage/ unless VELMAR_COVERAGE_BUILD_DIR says otherwise), runs the whole suite the
# way scripts/test.sh does and prints gcovr's line, function and branch summary for src/.
# Extra arguments go to ctest (for example -R tst_regions to measure one test).
set -euo pipefail
root="$(cd "$(dirname "${BASH_SOURCE[0]}")/.." && pwd)"
"$root/scripts/deps.sh"
if ! command -v gcovr >/dev/null 2>&1; then
  echo "velmar: installing gcovr"
  SUDO=""
  [ "$(id -u)" -eq 0 ] || SUDO="sudo"
  if ! { DEBIAN_FRONTEND=noninteractive $SUDO apt-get install -y -qq --no-install-recommends gcovr ||
    { $SUDO apt-get update -qq &&
      DEBIAN_FRONTEND=noninteractive $SUDO apt-get install -y -qq --no-install-recommends gcovr; }; } \
    >/tmp/velmar-apt.log 2>&1; then
    echo "velmar: error: could not install gcovr; the log follows" >&2
    tail -n 20 /tmp/velmar-apt.log >&2
    exit 1
  fi
fi
export VELMAR_BUILD_DIR="${VELMAR_COVERAGE_BUILD_DIR:-$root/build-coverage}"
# C++ only: the library is C++, and the classic C test programs are compiled by clang, whose
# coverage runtime the C++ linker does not bring.
export VELMAR_CMAKE_ARGS="-DCMAKE_BUILD_TYPE=Debug -DCMAKE_CXX_FLAGS=--coverage
  -DCMAKE_EXE_LINKER_FLAGS=--coverage -DCMAKE_SHARED_LINKER_FLAGS=--coverage
  -DVELMAR_BUILD_BENCH=OFF -DVELMAR_BUILD_EXAMPLES=OFF ${VELMAR_CMAKE_ARGS:-}"
source "$root/scripts/prepare.sh"
cmake --build "$build"
# Counts from an earlier run would be added to this one's.
find "$build" -name '*.gcda' -delete
# A failing test still counts what it ran; the summary comes first, the failure after it.
status=0
"$root/scripts/test.sh" "$@" || status=$?
echo "velmar: coverage of src/ by the suite"
gcovr --root "$root" --filter "$root/src/" --print-summary --output /dev/null "$build" | tail -n 3
exit "$status"

#!/usr/bin/env bash
# Builds the benchmarks in a Release tree and prints, for every "QD/<case>" benchmark,
# its time against the raw-Qt "Qt/<case>" baseline measured in the same run, followed by
# the benchmarks that stand alone. Extra arguments go to every benchmark program.
set -euo pipefail
root="$(cd "$(dirname "${BASH_SOURCE[0]}")/.." && pwd)"
export VELMAR_BUILD_DIR="${VELMAR_BENCH_BUILD_DIR:-$root/build-release}"
export VELMAR_CMAKE_ARGS="-DCMAKE_BUILD_TYPE=Release -DVELMAR_BUILD_TESTS=OFF ${VELMAR_CMAKE_ARGS:-}"
source "$root/scripts/prepare.sh"
cmake --build "$build"
out="$(mktemp -d)"
[ -n "${DISPLAY:-}" ] || export QT_QPA_PLATFORM="${QT_QPA_PLATFORM:-offscreen}"
for exe in "$build"/bench/bench_*; do
  [ -f "$exe" ] && [ -x "$exe" ] || continue
  "$exe" --benchmark_format=json --benchmark_out="$out/$(basename "$exe").json" \
    --benchmark_out_format=json "$@" >/dev/null
done
python3 "$root/scripts/bench_table.py" "$out"/*.json

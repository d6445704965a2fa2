#!/usr/bin/env bash
# Builds the fuzz targets as libFuzzer programs with clang (build-fuzz/, -DVELMAR_FUZZ=ON,
# only what they need) and runs each for a bounded time, starting from its committed corpus.
# Exits non-zero on any finding (crash, sanitizer report, leak, time-out, memory limit).
#
#   scripts/fuzz.sh [SECONDS [TARGET...]]    default: 60 s each, every tests/fuzz/fuzz_*.cpp
#
# VELMAR_CMAKE_ARGS adds configure arguments (CI: warnings are errors), VELMAR_FUZZ_BUILD_DIR
# moves the tree.
# New inputs go to build-fuzz/fuzz-new/<target>/ (libFuzzer writes into the first corpus
# folder it is given), never into tests/fuzz/corpus/; a finding is saved in
# build-fuzz/fuzz-findings/<target>/. The README says how to add either to the corpus.
set -euo pipefail
root="$(cd "$(dirname "${BASH_SOURCE[0]}")/.." && pwd)"
seconds="${1:-60}"
[ $# -gt 0 ] && shift
case "$seconds" in
  '' | *[!0-9]* | 0*)
    # (0 would mean "no limit" to libFuzzer.)
    echo "velmar: error: the time per target is a whole number of seconds from 1, not '$seconds'" >&2
    exit 2
    ;;
esac
targets=("$@")
if [ ${#targets[@]} -eq 0 ]; then
  for source in "$root"/tests/fuzz/fuzz_*.cpp; do
    targets+=("$(basename "$source" .cpp)")
  done
fi
for target in "${targets[@]}"; do
  if [ ! -f "$root/tests/fuzz/$target.cpp" ] || [ ! -d "$root/tests/fuzz/corpus/$target" ]; then
    echo "velmar: error: no fuzz target '$target' with a corpus in tests/fuzz/" >&2
    exit 2
  fi
done

"$root/scripts/deps.sh" fuzz
if [ -z "${XDG_RUNTIME_DIR:-}" ]; then export XDG_RUNTIME_DIR="$(mktemp -d)"; fi
case "$(basename "${CXX:-}")" in clang*) ;; *) export CXX=clang++ ;; esac

echo "velmar: fuzz build: $CXX, -DVELMAR_FUZZ=ON, targets ${targets[*]}"
started=$SECONDS
build="$(VELMAR_BUILD_DIR="${VELMAR_FUZZ_BUILD_DIR:-$root/build-fuzz}" \
  VELMAR_CMAKE_ARGS="-DVELMAR_FUZZ=ON -DVELMAR_BUILD_BENCH=OFF -DVELMAR_BUILD_EXAMPLES=OFF ${VELMAR_CMAKE_ARGS:-}" \
  "$root/scripts/configure.sh")"
cmake --build "$build" --target "${targets[@]}"
echo "velmar: fuzz build took $((SECONDS - started)) s"

# What is in the committed corpus folders, to check afterwards that no run wrote there.
corpusState() { find "$root/tests/fuzz/corpus" -type f -printf '%P %s %T@\n' | sort; }
corpusBefore="$(corpusState)"
export QT_QPA_PLATFORM=offscreen
export LSAN_OPTIONS="suppressions=$root/tests/lsan.supp${LSAN_OPTIONS:+:$LSAN_OPTIONS}"
failed=()
summary=()
for target in "${targets[@]}"; do
  corpus="$root/tests/fuzz/corpus/$target"
  new="$build/fuzz-new/$target"
  findings="$build/fuzz-findings/$target"
  log="$build/fuzz-$target.log"
  rm -rf "$new" "$findings"
  mkdir -p "$new" "$findings"
  echo "velmar: fuzzing $target for $seconds s from tests/fuzz/corpus/$target" \
    "($(find "$corpus" -type f | wc -l) inputs)"
  # -timeout: one input running longer than this is a finding, not a stalled run.
  if "$build/tests/fuzz/$target" -max_total_time="$seconds" -timeout=30 -print_final_stats=1 \
    -artifact_prefix="$findings/" "$new" "$corpus" >"$log" 2>&1; then
    result="ok"
  else
    result="FINDING"
    failed+=("$target")
    tail -n 80 "$log"
    echo "velmar: $target: the input is in $findings/, the whole log in $log"
  fi
  runs="$(sed -n 's/^stat::number_of_executed_units: *//p' "$log" | tail -n 1)"
  added="$(find "$new" -type f | wc -l)"
  summary+=("$(printf '%-20s %-8s %10s runs %6s new inputs' "$target" "$result" "${runs:-?}" "$added")")
done

echo "velmar: fuzz results ($seconds s each; new inputs in $build/fuzz-new/):"
printf '  %s\n' "${summary[@]}"
if [ "$(corpusState)" != "$corpusBefore" ]; then
  echo "velmar: error: tests/fuzz/corpus changed during the run" >&2
  exit 1
fi
if [ ${#failed[@]} -gt 0 ]; then
  echo "velmar: error: findings in ${failed[*]}" >&2
  exit 1
fi

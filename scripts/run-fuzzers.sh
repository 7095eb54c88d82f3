#!/usr/bin/env bash
# Builds every libFuzzer target (fuzz/*.cpp) with the "fuzz" preset and runs
# each for the given number of seconds (default 60), one after the other.
#
#   scripts/run-fuzzers.sh [seconds]
#
# Seeds come from fuzz/corpus/<name>/ and a dictionary from fuzz/<name>.dict
# when present; the growing corpus and any crashing input are kept under
# build/fuzz/fuzz-runs/<name>/, so the seeds in the repository stay as they are.
# Exits non-zero when any target finds a crash, a leak or undefined behaviour.
set -euo pipefail

seconds="${1:-60}"
if ! [[ "$seconds" =~ ^[0-9]+$ ]] || [ "$seconds" -lt 1 ]; then
  echo "usage: $0 [seconds]" >&2
  exit 2
fi

cd "$(dirname "$0")/.."
root="$(pwd)"
build="$root/build/fuzz"

# The library's own objects need coverage instrumentation too: without it the
# fuzzer would see only the entry point and mutate blindly.
cmake --preset fuzz \
  -DCMAKE_C_FLAGS="-fsanitize=fuzzer-no-link" \
  -DCMAKE_CXX_FLAGS="-fsanitize=fuzzer-no-link" >/dev/null

names=()
for src in "$root"/fuzz/*.cpp; do
  names+=("$(basename "$src" .cpp)")
done
if [ "${#names[@]}" -eq 0 ]; then
  echo "run-fuzzers: no targets in fuzz/" >&2
  exit 1
fi

targets=()
for name in "${names[@]}"; do targets+=("fuzz_$name"); done
cmake --build "$build" -j2 --target "${targets[@]}"

# The font libraries' process-wide caches are never freed, as in the test suite.
export LSAN_OPTIONS="suppressions=$root/tests/lsan.supp:print_suppressions=0"

failed=()
for name in "${names[@]}"; do
  work="$build/fuzz-runs/$name"
  mkdir -p "$work/corpus" "$work/artifacts"
  args=(-max_total_time="$seconds" -print_final_stats=1 -artifact_prefix="$work/artifacts/")
  if [ -f "$root/fuzz/$name.dict" ]; then args+=(-dict="$root/fuzz/$name.dict"); fi
  dirs=("$work/corpus")
  if [ -d "$root/fuzz/corpus/$name" ]; then dirs+=("$root/fuzz/corpus/$name"); fi

  echo "run-fuzzers: $name for ${seconds}s"
  if "$build/fuzz/fuzz_$name" "${args[@]}" "${dirs[@]}" >"$work/log.txt" 2>&1; then
    grep -E '^(stat::number_of_executed_units|stat::peak_rss_mb|#[0-9]+ +DONE)' "$work/log.txt" || true
    echo "run-fuzzers: $name ok"
  else
    tail -n 40 "$work/log.txt" >&2
    echo "run-fuzzers: $name FAILED (log: $work/log.txt, inputs: $work/artifacts/)" >&2
    failed+=("$name")
  fi
done

if [ "${#failed[@]}" -ne 0 ]; then
  echo "run-fuzzers: findings in ${failed[*]}" >&2
  exit 1
fi
echo "run-fuzzers: all ${#names[@]} targets ran ${seconds}s without findings"

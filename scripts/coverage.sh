#!/usr/bin/env bash
# Builds the coverage preset, runs the whole suite (headless and against a real X
# server) and prints the library's line and branch coverage per folder and in total.
# Usage: scripts/coverage.sh            build, run, report
#        scripts/coverage.sh --report   report on the counters of the last run only
# The build and the run take the shared build lock, so several checkouts on one
# machine never compile at the same time.
set -euo pipefail
cd "$(dirname "$0")/.."
export CCACHE_BASEDIR="$PWD"
BUILD=build/coverage
LOCK=/tmp/norvik-build.lock
# The library's folders: the layers the build knows that exist in this checkout.
FOLDERS=()
for f in $(sed -n 's/^set(NORVIK_LAYERS \(.*\))$/\1/p' cmake/NorvikLayers.cmake); do
  [ -d "$f" ] && FOLDERS+=("$f")
done

if [ "${1:-}" != "--report" ]; then
  command -v gcovr >/dev/null || bash scripts/install-deps.sh
  cmake --preset coverage >/dev/null
  flock "$LOCK" cmake --build --preset coverage
  # Counters of an earlier run, or of the test listing the build itself runs,
  # would add to this run's.
  find "$BUILD" -name '*.gcda' -delete
  flock "$LOCK" ctest --preset coverage -j"$(nproc)" \
    || echo "coverage: some tests failed; the figures below still count what ran" >&2
fi

filter=()
for f in "${FOLDERS[@]}"; do filter+=(--filter "$PWD/$f/"); done
summary="$BUILD/coverage-summary.json"
# Branches that only exist for exceptions or that the compiler proved unreachable
# are not decisions a test could take, so they stay out of the branch figure.
gcovr --root "$PWD" "${filter[@]}" --exclude-unreachable-branches --exclude-throw-branches \
  --gcov-ignore-parse-errors -j"$(nproc)" --json-summary "$summary" --json-summary-pretty \
  "$BUILD" >/dev/null

python3 - "$summary" "${FOLDERS[@]}" <<'EOF'
import json, sys
data = json.load(open(sys.argv[1]))
folders = sys.argv[2:]
sums = {f: [0, 0, 0, 0] for f in folders}
for entry in data["files"]:
    top = entry["filename"].split("/", 1)[0]
    if top in sums:
        s = sums[top]
        s[0] += entry["line_covered"]; s[1] += entry["line_total"]
        s[2] += entry["branch_covered"]; s[3] += entry["branch_total"]
def pct(a, b):
    return f"{100.0 * a / b:6.2f}%" if b else "    n/a"
print(f"{'folder':10} {'lines':>20} {'line':>8} {'branches':>20} {'branch':>8}")
total = [0, 0, 0, 0]
for f in folders:
    s = sums[f]
    total = [t + v for t, v in zip(total, s)]
    print(f"{f:10} {s[0]:>9}/{s[1]:<10} {pct(s[0], s[1])} {s[2]:>9}/{s[3]:<10} {pct(s[2], s[3])}")
print(f"{'total':10} {total[0]:>9}/{total[1]:<10} {pct(total[0], total[1])} "
      f"{total[2]:>9}/{total[3]:<10} {pct(total[2], total[3])}")
EOF

#!/usr/bin/env bash
# Builds every benchmark program under bench/ in release mode and prints one
# table: benchmark name, real time and thread CPU time per iteration, and the
# counters it reports.
# Timings on shared machines are noisy; compare ratios within one run.
set -euo pipefail
cd "$(dirname "$0")/.."
bash scripts/install-deps.sh >/dev/null
cmake --preset release >/dev/null
cmake --build --preset release
OUT="$(mktemp -d)"
trap 'rm -rf "$OUT"' EXIT
shopt -s nullglob
for exe in build/release/bench/bench_*; do
  [ -x "$exe" ] || continue
  "$exe" --benchmark_format=json --benchmark_min_time="${BENCH_MIN_TIME:-0.2}" \
    >"$OUT/$(basename "$exe").json" 2>/dev/null
done
python3 - "$OUT" <<'PY'
import json, os, sys
rows = []
for name in sorted(os.listdir(sys.argv[1])):
    with open(os.path.join(sys.argv[1], name)) as f:
        data = json.load(f)
    for b in data.get("benchmarks", []):
        t = b.get("real_time", 0.0)
        cpu = b.get("cpu_time", 0.0)
        unit = b.get("time_unit", "ns")
        extras = {k: v for k, v in b.items() if k not in (
            "name", "run_name", "run_type", "repetitions", "repetition_index", "threads",
            "iterations", "real_time", "cpu_time", "time_unit", "family_index",
            "per_family_instance_index", "aggregate_name", "aggregate_unit", "label")}
        extra = ", ".join(f"{k}={v:.4g}" if isinstance(v, float) else f"{k}={v}" for k, v in extras.items())
        rows.append((name[len("bench_"):-len(".json")], b["name"], f"{t:.4g} {unit}", f"{cpu:.4g} {unit}", extra))
w = [max([len(r[i]) for r in rows] + [len(h)]) for i, h in enumerate(("program", "benchmark", "real time", "cpu time"))]
print(f"{'program'.ljust(w[0])}  {'benchmark'.ljust(w[1])}  {'real time'.rjust(w[2])}  {'cpu time'.rjust(w[3])}  counters")
for r in rows:
    print(f"{r[0].ljust(w[0])}  {r[1].ljust(w[1])}  {r[2].rjust(w[2])}  {r[3].rjust(w[3])}  {r[4]}")
PY

#!/usr/bin/env bash
# Measures the toolkit against Qt 5 Widgets (offscreen platform) on the
# operations both do, in thread CPU time. The Qt figures and the matching
# toolkit benchmarks run in alternation, three rounds, so that both sides see
# the same load on a shared machine; the table gives the median of each side
# and their ratio (below 1: the toolkit is faster).
# Usage: scripts/compare-with-qt.sh [rounds]   (from anywhere; builds release)
set -euo pipefail
cd "$(dirname "$0")/.."
ROUNDS="${1:-3}"
# The peer sits beside the main checkout; a worktree finds it through git.
MAIN="$(cd "$(git rev-parse --git-common-dir)/.." && pwd)"
PEER="${QT_PEER:-$MAIN/../shared/peers/qt/run.sh}"
[ -f "$PEER" ] || { echo "compare-with-qt: no Qt peer at $PEER (set QT_PEER)" >&2; exit 1; }
cmake --preset release >/dev/null
cmake --build build/release --target bench_draw_traversal bench_drawing bench_node_tree bench_dispatch bench_focus >/dev/null
OUT="$(mktemp -d)"
trap 'rm -rf "$OUT"' EXIT
B=build/release/bench
for round in $(seq 1 "$ROUNDS"); do
  bash "$PEER" >"$OUT/qt.$round.txt"
  "$B/bench_draw_traversal" --benchmark_filter='RepaintAfterOneViewInvalidated|FullRepaintWithoutCaches' \
    --benchmark_format=json >"$OUT/nv.draw.$round.json" 2>/dev/null
  "$B/bench_drawing" --benchmark_filter='FillSmallRectangles|DrawShortLabels' \
    --benchmark_format=json >"$OUT/nv.drawing.$round.json" 2>/dev/null
  "$B/bench_node_tree" --benchmark_filter='LocalToGlobalF_Depth32|GetChildHit_10000' \
    --benchmark_format=json >"$OUT/nv.tree.$round.json" 2>/dev/null
  "$B/bench_dispatch" --benchmark_filter='ButtonPressAtRootOverLeaf32Deep|MouseOverMoveAcross100x100' \
    --benchmark_format=json >"$OUT/nv.dispatch.$round.json" 2>/dev/null
  "$B/bench_focus" --benchmark_filter='TabForwardAcrossNestedPanel' \
    --benchmark_format=json >"$OUT/nv.focus.$round.json" 2>/dev/null
done
python3 - "$OUT" "$ROUNDS" <<'PY'
import glob, json, os, re, statistics, sys
out, rounds = sys.argv[1], int(sys.argv[2])
scale = {"ns": 1.0, "us": 1e3, "ms": 1e6, "s": 1e9}
# Each row: label, the Qt line's pattern and unit, the toolkit benchmark.
rows = [
    ("repaint after one 46 x 20 cell of the 2,000-cell panel is invalidated",
     r"qtx: render of one cell's rectangle of the panel: ([\d.]+) us", 1e3, "RepaintAfterOneViewInvalidated"),
    ("10,000 small rectangle fills", r"qtx: 10000 small rectangles: ([\d.]+) ms", 1e6, "FillSmallRectangles"),
    ("1,000 short labels, anti-aliased, DejaVu Sans 12 px", r"qtx: 1000 short labels: ([\d.]+) ms", 1e6,
     "DrawShortLabels"),
    ("map a point through a 32-deep chain", r"qt: mapTo through 32-deep chain: ([\d.]+) ns", 1.0,
     "BM_LocalToGlobalF_Depth32"),
    ("child hit among 10,000 children", r"qt: childAt among 10,000 children.*?: ([\d.]+) ns", 1.0,
     "BM_GetChildHit_10000Children_FirstHit"),
    ("full render of the 2,000-cell panel, no caches", r"qtx: panel render mode full: ([\d.]+) ms", 1e6,
     "FullRepaintWithoutCaches"),
    ("press at the root over a 32-deep leaf, hit-tested from the root",
     r"qtx: press with childAt hit test from the root.*?: ([\d.]+) ns", 1.0, "BM_ButtonPressAtRootOverLeaf32Deep"),
    ("Tab among 1,000 buttons", r"qt: Tab focus advance among 1,000 buttons: ([\d.]+) ns", 1.0,
     "BM_TabForwardAcrossNestedPanel"),
]
qt = {r[0]: [] for r in rows}
nv = {r[0]: [] for r in rows}
for i in range(1, rounds + 1):
    text = open(os.path.join(out, f"qt.{i}.txt")).read()
    for label, pattern, unit, _ in rows:
        m = re.search(pattern, text)
        if m: qt[label].append(float(m.group(1)) * unit)
    for path in glob.glob(os.path.join(out, f"nv.*.{i}.json")):
        for b in json.load(open(path)).get("benchmarks", []):
            for label, _, _, name in rows:
                if b["name"] == name:
                    nv[label].append(b["cpu_time"] * scale[b.get("time_unit", "ns")])
def show(ns):
    if ns >= 1e6: return f"{ns / 1e6:.2f} ms"
    if ns >= 1e3: return f"{ns / 1e3:.1f} us"
    return f"{ns:.0f} ns"
print(f"Medians of {rounds} alternating rounds, thread CPU time.")
print("| Operation | Qt 5 | toolkit | ratio |")
print("|---|---|---|---|")
for label, _, _, _ in rows:
    if not qt[label] or not nv[label]:
        print(f"| {label} | {'-' if not qt[label] else show(statistics.median(qt[label]))} | "
              f"{'-' if not nv[label] else show(statistics.median(nv[label]))} | - |")
        continue
    q, n = statistics.median(qt[label]), statistics.median(nv[label])
    print(f"| {label} | {show(q)} | {show(n)} | {n / q:.2f} |")
PY

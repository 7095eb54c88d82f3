#!/usr/bin/env bash
# The gallery's start on a real X server: from launching the program to its
# first frame on the screen. Starts a private Xvfb, runs the gallery RUNS times
# (default 11, after one uncounted warm-up run that fills the font caches) with
# --exit-after-first-frame, and prints every run and the medians of
#   launch   from launching the process to the line it prints right after its
#            first frame went to the server (measured from outside), and
#   program  the time the program tells, from its static start-up.
# The target for the launch median is 300 ms at most.
set -euo pipefail
cd "$(dirname "$0")/.."
EXE="${GALLERY:-build/release/apps/gallery/norvik-gallery}"
RUNS="${RUNS:-11}"
if [ ! -x "$EXE" ]; then
  cmake --preset release >/dev/null
  cmake --build --preset release --target norvik-gallery
fi
if ! command -v Xvfb >/dev/null; then
  echo "bench-gallery-start: Xvfb is not installed (scripts/install-deps.sh installs it)" >&2
  exit 1
fi

WORK="$(mktemp -d)"
XVFB_PID=""
cleanup() {
  if [ -n "$XVFB_PID" ]; then kill "$XVFB_PID" 2>/dev/null || true; wait "$XVFB_PID" 2>/dev/null || true; fi
  rm -rf "$WORK"
}
trap cleanup EXIT
# Xvfb writes the display number it took to the file once it accepts clients.
Xvfb -displayfd 3 -screen 0 1280x800x24 -nolisten tcp -noreset 3>"$WORK/display" 2>/dev/null &
XVFB_PID=$!
for _ in $(seq 100); do
  [ -s "$WORK/display" ] && break
  sleep 0.05
done
if [ ! -s "$WORK/display" ]; then
  echo "bench-gallery-start: Xvfb did not start" >&2
  exit 1
fi
DISPLAY=":$(head -n1 "$WORK/display")" python3 - "$EXE" "$RUNS" <<'PY'
import re, statistics, subprocess, sys, time

exe, runs = sys.argv[1], int(sys.argv[2])

def run_once():
    start = time.monotonic()
    proc = subprocess.Popen([exe, "--exit-after-first-frame"], stdout=subprocess.PIPE, stderr=subprocess.STDOUT,
                            text=True)
    launch, told, output = None, None, []
    for line in proc.stdout:
        output.append(line)
        m = re.search(r"First frame after ([0-9.]+) ms", line)
        if m and launch is None:
            launch = (time.monotonic() - start) * 1000.0
            told = float(m.group(1))
    proc.wait()
    if proc.returncode != 0 or launch is None:
        sys.exit("bench-gallery-start: the gallery failed:\n" + "".join(output))
    if any("rendering to" in line for line in output):
        sys.exit("bench-gallery-start: the gallery did not open the display:\n" + "".join(output))
    return launch, told

run_once()  # warm-up: font and shader caches, page cache of the library
results = [run_once() for _ in range(runs)]
print(f"{'run':>4}  {'launch ms':>10}  {'program ms':>10}")
for i, (launch, told) in enumerate(results, 1):
    print(f"{i:>4}  {launch:>10.1f}  {told:>10.1f}")
launch_median = statistics.median(r[0] for r in results)
told_median = statistics.median(r[1] for r in results)
print(f"median  launch {launch_median:.1f} ms  program {told_median:.1f} ms  (target: launch at most 300 ms)")
PY

#!/usr/bin/env bash
# Builds the toolkit and runs its whole test suite: the headless tests and the
# tests against a real X server (Xvfb is started by those tests themselves).
# Usage: scripts/test.sh [preset]   (release by default; "sanitize" for ASan+UBSan)
set -euo pipefail
cd "$(dirname "$0")/.."
PRESET="${1:-release}"
# Paths below the checkout count as relative for ccache, so clones share the cache.
export CCACHE_BASEDIR="$PWD"
bash scripts/install-deps.sh
bash scripts/check-layering.sh
cmake --preset "$PRESET" >/dev/null
cmake --build --preset "$PRESET"
ctest --preset "$PRESET" -j"$(nproc)"

#!/usr/bin/env bash
# Builds the toolkit and runs the gallery. Extra arguments go to the gallery.
set -euo pipefail
cd "$(dirname "$0")/.."
bash scripts/install-deps.sh
cmake --preset release >/dev/null
cmake --build --preset release --target norvik-gallery
exec ./build/release/apps/gallery/norvik-gallery "$@"

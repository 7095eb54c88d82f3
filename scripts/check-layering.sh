#!/usr/bin/env bash
# Fails when a file outside the platform folders includes a platform header
# (X11, xcb, xkbcommon, Cairo, Pango, fontconfig, OpenGL and GLX). Platform code lives only
# in folders named cairo, x11 or headless, so that another port is a new folder.
set -euo pipefail
cd "$(dirname "$0")/.."
pattern='#[[:space:]]*include[[:space:]]*[<"](X11/|xcb/|xkbcommon/|cairo|pango/|fontconfig/|GL/|glib)'
bad=$(grep -rEl "$pattern" --include='*.h' --include='*.cpp' \
        tarsel drawbot ui utility controls arrange layout dialogs sharedui automateui apps 2>/dev/null \
      | grep -Ev '/src/(cairo|x11|headless)/' || true)
if [ -n "$bad" ]; then
  echo "check-layering: platform headers included outside the platform folders:" >&2
  echo "$bad" >&2
  exit 1
fi
echo "check-layering: ok"

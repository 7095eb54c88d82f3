#!/usr/bin/env bash
# Installs every Debian package that building, testing, fuzzing and benchmarking
# the toolkit needs. Safe to run again: apt-get skips what is already present.
set -euo pipefail

PACKAGES=(
  build-essential cmake ninja-build ccache pkg-config clang
  libboost-dev
  libexpat1-dev nlohmann-json3-dev
  libcairo2-dev libpango1.0-dev libfontconfig-dev fonts-dejavu-core
  libpng-dev libjpeg-dev librsvg2-bin
  libxcb1-dev libxcb-randr0-dev libxcb-xkb-dev libxcb-xtest0-dev libxcb-shape0-dev
  libxcb-render0-dev libxcb-cursor-dev libxcb-xfixes0-dev libxcb-icccm4-dev
  libxkbcommon-dev libxkbcommon-x11-dev
  libx11-dev libgl-dev libglx-dev mesa-common-dev libgl1-mesa-dri
  libgtest-dev libgmock-dev googletest libbenchmark-dev
  xvfb xdotool xclip x11-utils x11-xkb-utils openbox wmctrl
  gcovr
)

SUDO=""
if [ "$(id -u)" -ne 0 ]; then SUDO="sudo"; fi

missing=()
for p in "${PACKAGES[@]}"; do
  if ! dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q "install ok installed"; then
    missing+=("$p")
  fi
done

if [ "${#missing[@]}" -eq 0 ]; then
  echo "install-deps: all ${#PACKAGES[@]} packages present"
  exit 0
fi

echo "install-deps: installing ${missing[*]}"
export DEBIAN_FRONTEND=noninteractive
$SUDO apt-get update -qq
$SUDO apt-get install -y -qq --no-install-recommends "${missing[@]}"

#!/usr/bin/env bash
# Installs every Debian package that the build, the tests and the demo need; with --tests only
# what the build and the tests need (no display server or picture tools).
# Idempotent and non-interactive; run as root (or with sudo available).
set -euo pipefail

PACKAGES=(
    cmake ninja-build g++ ccache pkg-config
    qt6-base-dev qt6-serialport-dev libgl-dev
    poppler-utils fonts-liberation
    clang-14 libclang-rt-14-dev
)
[ "${1:-}" = "--tests" ] || PACKAGES+=(xvfb xdotool x11-apps imagemagick)

missing=()
for p in "${PACKAGES[@]}"; do
    dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q "install ok installed" || missing+=("$p")
done
[ ${#missing[@]} -eq 0 ] && exit 0

SUDO=""
[ "$(id -u)" -eq 0 ] || SUDO="sudo"
export DEBIAN_FRONTEND=noninteractive
$SUDO apt-get update -qq
$SUDO apt-get install -y -qq --no-install-recommends "${missing[@]}"

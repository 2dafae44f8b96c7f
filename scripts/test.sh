#!/usr/bin/env bash
# Installs what is needed, builds and runs the whole test suite.
set -euo pipefail
top="$(cd "$(dirname "$0")/.." && pwd)"
cd "$top"
bash scripts/deps.sh
export QT_QPA_PLATFORM=offscreen
jobs="$(nproc)"

bash scripts/build.sh build
(cd build && ctest --output-on-failure --parallel "$jobs")

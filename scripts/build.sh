#!/usr/bin/env bash
# Configures and builds one build folder:
#   scripts/build.sh DIR [cmake arguments ...] [--target T ...]
set -euo pipefail
top="$(cd "$(dirname "$0")/.." && pwd)"
dir="$1"; shift
cmake_args=()
targets=()
while [ $# -gt 0 ]; do
    if [ "$1" = "--target" ]; then targets+=(--target "$2"); shift 2
    else cmake_args+=("$1"); shift; fi
done
launcher=()
command -v ccache >/dev/null && launcher=(-DCMAKE_CXX_COMPILER_LAUNCHER=ccache)
cmake -S "$top" -B "$dir" -G Ninja -DCMAKE_BUILD_TYPE=RelWithDebInfo "${launcher[@]}" "${cmake_args[@]}" >/dev/null
cmake --build "$dir" --parallel "$(nproc)" "${targets[@]}"

#!/usr/bin/env bash
# Installs what is needed, builds and runs the whole test suite: once in the normal build, once
# with AddressSanitizer and UndefinedBehaviorSanitizer (build-asan), then every fuzzer briefly.
set -euo pipefail
top="$(cd "$(dirname "$0")/.." && pwd)"
cd "$top"
bash scripts/deps.sh --tests
export QT_QPA_PLATFORM=offscreen
jobs="$(nproc)"
# Build folders may move between machines and checkouts: let ccache match them anyway.
export CCACHE_BASEDIR="$top" CCACHE_NOHASHDIR=true CCACHE_SLOPPINESS=pch_defines,time_macros,include_file_mtime,include_file_ctime

bash scripts/build.sh build
(cd build && ctest --output-on-failure --parallel "$jobs")

# Any sanitizer report fails the test that caused it. Leaks are checked; the only ones left out
# are listed, each with its reason, in the suppressions file.
export ASAN_OPTIONS="detect_leaks=1:halt_on_error=1:abort_on_error=0:strict_init_order=1:check_initialization_order=1:detect_stack_use_after_return=1:allocator_may_return_null=0"
export LSAN_OPTIONS="suppressions=$top/scripts/lsan.supp:print_suppressions=0"
export UBSAN_OPTIONS="print_stacktrace=1:halt_on_error=1"
# The benchmarks run by hand in the normal build; sanitizing them as well buys nothing.
bash scripts/build.sh build-asan -DTELVIO_SANITIZE=ON -DTELVIO_BENCH=OFF
# Window tests wait on timers; a sanitized build is slower, so give each test more time.
(cd build-asan && ctest --output-on-failure --parallel "$jobs" --timeout 300)

bash scripts/fuzz.sh --ci

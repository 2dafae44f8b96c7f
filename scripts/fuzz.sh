#!/usr/bin/env bash
# Builds the libFuzzer targets with clang (build-fuzz) and runs each for a set time.
#   scripts/fuzz.sh [--ci] [--seconds N] [target ...]
# Default: every target for 20 s; --ci: 5 s each (the seed corpus and a little beyond; long runs
# are for by hand). Targets are the names under fuzz/ without ".cpp" (status_reply, log_line,
# ...). A crash, a hang (over 5 s for one input), a sanitizer
# report or a broken invariant stops that target, keeps the input under build-fuzz/artifacts/
# and makes the script fail. New inputs the fuzzer finds go to build-fuzz/corpus/, never into
# the seed corpus in the repository.
set -euo pipefail
top="$(cd "$(dirname "$0")/.." && pwd)"
cd "$top"
seconds=20
targets=()
while [ $# -gt 0 ]; do
    case "$1" in
    --ci) seconds=5 ;;
    --seconds) seconds="$2"; shift ;;
    *) targets+=("$1") ;;
    esac
    shift
done
dir="${FUZZ_BUILD:-$top/build-fuzz}"
export CCACHE_BASEDIR="$top" CCACHE_NOHASHDIR=true CCACHE_SLOPPINESS=pch_defines,time_macros,include_file_mtime,include_file_ctime

launcher=()
command -v ccache >/dev/null && launcher=(-DCMAKE_CXX_COMPILER_LAUNCHER=ccache)
cmake -S "$top" -B "$dir" -G Ninja -DCMAKE_BUILD_TYPE=RelWithDebInfo -DCMAKE_CXX_COMPILER=clang++-14 \
    -DTELVIO_FUZZ=ON "${launcher[@]}" >/dev/null
cmake --build "$dir" --target fuzzers --parallel "$(nproc)"

if [ ${#targets[@]} -eq 0 ]; then
    for f in fuzz/*.cpp; do targets+=("$(basename "$f" .cpp)"); done
fi

export ASAN_OPTIONS="detect_leaks=1:halt_on_error=1:allocator_may_return_null=1"
export UBSAN_OPTIONS="print_stacktrace=1:halt_on_error=1"
mkdir -p "$dir/artifacts" "$dir/logs"
failed=0
printf '%-18s %10s %8s %s\n' target executions corpus result
for t in "${targets[@]}"; do
    corpus="$dir/corpus/$t"
    mkdir -p "$corpus"
    log="$dir/logs/$t.log"
    status=0
    "$dir/fuzz/fuzz_$t" "$corpus" "fuzz/corpus/$t" -max_total_time="$seconds" -timeout=5 \
        -rss_limit_mb=2048 -max_len=4096 -print_final_stats=1 \
        -artifact_prefix="$dir/artifacts/$t-" >"$log" 2>&1 || status=$?
    execs="$(sed -n 's/^stat::number_of_executed_units: *//p' "$log" | tail -1)"
    units="$(ls "$corpus" | wc -l)"
    if [ "$status" -eq 0 ]; then
        result=ok
    else
        result="FAILED (exit $status, see $log)"
        failed=1
        grep -m5 -E 'ERROR|broken invariant|runtime error|SUMMARY' "$log" | sed 's/^/    /' >&2 || true
    fi
    printf '%-18s %10s %8s %s\n' "$t" "${execs:-?}" "$units" "$result"
done
exit $failed

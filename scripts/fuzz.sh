#!/usr/bin/env bash
# Builds the fuzz targets with clang and libFuzzer (the fuzz preset) and runs
# each one on its corpus.
#   scripts/fuzz.sh --ci            every target for 20 s (make test does this)
#   scripts/fuzz.sh [SECONDS [NAME]] a long campaign, one hour each by default
# New corpus entries stay in build/fuzz/corpus; an input that crashes is
# written to tests/fuzz/crashers/<name>/, where the normal test run replays
# it from then on: commit it with the fix.
set -euo pipefail
cd "$(dirname "$0")/.."

seconds=3600
only=""
if [ "${1:-}" = "--ci" ]; then
    seconds=20
    shift
elif [ -n "${1:-}" ]; then
    seconds=$1
    only=${2:-}
fi
targets=(tagmap comp expression layout shape)
[ -n "$only" ] && targets=("$only")

jobs=${JOBS:-$(nproc)}
cmake --preset fuzz >/dev/null
cmake --build --preset fuzz -j "$jobs" --target "${targets[@]/#/fuzz_}"

export QT_QPA_PLATFORM=offscreen
export ASAN_OPTIONS=detect_leaks=0:${ASAN_OPTIONS:-}
export UBSAN_OPTIONS=print_stacktrace=1:halt_on_error=1:${UBSAN_OPTIONS:-}
status=0
for name in "${targets[@]}"; do
    work=build/fuzz/corpus/$name
    crashers=tests/fuzz/crashers/$name
    mkdir -p "$work" "$crashers"
    echo "fuzz: $name for ${seconds}s"
    if ! build/fuzz/bin/fuzz_"$name" -max_total_time="$seconds" -timeout=10 -rss_limit_mb=2048 \
        -max_len=4096 -artifact_prefix="$crashers/" "$work" tests/fuzz/corpus/"$name" >build/fuzz/"$name".log 2>&1; then
        echo "fuzz: $name found a failure; see build/fuzz/$name.log and $crashers/"
        tail -n 30 build/fuzz/"$name".log
        status=1
    fi
done
exit $status

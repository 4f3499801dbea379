#!/usr/bin/env bash
# fuzz/run.sh BIN SECONDS [TARGET...]: runs each fuzz target for SECONDS, two at a time, and prints the outcomes.
# A run keeps new inputs in BIN/../corpus and findings in fuzz/found/TARGET. Ends with status 1 if there was a finding.
set -euo pipefail
bin=$(cd "${1:?folder of the fuzz programs}" && pwd)
seconds=${2:?seconds for each target}
shift 2
cd "$(dirname "${BASH_SOURCE[0]}")"
targets=("$@")
[ $# -gt 0 ] || mapfile -t targets < <(cd corpus && ls)
work=$(dirname "$bin")/corpus
findings=$PWD/found
logs=$(dirname "$bin")/logs
mkdir -p "$logs"
export CIMDELTA_ROOT=${CIMDELTA_ROOT:-$(dirname "$PWD")}
export ASAN_OPTIONS=${ASAN_OPTIONS:-detect_stack_use_after_return=0} UBSAN_OPTIONS=${UBSAN_OPTIONS:-print_stacktrace=1}

run_target() {
    local target=$1 status=0 dictionary=()
    mkdir -p "$work/$target" "found/$target"
    [ ! -f "dictionaries/$target.dict" ] || dictionary=("-dict=dictionaries/$target.dict")
    # Without the entropic schedule: its bookkeeping takes most of the time if an input has thousands of features.
    "$bin/fuzz_$target" -entropic=0 -max_total_time="$seconds" -timeout=20 -rss_limit_mb=3000 -max_len=8192 -print_final_stats=1 \
        -artifact_prefix="$findings/$target/" "${dictionary[@]}" "$work/$target" "corpus/$target" >"$logs/$target" 2>&1 || status=$?
    rmdir --ignore-fail-on-non-empty "found/$target"
    echo "$status" >"$logs/$target.status"
}

field() { grep -oE "$2 *[0-9]+" "$logs/$1" | grep -oE '[0-9]+$' | tail -1; }

for target in "${targets[@]}"; do
    while [ "$(jobs -rp | wc -l)" -ge 2 ]; do wait -n; done
    run_target "$target" &
done
wait

found=0
printf '%-14s %12s %10s %10s  %s\n' target executions coverage features outcome
for target in "${targets[@]}"; do
    outcome=clean
    if [ "$(cat "$logs/$target.status")" -ne 0 ]; then
        outcome="FINDING: $(grep -m1 -oE 'found/[^ ]*/(crash|leak|timeout|oom|slow-unit)-[0-9a-f]+' "$logs/$target" || echo "see $logs/$target")"
        found=1
    fi
    printf '%-14s %12s %10s %10s  %s\n' "$target" "$(field "$target" 'number_of_executed_units:' || echo '?')" \
        "$(field "$target" 'cov:' || echo '?')" "$(field "$target" 'ft:' || echo '?')" "$outcome"
done
exit $found

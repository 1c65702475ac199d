#!/usr/bin/env bash
# Lets each fuzz target search for inputs that break it, starting from its committed corpus.
#
#   scripts/fuzz.sh [SECONDS] [TARGET...]      seconds for each target (60), all targets unless named
#
# It is for people: no two runs are alike. What every change must pass is `ctest --preset asan -L fuzz`, which tries the
# same inputs each time. A finding is left as build/fuzz/findings/TARGET-*; it belongs into tests/fuzz/corpus/TARGET/
# together with its mend.
set -euo pipefail
cd "$(dirname "$0")/.."

seconds=${1:-60}
shift || true
scripts/setup.sh build test fuzz
cmake --preset asan
cmake --build --preset asan --target fuzz-tests
if [ $# -eq 0 ]; then
    mapfile -t names < <(find tests/fuzz -maxdepth 1 -name '*.cpp' ! -name Replay.cpp -printf '%f\n' | sort)
    set -- "${names[@]%.cpp}"
fi

mkdir -p build/fuzz/findings
failed=0
for target in "$@"; do
    corpus="build/fuzz/corpus/$target"
    log="build/fuzz/$target.log"
    mkdir -p "$corpus"
    # The first folder takes what is found, the second is only read.
    if scripts/test-env.sh fuzz "build/asan/bin/$target" -max_total_time="$seconds" -timeout=10 -rss_limit_mb=4096 \
        -print_final_stats=1 -artifact_prefix="build/fuzz/findings/$target-" \
        "$corpus" "tests/fuzz/corpus/$target" >"$log" 2>&1; then
        printf 'OK    %s: %s inputs tried in %s s\n' "$target" \
            "$(sed -n 's/^stat::number_of_executed_units: *//p' "$log")" "$seconds"
    else
        printf 'FAIL  %s, from %s:\n' "$target" "$log"
        grep -v '# Uses:' "$log" | tail -n 60
        failed=1
    fi
done
exit "$failed"

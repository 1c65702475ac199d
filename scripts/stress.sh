#!/usr/bin/env bash
# Runs tests again and again and tells which failed how often: for tests that fail now and then. For people, not part of
# the gate.
#
#   scripts/stress.sh [-b] [-o DIRECTORY] [-p PRESET] TIMES -L LABEL|-R PATTERN [CTEST-ARGUMENT...]
#
#   scripts/stress.sh 30 -R Placement       one group of tests thirty times
#   scripts/stress.sh -b 10 -L '^ui$'       all ui tests ten times, with a busy loop on each core
#
# The preset's build (debug) is used as it is. What failed tests said goes into DIRECTORY (build/stress), a file a round.
# The exit code is 1 when a test failed in any round, 2 when none could be run.
set -euo pipefail

usage() {
    sed -n '2,/^set/s/^# \{0,1\}//p' "$0" >&2
    exit 2
}
root=$(cd "$(dirname "$0")/.." && pwd)
busy='' preset=debug output="$root/build/stress"
while getopts bo:p: option; do
    case "$option" in
    b) busy=1 ;;
    o) output=$OPTARG ;;
    p) preset=$OPTARG ;;
    *) usage ;;
    esac
done
shift $((OPTIND - 1))
if [ $# -lt 2 ] || ! [[ $1 =~ ^[1-9][0-9]*$ ]]; then usage; fi
times=$1
shift
output=$(mkdir -p "$output" && cd "$output" && pwd)
cd "$root"

loops=()
stop() {
    [ ${#loops[@]} -eq 0 ] || kill "${loops[@]}" 2>/dev/null || true
}
trap stop EXIT
if [ -n "$busy" ]; then
    for ((core = $(nproc); core > 0; core--)); do
        # The loops end with this script even when that is killed.
        setpriv --pdeathsig KILL bash -c 'while :; do :; done' &
        loops+=($!)
    done
fi

rounds=0 bad=0
rm -f "$output"/round-*.log "$output/failed"
for ((round = 1; round <= times; round++)); do
    log="$output/round-$round.log" code=0
    ctest --preset "$preset" "$@" >"$log" 2>&1 || code=$?
    if ! grep -q '^[0-9]*% tests passed' "$log"; then
        echo "stress: round $round ran no tests" >&2
        tail -n 5 "$log" >&2
        exit 2
    fi
    rounds=$((rounds + 1))
    if [ $code -eq 0 ]; then
        rm "$log"
        continue
    fi
    bad=$((bad + 1))
    # The list at the end: "<tab>  7 - Name (Failed)"
    sed -n '/^The following tests FAILED:/,$s/^[[:blank:]]*[0-9]* - \(.*\) (\(.*\)).*$/\1 (\2)/p' "$log" >>"$output/failed"
done

echo "$rounds rounds, $bad with failures"
[ "$bad" -eq 0 ] && exit 0
echo "failed  test"
sort "$output/failed" | uniq -c | sort -rn | awk '{count = $1; $1 = ""; printf "%6d %s\n", count, $0}'
echo "what they said: $output/round-*.log"
exit 1

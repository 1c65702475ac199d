#!/usr/bin/env bash
# Runs the tests instrumented and tells which lines of s/ and platform/ they run. Arguments pass on to ctest.
# The page for each source: build/coverage/report/index.html
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/setup.sh coverage
find build/coverage -name '*.gcda' -delete 2>/dev/null || true
TVX_PRESET=coverage ./run-tests "$@"
mkdir -p build/coverage/report
gcovr --root . --object-directory build/coverage --filter 's/' --filter 'platform/' --exclude-throw-branches \
    --html-details build/coverage/report/index.html --txt build/coverage/report/summary.txt
cat build/coverage/report/summary.txt

#!/usr/bin/env bash
# Builds the libFuzzer targets with clang and runs each for a while on its corpus.
#   scripts/fuzz.sh [seconds per target]     (default 300; the test command uses a few seconds)
# The corpus grows in build-fuzz/corpus/<target>, seeded from tests/data/fuzz/<target>.
set -euo pipefail
root="$(cd "$(dirname "$0")/.." && pwd)"
source "$root/scripts/common.sh"
pemla_install_missing
seconds="${1:-300}"

CXX=clang++ cmake -S "$root" -B "$root/build-fuzz" -G Ninja -DPEMLA_FUZZ=ON -DPEMLA_WERROR=ON \
    -DCMAKE_BUILD_TYPE=RelWithDebInfo >/dev/null
cmake --build "$root/build-fuzz" -j "$(nproc)" >/dev/null

status=0
for seeds in "$root"/tests/data/fuzz/*/; do
    target="$(basename "$seeds")"
    corpus="$root/build-fuzz/corpus/$target"
    mkdir -p "$corpus"
    cp -n "$seeds"* "$corpus"/ 2>/dev/null || true
    log="$root/build-fuzz/$target.log"
    if "$root/build-fuzz/fuzz/$target" -max_total_time="$seconds" -max_len=65536 \
        -print_final_stats=1 "$corpus" >"$log" 2>&1; then
        runs="$(grep -o 'stat::number_of_executed_units: *[0-9]*' "$log" | grep -o '[0-9]*$' || echo '?')"
        echo "$target: ok, $runs runs in ${seconds}s"
    else
        echo "$target: FAILED (see $log)"
        tail -n 30 "$log"
        status=1
    fi
done
exit $status

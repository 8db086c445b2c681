#!/usr/bin/env bash
# Builds a Release binary of the benchmark and prints its table: each operation's time on lists of
# 1,000 and 32,767 generated entries, and its ratio to the floor (reading the list's files and
# writing them once through the same atomic path).
set -euo pipefail
root="$(cd "$(dirname "$0")/.." && pwd)"
source "$root/scripts/common.sh"
pemla_install_missing
cmake -S "$root" -B "$root/build-bench" -G Ninja -DCMAKE_BUILD_TYPE=Release >/dev/null
cmake --build "$root/build-bench" --target pemla_bench -j "$(nproc)" >/dev/null
echo "$(date -u +%F) on $(nproc) cores, $(free -g | awk '/^Mem:/{print $2}') GiB"
QT_QPA_PLATFORM=offscreen "$root/build-bench/bench/pemla_bench" --benchmark_min_time=0.5 "$@"

#!/usr/bin/env bash
# Builds the program (Release, without tests) and starts it; arguments go to the program, e.g.
# scripts/run.sh --data ~/discs. The program prepares its data folder itself.
set -euo pipefail
root="$(cd "$(dirname "$0")/.." && pwd)"
source "$root/scripts/common.sh"

pemla_install "${PEMLA_BUILD_PACKAGES[@]}"
cmake -S "$root" -B "$root/build-release" -G Ninja -DCMAKE_BUILD_TYPE=Release \
    -DPEMLA_BUILD_TESTS=OFF >/dev/null
cmake --build "$root/build-release" --target pemla -j "$(nproc)" >/dev/null
exec "$root/build-release/app/pemla" "$@"

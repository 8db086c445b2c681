#!/usr/bin/env bash
# Builds the program and starts it on the catalogue in the data folder
# ($PEMLA_DATA, else ${XDG_DATA_HOME:-$HOME/.local/share}/pemla).
set -euo pipefail
root="$(cd "$(dirname "$0")/.." && pwd)"
source "$root/scripts/common.sh"

if [ -z "${DISPLAY:-}" ] && [ -z "${WAYLAND_DISPLAY:-}" ] && [ -z "${QT_QPA_PLATFORM:-}" ]; then
    echo "No display found: run this on a desktop, or without one as: xvfb-run -a scripts/run.sh" >&2
    exit 1
fi

pemla_install_missing
cmake -S "$root" -B "$root/build-release" -G Ninja -DCMAKE_BUILD_TYPE=Release \
    -DPEMLA_BUILD_TESTS=OFF >/dev/null
cmake --build "$root/build-release" --target pemla -j "$(nproc)" >/dev/null

# The launcher prepares the data folder and starts the program there.
exec "$root/build-release/app/pemla-launcher"

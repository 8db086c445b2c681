#!/usr/bin/env bash
# Installs what is missing, builds, and runs every test twice: a normal build, then one with
# AddressSanitizer and UndefinedBehaviorSanitizer. Exits non-zero on any failure.
set -euo pipefail
root="$(cd "$(dirname "$0")/.." && pwd)"
source "$root/scripts/common.sh"
pemla_install_missing

jobs="$(nproc)"
export QT_QPA_PLATFORM=offscreen
export ASAN_OPTIONS="detect_leaks=1:abort_on_error=1"
export LSAN_OPTIONS="suppressions=$root/scripts/lsan.supp:print_suppressions=0"
export UBSAN_OPTIONS="print_stacktrace=1:halt_on_error=1"

build() {  # folder, extra cmake options...
    local folder="$1"
    shift
    cmake -S "$root" -B "$root/$folder" -G Ninja "$@" >/dev/null
    cmake --build "$root/$folder" -j "$jobs"
}

build build-test -DCMAKE_BUILD_TYPE=RelWithDebInfo -DPEMLA_WERROR=ON
build build-asan -DCMAKE_BUILD_TYPE=Debug -DPEMLA_SANITIZE=ON -DPEMLA_WERROR=ON

status=0
echo "== Format =="
(cd "$root" && git ls-files -- '*.cpp' '*.h' | xargs clang-format --dry-run --Werror) || status=1
echo "== Fuzz targets (a few seconds each) =="
"$root/scripts/fuzz.sh" "${PEMLA_FUZZ_SECONDS:-5}" || status=1
echo "== Tests (sanitizers) =="
ctest --test-dir "$root/build-asan" --output-on-failure --timeout 300 -j "$jobs" >"$root/build-asan/ctest.log" 2>&1 ||
    status=1
tail -n 25 "$root/build-asan/ctest.log"
echo "== Tests =="
ctest --test-dir "$root/build-test" --output-on-failure --timeout 300 -j "$jobs" || status=1
exit $status

#!/usr/bin/env bash
# Installs into a temporary prefix and starts the installed launcher offscreen on a fresh data
# folder: the folder gets the supplied files and the program keeps running until stopped.
set -euo pipefail
build="$1"
work="$(mktemp -d)"
trap 'rm -rf "$work"' EXIT

cmake --install "$build" --prefix "$work/prefix" >/dev/null
for file in bin/pemla libexec/pemla/pemla share/applications/pemla.desktop \
    share/icons/hicolor/scalable/apps/pemla.svg share/pemla/type.dat share/pemla/information.dat; do
    [ -f "$work/prefix/$file" ] || { echo "not installed: $file"; exit 1; }
done
grep -q '^Exec=pemla$' "$work/prefix/share/applications/pemla.desktop"

# Without a display the launcher says so and stops.
if env -u DISPLAY -u WAYLAND_DISPLAY -u QT_QPA_PLATFORM "$work/prefix/bin/pemla" 2>"$work/err"; then
    echo "started without a display"; exit 1
fi
grep -q "xvfb-run" "$work/err"

# An existing file in the data folder is kept; the missing ones are supplied.
mkdir -p "$work/data"
printf 'Mine\r\n' >"$work/data/type.dat"
status=0
PEMLA_DATA="$work/data" QT_QPA_PLATFORM=offscreen timeout 3 "$work/prefix/bin/pemla" || status=$?
[ "$status" -eq 124 ] || { echo "the program did not keep running (status $status)"; exit 1; }
[ "$(cat "$work/data/type.dat")" = $'Mine\r' ] || { echo "type.dat was overwritten"; exit 1; }
cmp "$work/data/information.dat" "$work/prefix/share/pemla/information.dat"
[ -f "$work/data/pemla.dat" ] && [ ! -s "$work/data/pemla.dat" ]
echo "installed and started"

#!/usr/bin/env bash
# Installs into a temporary prefix and starts the installed program as a menu or a shell would:
# through a link in another folder, with a fresh home, no display for the command line.
set -euo pipefail
build="$1"
work="$(mktemp -d)"
trap 'rm -rf "$work"' EXIT
prefix="$work/prefix"
fail() { echo "$*"; exit 1; }

cmake --install "$build" --prefix "$prefix" >/dev/null
for file in bin/pemla share/applications/io.github.pemla.Pemla.desktop \
    share/metainfo/io.github.pemla.Pemla.metainfo.xml share/icons/hicolor/scalable/apps/pemla.svg \
    share/pemla/type.dat share/pemla/information.dat; do
    [ -f "$prefix/$file" ] || fail "not installed: $file"
done
desktop-file-validate "$prefix/share/applications/io.github.pemla.Pemla.desktop"
grep -qx "Exec=\"$prefix/bin/pemla\"" "$prefix/share/applications/io.github.pemla.Pemla.desktop" ||
    fail "the menu entry does not name the installed program"
appstreamcli validate --no-net "$prefix/share/metainfo/io.github.pemla.Pemla.metainfo.xml" >/dev/null

mkdir "$work/elsewhere" "$work/home"
ln -s "$prefix/bin/pemla" "$work/elsewhere/pemla"
cd "$work/elsewhere"
nodisplay=(env -u DISPLAY -u WAYLAND_DISPLAY -u QT_QPA_PLATFORM HOME="$work/home")

# The command line answers without a display.
"${nodisplay[@]}" ./pemla --help >"$work/out" 2>"$work/err"
grep -q -- '--data <folder>' "$work/out" && [ ! -s "$work/err" ] || fail "--help"
[ "$("${nodisplay[@]}" ./pemla --version)" = "pemla 0.90" ] || fail "--version"
# So do export and import; a file named relative to the shell's folder is found there.
printf 'title,discs\r\nMiles,2\r\n' >"$work/in.csv"
"${nodisplay[@]}" ./pemla --data "$work/cli" import Jazz ../in.csv >/dev/null || fail "import"
[ "$("${nodisplay[@]}" ./pemla --data "$work/cli" export jazz --csv)" = \
  "$(printf 'title,type,discs,information,article number\r\nMiles,,2,,M001\r')" ] || fail "export"
status=0
"${nodisplay[@]}" ./pemla --bogus >"$work/out" 2>"$work/err" || status=$?
[ "$status" -eq 2 ] && [ ! -s "$work/out" ] && grep -q '^Usage: pemla' "$work/err" ||
    fail "unknown option: status $status"

# Started through the link with a fresh home, it prepares its data folder and keeps running.
status=0
env -u PEMLA_DATA -u XDG_DATA_HOME HOME="$work/home" QT_QPA_PLATFORM=offscreen timeout 3 ./pemla ||
    status=$?
[ "$status" -eq 124 ] || fail "the program did not keep running (status $status)"
data="$work/home/.local/share/pemla"
cmp "$data/type.dat" "$prefix/share/pemla/type.dat"
cmp "$data/information.dat" "$prefix/share/pemla/information.dat"
[ -f "$data/pemla.dat" ] && [ ! -s "$data/pemla.dat" ] || fail "no empty list index"

# A folder that cannot be prepared is named with its reason; the message box then waits.
touch "$work/file"
status=0
QT_QPA_PLATFORM=offscreen timeout 3 ./pemla --data "$work/file/data" 2>"$work/err" || status=$?
[ "$status" -eq 124 ] || fail "no message box for a folder that cannot be prepared ($status)"
grep -q "^pemla: The data folder \"$work/file/data\" cannot be used: Not a directory.$" \
    "$work/err" || fail "unexpected message: $(cat "$work/err")"
echo "installed and started"

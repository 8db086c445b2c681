#!/usr/bin/env bash
# Builds the program, starts it under Xvfb on a sample catalogue and saves PNGs of the main window
# (a list open, an entry selected; once for a list with and once for one without the information
# column; once filling the screen) and of each dialog (new list, search with a result, export),
# at the normal size, with 14-point fonts and at twice the scale.
#   scripts/screenshot.sh [output folder]     (default /tmp/pemla-shots)
set -euo pipefail
root="$(cd "$(dirname "$0")/.." && pwd)"
out="$(mkdir -p "${1:-/tmp/pemla-shots}" && cd "${1:-/tmp/pemla-shots}" && pwd)"

# Second stage: runs inside xvfb-run with the sample catalogue ready.
if [ "${PEMLA_SHOTS_STAGE:-}" = "display" ]; then
    variant="${PEMLA_SHOTS_VARIANT:-}"
    PEMLA_DATA="$PEMLA_SHOTS_DATA" XDG_CONFIG_HOME="$PEMLA_SHOTS_DATA/config" \
        "$root/build-release/app/pemla" &
    program=$!
    trap 'kill "$program" 2>/dev/null || true' EXIT

    # Waits for a visible window by its exact title and prints its id.
    window() {
        local id
        id=$(timeout 20 xdotool search --sync --onlyvisible --name "^$1\$" | head -n 1) || true
        if [ -z "$id" ]; then
            echo "screenshot.sh: the window \"$1\" did not appear; the screen is in" \
                "$out/failed-screen.png" >&2
            import -window root "$out/failed-screen.png"
            return 1
        fi
        echo "$id"
    }
    # Types into the window that has the focus.
    typeText() {
        xdotool windowfocus --sync "$1"
        xdotool type --delay 40 "$2"
        sleep 0.3
    }
    shot() {
        sleep 0.5
        import -window "$1" "$out/$2.png"
        echo "saved $out/$2.png"
    }

    main=$(window "Pemla 0.90Beta")
    sleep 1
    xdotool windowfocus --sync "$main"
    keys() { xdotool key --delay 80 "$@"; sleep 0.4; }

    # The lists are sorted: Films, Jeux vidéo, Musique. The focus starts in the title box; a
    # list box starts with its first row current but not selected. Open Films (three back from the
    # title box, past the titles and the find box), pick "Les Misérables" in the titles.
    keys shift+Tab shift+Tab shift+Tab Down Up
    keys Tab Tab Down Down Down Down
    shot "$main" "${variant}main-window"

    # The list without an information column, with its longest title selected.
    keys shift+Tab shift+Tab Down Tab Tab Down
    shot "$main" "${variant}main-window-no-information"

    # The same window filling the screen.
    xdotool windowsize --sync "$main" 100% 100%
    shot "$main" "${variant}main-window-maximised"

    # Back to Films for the dialogs, opened and closed by their access keys.
    keys shift+Tab shift+Tab Up
    keys alt+n
    dialog=$(window "Create new list")
    typeText "$dialog" "Séries télé"
    shot "$dialog" "${variant}new-list"
    keys alt+c

    xdotool windowfocus --sync "$main"
    keys alt+s
    dialog=$(window "Search article number")
    typeText "$dialog" "a001"
    keys alt+s
    shot "$dialog" "${variant}search"
    keys alt+c

    xdotool windowfocus --sync "$main"
    keys alt+e
    dialog=$(window "Export list")
    sleep 1  # the folder list reads its folders in the background
    shot "$dialog" "${variant}export"
    keys alt+c
    exit 0
fi

# shellcheck source=scripts/common.sh
source "$root/scripts/common.sh"
pemla_install_missing
cmake -S "$root" -B "$root/build-release" -G Ninja -DCMAKE_BUILD_TYPE=Release \
    -DPEMLA_BUILD_TESTS=OFF >/dev/null
cmake --build "$root/build-release" --target pemla -j "$(nproc)" >/dev/null

data="$(mktemp -d /tmp/pemla-shots-data.XXXXXX)"
trap 'rm -rf "$data"' EXIT
mkdir -p "$data/reports"

# Writes a catalogue file: each argument one line, every line ended by CR LF. The program's
# texts and file names are Latin-1 bytes, so both are converted from this script's UTF-8.
latin1() { printf '%s' "$1" | iconv -f UTF-8 -t ISO-8859-1; }
put() {
    local file
    file="$(latin1 "$1")"
    shift
    printf '%s\r\n' "$@" | iconv -f UTF-8 -t ISO-8859-1 >"$data/$file"
}
# A list: its name, its information flag, then title, type, discs, information, article number
# for each entry.
list() {
    local name="$1" flag="$2"
    shift 2
    local entries=() articles=()
    while [ $# -gt 0 ]; do
        entries+=("<|?$1" "<|'$2" "<||$3" "<|*$4")
        articles+=("$1#*\\$5")
        shift 5
    done
    put "$name.dat" "${entries[@]}"
    put "$name.art" "${articles[@]}"
    put "$name.inf" " $flag "
}

put pemla.dat "Films" "Musique" "Jeux vidéo"
list Films 1 \
    "Amélie" "DVD video" 1 "Original" A001 \
    "Brazil" "Blu-ray video" 1 "Copy" B001 \
    "Casablanca" "DVD video" 1 "Boxed" C001 \
    "Ça commence aujourd'hui" "DVD video" 1 "Signed" "!001" \
    "Le fabuleux destin" "DVD video" 2 "Still sealed" L001 \
    "Les Misérables" "Blu-ray video" 3 "Original" L002 \
    "Zazie dans le métro" "DVD video" 1 "Missing cover" Z001 \
    "Être et avoir" "DVD video" 1 "Lent out" "!002" \
    "Metropolis" "Blu-ray video" 2 "Scratched" M001
put Films.arn "A#002" "B#002" "C#002" "!#003" "L#003" "Z#002" "M#002"
list Musique 1 \
    "Abbey Road" "Music CD" 1 "Original" A001 \
    "Déjà vu" "Music CD" 1 "Signed" D001 \
    "Für Elise" "Music CD" 1 "Copy" F001
put Musique.arn "A#002" "D#002" "F#002"
list "Jeux vidéo" 0 \
    "Élite" "Game" 2 "  " "!001" \
    "The Secret of Monkey Island: Special Edn." "Game" 1 "  " T001 \
    "Tetris" "Game" 1 "  " T002
put "Jeux vidéo.arn" "A#001" "!#002" "T#003"
put export.dat "$data/reports" " 1 " " 0 " " 1 " " 0 " " 1 " " 1 " "10" "Top"
# The program puts the supplied suggestion files into the data folder itself.

# Once as it comes, once with fonts of 14 points (the program's 9 points at 149 dpi), once at
# twice the scale.
export PEMLA_SHOTS_STAGE=display PEMLA_SHOTS_DATA="$data"
xvfb-run -a -s "-screen 0 1600x1000x24" "$0" "$out"
PEMLA_SHOTS_VARIANT=font14- QT_FONT_DPI=149 xvfb-run -a -s "-screen 0 1600x1000x24" "$0" "$out"
PEMLA_SHOTS_VARIANT=scale2- QT_SCALE_FACTOR=2 xvfb-run -a -s "-screen 0 1600x1000x24" "$0" "$out"

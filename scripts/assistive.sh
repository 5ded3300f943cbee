#!/usr/bin/env bash
# assistive.sh PRESET: a record is typed in on a virtual display beside the bus of screen readers, where
# every key takes a way of its own: it must mean what it means without a reader.
set -eu
cd "$(dirname "$0")/.."
if [ -z "${2:-}" ]; then
    . scripts/common.sh
    # shellcheck disable=SC2086
    need $assistive_packages
    exec timeout 100 dbus-run-session -- "$0" "$1" inside 2>&1
fi

. scripts/display.sh
start_display
export HOME=$display_folder XDG_RUNTIME_DIR=$display_folder/run LC_ALL=C.UTF-8
unset SONGCASE_FOLDER XDG_CONFIG_HOME XDG_DATA_HOME XDG_CACHE_HOME
mkdir -m 700 "$XDG_RUNTIME_DIR"
dbus-send --session --print-reply --dest=org.a11y.Bus /org/a11y/bus org.a11y.Bus.GetAddress >/dev/null
QT_QPA_PLATFORM=xcb QT_LINUX_ACCESSIBILITY_ALWAYS_ON=1 start_program "build/$1/bin/songcase"
await_main_window
xdotool windowfocus --sync "$window"
# Only the system's own Python finds the library of the bus.
/usr/bin/python3 scripts/assistive.py
end_program

saved=$(sqlite3 "$HOME/.local/share/songcase/Compact4.orv" \
    "select TrackNo, Naam, Tracks.Titel from CompactDiscs, Tracks, Artiesten
     where Tracks.ID = Track_ID and Artiesten.ID = Artiest_ID" | sort)
expected='1|Ann|Song
2|Anton|Song
3|Anton|Two!'
[ "$saved" = "$expected" ] || { printf 'FAILED: these tracks were saved:\n%s\n' "$saved"; exit 1; }

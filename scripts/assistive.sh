#!/usr/bin/env bash
# assistive.sh PRESET: the program beside a real accessibility bus, as a screen reader starts it: what
# the bus tells of it, and whether keys mean what they mean without a reader.
set -eu
cd "$(dirname "$0")/.."
. scripts/common.sh
. scripts/display.sh
# shellcheck disable=SC2086
need $assistive_packages
start_display
work=$display_folder/catalogue
mkdir -p "$work"
"build/$1/bin/make-catalogue" "$work/Compact4.orv"
sqlite3 "$work/Compact4.orv" -cmd ".load build/$1/lib/songcase.so sqlite3_songcase_init" "
    insert into Artiesten values (1, 'Anna'), (2, 'Annabel'), (3, 'Bert');
    insert into Tracks values (1, 1, 'One', null, null), (2, 2, 'Two', null, null), (3, 3, 'Three', null, null);
    insert into CDTitels values (1, 'Aap', null, 'V', null, null);
    insert into CompactDiscs values (1, 1, 1, 1, 1, null), (2, 1, 1, 2, 2, null), (3, 1, 1, 3, 3, null)"
export SONGCASE_FOLDER=$work XDG_CONFIG_HOME=$display_folder/config XDG_DATA_HOME=$display_folder/data
export XDG_CACHE_HOME=$display_folder/cache XDG_RUNTIME_DIR=$display_folder/run LC_ALL=C.UTF-8
mkdir -m 700 "$XDG_RUNTIME_DIR"
export QT_QPA_PLATFORM=xcb QT_LINUX_ACCESSIBILITY_ALWAYS_ON=1 NO_AT_BRIDGE=0
# Only the system's own Python finds the library of the bus.
timeout 100 dbus-run-session -- /usr/bin/python3 scripts/assistive.py "build/$1/bin/songcase"

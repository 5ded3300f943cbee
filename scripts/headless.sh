#!/usr/bin/env bash
# headless.sh PROGRAM PICTURE: starts the program on a virtual display, waits for its main window,
# takes a picture and ends it in an orderly way.
set -eu
. "$(dirname "$0")/display.sh"
start_display
QT_QPA_PLATFORM=xcb start_program "$1"
await_main_window
take_picture "$2"
end_program

#!/usr/bin/env bash
# headless.sh PROGRAM PICTURE: starts the program on a virtual display, waits for its main window,
# takes a picture and ends it in an orderly way.
set -eu
program=$1 picture=$2
work=$(mktemp -d)
xvfb="" running=""
finish() {
    [ -z "$running" ] || kill "$running" 2>/dev/null || true
    [ -z "$running" ] || wait "$running" 2>/dev/null || true
    [ -z "$xvfb" ] || kill "$xvfb" 2>/dev/null || true
    rm -rf "$work"
}
trap finish EXIT

Xvfb -displayfd 3 -screen 0 1280x900x24 -nolisten tcp 3>"$work/display" 2>/dev/null &
xvfb=$!
for _ in $(seq 100); do
    [ -s "$work/display" ] && break
    sleep 0.1
done
DISPLAY=:$(cat "$work/display")
export DISPLAY
QT_QPA_PLATFORM=xcb "$program" &
running=$!

# The splash has the same title; the main window is the wide one.
for _ in $(seq 200); do
    for window in $(xdotool search --onlyvisible --name "Dr. Orvanta" 2>/dev/null); do
        width=$(xdotool getwindowgeometry --shell "$window" 2>/dev/null | sed -n 's/^WIDTH=//p')
        [ "${width:-0}" -lt 900 ] || found=yes
    done
    [ -z "${found:-}" ] || break
    kill -0 "$running" 2>/dev/null || { echo "The program ended early."; exit 1; }
    sleep 0.1
done
[ -n "${found:-}" ] || { echo "No main window came up."; exit 1; }
sleep 1
import -window root "$picture"

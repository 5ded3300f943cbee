#!/usr/bin/env bash
# tagreaders.sh PRESET: what the program saves in tags is read by four other programs, and all else in
# the files is what it was.
set -eu
cd "$(dirname "$0")/.."
. scripts/common.sh
# shellcheck disable=SC2086
need $tagreader_packages
folder=$(mktemp -d)
trap 'rm -rf "$folder"' EXIT
work=$PWD/build/$1/bin/songcase-work
reader=$PWD/scripts/tagreaders.py
cd "$folder" # the journal of the saves stands in the current folder
# Only the system's own Python finds the libraries.
HOME=$folder LC_ALL=C.UTF-8 QT_QPA_PLATFORM=offscreen timeout 300 /usr/bin/python3 "$reader" "$work"

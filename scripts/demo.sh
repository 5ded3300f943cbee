#!/usr/bin/env bash
# Fills a catalogue with made-up discs, once, and puts a fresh copy of it where ./run --demo looks, with two
# collections of made-up MP3 files.
set -eu
cd "$(dirname "$0")/.."
work=build/release/bin/songcase-work
demo=build/demo
if [ ! -f "$demo/filled.orv" ] || [ demo/make_demo.py -nt "$demo/filled.orv" ] || [ "$work" -nt "$demo/filled.orv" ]; then
    rm -rf "$demo"
    mkdir -p "$demo/texts"
    python3 demo/make_demo.py "$demo/texts" >/dev/null
    "$work" new "$demo/new.orv" >/dev/null
    "$work" load "$demo/new.orv" A "$demo/texts/compilations-a.txt" >/dev/null
    "$work" load "$demo/new.orv" B "$demo/texts/albums-b.txt" >/dev/null
    "$work" load "$demo/new.orv" C "$demo/texts/compilations-c.txt" >/dev/null
    "$work" load "$demo/new.orv" D "$demo/texts/albums-d.txt" >/dev/null
    mv "$demo/new.orv" "$demo/filled.orv"
fi
rm -rf "$demo/folder" "$demo/music"
mkdir -p "$demo/folder"
cp "$demo/filled.orv" "$demo/folder/Compact4.orv"
python3 demo/make_music.py "$demo/music"
for title in "Harbour Lights" "Mixed Tape"; do
    "$work" addcollection "$demo/folder/Compact4.orv" "$PWD/$demo/music/$title" "$title" >/dev/null
done

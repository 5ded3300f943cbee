#!/usr/bin/env python3
"""Writes two small folders of MP3 files for the demo: real ones, with tags, a second of tone each.

    make_music.py OUTDIR

gives "Harbour Lights", an album on two discs whose files still have the names that a ripping
program gave them, and "Mixed Tape", songs by several artists. All names are invented, and the
files are the same on every run.
"""

import argparse
import math
import struct
from dataclasses import dataclass
from pathlib import Path

import mp3tone


@dataclass(frozen=True)
class Song:
    file: str
    artist: str
    title: str
    album: str
    number: int
    part: str  # of a set, "1/2"; empty: not told
    year: str
    genre: str


ALBUM = """
Leaving Port;Salt On The Window;The Ferryman's Daughter;Low Water;Two Lanterns;Harbour Lights
Fog Horn Waltz;The Keeper;Driftwood;North Of The Island;Seven Bells;Home Before Dark
"""

TAPE = """
Abigail Thorne;The Willow Tree;1971;Folk
Blue Tram;Last Stop Sunday;1985;Pop
Benny Okafor Quartet;Slow Corner;1963;Jazz
Anchor Street;Paper Crown;1989;Rock
Amber Kincaid;Dust And Diamonds;1979;Country
Bayou Ferguson;Rain On The Levee;1958;Blues
Abigail Thorne;Michaelmas;1974;Folk
Blue Tram;Électricité;1987;Pop
"""


def songs_of_album():
    for disc, line in enumerate(ALBUM.strip().splitlines(), 1):
        for number, title in enumerate(line.split(";"), 1):
            file = f"Disc {disc}/track{number:02}.mp3"
            yield Song(file, "Alder & Ash", title, "Harbour Lights", number, f"{disc}/2", "1998", "Folk")


def songs_of_tape():
    for number, line in enumerate(TAPE.strip().splitlines(), 1):
        artist, title, year, genre = line.split(";")
        yield Song(f"{number:02}-{artist}-{title}.mp3", artist, title, "", number, "", year, genre)


def frame(name, text):
    """A text frame of ID3v2.3, in UTF-16."""
    body = b"\x01" + text.encode("utf-16")
    return name + struct.pack(">I2x", len(body)) + body


def tag(song):
    fields = {b"TPE1": song.artist, b"TIT2": song.title, b"TALB": song.album, b"TRCK": str(song.number),
              b"TPOS": song.part, b"TYER": song.year, b"TCON": song.genre}
    frames = b"".join(frame(name, text) for name, text in fields.items() if text)
    frames += bytes(512)  # room for what is typed later
    size = bytes(len(frames) >> shift & 0x7F for shift in (21, 14, 7, 0))
    return b"ID3\x03\x00\x00" + size + frames


def chord(song):
    """Three notes over one that moves along a scale with the number of the song."""
    scale = (0, 2, 4, 5, 7, 9, 11, 12)
    step = scale[song.number % len(scale)] + (0 if song.part == "1/2" else 5)
    root = 330 * math.pow(2, step / 12)
    return [root, root * 5 / 4, root * 3 / 2]


def write_folder(folder, songs):
    for song in songs:
        path = folder / song.file
        path.parent.mkdir(parents=True, exist_ok=True)
        path.write_bytes(tag(song) + mp3tone.tone(chord(song), seconds=1))


def main():
    parser = argparse.ArgumentParser(description="Writes two folders of invented MP3 files.")
    parser.add_argument("outdir", type=Path, help="folder for the two; made if it is not there")
    folder = parser.parse_args().outdir
    write_folder(folder / "Harbour Lights", songs_of_album())
    write_folder(folder / "Mixed Tape", songs_of_tape())


if __name__ == "__main__":
    main()

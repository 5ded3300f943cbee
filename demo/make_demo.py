#!/usr/bin/env python3
"""Writes an invented CD collection as four text files that Songcase can import.

    make_demo.py OUTDIR

gives compilations-a.txt, albums-b.txt, compilations-c.txt and albums-d.txt, one for each text
format of the import wizard (UTF-8, lines end at LF). The collection is the same on every run:
about 350 discs with 5000 tracks. Tracks on a compilation, a best-of or a live album are often the
very tracks of another CD, as they are in a real collection.
"""

import argparse
import random
import re
from dataclasses import dataclass, field
from pathlib import Path

import words

SEED = 1977


@dataclass(frozen=True)
class Track:
    artist: str
    title: str
    genre: str  # empty: unknown
    year: str  # four digits, or empty: unknown


@dataclass
class Cd:
    artist: str  # empty: a compilation
    title: str
    discs: list  # of lists of Track


@dataclass
class Artist:
    name: str
    genre: str
    first: int
    last: int
    language: str
    tracks: list = field(default_factory=list)
    titles: set = field(default_factory=set)


def proper_case(text):
    """The case that the import gives to every field, so that the files show what will be stored."""
    return " ".join(word[:1].upper() + word[1:].lower() for word in text.split())


def mended_grammar(text):
    """Mends what filling in words does to English: "Memorys" and "A Empty Room"."""
    return re.sub(r"\bA (?=[AEIOU])", "An ", re.sub(r"([^aeiou])ys\b", r"\1ies", text))


def word_list(text):
    return [word.strip() for word in text.split("|")]


def read_artists():
    artists = []
    for language, table in words.ARTISTS.items():
        for line in table.strip().splitlines():
            name, genre, first, last = line.split(";")
            artists.append(Artist(proper_case(name), proper_case(genre), int(first), int(last), language))
    return artists


class Titles:
    """Makes titles from the patterns and sees to it that a title of a CD is given only once."""

    def __init__(self, dice):
        self.dice = dice
        self.cd_titles = set()

    def fill(self, pattern, language):
        """Puts a word into each brace; {place2} is another place than {place}."""
        chosen = {}

        def word(match):
            kind = match[1].rstrip("2")
            own = words.WORDS[language]
            pool = word_list(own[kind] if kind in own else words.WORDS["en"][kind])
            taken = chosen.setdefault(kind, [])
            taken.append(self.dice.choice([w for w in pool if w not in taken]))
            return taken[-1]

        return proper_case(mended_grammar(re.sub(r"\{(\w+)\}", word, pattern)))

    def track(self, artist):
        style = self.style(artist, 0.65)
        weights, patterns = zip(*words.PATTERNS[style])
        while True:
            title = self.fill(self.dice.choices(patterns, weights)[0], style)
            if title.casefold() not in artist.titles:
                artist.titles.add(title.casefold())
                return title

    def album(self, artist):
        style = self.style(artist, 0.8)
        while True:
            title = self.fill(self.dice.choice(word_list(words.ALBUMS[style])), style)
            if self.claim(title):
                return title

    def style(self, artist, jazz_share):
        if artist.genre == "Classical":
            return "classical"
        if artist.genre == "Jazz" and self.dice.random() < jazz_share:
            return "jazz"
        return artist.language

    def claim(self, title):
        """True if no CD has had this title yet, whatever the case of its letters."""
        is_new = title.casefold() not in self.cd_titles
        self.cd_titles.add(title.casefold())
        return is_new


class Collection:
    def __init__(self, seed):
        self.dice = random.Random(seed)
        self.titles = Titles(self.dice)
        self.artists = read_artists()
        self.albums = []
        self.compilations = []

    def build(self):
        for line in words.COMPILATIONS.strip().splitlines():
            self.titles.claim(proper_case(line.split(";")[0]))
        for artist in self.artists:
            self.add_albums_of(artist)
        for line in words.COMPILATIONS.strip().splitlines():
            self.compilations.append(self.compilation(*line.split(";")))
        self.dice.shuffle(self.albums)
        self.dice.shuffle(self.compilations)

    def new_track(self, artist, year):
        """A track of that year; now and then genre or year are unknown, as on many a shelf."""
        genre = artist.genre if self.dice.random() > 0.06 else ""
        undated = 0.9 if artist.genre == "Classical" else 0.12
        known = str(year) if self.dice.random() > undated else ""
        track = Track(artist.name, self.titles.track(artist), genre, known)
        artist.tracks.append(track)
        return track

    def new_disc(self, artist, year):
        return [self.new_track(artist, year) for _ in range(self.dice.randint(10, 16))]

    def add_albums_of(self, artist):
        studio = self.dice.choices((0, 1, 2, 3), (26, 57, 13, 4))[0]
        years = sorted(self.dice.randint(artist.first, artist.last) for _ in range(studio))
        for number, year in enumerate(years):
            is_debut = number == 0 and self.dice.random() < 0.1 and self.titles.claim(artist.name)
            title = artist.name if is_debut else self.titles.album(artist)
            discs = 2 if self.dice.random() < 0.04 else 1
            self.add_album(artist, title, [self.new_disc(artist, year) for _ in range(discs)])
        if len(artist.tracks) > 20:
            self.add_retrospective(artist)

    def add_retrospective(self, artist):
        """A best-of or a box set of an artist with several albums: mostly tracks that are there already."""
        chance = self.dice.random()
        if chance < 0.3:
            self.add_album(artist, f"The Best Of {artist.name}", [self.selection(artist, 16)])
        elif chance < 0.45:
            everything = self.selection(artist, 36)
            box = [everything[start : start + 12] for start in range(0, len(everything) - 5, 12)]
            rarities = self.new_disc(artist, artist.last)
            self.add_album(artist, f"{artist.name}: The Collected Recordings", box + [rarities])

    def selection(self, artist, count):
        return self.dice.sample(artist.tracks, min(count, len(artist.tracks)))

    def add_album(self, artist, title, discs):
        self.titles.claim(title)
        self.albums.append(Cd(artist.name, proper_case(title), discs))

    def compilation(self, title, genres, languages, first, last):
        first, last = int(first), int(last)
        fitting = [a for a in self.artists if fits(a, genres, languages, first, last)]
        disc_count = self.dice.choices((1, 2, 3), (72, 23, 5))[0] if len(fitting) > 12 else 1
        taken = set()
        discs = []
        for _ in range(disc_count):
            guests = self.dice.sample(fitting, min(self.dice.randint(15, 20), len(fitting)))
            while len(guests) < 14:
                guests.append(self.dice.choice(fitting))
            discs.append([self.contribution(guest, first, last, taken) for guest in guests])
        return Cd("", proper_case(title), discs)

    def contribution(self, artist, first, last, taken):
        """A track of this artist from those years, not yet on the CD: a known one if possible, else a single."""
        known = [t for t in artist.tracks if t.year and first <= int(t.year) <= last and t not in taken]
        if known and self.dice.random() < 0.85:
            track = self.dice.choice(known)
        else:
            track = self.new_track(artist, self.dice.randint(max(first, artist.first), min(last, artist.last)))
        taken.add(track)
        return track


def fits(artist, genres, languages, first, last):
    in_time = artist.first <= last and artist.last >= first
    in_genre = not genres or artist.genre in genres.split(",")
    in_language = not languages or artist.language in languages.split(",")
    return in_time and in_genre and in_language


def one_field_per_row(cds):
    """Formats A and B: counts say how long a CD is, "*" stands for an unknown genre or year."""
    for cd in cds:
        if cd.artist:
            yield cd.artist
        yield cd.title
        yield str(len(cd.discs))
        for disc in cd.discs:
            yield str(len(disc))
            for track in disc:
                if not cd.artist:
                    yield track.artist
                yield from (track.title, track.genre or "*", track.year or "*")


def one_track_per_row(cds):
    """Formats C and D: "*" parts the fields, a line "*" parts discs, an empty line ends a CD."""
    for cd in cds:
        if cd.artist:
            yield cd.artist
        yield cd.title
        for number, disc in enumerate(cd.discs):
            if number:
                yield "*"
            for track in disc:
                fields = (track.title, track.genre, track.year)
                yield "*".join(fields if cd.artist else (track.artist, *fields))
        yield ""


def write_file(folder, name, cds, layout):
    lines = "".join(f"{line}\n" for line in layout(cds))
    (folder / name).write_bytes(lines.encode("utf-8"))
    discs = [disc for cd in cds for disc in cd.discs]
    counts = len(cds), len(discs), sum(map(len, discs))
    print("{:20} {:4} CDs {:4} discs {:5} tracks".format(name, *counts))
    return counts


def main():
    parser = argparse.ArgumentParser(description="Writes an invented CD collection for the text import.")
    parser.add_argument("outdir", type=Path, help="folder for the four files; made if it is not there")
    folder = parser.parse_args().outdir
    folder.mkdir(parents=True, exist_ok=True)

    collection = Collection(SEED)
    collection.build()
    compilations, albums = collection.compilations, collection.albums
    part_a, part_b = len(compilations) * 2 // 3, len(albums) * 7 // 10
    totals = zip(
        write_file(folder, "compilations-a.txt", compilations[:part_a], one_field_per_row),
        write_file(folder, "albums-b.txt", albums[:part_b], one_field_per_row),
        write_file(folder, "compilations-c.txt", compilations[part_a:], one_track_per_row),
        write_file(folder, "albums-d.txt", albums[part_b:], one_track_per_row),
    )
    print("{:20} {:4} CDs {:4} discs {:5} tracks".format("altogether", *map(sum, totals)))


if __name__ == "__main__":
    main()

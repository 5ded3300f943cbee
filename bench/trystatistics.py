#!/usr/bin/python3
"""Try other statistics for the catalogue: which plans the searches get, and how long they take.

trystatistics.py BUILD CATALOGUE [--runs 5] [--slower 1.1]

The program tells the engine once and for all how large its tables are (src/catalogue/cataloguefile.cpp). This
changes one number at a time in a copy of CATALOGUE, and takes none and the engine's own as well. For each it prints
the table with which each kind of search begins, its time beside that of the numbers that stand in the catalogue, and
in bold what is slower. A number is good if no other one beats it on catalogues of both sizes.
It wants a Python whose sqlite3 loads extensions, as Debian's own does.
"""
import argparse
import os
import shutil
import sqlite3
import tempfile
import time

SELECT = """select art.naam, trk.titel, vcd.diskno, vcd.trackno, cdt.titel, trk.genre, trk.hitjaar,
 iif(cdt.cd_type='V','Compilation','Album') from artiesten as art, tracks as trk, cdtitels as cdt,
 compactdiscs as vcd where trk.artiest_id = art.id and cdt.id = vcd.cdtitels_id and trk.id = vcd.track_id """
LIKE = {"artist": "art.naam", "title": "trk.titel", "genre": "trk.genre"}
WORDS = {"artist": "%maan%", "title": "%maan%", "genre": "%pop%"}
FACTORS = (0.1, 0.3, 3, 10)


def searches():
    """The kinds of search by name: each field, pairs of them, all, years, nothing."""
    def like(*fields):
        return "".join(f" and unlikely({LIKE[field]} like '{WORDS[field]}')" for field in fields)
    kinds = [("artist",), ("title",), ("genre",), ("artist", "title"), ("artist", "genre"), ("title", "genre"),
             ("artist", "title", "genre")]
    found = {"+".join(kind): like(*kind) for kind in kinds}
    found["year"] = " and trk.hitjaar = 1985"
    found["years"] = " and trk.hitjaar between 1980 and 1989"
    found["artist+year"] = like("artist") + " and trk.hitjaar = 1985"
    found["nothing"] = ""
    return found


class Catalogue:
    """A copy of a catalogue whose statistics are changed."""

    def __init__(self, file, extension):
        self.file, self.extension = file, extension
        with self.opened() as db:
            self.shipped = dict(db.execute("select idx, stat from sqlite_stat1 where idx is not null"))
            self.tables = dict(db.execute("select idx, tbl from sqlite_stat1 where idx is not null"))

    def opened(self):
        db = sqlite3.connect(self.file)
        db.enable_load_extension(True)
        db.load_extension(self.extension)  # not by a statement: it puts another LIKE in place
        return db

    def told(self, numbers):
        """A connection on the catalogue with these statistics; None: the engine's own."""
        with self.opened() as db:
            if numbers is None:
                db.execute("analyze")
            else:
                db.execute("delete from sqlite_stat1")
                db.executemany("insert into sqlite_stat1(tbl, idx, stat) values (?, ?, ?)",
                               [(self.tables[idx], idx, stat) for idx, stat in numbers.items()])
        return self.opened()  # they are read when a catalogue is opened


def combinations(shipped):
    yield "none", {}
    yield "the engine's own", None
    for idx, stat in shipped.items():
        for place, number in enumerate(stat.split()):
            for factor in FACTORS:
                other = max(1, round(int(number) * factor))
                if other == int(number):
                    continue
                numbers = stat.split()
                numbers[place] = str(other)
                yield f"{idx} {' '.join(numbers)}", {**shipped, idx: " ".join(numbers)}


def first_table(db, sql):
    """What the plan reads first."""
    details = [row[3].split() for row in db.execute("explain query plan " + sql)]
    return next(words[1] for words in details if words[0] in ("SCAN", "SEARCH"))


def seconds(db, sql, runs):
    times = []
    for _ in range(runs):
        begin = time.process_time()
        for _ in db.execute(sql):
            pass
        times.append(time.process_time() - begin)
    return min(times)


def measured(catalogue, numbers, runs, known):
    """Plan and time of each search; a plan that is known is not timed again."""
    with catalogue.told(numbers) as db:
        result = {}
        for name, condition in searches().items():
            sql = SELECT + condition
            plan = tuple(row[3] for row in db.execute("explain query plan " + sql))
            if (name, plan) not in known:
                known[name, plan] = seconds(db, sql, runs)
            result[name] = first_table(db, sql), known[name, plan]
    return result


def cell(found, beside, slower):
    ratio = found[1] / beside[1]
    text = f"{found[0]} {ratio:.2f}"
    return f"**{text}**" if ratio > slower else text


def main():
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("build")
    parser.add_argument("catalogue")
    parser.add_argument("--runs", type=int, default=5)
    parser.add_argument("--slower", type=float, default=1.1)
    options = parser.parse_args()
    with tempfile.TemporaryDirectory() as folder:
        copy = os.path.join(folder, "copy.orv")
        shutil.copyfile(options.catalogue, copy)
        catalogue = Catalogue(copy, os.path.abspath(os.path.join(options.build, "lib", "songcase")))
        known = {}
        beside = measured(catalogue, catalogue.shipped, options.runs, known)
        print("| statistics | " + " | ".join(beside) + " |\n|---" * 1 + "|---" * len(beside) + "|")
        print("| as they are | " + " | ".join(f"{table} {time * 1000:.1f} ms" for table, time in beside.values()) + " |")
        for name, numbers in combinations(catalogue.shipped):
            result = measured(catalogue, numbers, options.runs, known)
            print(f"| {name} | " + " | ".join(cell(result[kind], beside[kind], options.slower) for kind in beside) + " |",
                  flush=True)


if __name__ == "__main__":
    main()

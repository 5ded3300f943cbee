#!/usr/bin/env python3
"""Time whole programs: ours against the least that the same work can take. Prints Markdown tables.

ratios.py BUILD [load] [read] [browse] [orphans] [search] [start] [--runs 7] [--stress] [--data FOLDER]

BUILD is the folder of a release build. Without names all comparisons run. The runs of a comparison
are interleaved, so that a busy moment of the machine hits all of its programs alike; still, only the
ratios of one table mean anything, and those below 1.15 mean equal. --stress takes catalogues of
100,000 discs as well. Needs the sqlite3 shell; "start" needs Xvfb and window-watch.
"""
import argparse
import contextlib
import os
import re
import shutil
import statistics
import subprocess
import sys
import tempfile
import time

TABLES = ("Artiesten", "Tracks", "CDTitels", "CompactDiscs")
CLEAN = """begin immediate;
delete from Tracks as trk where not exists (select '1' from CompactDiscs where Track_ID=trk.ID);
delete from CDTitels as cdt where not exists (select '1' from CompactDiscs where CDTitels_ID=cdt.ID);
delete from Artiesten as art where not exists (select '1' from Tracks where Artiest_ID=art.ID)
 and not exists (select '1' from CDTitels where Artiest_ID=art.ID);
commit;"""

SELECT = """select art.naam as artiest, trk.titel as titel, vcd.diskno as disk, vcd.trackno as track,
 cdt.titel as verzamelcd, trk.genre as genre, trk.hitjaar as hitjaar,
 iif(cdt.cd_type='V','Compilation','Album') as type from {} where trk.artiest_id = art.id
 and cdt.id = vcd.cdtitels_id and trk.id = vcd.track_id {} order by 1,2,5,3,4"""
JOINS = {"as it chooses": "artiesten as art, tracks as trk, cdtitels as cdt, compactdiscs as vcd",
         **{order: " cross join ".join({"art": "artiesten as art", "trk": "tracks as trk", "cdt": "cdtitels as cdt",
                                        "vcd": "compactdiscs as vcd"}[name] for name in order.split())
            for order in ("art trk vcd cdt", "trk art vcd cdt", "vcd trk art cdt")}}
SEARCHES = {"title %maan%": ("title", "maan", "trk.titel like '%maan%'"),
            "artist, title and genre %o%":
                ("three", "o", "art.naam like '%o%' and trk.titel like '%o%' and trk.genre like '%o%'"),
            "year 1985": ("year", "1985", "trk.hitjaar = 1985"), "everything": ("nothing", "", "1")}


class Case:
    """One program of a comparison: prepare() gives the command for the next run."""

    def __init__(self, name, prepare):
        self.name, self.prepare = name, prepare
        self.wall, self.cpu, self.peaks = [], [], []

    def run(self):
        command = self.prepare()
        begin = time.perf_counter()
        process = subprocess.Popen(command, stdout=subprocess.PIPE, text=True)
        output = process.stdout.read()
        _, status, usage = os.wait4(process.pid, 0)
        self.wall.append(time.perf_counter() - begin)
        if status:
            sys.exit(f"{' '.join(command)} failed: {output}")
        self.cpu.append(usage.ru_utime + usage.ru_stime)
        # The system's own figure would count the memory of this script as well.
        self.peaks += [int(kib) / 1024 for kib in re.findall(r"peak_kib=(\d+)", output)]


def table(title, cases, runs):
    """Runs the cases in turn and prints their figures; the ratios are to the last one."""
    for _ in range(runs):
        for case in cases:
            case.run()
    print(f"\n### {title}\n")
    print("| program | wall ms, min / median | CPU ms, min / median | peak MiB | CPU ratio, min / median |")
    print("|---|---|---|---|---|")
    for case in cases:
        ratio = both(case.cpu, lambda value, of: f"{value / of(cases[-1].cpu):.2f}")
        peak = f"{max(case.peaks):.0f}" if case.peaks else ""
        milliseconds = lambda value, _: f"{value * 1000:.1f}"
        print(f"| {case.name} | {both(case.wall, milliseconds)} | {both(case.cpu, milliseconds)} | {peak} | {ratio} |")
    sys.stdout.flush()


def cpu_of(command):
    case = Case("", lambda: command)
    case.run()
    return case.cpu[0]


def both(values, text):
    return " / ".join(text(of(values), of) for of in (min, statistics.median))


class Bench:
    def __init__(self, build, data, stress):
        self.bin, self.extension = os.path.join(build, "bin"), os.path.join(build, "lib", "songcase.so")
        self.data = data
        self.scales = {"owner": 3000, **({"stress": 100_000} if stress else {})}

    def program(self, name, *arguments):
        return [os.path.join(self.bin, name), *map(str, arguments)]

    def shell(self, file, sql, *options):
        """The sqlite3 shell with our collation, on a file."""
        return ["sqlite3", "-cmd", f".load {self.extension} sqlite3_songcase_init", *options, file, sql]

    def made(self, name, *command):
        """A file of the data folder; made if it is not there, or older than the generator."""
        file = os.path.join(self.data, name)
        generator = self.program("songcase-generate")[0]
        if not os.path.exists(file) or os.path.getmtime(file) < os.path.getmtime(generator):
            half = file + ".half"
            with contextlib.suppress(FileNotFoundError):
                os.remove(half)
            subprocess.run(self.program(*(half if word == "FILE" else word for word in command)),
                           check=True, stdout=subprocess.DEVNULL)
            os.rename(half, file)
        return file

    def catalogue(self, scale, orphans=0.0):
        name = f"ratios-{scale}{'-orphans' if orphans else ''}.orv"
        return self.made(name, "songcase-generate", "catalogue", "FILE", "--discs", self.scales[scale],
                         "--orphans", orphans)

    def text(self, text_format):
        return self.made(f"ratios-{text_format}.txt", "songcase-generate", "text", text_format, "FILE")

    def empty(self):
        return self.made("ratios-empty.orv", "songcase-work", "new", "FILE")

    def copy(self, file, name):
        """A fresh copy, on the disk before the run begins."""
        to = os.path.join(self.data, name)
        shutil.copyfile(file, to)
        with open(to, "rb") as copied:
            os.fsync(copied.fileno())
        return to

    def counts(self, file):
        sql = ";".join(f"select count(*) from {name}" for name in TABLES)
        return subprocess.run(self.shell(file, sql), check=True, capture_output=True, text=True).stdout.split()

    def must_agree(self, one, other):
        if self.counts(one) != self.counts(other):
            sys.exit(f"not the same work: {self.counts(one)} and {self.counts(other)} rows")

    def load(self, runs):
        targets = {"an empty catalogue": self.empty()}
        targets.update({f"the catalogue '{scale}'": self.catalogue(scale) for scale in self.scales})
        for where, catalogue in targets.items():
            for text_format in "ABCD" if "empty" in where else "A":
                self.load_one(where, catalogue, text_format, runs)

    def load_one(self, where, catalogue, text_format, runs):
        text = self.text(text_format)
        ours = lambda: self.program("songcase-work", "load", self.copy(catalogue, "ours"), text_format, text)
        bare = lambda: self.program("bare-load", self.copy(catalogue, "bare"), text_format, text)
        table(f"Load 100,000 tracks, format {text_format}, into {where}",
              [Case("songcase-work load", ours), Case("bare find-or-create loop", bare)], runs)
        self.must_agree(os.path.join(self.data, "ours"), os.path.join(self.data, "bare"))

    def read(self, runs):
        for text_format in "ABCD":
            text = self.text(text_format)
            command = self.program("songcase-work", "read", text_format, text)
            table(f"Read 100,000 tracks, format {text_format}", [Case("songcase-work read", lambda: command)], runs)

    def browse(self, runs):
        sqls = (" select cdt.id, cdt.titel from cdtitels as cdt where cdt.cd_type='V' order by cdt.titel",
                " select cdt.id, art.naam, cdt.titel from cdtitels as cdt, artiesten as art"
                " where cdt.cd_type='E' and cdt.artiest_id=art.id order by cdt.titel",
                "select count(*) from tracks", "select id, map, album from mp3collections order by album")
        for scale in self.scales:
            file = self.catalogue(scale)
            shell = lambda: self.shell(file, ";".join(sqls), "-cmd", ".output /dev/null")
            table(f"Load of the browser, '{scale}'",
                  [Case("songcase-work browse", lambda: self.program("songcase-work", "browse", file)),
                   Case("sqlite3 shell, the four statements", shell)], runs)

    def orphans(self, runs):
        for scale in self.scales:
            file = self.catalogue(scale, 0.02)
            ours = lambda: self.program("songcase-work", "orphans", self.copy(file, "ours"))
            shell = lambda: self.shell(self.copy(file, "bare"), CLEAN)
            table(f"CleanOrphans, '{scale}' with 2 % of orphans",
                  [Case("songcase-work orphans", ours), Case("sqlite3 shell, the three deletes", shell)], runs)
            self.must_agree(os.path.join(self.data, "ours"), os.path.join(self.data, "bare"))

    def search(self, runs):
        for scale in self.scales:
            file = self.catalogue(scale)
            for name, (field, word, condition) in SEARCHES.items():
                shell = lambda join: self.shell(file, SELECT.format(JOINS[join], f"and {condition}"),
                                                "-cmd", ".output /dev/null")
                best = min(JOINS, key=lambda join: min(cpu_of(shell(join)) for _ in range(3)))
                ours = self.program("songcase-work", "search", file, "part", field, word)
                table(f"Search {name}, '{scale}'",
                      [Case("songcase-work search", lambda: ours),
                       Case(f"sqlite3 shell, its best join ({best})", lambda: shell(best))], runs)

    def start(self, runs):
        if not shutil.which("Xvfb") or not os.path.exists(os.path.join(self.bin, "window-watch")):
            print("\nstart: no Xvfb or no window-watch, left out")
            return
        with screen() as display, tempfile.TemporaryDirectory() as home:
            os.environ.update(DISPLAY=display, HOME=home, XDG_RUNTIME_DIR=home, SONGCASE_FOLDER=home,
                              QT_QPA_PLATFORM="xcb")
            print("\n### Start to a painted window\n\n| program | mapped ms | painted ms | CPU ms | peak MiB |")
            print("|---|---|---|---|---|")
            programs = {"empty Qt window": ["empty-window"]}
            for scale in self.scales:
                programs[f"songcase, splash, '{scale}'"] = ["songcase", scale]
            figures = {name: [] for name in programs}
            for _ in range(runs):
                for name, (program, *scale) in programs.items():
                    if scale:
                        self.copy(self.catalogue(scale[0]), os.path.join(home, "Compact4.orv"))
                    figures[name].append(self.watch(program))
            for name, rows in figures.items():
                columns = [" / ".join((f"{min(c):.1f}", f"{statistics.median(c):.1f}")) for c in zip(*rows)]
                print(f"| {name} | {' | '.join(columns)} |")

    def watch(self, program):
        """Mapped, painted, CPU in ms and the peak in MiB of one start."""
        command = self.program("window-watch", os.path.join(self.bin, program))
        output = subprocess.run(command, check=True, capture_output=True, text=True).stdout
        mapped, painted, cpu, peak = map(float, re.findall(r"=([\d.]+)", output))
        return mapped, painted, cpu, peak / 1024


@contextlib.contextmanager
def screen():
    """An X server of our own for as long as it is needed; gives its display."""
    reading, writing = os.pipe()
    server = subprocess.Popen(["Xvfb", "-noreset", "-displayfd", str(writing), "-screen", "0", "1280x1024x24"],
                              pass_fds=[writing], stderr=subprocess.DEVNULL)
    os.close(writing)
    try:
        with os.fdopen(reading) as told:
            yield ":" + told.readline().strip()
    finally:
        server.terminate()
        server.wait()


def main():
    names = ("load", "read", "browse", "orphans", "search", "start")
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("build")
    parser.add_argument("comparisons", nargs="*", metavar="COMPARISON", help=", ".join(names))
    parser.add_argument("--runs", type=int, default=7)
    parser.add_argument("--stress", action="store_true")
    parser.add_argument("--data", default=os.environ.get(
        "SONGCASE_BENCH_DATA", os.path.join(tempfile.gettempdir(), "songcase-bench")))
    options = parser.parse_args()
    unknown = set(options.comparisons) - set(names)
    if unknown:
        parser.error(f"no such comparison: {', '.join(unknown)}")
    os.makedirs(options.data, exist_ok=True)
    bench = Bench(os.path.abspath(options.build), options.data, options.stress)
    for name in options.comparisons or names:
        getattr(bench, name)(options.runs)


if __name__ == "__main__":
    main()

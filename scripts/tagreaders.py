"""Saves fields of tags with the program, reads them with mutagen, eyeD3, kid3 and exiftool, and compares
them and the rest of the files. Argument: songcase-work. Works in the current folder."""
import json
import subprocess
import sys

import eyed3
from mutagen import id3

SOUND = (b"\xff\xfb\x90\x64" + bytes(413)) * 8 + b"TAG" + b"Title".ljust(125, b"\0")
# By field: its value, frame, name in kid3, name in exiftool.
FIELDS = {
    "album": ("Das Blaue Album", "TALB", "album", "Album"),
    "title": ("Ærø – €5, ещё", "TIT2", "title", "Title"),
    "copyright": ("2026 Wij", "TCOP", "copyright", "Copyright"),
    "comments": ("één\nregel twee", "COMM", "comment", "Comment"),
    "label": ("Plåt", "TPUB", "publisher", "Publisher"),
    "artist": ("Motörhead/AC/DC", "TPE1", "artist", "Artist"),
    "part": ("2/3", "TPOS", "discnumber", "PartOfSet"),
    "track": ("7/12", "TRCK", "tracknumber", "Track"),
    "year": ("1985", "TDRC", "date", ("RecordingTime", "Year")),
    "genre": ("Rock", "TCON", "genre", "Genre"),
}
faults = []


def check(what, found, wanted):
    if found != wanted:
        faults.append(f"{what}: {found!r}, not {wanted!r}")


def make(path, version, padding):
    """A tag of ID3v2.version with a picture and a frame that no program knows, before some sound."""
    tag = id3.ID3()
    tag.add(id3.TIT2(encoding=0, text=["Before"]))
    tag.add(id3.TALB(encoding=1, text=["Альбом"]))
    tag.add(id3.APIC(encoding=0, mime="image/png", type=3, desc="", data=bytes(range(256)) * 8))
    tag.add(id3.PRIV(owner="nobody", data=b"\xff\xe0\xff\x00kept"))
    tag.add(id3.COMM(encoding=0, lang="eng", desc="iTunNORM", text=["00 1F"]))
    with open(path, "wb") as file:
        file.write(SOUND)
    tag.save(path, v1=1, v2_version=version, padding=lambda info: padding)


def mutagen_reads(path, frame):
    tag = id3.ID3(path)
    if frame == "COMM":
        return tag["COMM::eng"].text[0]
    return "/".join(str(text) for text in tag[frame].text)


def eyed3_reads(path, frame):
    tag = eyed3.load(path).tag
    if frame == "COMM":
        return tag.comments.get("").text
    if frame == "TDRC":
        return str(tag.recording_date or tag.release_date)
    return (tag.genre.name if frame == "TCON" else tag.frame_set[frame.encode()][0].text).replace("\0", "/")


def kid3_reads(path, name):
    return subprocess.run(["kid3-cli", "-c", f"get {name} 2", path], capture_output=True, text=True,
                          check=True).stdout.rstrip("\n")


def exiftool_reads(path, names):
    answer = json.loads(subprocess.run(["exiftool", "-j", "-ID3:all", path], capture_output=True, check=True).stdout)[0]
    found = [str(answer[name]) for name in ([names] if isinstance(names, str) else names) if name in answer]
    return found[0] if found else None


def kept(path):
    tag = id3.ID3(path)
    with open(path, "rb") as file:
        bytes_ = file.read()
    return tag.getall("APIC")[0].data, tag.getall("PRIV")[0].data, tag["COMM:iTunNORM:eng"].text, bytes_[-len(SOUND):]


def save(path, field, value):
    subprocess.run([sys.argv[1], "savetag", path, field, value], check=True, stdout=subprocess.DEVNULL)


def main():
    eyed3.log.setLevel("ERROR")
    saves = 0
    for version in (3, 4):
        for padding in (0, 2000):
            path = f"v{version}-{padding}.mp3"
            make(path, version, padding)
            before = kept(path)
            for field, (value, *_) in FIELDS.items():
                save(path, field, value)
                saves += 1
                check(f"{path} after {field}: the rest", kept(path), before)
            check(f"{path}: version", id3.ID3(path).version[1], version)
            for field, (value, frame, kid3, exif) in FIELDS.items():
                check(f"{path} {field}, mutagen", mutagen_reads(path, frame), value)
                check(f"{path} {field}, eyeD3", eyed3_reads(path, frame), value)
                check(f"{path} {field}, kid3", kid3_reads(path, kid3), value)
                check(f"{path} {field}, exiftool", exiftool_reads(path, exif).replace("..", "\n"), value)
    print(f"{saves} saves, {len(faults)} faults")
    for fault in faults:
        print(fault)
    sys.exit(1 if faults else 0)


main()

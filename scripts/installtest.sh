#!/usr/bin/env bash
# installtest.sh FOLDER: the story of a package from its installation to its end; see cleanroot.sh.
# The display and what drives it stay outside: in the root is only what the package itself asks for.
set -eu
. "$(dirname "$0")/display.sh"
work=$1
packages=$PWD/build/packages
root=$work/root
bare=$work/bare.tar
log=$work/apt.log
release=$(. /etc/os-release && echo "$VERSION_CODENAME")

say() { printf '%4d s  %s\n' $SECONDS "$*"; }
fail() { echo "FAILED: $*"; exit 1; }
expect() { # WHAT COMMAND...
    local what=$1
    shift
    "$@" || fail "$what"
}

# --- the root -------------------------------------------------------------------------------------

# The sources of this machine for its own release, as lines of a sources.list. Whose they are stands in
# the lists that are fetched from them.
sources() {
    apt-get indextargets --format '$(ORIGIN)|$(CODENAME)|deb $(REPO_URI) $(RELEASE) $(COMPONENT)' \
        'Created-By: Packages' | sed -n "s/^Debian|$release[^|]*|//p" | sort -u
}

make_bare_root() {
    rm -f "$bare"
    mmdebstrap --mode=root --format=tar --variant=minbase "$release" "$bare.new" "$work/sources.list" >"$log" 2>&1 ||
        { tail -20 "$log"; fail "no root could be made: mmdebstrap needs root rights, chroot and mknod."; }
    mv "$bare.new" "$bare"
}

unpack_root() {
    rm -rf --one-file-system "$root"
    mkdir -p "$root"
    tar -C "$root" -xpf "$bare"
    rm -f "$root"/etc/apt/sources.list.d/*
    cp "$work/sources.list" "$root/etc/apt/sources.list"
    if [ -n "$MOUNTS" ]; then
        mount -t proc proc "$root/proc"
        mkdir -p "$root/dev/shm"
        mount -t tmpfs -o mode=1777 tmpfs "$root/dev/shm"
    fi
    chroot "$root" true || fail "chroot is not permitted here."
}

in_root() { chroot "$root" env -i PATH=/usr/sbin:/usr/bin:/sbin:/bin LC_ALL=C.UTF-8 DEBIAN_FRONTEND=noninteractive "$@"; }

# Lists and packages come by the apt of this machine, whatever way it has to the net; the apt of the
# root then decides and installs from them.
outer_apt() {
    apt-get -q -o Dir="$root" -o Dir::State::status="$root/var/lib/dpkg/status" \
        -o Dir::Cache::archives="$work/archives" -o APT::Install-Recommends=false "$@" >>"$log" 2>&1
}
fetch() {
    outer_apt -y --download-only install "$@" || { tail -20 "$log"; fail "no download of $*"; }
    outer_apt autoclean
}
inner_apt() {
    in_root apt-get -q -y -o Dpkg::Use-Pty=0 -o Dpkg::Options::=--force-unsafe-io "$@" >>"$log" 2>&1
}
install() {
    cp -l "$work"/archives/*.deb "$root/var/cache/apt/archives/" 2>/dev/null || true
    inner_apt --no-install-recommends install "$@" ||
        { tail -30 "$log"; fail "$* does not install"; }
}

# --- the person at the display ----------------------------------------------------------------------

as_person() { # NAME: sets the words that start a command as this user
    person=(chroot "--userspec=$1:$1" "$root" env -i "HOME=/home/$1" "USER=$1" "DISPLAY=$DISPLAY"
        PATH=/usr/bin:/bin LANG=C.UTF-8 BROWSER=/usr/local/bin/browser)
}
start() { # PICTURE PROGRAM
    start_program "${person[@]}" "$2"
    await_main_window || fail "the start of $2"
    take_picture "$work/$1.png"
}
stop() { expect "the program ended with an error" end_program; }
catalogue=/home/listener/.local/share/songcase/Compact4.orv
sql() { "${person[@]}" sqlite3 -cmd ".load /usr/lib/songcase/sqlite3/songcase" "$catalogue" "$1"; }
maps() { grep -q "$1" "/proc/$running/maps"; }
has_class() { xdotool search --onlyvisible --class "^$1\$" | grep -qx "$window"; }
opens_guide() { # USER PAGE: the help screen stands open after a first start, on its link
    xdotool windowfocus --sync "$window" key Return
    for _ in $(seq 50); do
        ! grep -qsx "file://$2" "$root/home/$1/opened" || return 0
        sleep 0.1
    done
    return 1
}
holds_open() { ls -l "/proc/$running/fd" | grep -q -- "$1\$"; }

# Everything but what apt and dpkg keep for themselves, and what belongs to people.
files() {
    (cd "$root" && find . -xdev \( -path ./proc -o -path ./dev -o -path ./home -o -path ./var/lib/dpkg -o -path \
        ./var/lib/apt -o -path ./var/cache -o -path ./var/log -o -path ./tmp \) -prune -o -print | sort)
}

# --- the story --------------------------------------------------------------------------------------

[ "$(id -u)" = 0 ] || fail "a fresh root can only be made with root rights."
mkdir -p "$work/archives"
[ -n "$(sources)" ] || apt-get -qq update
sources >"$work/sources.list"
[ -s "$work/sources.list" ] || fail "the apt of this machine knows no source of Debian's $release."
: >"$log"
if [ -z "$(find "$bare" -mtime -7 2>/dev/null)" ]; then
    make_bare_root
fi
unpack_root
say "a bare root"

in_root useradd --create-home listener
in_root useradd --create-home guest
printf '#!/bin/sh\necho "$1" >"$HOME/opened"\n' >"$root/usr/local/bin/browser"
chmod 755 "$root/usr/local/bin/browser"
files >"$work/files.before"

outer_apt update || { tail -20 "$log"; fail "no lists of packages"; }
deb=$(ls "$packages"/songcase_*.deb)
newer=$(ls "$work"/newer/songcase_*.deb)
cp "$deb" "$newer" "$root/tmp/"
fetch "$deb" sqlite3 xdg-utils
say "packages fetched"

install "/tmp/$(basename "$deb")" xdg-utils
dpkg-deb --fsys-tarfile "$deb" | tar -C "$root" -d || fail "the files of the package are not those in the root"
expect "the reader of discs does not run" in_root /usr/libexec/songcase/songcase-disc drives
expect "the reader of old catalogues does not run" in_root sh -c '/usr/libexec/songcase/songcase-jet /etc/passwd Tracks; [ $? = 5 ]'
say "installed"

start_display
as_person listener
start first-start /usr/bin/songcase
expect "the first start made no catalogue" test -f "$root$catalogue"
expect "the window is not the one that the desktop entry names" has_class songcase
expect "the guide does not open" opens_guide listener /usr/share/songcase-guide/en/index.html
stop
say "first start"

sed -i '/"language"/,/}/ s/"value": 1$/"value": 19/' "$root/home/listener/.config/songcase/settings.json"
start dutch /usr/bin/songcase
expect "Qt's Dutch texts are not found" maps qtbase_nl.qm
stop
say "Dutch"

install sqlite3
sql "insert into Artiesten(ID, Naam) values(1, 'Zoë');
     insert into Tracks(ID, Artiest_ID, Titel) values(1, 1, 'A Song');
     insert into CDTitels(ID, Titel, CD_Type) values(1, 'Kept', 'V');
     insert into CompactDiscs(ID, CDTitels_ID, DiskNo, TrackNo, Track_ID) values(1, 1, 1, 1, 1);"
kept() { [ "$(sql "select count(*) from CDTitels, Artiesten where CDTitels.Titel like 'KEPT' and Naam = 'ZOË'")" = 1 ]; }
expect "the sqlite3 shell cannot search the catalogue" kept
install "/tmp/$(basename "$newer")"
expect "the newer version is not installed" grep -q 99.0.0 <(in_root dpkg-query -W songcase)
start upgraded /usr/bin/songcase
stop
expect "the catalogue is not what it was before the upgrade" kept
say "upgraded"

tar -C "$root/home/guest" -xzf "$packages/songcase-portable.tar.gz"
in_root chown -R guest:guest /home/guest/songcase-portable
as_person guest
start portable /home/guest/songcase-portable/bin/songcase
expect "the portable program uses another catalogue" holds_open /home/guest/songcase-portable/bin/Compact4.orv
expect "the portable guide does not open" opens_guide guest /home/guest/songcase-portable/share/songcase-guide/en/index.html
stop
expect "the portable program made a data folder" test ! -e "$root/home/guest/.local/share/songcase"
say "portable folder"

cp "$root$catalogue" "$work/kept.orv"
inner_apt remove songcase || fail "it cannot be removed"
inner_apt purge --auto-remove sqlite3 xdg-utils || fail "what came with it cannot be removed"
files >"$work/files.after"
diff "$work/files.before" "$work/files.after" || fail "these files were left or lost"
expect "the catalogue has not outlived the program" cmp "$root$catalogue" "$work/kept.orv"
say "removed"

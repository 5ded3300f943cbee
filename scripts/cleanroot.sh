#!/usr/bin/env bash
# Installs, starts, upgrades and removes the package in a fresh root of Debian, made from the sources
# of packages of this machine. Pictures and the log of apt stay in build/cleanroot. Needs root rights.
set -eu
cd "$(dirname "$0")/.."
. scripts/common.sh
# shellcheck disable=SC2086
need $package_packages $cleanroot_packages $headless_packages

work=$PWD/build/cleanroot
mkdir -p "$work"
[ -n "$(ls build/packages/songcase_*.deb 2>/dev/null)" ] || { echo "No package: run scripts/package.sh first."; exit 1; }

# The same files once more under a higher version.
rm -rf "$work/newer"
cpack --config build/release/CPackConfig.cmake -D CPACK_PACKAGE_VERSION=99.0.0 -B "$work/newer" >build/package.log 2>&1 || { cat build/package.log; exit 1; }

# In rooms of its own for mounts and processes nothing of it outlives this script.
isolate="unshare --mount --pid --fork --kill-child --mount-proc"
# shellcheck disable=SC2086
if ! as_root $isolate true 2>/dev/null; then
    echo "Mounts are not permitted here: the root goes without /proc and /dev/shm."
    isolate=""
fi
status=0
# shellcheck disable=SC2086
as_root $isolate env MOUNTS="$isolate" scripts/installtest.sh "$work" || status=$?
as_root rm -rf --one-file-system "$work/root"
exit $status

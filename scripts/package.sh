#!/usr/bin/env bash
# Makes what people install, in build/packages: the Debian package and the portable folder.
set -eu
cd "$(dirname "$0")/.."
. scripts/common.sh
# shellcheck disable=SC2086
need $build_packages $package_packages
build release

made=build/packages
rm -rf "$made"
mkdir -p "$made"
cpack --config build/release/CPackConfig.cmake -B "$made" >build/package.log 2>&1 || { cat build/package.log; exit 1; }
rm -rf "$made/_CPack_Packages"

cmake --install build/release --component portable --strip --prefix "$made/songcase-portable" >/dev/null
tar -C "$made" --owner=0 --group=0 -czf "$made/songcase-portable.tar.gz" songcase-portable
rm -rf "$made/songcase-portable"
ls -1 "$made"/*

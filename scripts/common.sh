# Shared by ./run and ./check: sourced, not run.

jobs=$(nproc 2>/dev/null || echo 2)

build_packages="g++ cmake ninja-build ccache pkg-config qt6-base-dev qt6-base-private-dev qt6-base-dev-tools qt6-l10n-tools qt6-svg-dev libsqlite3-dev libicu-dev libtag1-dev libcdio-dev mdbtools-dev libbenchmark-dev"
run_packages="libqt6svg6 qt6-wayland qt6-qpa-plugins qt6-translations-l10n fonts-dejavu-core xdg-utils ca-certificates"
headless_packages="xvfb xdotool imagemagick"
assistive_packages="at-spi2-core dbus-daemon gir1.2-atspi-2.0 python3-gi xvfb xdotool sqlite3"
check_packages="mold clang-format sqlite3 python3 poppler-utils desktop-file-utils appstream mandoc tidy"
tagreader_packages="python3-mutagen eyed3 kid3-cli libimage-exiftool-perl"
tidy_packages="clang-tidy"
package_packages="dpkg-dev file"
cleanroot_packages="mmdebstrap"

as_root() {
    if [ "$(id -u)" = 0 ]; then "$@"; else sudo "$@"; fi
}

# need PACKAGE...: installs those that are missing; quick when none is.
need() {
    local missing=""
    for p in "$@"; do
        [ "$(dpkg-query -W -f='${db:Status-Abbrev}' "$p" 2>/dev/null)" = "ii " ] || missing="$missing $p"
    done
    [ -n "$missing" ] || return 0
    echo "Installing:$missing"
    as_root apt-get -qq update
    # shellcheck disable=SC2086
    as_root env DEBIAN_FRONTEND=noninteractive apt-get -qq -y --no-install-recommends install $missing >/dev/null
}

# build PRESET [TARGET...]: configures when that was not done yet, and builds.
build() {
    local preset=$1
    shift
    mkdir -p build
    [ -f "build/$preset/build.ninja" ] || cmake --preset "$preset" >"build/$preset.log" 2>&1 || { cat "build/$preset.log"; return 1; }
    if [ $# -gt 0 ]; then set -- --target "$@"; fi
    cmake --build --preset "$preset" -j "$jobs" "$@" >"build/$preset.log" 2>&1 || { grep -E "error|warning|FAILED|\*\*\*" "build/$preset.log" | head -60 || tail -40 "build/$preset.log"; return 1; }
}

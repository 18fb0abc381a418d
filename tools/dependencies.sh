# Sourced by the scripts at the root: installs the Debian packages that a job needs and that are not there yet.

need_packages() {
    local missing=() package
    for package in "$@"; do
        dpkg-query -W -f='${Status}' "$package" 2>/dev/null | grep -q '^install ok installed' || missing+=("$package")
    done
    [ ${#missing[@]} -eq 0 ] && return 0
    local as_root=()
    if [ "$(id -u)" -ne 0 ]; then
        command -v sudo >/dev/null || { echo "Please install: ${missing[*]} (no sudo here to do it)" >&2; return 1; }
        as_root=(sudo)
    fi
    echo "Installing ${missing[*]}"
    export DEBIAN_FRONTEND=noninteractive
    "${as_root[@]}" apt-get update -qq
    "${as_root[@]}" apt-get install -y -qq --no-install-recommends "${missing[@]}" >/dev/null
}

BUILD_PACKAGES=(g++ cmake ninja-build ccache pkg-config libcanberra-dev libcli11-dev libdbus-1-dev
    libexpat1-dev libicu-dev libmd4c-dev libmd4c-html0-dev libsqlite3-dev libx11-dev libxcb-xfixes0-dev libxcb-xinput-dev
    libxcb-xkb-dev libxcb-xtest0-dev libxcb1-dev libxkbcommon-dev libxkbcommon-x11-dev libxml2-dev libyaml-cpp-dev
    nlohmann-json3-dev qt6-base-dev qt6-l10n-tools qt6-webengine-dev)
TEST_PACKAGES=(clang libclang-rt-14-dev libgtest-dev libgmock-dev librapidcheck-dev perl python3 tzdata)
CHECK_PACKAGES=(clang-format clang-tidy git)

# build <preset> [CMake options]: configures and builds, quietly unless something is wrong.
build() {
    cmake --preset "$@" >"build-$1.log" 2>&1 || { cat "build-$1.log"; rm -f "build-$1.log"; return 1; }
    rm -f "build-$1.log"
    cmake --build --preset "$1" -- --quiet
}

# What the desktop tests are built with and run: a real X server, a window manager, programs to type into.
DESKTOP_PACKAGES=(pkg-config xserver-xorg-dev libxcb1-dev libxcb-xinput-dev libxkbcommon-dev libpng-dev libgtk-3-dev
    nlohmann-json3-dev xserver-xorg-core xserver-xorg-video-dummy x11-xkb-utils xkb-data
    openbox xfwm4 trayer x11-xserver-utils dbus-daemon at-spi2-core xterm xfonts-base fonts-dejavu-core)

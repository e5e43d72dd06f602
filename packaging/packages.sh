# shellcheck shell=bash disable=SC2034
# Sourced by ./run and ./test: which Debian packages they need, and how what is missing is installed.

build_packages=(
    g++ cmake ninja-build pkg-config ccache
    qt6-base-dev libexpat1-dev libpcap-dev libncurses-dev libcli11-dev rapidjson-dev
    qt6-declarative-dev qt6-declarative-dev-tools qt6-wayland libqt6svg6
    # The QML modules that the graphical screens load; nothing pulls them in.
    qml6-module-qtqml qml6-module-qtqml-models qml6-module-qtqml-workerscript qml6-module-qtquick
    qml6-module-qtquick-controls qml6-module-qtquick-layouts qml6-module-qtquick-templates qml6-module-qtquick-window
)
test_packages=(
    "${build_packages[@]}"
    libgtest-dev libgmock-dev libbenchmark-dev
    clang clang-format libclang-rt-14-dev
    python3 tmux git procps dbus-daemon systemd tcpdump
    python3-dbusmock modemmanager
    xvfb xdotool imagemagick appstream desktop-file-utils
)
check_packages=(clang-tidy shellcheck) # for ./test --all; qmllint is among the build's
picture_packages=(
    "${build_packages[@]}"
    python3 xvfb xdotool imagemagick optipng fonts-inter
)

# install_missing PACKAGE...: asks the package manager only when something is missing.
install_missing() {
    local missing=() package
    for package in "$@"; do
        [[ $(dpkg-query -W -f='${db:Status-Status}' "$package" 2>/dev/null) == installed ]] || missing+=("$package")
    done
    ((${#missing[@]})) || return 0
    echo "Installing: ${missing[*]}" >&2
    local as_root=()
    ((EUID == 0)) || as_root=(sudo)
    "${as_root[@]}" apt-get update -qq >&2
    "${as_root[@]}" env DEBIAN_FRONTEND=noninteractive \
        apt-get install -y -qq --no-install-recommends "${missing[@]}" >&2
}

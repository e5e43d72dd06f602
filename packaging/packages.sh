# Sourced by ./run and ./test: which Debian packages they need, and how what is missing is installed.

build_packages=(
    g++ cmake ninja-build pkg-config ccache
    qt6-base-dev libexpat1-dev libpcap-dev libncurses-dev libcli11-dev rapidjson-dev
)
test_packages=(
    "${build_packages[@]}"
    libgtest-dev libgmock-dev libbenchmark-dev
    clang clang-format libclang-rt-14-dev
    python3 tmux git procps dbus-daemon systemd tcpdump
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

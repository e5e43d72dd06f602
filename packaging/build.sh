# shellcheck shell=bash
# Sourced by ./run and ./test: builds with progress on a terminal, and with no word otherwise unless it fails.

# quietly COMMAND...: shows what the command prints only when it fails.
quietly() {
    local log status=0
    log=$(mktemp)
    "$@" >"$log" 2>&1 || status=$?
    ((status == 0)) || cat "$log" >&2
    rm -f "$log"
    return "$status"
}

# with_progress COMMAND...: on a terminal the command's own counter, otherwise quietly.
with_progress() {
    if [[ -t 2 ]]; then "$@" >&2; else quietly "$@"; fi
}

# configure PRESET: once, and again when the presets have changed.
configure() {
    [[ build/$1/build.ninja -nt CMakePresets.json ]] || quietly cmake --preset "$1"
}

# build PRESET [TARGET...]: the targets, or else everything, from the top of the source tree.
build() {
    local preset=$1
    shift
    configure "$preset" && with_progress cmake --build --preset "$preset" ${1:+--target "$@"}
}

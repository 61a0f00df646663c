# What run.sh and test.sh share: the packages they need, and building a tree with its output in a log file.
# Sourced by bash from the repository's root.
# shellcheck shell=bash

# shellcheck disable=SC2034 # for those that source this
build_packages="cmake ninja-build g++ pkg-config libcli11-dev nlohmann-json3-dev libfmt-dev libgtest-dev libgmock-dev libbenchmark-dev libmd-dev libutfcpp-dev libpugixml-dev libgnutls28-dev libmicrohttpd-dev libpam0g-dev libsystemd-dev libcurl4-openssl-dev tzdata python3"

# What single tests take; they are skipped without.
# shellcheck disable=SC2034
test_packages="curl git sblim-wbemcli python3-clang python3-jsonschema groff bubblewrap strace iproute2 util-linux procps"

die() {
    echo "$0: $*" >&2
    exit 3
}

# install_packages PACKAGE...: installs those that are missing, and says which.
install_packages() {
    local missing=() package
    for package in "$@"; do
        [ "$(dpkg-query -W -f='${db:Status-Status}' "$package" 2>/dev/null)" = installed ] || missing+=("$package")
    done
    [ ${#missing[@]} -eq 0 ] && return
    local as_root=()
    if [ "$(id -u)" -ne 0 ]; then
        command -v sudo >/dev/null || die "these Debian packages are missing and installing them takes root or sudo: ${missing[*]}"
        as_root=(sudo)
    fi
    echo "installing Debian packages: ${missing[*]}" >&2
    local log
    log=$(mktemp)
    if ! { "${as_root[@]}" apt-get update -q &&
        "${as_root[@]}" env DEBIAN_FRONTEND=noninteractive apt-get install -q -y --no-install-recommends "${missing[@]}"; } >"$log" 2>&1 </dev/null; then
        tail -n 15 "$log" >&2
        die "installing ${missing[*]} failed; everything apt-get said is in $log"
    fi
    rm -f "$log"
}

# Whether a tree was configured for this checkout. One that was copied or moved with its checkout is not, and would build
# the sources of the place that it was configured for.
configured_here() {
    local home
    home=$(sed -n 's/^CMAKE_HOME_DIRECTORY:INTERNAL=//p' "$1/CMakeCache.txt" 2>/dev/null) || return
    [ "$home" -ef "$PWD" ]
}

# show_progress TEXT: passes on what cmake and ninja print, and shows on standard error how far they are: on a terminal in
# one line, which is gone at the end; elsewhere the text is printed once. Where nothing is to be done nothing is shown.
show_progress() {
    local line step shown="" terminal=""
    if [ -t 2 ] && [ "${TERM:-dumb}" != dumb ]; then terminal=yes; fi
    while IFS= read -r line || [ -n "$line" ]; do
        printf '%s\n' "$line"
        if [[ $line == "-- "* ]]; then
            step=configuring
        # At its step 0 ninja only looks whether there are new files.
        elif [[ $line =~ ^\[([1-9][0-9]*)/([0-9]+)\]\  ]]; then
            step="building: ${BASH_REMATCH[1]} of ${BASH_REMATCH[2]}"
        else
            continue
        fi
        if [ -n "$terminal" ]; then
            printf '\r\033[K%s' "$step" >&2
        elif [ -z "$shown" ]; then
            printf '%s\n' "$1" >&2
        fi
        shown=yes
    done
    if [ -n "$terminal" ] && [ -n "$shown" ]; then printf '\r\033[K' >&2; fi
}

# configure_tree PRESET DIRECTORY: once, and anew where the tree is another checkout's.
configure_tree() {
    if [ -f "$2/build.ninja" ] && configured_here "$2"; then return; fi
    # Written last: without it a configuration that failed is not taken for one that is done.
    rm -f "$2/build.ninja"
    cmake --fresh --preset "$1"
}

# build_tree PRESET DIRECTORY [TARGET...]: configures and builds all, or the targets; the output goes to DIRECTORY/build.log.
build_tree() {
    local preset=$1 directory=$2
    shift 2
    local log="$PWD/$directory/build.log"
    # Tried first: bash goes on as if all were well where it cannot open the file that a group of commands writes to.
    { mkdir -p "$directory" && true >"$log"; } 2>/dev/null ||
        die "cannot write $log, which belongs to $(stat -c %U "$log" "$directory" . 2>/dev/null | head -n 1); remove $directory, or build as its owner"
    if ! { configure_tree "$preset" "$directory" && cmake --build "$directory" ${1:+--target "$@"}; } 2>&1 </dev/null |
        show_progress "building the $preset tree in $directory" >"$log"; then
        grep -E 'error|Error|FAILED' "$log" | head -n 15 >&2 || true
        die "building the $preset tree failed; the whole output is in $log"
    fi
}

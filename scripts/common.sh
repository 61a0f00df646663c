# What run.sh and test.sh share: the packages they need, and building a tree with its output in a log file.
# Sourced by bash from the repository's root.
# shellcheck shell=bash

# shellcheck disable=SC2034 # for those that source this
build_packages="cmake ninja-build g++ pkg-config libcli11-dev nlohmann-json3-dev libfmt-dev libgtest-dev libgmock-dev libbenchmark-dev libmd-dev libutfcpp-dev tzdata python3"

# What single tests take; they are skipped without.
# shellcheck disable=SC2034
test_packages="python3-clang python3-jsonschema groff bubblewrap strace iproute2 util-linux procps"

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

# build_tree PRESET FOLDER [TARGET...]: configures once and builds all, or the targets; the output goes to
# FOLDER/build.log.
build_tree() {
    local preset=$1 directory=$2
    shift 2
    local log="$PWD/$directory/build.log"
    mkdir -p "$directory"
    if ! { { [ -f "$directory/build.ninja" ] || cmake --preset "$preset"; } &&
        cmake --build "$directory" ${1:+--target "$@"}; } >"$log" 2>&1 </dev/null; then
        grep -E 'error|Error|FAILED' "$log" | head -n 15 >&2
        die "building the $preset tree failed; the whole output is in $log"
    fi
}

#!/usr/bin/env bash
# Builds the project and runs vkcim: ./run.sh [ARGS], without ARGS a report of this host. See ./run.sh --help.
set -euo pipefail
here=$(cd "$(dirname "${BASH_SOURCE[0]}")" && pwd)
caller=$PWD
cd "$here"
. scripts/common.sh
# shellcheck disable=SC2086
install_packages $build_packages
# The tests are most of the tree; test.sh builds them, and the benchmarks.
build_tree release build vkcim vknabaseserverprofileprovider
cd "$caller"
[ $# -gt 0 ] || set -- report
exec "$here/build/bin/vkcim" "$@"

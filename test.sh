#!/usr/bin/env bash
# Builds the project and runs its tests: ./test.sh [CTEST ARGS].
set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")"
. scripts/common.sh
# shellcheck disable=SC2086
install_packages $build_packages
build_tree release build
exec ctest --test-dir build --output-on-failure -j "$(nproc)" "$@"

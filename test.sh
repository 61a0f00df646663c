#!/usr/bin/env bash
# Builds the project and runs its tests: ./test.sh [CTEST ARGS]; with --coverage first, in a tree of their own that
# tells how much of the provider they reach: ./test.sh --coverage [CTEST ARGS].
set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")"
. scripts/common.sh
if [ "${1:-}" = --coverage ]; then
    shift
    # shellcheck disable=SC2086
    install_packages $build_packages python3
    build_tree coverage build-coverage
    find build-coverage -name '*.gcda' -delete
    ctest --test-dir build-coverage --output-on-failure -j "$(nproc)" "$@"
    exec scripts/coverage build-coverage
fi
# shellcheck disable=SC2086
install_packages $build_packages
build_tree release build
exec ctest --test-dir build --output-on-failure -j "$(nproc)" "$@"

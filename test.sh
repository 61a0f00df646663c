#!/usr/bin/env bash
# Builds the project and runs its tests: ./test.sh [CTEST ARGS]. With --coverage, the tests that mirror the provider's own
# folders instead, in a tree of their own that tells how much of the provider they reach: ./test.sh --coverage.
set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")"
. scripts/common.sh
if [ "${1:-}" = --coverage ]; then
    # shellcheck disable=SC2086
    install_packages $build_packages clang llvm libclang-rt-14-dev
    build_tree coverage build-coverage provider-tests
    rm -rf build-coverage/profiles
    ctest --test-dir build-coverage --output-on-failure -j "$(nproc)" -R '^((provider|cmpi|Linux)_[A-Z]|include_)'
    exec scripts/coverage build-coverage
fi
# shellcheck disable=SC2086
install_packages $build_packages $test_packages
build_tree release build
exec ctest --test-dir build --output-on-failure -j "$(nproc)" "$@"

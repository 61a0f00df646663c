#!/usr/bin/env bash
# Builds the project and runs its tests: ./test.sh [CTEST ARGS]. With --coverage, the tests that mirror the provider's own
# directories instead, in a tree of their own that counts how much of the provider they reach; gcovr.cfg says what must be.
set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")"
. scripts/common.sh
if [ "${1:-}" = --coverage ]; then
    # shellcheck disable=SC2086
    install_packages $build_packages gcovr
    build_tree coverage build-coverage provider-tests
    find build-coverage -name '*.gcda' -delete
    ctest --test-dir build-coverage --output-on-failure -j "$(nproc)" -R '^((provider|cmpi|Linux)_[A-Z]|include_)'
    gcovr --json build-coverage/coverage.json --txt --print-summary build-coverage
    exec gcovr --add-tracefile build-coverage/coverage.json --branches
fi
# shellcheck disable=SC2086
install_packages $build_packages $test_packages
build_tree release build
exec ctest --test-dir build --output-on-failure -j "$(nproc)" "$@"

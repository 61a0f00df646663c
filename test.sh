#!/usr/bin/env bash
# Builds the project and runs its tests: ./test.sh [CTEST ARGS]. With --coverage, the tests that mirror the provider's own
# directories instead, in the sanitized tree, which counts how much of the provider they reach; gcovr.cfg says what must be.
set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")"
. scripts/common.sh
if [ "${1:-}" = --coverage ]; then
    # shellcheck disable=SC2086
    install_packages $build_packages gcovr
    build_tree debug build-debug provider-tests
    find build-debug -name '*.gcda' -delete
    ctest --test-dir build-debug --output-on-failure --timeout 600 -j "$(nproc)" -R "$provider_tests"
    gcovr --json build-debug/coverage.json --txt --print-summary build-debug
    exec gcovr --add-tracefile build-debug/coverage.json --branches
fi
# shellcheck disable=SC2086
install_packages $build_packages $test_packages
build_tree release build
exec ctest --test-dir build --output-on-failure -j "$(nproc)" "$@"

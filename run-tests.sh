#!/usr/bin/env bash
# Installs what the tests need, builds pendra with AddressSanitizer and
# UndefinedBehaviorSanitizer, and runs the whole test suite under them.
set -euo pipefail
cd "$(dirname "$0")"
tools/install-deps.sh test
cmake -S . -B build-test -DCMAKE_BUILD_TYPE=RelWithDebInfo -DPENDRA_SANITIZE=ON
cmake --build build-test -j"$(nproc)"
ctest --test-dir build-test --output-on-failure -j"$(nproc)"

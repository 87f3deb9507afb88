#!/usr/bin/env bash
# Installs what pendra needs, builds it, and configures the bundled example
# design silently: the written files are listed at the end.
set -euo pipefail
cd "$(dirname "$0")"
tools/install-deps.sh build
cmake -S . -B build -DCMAKE_BUILD_TYPE=RelWithDebInfo -DPENDRA_TESTS=OFF
cmake --build build -j"$(nproc)"
build/bin/pendra generate examples/single_dcm.tsw -o out/example

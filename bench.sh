#!/usr/bin/env bash
# Builds and runs the benchmarks: a table of ratios against what a user could take instead. --goals prints one line a
# goal and nothing else on standard output.
set -euo pipefail
cd "$(dirname "$0")"
. scripts/install_packages.sh
{
    install_packages "${BUILD_PACKAGES[@]}"
    cmake --preset release >/dev/null
    cmake --build --preset release --target zeph_bench
} >&2
exec build/release/bench/zeph_bench "$@"

#!/usr/bin/env bash
# Builds and runs the benchmarks: a table of ratios against what a user could take instead. --goals prints one line a
# goal and nothing else on standard output; names of subjects choose among them (see zeph_bench).
set -euo pipefail
cd "$(dirname "$0")"
. scripts/install_packages.sh
{
    install_packages "${BUILD_PACKAGES[@]}" "${RUN_PACKAGES[@]}" xvfb xauth
    cmake --preset release >/dev/null
    cmake --build --preset release --target zeph_bench zeph_window_bench
} >&2
build/release/bench/zeph_bench "$@"
# The window is measured along with all the others, on a virtual screen.
case "$*" in
"" | --goals) exec scripts/on_virtual_screen.sh build/release/bench/zeph_window_bench "$@" ;;
esac

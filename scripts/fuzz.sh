#!/usr/bin/env bash
# Hunts with one fuzz target for as long as one likes: scripts/fuzz.sh TARGET [SECONDS, default an hour].
# What it learns stays in build/corpus/TARGET; a crash is written to build/.
set -euo pipefail
cd "$(dirname "$0")/.."
target=${1:?name a target: $(ls fuzz/corpus | tr '\n' ' ')}
. scripts/install_packages.sh
install_packages "${BUILD_PACKAGES[@]}" "${TEST_PACKAGES[@]}"
cmake --preset sanitizers >/dev/null
cmake --build build/sanitizers --target "fuzz_$target"
mkdir -p "build/corpus/$target"
exec "build/sanitizers/fuzz/fuzz_$target" "build/corpus/$target" "fuzz/corpus/$target" \
    -max_total_time="${2:-3600}" -artifact_prefix=build/

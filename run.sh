#!/usr/bin/env bash
# Installs what is missing, builds, and shows the example display: the window, with the captured show playing to it over
# UDP from a second process. Without a screen a film of the show is rendered instead.
set -euo pipefail
cd "$(dirname "$0")"
. scripts/install_packages.sh
install_packages "${BUILD_PACKAGES[@]}" "${RUN_PACKAGES[@]}"

cmake --preset release >/dev/null
echo "Building"
cmake --build --preset release --target zeph zeph-tool

display=examples/house.zee
show=examples/house.zcap

if [ -z "${DISPLAY:-}${WAYLAND_DISPLAY:-}" ]; then
    film=build/house.mp4
    echo "There is no screen here, so a film of the show is made."
    if command -v ffmpeg >/dev/null; then
        build/release/bin/zeph-tool render "$display" --capture "$show" --from 0 --to 45000 --fps 25 --out "$film"
        echo "The film: $PWD/$film"
    else
        build/release/bin/zeph-tool render "$display" --capture "$show" --from 0 --to 45000 --fps 2 --out build/house/
        echo "The pictures: $PWD/build/house/"
    fi
    exit 0
fi

build/release/bin/zeph-tool send "$show" --loop --on-request &
player=$!
trap 'kill $player 2>/dev/null || true' EXIT
echo "The show plays to UDP port 30303, and the window simulates it. Play and Halt start and stop the show;"
echo "Esc or Stop leads to the editor, F5 back."
build/release/bin/zeph --simulate "$@" "$display"

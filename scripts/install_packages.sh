# Sourced by run.sh, test.sh and bench.sh: installs the Debian packages that are missing, and nothing where none is.
# Usage: install_packages PACKAGE...

install_packages() {
    local missing=()
    local package
    for package in "$@"; do
        if [ "$(dpkg-query -W -f='${db:Status-Status}' "$package" 2>/dev/null)" != installed ]; then
            missing+=("$package")
        fi
    done
    [ ${#missing[@]} -eq 0 ] && return 0

    command -v apt-get >/dev/null || {
        echo "This script installs Debian packages, and there is no apt-get here. Needed: ${missing[*]}" >&2
        return 1
    }
    local as_root=()
    if [ "$(id -u)" -ne 0 ]; then
        command -v sudo >/dev/null || {
            echo "These packages are missing and neither root nor sudo is at hand: ${missing[*]}" >&2
            return 1
        }
        as_root=(sudo)
    fi
    echo "Installing: ${missing[*]}"
    local log
    log=$(mktemp)
    if ! "${as_root[@]}" apt-get update >"$log" 2>&1 ||
        ! "${as_root[@]}" env DEBIAN_FRONTEND=noninteractive apt-get install -y --no-install-recommends \
            "${missing[@]}" >>"$log" 2>&1; then
        tail -n 20 "$log" >&2
        echo "apt-get could not install: ${missing[*]}" >&2
        rm -f "$log"
        return 1
    fi
    rm -f "$log"
}

# What building and running takes.
BUILD_PACKAGES=(g++ cmake ninja-build ccache pkg-config qt6-base-dev qt6-svg-dev libegl-dev libpugixml-dev libgtest-dev
    libgmock-dev libpixman-1-dev)
# What looking at the result takes besides: the platform plugin's own needs come with qt6-base-dev.
RUN_PACKAGES=(ffmpeg libgl1-mesa-dri qt6-image-formats-plugins)
# What checking takes besides.
TEST_PACKAGES=(git clang-14 libclang-rt-14-dev clang-format-14 python3 xvfb xauth)

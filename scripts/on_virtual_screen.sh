#!/usr/bin/env bash
# Runs a program on a virtual screen, with OpenGL drawn in software, so that a test sees the same on every machine.
# Usage: on_virtual_screen.sh PROGRAM [ARGUMENT...]
set -euo pipefail
command -v xvfb-run >/dev/null || {
    echo "There is no xvfb-run here: this test needs the Debian packages xvfb and xauth." >&2
    exit 1
}
export LIBGL_ALWAYS_SOFTWARE=1 QT_QPA_PLATFORM=xcb
exec xvfb-run -a -s "-screen 0 1280x1024x24" "$@"

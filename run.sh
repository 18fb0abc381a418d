#!/usr/bin/env bash
# Builds Plume and starts it.
#   ./run.sh          where there is a display: with its icon and windows, until Ctrl+C; elsewhere: the demonstration
#   ./run.sh demo     the demonstration: a private X server with real programs, in which Plume expands what is typed
#   ./run.sh ARGS...  the program with these arguments, such as: ./run.sh doctor
set -euo pipefail
cd "$(dirname "$0")"
. tools/dependencies.sh

demonstrate() {
    need_packages "${BUILD_PACKAGES[@]}" "${DESKTOP_PACKAGES[@]}"
    echo "Building the demonstration"
    build run -DPLUME_DEMO=ON
    build/run/bin/plume_demo build/plume-demo.png
    echo "A picture of the screen is in build/plume-demo.png"
}

if [ "${1:-}" = demo ] || { [ $# -eq 0 ] && [ -z "${DISPLAY:-}" ]; }; then
    demonstrate
    exit
fi
need_packages "${BUILD_PACKAGES[@]}"
build run
if [ $# -eq 0 ]; then
    cat <<'TEXT'
Plume is starting. In any program, type for instance
    btw and a space     by the way
    ;date               the date of today
    ;sig                a signature
    ;->                 an arrow
"build/run/bin/plume list" shows all of it; its icon is in the panel; Ctrl+C here ends it.
TEXT
fi
exec build/run/bin/plume "$@"

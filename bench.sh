#!/usr/bin/env bash
# Builds the benchmarks, optimised, and prints one line a figure: "name: value unit".
#   ./bench.sh [matching|content|input|delivery]…    all of them when none is named
set -euo pipefail
cd "$(dirname "$0")"
. tools/dependencies.sh
need_packages "${BUILD_PACKAGES[@]}" "${DESKTOP_PACKAGES[@]}" >&2
build bench >&2

[ $# -gt 0 ] || set -- matching content input delivery
for name in "$@"; do
    if [ ! -x "build/bench/bin/bench_$name" ]; then
        echo "bench.sh: no benchmark is called '$name'; there are: matching content input delivery" >&2
        exit 2
    fi
    "build/bench/bin/bench_$name"
done

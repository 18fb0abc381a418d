#!/usr/bin/env bash
# Builds the benchmarks, optimised, and prints one line a figure: "name: value unit".
#   ./bench.sh [matching|content]…    all of them when none is named
set -euo pipefail
cd "$(dirname "$0")"
. tools/dependencies.sh
need_packages "${BUILD_PACKAGES[@]}" >&2
build bench >&2

[ $# -gt 0 ] || set -- matching content
for name in "$@"; do
    if [ ! -x "build/bench/bin/bench_$name" ]; then
        echo "bench.sh: no benchmark is called '$name'; there are: matching content" >&2
        exit 2
    fi
    "build/bench/bin/bench_$name"
done

#!/usr/bin/env bash
# Builds the benchmarks, optimised, and prints one line a figure: "name: value unit".
#   ./bench.sh [matching|search|form|content|library|input|delivery|app]…    all of them when none is named
#   ./bench.sh delivery --with-peer                  beside AutoKey, which it installs
set -euo pipefail
cd "$(dirname "$0")"
. tools/dependencies.sh
need_packages "${BUILD_PACKAGES[@]}" "${DESKTOP_PACKAGES[@]}" >&2
build bench >&2

names=()
delivery=()
for argument in "$@"; do
    case $argument in
        --with-peer) need_packages autokey-gtk >&2; delivery+=(--with-peer) ;;
        *) names+=("$argument") ;;
    esac
done
[ ${#names[@]} -gt 0 ] || names=(matching search form content library input delivery app)
for name in "${names[@]}"; do
    if [ ! -x "build/bench/bin/bench_$name" ]; then
        echo "bench.sh: no benchmark is called '$name'; there are: matching search form content library input delivery app" >&2
        exit 2
    fi
    if [ "$name" = delivery ]; then
        build/bench/bin/bench_delivery "${delivery[@]}"
    else
        "build/bench/bin/bench_$name"
    fi
done

#!/usr/bin/env bash
# Builds Plume and runs its tests: optimised, with those on a real desktop, and with AddressSanitizer and
# UndefinedBehaviorSanitizer.
set -euo pipefail
cd "$(dirname "$0")"
. tools/dependencies.sh
need_packages "${BUILD_PACKAGES[@]}" "${TEST_PACKAGES[@]}" "${DESKTOP_PACKAGES[@]}"

python3 tools/check_layers.py
for preset in default asan; do
    echo "== $preset"
    build "$preset"
    ctest --preset "$preset" --parallel "$(nproc)" --progress
done

#!/usr/bin/env bash
# Builds Plume and runs its tests: optimised, with all those on a real desktop, and with AddressSanitizer and
# UndefinedBehaviorSanitizer, with those in which Plume reads what the programs of a real desktop send.
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

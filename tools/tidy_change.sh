#!/usr/bin/env bash
# Runs clang-tidy on the source files of the change: all that differ from the newest commit older than PLUME_TIDY_SINCE
# (default "4 hours ago"), or every file when there is none.
set -euo pipefail
cd "$(dirname "$0")/.."
base=$(git rev-list -1 --before="${PLUME_TIDY_SINCE:-4 hours ago}" HEAD 2>/dev/null || true)
if [ -n "$base" ]; then
    mapfile -t files < <(git diff --name-only --diff-filter=d "$base" HEAD -- 'src/*.cpp')
else
    mapfile -t files < <(git ls-files 'src/*.cpp')
fi
[ ${#files[@]} -gt 0 ] || { echo "no source file changed"; exit 0; }
printf '%s\n' "${files[@]}" | xargs -P "$(nproc)" -n 4 clang-tidy --quiet -p ${PLUME_TIDY_BUILD:-build/default} \
    --extra-arg=-Wno-unknown-warning-option --warnings-as-errors='*' 2>/dev/null
echo "${#files[@]} files are clean"

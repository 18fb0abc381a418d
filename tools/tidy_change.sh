#!/usr/bin/env bash
# Runs clang-tidy on the .cpp files of the change, and through them on the headers that they include.
# What the build folder does not build (in build/tidy, benchmarks and fuzzers) is left out.
#   tools/tidy_change.sh [BRANCH]
# The change is what came since HEAD left BRANCH (origin/main when none is named). When that is HEAD itself, it is what came
# since the newest commit older than PLUME_TIDY_SINCE ("4 hours ago"), and every file when there is no such commit.
# A large change would take too long: of more than PLUME_TIDY_FILES (40) files, those with the most new lines are checked.
# PLUME_TIDY_BUILD is a build folder with the commands that compile each source by itself; when none is named, build/tidy
# is made.
set -euo pipefail
cd "$(dirname "$0")/.."
most=${PLUME_TIDY_FILES:-40}
build=${PLUME_TIDY_BUILD:-build/tidy}
sources=('src/*.cpp' 'testing/*.cpp' 'tests/*.cpp' 'bench/*.cpp')
if [ -z "${PLUME_TIDY_BUILD:-}" ]; then
    cmake --preset tidy >/dev/null
fi
[ -f "$build/compile_commands.json" ] || { echo "$build is no build folder: build there first" >&2; exit 2; }
root=$(sed -n 's/^CMAKE_HOME_DIRECTORY:INTERNAL=//p' "$build/CMakeCache.txt")

# The commit that the change starts from, or nothing when all is new.
base_commit() {
    local base
    if [ $# -gt 0 ]; then
        git merge-base "$1" HEAD
        return
    fi
    base=$(git merge-base origin/main HEAD 2>/dev/null || true)
    if [ -z "$base" ] || [ "$base" = "$(git rev-parse HEAD)" ]; then
        base=$(git rev-list -1 --before="${PLUME_TIDY_SINCE:-4 hours ago}" HEAD)
    fi
    echo "$base"
}

# The files that the build folder builds, by their paths in the tree.
built_files() {
    sed -nE 's,.*"file": "(.*)".*,\1,p' "$build/compile_commands.json" | sed "s,^$root/,,"
}

# The changed files among them, those with the most new lines first. A file that only moved has none and comes last.
changed_files() {
    local since=${1:-$(git hash-object -t tree /dev/null)}
    git diff --numstat --find-renames --diff-filter=d "$since" HEAD -- "${sources[@]}" |
        cut -f1,3 | sort -k1,1nr -k2 | cut -f2 |
        sed -E 's/\{.* => (.*)\}/\1/; s/.* => //; s,//,/,' |
        { grep -Fxf <(built_files) || true; }
}

base=$(base_commit "$@")
changed=$(changed_files "$base")
[ -n "$changed" ] || { echo "no source file changed"; exit 0; }
mapfile -t files <<<"$changed"
checked=("${files[@]:0:most}")
printf '%s\n' "${checked[@]}" | xargs -P "$(nproc)" -n 1 clang-tidy --quiet -p "$build" \
    --extra-arg=-Wno-unknown-warning-option --warnings-as-errors='*' 2> >(grep -v ' generated\.$' >&2)
echo "${#checked[@]} of the ${#files[@]} files that changed are clean; $((${#files[@]} - ${#checked[@]})) were left out"

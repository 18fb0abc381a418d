#!/usr/bin/env bash
# Runs every fuzz target for the given number of seconds, as many at a time as there are processors.
#   tools/fuzz.sh SECONDS
set -euo pipefail
cd "$(dirname "$0")/.."
seconds=${1:?usage: tools/fuzz.sh SECONDS}
scratch=$(mktemp -d)
trap 'rm -rf "$scratch"' EXIT

run_one() {
    local target=$1 name log
    name=$(basename "$target")
    log=$2/$name.log
    if (cd "$2" && "$target" -max_total_time="$3" -timeout=60 -rss_limit_mb=4096 -print_final_stats=1) >"$log" 2>&1; then
        echo "$name: $(grep -o 'number_of_executed_units: .*' "$log" | grep -o '[0-9]*') inputs, no fault"
    else
        tail -n 60 "$log"
        echo "$name: FAILED"
        return 1
    fi
}
export -f run_one
targets=("$PWD"/build/fuzz/bin/Fuzz*)
[ -x "${targets[0]}" ] || { echo "no fuzz target is built" >&2; exit 1; }
printf '%s\n' "${targets[@]}" | xargs -P "$(nproc)" -I{} bash -c 'run_one "$@"' _ {} "$scratch" "$seconds"

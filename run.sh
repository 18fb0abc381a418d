#!/usr/bin/env bash
# Starts Plume. There is no program to start yet: the core is being built, and its tests are what shows it at work.
set -euo pipefail
cat <<'TEXT'
Plume cannot be used yet: so far it is the core of a text expander, without the part that listens to a keyboard.
./test.sh builds that core and shows that it works; ./bench.sh shows how fast it is.
TEXT

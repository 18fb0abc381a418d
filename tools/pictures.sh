#!/bin/bash
# Takes the pictures of docs/windows.md anew: tools/pictures.sh BUILD
set -euo pipefail

build=$1
documents=$(cd "$(dirname "$0")/../docs/pictures" && pwd)
PLUME_PICTURES=$(mktemp -d)
export PLUME_PICTURES
trap 'rm -rf "$PLUME_PICTURES"' EXIT

for tests in form windows preferences search status; do
    LC_ALL=C.UTF-8 "$build/bin/plume_${tests}_tests" --gtest_brief=1
done

PLUME_SCREENSHOTS=$PLUME_PICTURES "$build/bin/form_test" --gtest_brief=1 --gtest_filter='*SendsTheText/Page'

while read -r taken name; do
    cp "$PLUME_PICTURES/$taken.png" "$documents/$name.png"
done <<PICTURES
Welcome welcome
General preferences-general
HotKeys preferences-hot-keys
Applications-own preferences-applications
Typing-dark preferences-dark
SuggestionsExample suggestions
QuickSearchExample quick-search
QuickSearchExample-dark quick-search-dark
form-GTK-page form
PlainForm-en form-plain
UnsentText unsent-text
Decisions decisions
Restore restore
Diagnostic diagnostics
status-menu-light menu
status-icons icons
PICTURES

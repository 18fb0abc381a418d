#!/usr/bin/env bash
# Types into the programs that people use, with Plume beside them, on a private X server, and prints what came of it;
# docs/real-programs.md. Installs what is missing: this takes a few GB.
#   tools/real_programs.sh                     all programs
#   tools/real_programs.sh --program gedit     one; build/run/bin/plume_real_programs lists the other options
set -euo pipefail
cd "$(dirname "$0")/.."
. tools/dependencies.sh

REAL_PROGRAMS=(gedit gnome-text-editor mousepad kate kwrite geany featherpad l3afpad emacs-gtk vim-gtk3 tk
    openjdk-17-jdk-headless openjdk-17-jre gnome-terminal konsole xfce4-terminal qterminal xterm libreoffice-writer
    libreoffice-calc libreoffice-impress libreoffice-gtk3 libreoffice-kf5 firefox-esr chromium copyq)

need_packages "${BUILD_PACKAGES[@]}" "${DESKTOP_PACKAGES[@]}" "${REAL_PROGRAMS[@]}"
build run -DPLUME_DEMO=ON
exec build/run/bin/plume_real_programs --pictures build/real-programs "$@"

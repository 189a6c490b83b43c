#!/usr/bin/env bash
# Installs what is missing, builds Quillmark with warnings as errors and runs
# every test (logic, corpus, windows) on the offscreen platform.
set -euo pipefail
here="$(cd "$(dirname "$0")/.." && pwd)"
"$here/scripts/deps.sh"
QM_CMAKE_ARGS="-DQM_WERROR=ON ${QM_CMAKE_ARGS:-}" "$here/scripts/build.sh"
export QT_QPA_PLATFORM=offscreen
cd "${QM_BUILD_DIR:-$here/build}"
ctest --output-on-failure -j2 "$@"

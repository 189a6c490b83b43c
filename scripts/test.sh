#!/usr/bin/env bash
# Installs what is missing, builds Quillmark with warnings as errors, builds
# the fuzz targets and runs each for a short fixed number of inputs
# (scripts/fuzz.sh; QM_FUZZ_RUNS=0 leaves them out), and runs every test
# (logic, corpus, windows) on the offscreen platform.
set -euo pipefail
here="$(cd "$(dirname "$0")/.." && pwd)"
"$here/scripts/deps.sh"
QM_CMAKE_ARGS="-DQM_WERROR=ON ${QM_CMAKE_ARGS:-}" "$here/scripts/build.sh"
[ "${QM_FUZZ_RUNS:-}" = 0 ] || "$here/scripts/fuzz.sh"
export QT_QPA_PLATFORM=offscreen
cd "${QM_BUILD_DIR:-$here/build}"
ctest --output-on-failure -j2 "$@"

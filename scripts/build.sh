#!/usr/bin/env bash
# Configures and builds Quillmark in build/ (or $QM_BUILD_DIR).
set -euo pipefail
here="$(cd "$(dirname "$0")/.." && pwd)"
build="${QM_BUILD_DIR:-$here/build}"
launcher=()
command -v ccache >/dev/null && launcher=(-DCMAKE_CXX_COMPILER_LAUNCHER=ccache)
cmake -S "$here" -B "$build" -G Ninja -DCMAKE_BUILD_TYPE=RelWithDebInfo "${launcher[@]}" ${QM_CMAKE_ARGS:-} >/dev/null
cmake --build "$build" "$@"

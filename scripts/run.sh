#!/usr/bin/env bash
# Installs what is missing, builds Quillmark and starts it on the bundled sample
# family file (or on the file given as the first argument).
set -euo pipefail
here="$(cd "$(dirname "$0")/.." && pwd)"
"$here/scripts/deps.sh"
"$here/scripts/build.sh" --target quillmark quillmark-cli
build="${QM_BUILD_DIR:-$here/build}"
if [ $# -ge 1 ]; then
  file="$1"
else
  # Work on a copy, so that saving entries never changes the bundled sample.
  file="$build/sample/sample.ged"
  if [ ! -f "$file" ]; then
    mkdir -p "$build/sample"
    cp "$here/examples/sample.ged" "$file"
  fi
fi
if [ -z "${DISPLAY:-}${WAYLAND_DISPLAY:-}" ] && [ -z "${QT_QPA_PLATFORM:-}" ]; then
  echo "No display found: printing the file's summary instead of opening the window."
  exec "$build/quillmark-cli" stats "$file"
fi
exec "$build/quillmark" "$file"

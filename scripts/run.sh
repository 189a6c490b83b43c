#!/usr/bin/env bash
# Installs what is missing, builds Quillmark and starts it on the bundled sample
# family file (or on the file given as the first argument).
set -euo pipefail
here="$(cd "$(dirname "$0")/.." && pwd)"
"$here/scripts/deps.sh"
"$here/scripts/build.sh" --target quillmark quillmark-cli
file="${1:-$here/examples/sample.ged}"
if [ -z "${DISPLAY:-}${WAYLAND_DISPLAY:-}" ] && [ -z "${QT_QPA_PLATFORM:-}" ]; then
  echo "No display found: printing the file's summary instead of opening the window."
  exec "${QM_BUILD_DIR:-$here/build}/quillmark-cli" stats "$file"
fi
exec "${QM_BUILD_DIR:-$here/build}/quillmark" "$file"

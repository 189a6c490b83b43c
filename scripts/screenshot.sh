#!/bin/sh
# Pictures the main window with the sample file open and a household half
# entered, on an offscreen 1366x768 screen: docs/mainwindow.png; and the
# Census Coverage window over the same file: docs/coverage.png.
# Usage: scripts/screenshot.sh [build folder]   (default: build)
set -e
root=$(cd "$(dirname "$0")/.." && pwd)
build=${1:-$root/build}
cmake --build "$build" --target mainfrm_test coveragefrm_test >/dev/null
config=$(mktemp)
trap 'rm -f "$config"' EXIT
cat >"$config" <<JSON
{ "screens": [ { "name": "screen", "x": 0, "y": 0, "width": 1366, "height": 768,
                 "logicalDpi": 96, "dpr": 1 } ] }
JSON
QT_QPA_PLATFORM="offscreen:configfile=$config" QM_SCREENSHOT="$root/docs/mainwindow.png" \
    "$build/tests/mainfrm_test" screenshot
echo "wrote $root/docs/mainwindow.png"
QT_QPA_PLATFORM="offscreen:configfile=$config" QM_SCREENSHOT_COVERAGE="$root/docs/coverage.png" \
    "$build/tests/coveragefrm_test" screenshot
echo "wrote $root/docs/coverage.png"

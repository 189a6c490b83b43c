#!/usr/bin/env bash
# Cross-builds Quillmark for Windows with MinGW-w64, tests it under Wine and
# packs a portable zip, all from Debian packages:
#
#   1. installs what is missing (MinGW-w64, Wine, Xvfb, GoogleTest's sources)
#   2. builds the Windows Qt once into a cache folder (scripts/windows-qt.sh)
#   3. cross-builds quillmark.exe, quillmark-cli.exe and the tests with
#      warnings as errors, in build-windows/ (or $QM_WIN_BUILD_DIR)
#   4. runs the logic, corpus and window tests under Wine (offscreen platform)
#   5. runs the command-line examples of the README under Wine
#   6. paints the main window under Wine with the windows platform (in Xvfb)
#      into build-windows/mainwindow-windows.png
#   7. packs build-windows/Quillmark-VERSION-windows-x64.zip
#
# It prints the time of each step. ctest arguments may follow (e.g. -R logic);
# they narrow step 4. QM_WINQT_CACHE names the cache folder (default
# ~/.cache/quillmark/qt6-mingw); the Wine prefix lives there too.
set -euo pipefail
here="$(cd "$(dirname "$0")/.." && pwd)"
build="${QM_WIN_BUILD_DIR:-$here/build-windows}"
export QM_WINQT_CACHE="${QM_WINQT_CACHE:-$HOME/.cache/quillmark/qt6-mingw}"
qt="$QM_WINQT_CACHE/qt"
triple=x86_64-w64-mingw32

declare -a times=()
step() {
  local name="$1" start
  shift
  echo "== $name"
  start=$(date +%s)
  "$@"
  times+=("$(printf '%-12s %5d s' "$name" $(($(date +%s) - start)))")
  echo "-- $name: $(($(date +%s) - start)) s"
}

install_packages() {
  "$here/scripts/deps.sh"
  local packages=(g++-mingw-w64-x86-64-posix gcc-mingw-w64-x86-64-posix mingw-w64-x86-64-dev
                  binutils-mingw-w64-x86-64 wine wine64 libwine-dev xvfb xauth googletest dpkg-dev zip
                  fonts-dejavu-core)
  local missing=() p sudo="" update=0
  for p in "${packages[@]}"; do
    dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q "install ok installed" || missing+=("$p")
  done
  [ "$(id -u)" -ne 0 ] && sudo="sudo"
  # The Windows Qt is built from Debian's own qt6-base source: that needs a
  # deb-src entry for the release's main archive, taken from the configured one.
  if [ ! -f "$qt/.quillmark-recipe" ] && [ -z "$(apt-cache showsrc qt6-base 2>/dev/null | head -1)" ]; then
    local codename uri
    codename=$(. /etc/os-release && echo "$VERSION_CODENAME")
    uri=$(apt-get indextargets --format '$(REPO_URI) $(RELEASE) $(TARGET_OF)' |
            awk -v r="$codename" '$2 == r && $3 == "deb" { print $1; exit }')
    echo "Adding the source packages of $uri $codename"
    printf 'Types: deb-src\nURIs: %s\nSuites: %s\nComponents: main\n' "$uri" "$codename" |
      $sudo tee /etc/apt/sources.list.d/quillmark-src.sources >/dev/null
    update=1
  fi
  [ ${#missing[@]} -eq 0 ] && [ $update = 0 ] && return 0
  export DEBIAN_FRONTEND=noninteractive
  $sudo apt-get update -qq
  [ ${#missing[@]} -eq 0 ] || $sudo apt-get install -y -qq --no-install-recommends "${missing[@]}"
}

configure_and_build() {
  local launcher=()
  command -v ccache >/dev/null && launcher=(-DCMAKE_CXX_COMPILER_LAUNCHER=ccache -DCMAKE_C_COMPILER_LAUNCHER=ccache)
  # Qt's own toolchain file for its cross build loads ours and makes CMake
  # find the Windows Qt outside the MinGW tree.
  cmake -S "$here" -B "$build" -G Ninja -DCMAKE_BUILD_TYPE=RelWithDebInfo \
    -DCMAKE_TOOLCHAIN_FILE="$qt/lib/cmake/Qt6/qt.toolchain.cmake" \
    -DQT_CHAINLOAD_TOOLCHAIN_FILE="$here/cmake/mingw-w64-x86_64.cmake" \
    -DQT_HOST_PATH=/usr -DQT_HOST_PATH_CMAKE_DIR=/usr/lib/x86_64-linux-gnu/cmake \
    -DCMAKE_AUTORCC_OPTIONS=--no-zstd \
    -DQM_GTEST_SOURCE_DIR=/usr/src/googletest -DQM_BENCH=OFF -DQM_WERROR=ON "${launcher[@]}" >/dev/null
  nice -n 10 cmake --build "$build" -j 2
}

# Wine: its own prefix in the cache folder (made once, ~15 s), no Mono or Gecko
# installers, quiet, and the Qt and MinGW runtime DLLs on its search path.
windows_path() { echo "Z:${1//\//\\}"; }
gccdir=$(dirname "$($triple-g++-posix -print-libgcc-file-name)")
export WINEPREFIX="$QM_WINQT_CACHE/wine"
export WINEARCH=win64
export WINEDEBUG=-all
export WINEDLLOVERRIDES="mscoree,mshtml="
export WINEPATH="$(windows_path "$qt/bin");$(windows_path "$gccdir");$(windows_path "/usr/$triple/lib")"
# Wine gives Windows programs none of the QT_ variables of the Unix
# environment (they belong to the Linux desktop); WINEQT_X reaches them as QT_X.
export WINEQT_PLUGIN_PATH="$(windows_path "$qt/plugins")"
# The offscreen platform of a Windows Qt draws with FreeType from the fonts of
# one folder: the same DejaVu fonts the Linux tests get from fontconfig.
export WINEQT_QPA_FONTDIR="$(windows_path /usr/share/fonts/truetype/dejavu)"

start_wine() {
  if [ ! -f "$WINEPREFIX/system.reg" ]; then
    wineboot --init >/dev/null 2>&1
  fi
  wineserver -p 60 2>/dev/null || true # kept running between the programs of the tests (status 2: already running)
}

run_tests() {
  start_wine
  (cd "$build" && ctest --output-on-failure --timeout 900 -j 2 "$@")
}

# The README's command-line examples, on a copy of the sample file, with the
# settings of the Wine prefix's user (the defaults: backups and census log in
# its %LOCALAPPDATA%\Quillmark).
run_examples() {
  start_wine
  local work="$build/examples" cli="$build/quillmark-cli.exe" out f
  rm -rf "$work" && mkdir -p "$work"
  cp "$here/examples/sample.ged" "$here/examples/entry.json" "$work/"
  f="$(windows_path "$work/sample.ged")"
  out=$(wine "$cli" stats "$f")
  echo "stats: $out"
  case "$out" in \{*\}) ;; *) echo "stats printed no JSON object" >&2; return 1 ;; esac
  [[ "$out" != *$'\r'* ]] || { echo "stats wrote CR LF" >&2; return 1; }
  out=$(wine "$cli" add-entry "$f" --entry "$(windows_path "$work/entry.json")")
  echo "add-entry: $out"
  [[ "$out" == *'"backup":"C:\\'* ]] || { echo "add-entry named no backup" >&2; return 1; }
  wine "$cli" date-check "$f" | head -5
  wine "$cli" flag-check "$f" | head -5
  grep -q "2 PLAC Hebden Bridge, Yorkshire, England" "$work/sample.ged"
  # A missing file: one line on standard error and exit status 2.
  local status=0
  wine "$cli" stats "$(windows_path "$work/none.ged")" 2>"$work/err.txt" || status=$?
  [ "$status" = 2 ] && [ "$(wc -l <"$work/err.txt")" = 1 ] || { echo "missing file: status $status" >&2; return 1; }
}

# The main window as the windows platform paints it under Wine, in a virtual
# X screen, with the sample file open and a household half entered.
paint_window() {
  start_wine
  rm -f "$build/mainwindow-windows.png"
  QM_SCREENSHOT="$(windows_path "$build/mainwindow-windows.png")" WINEQT_QPA_PLATFORM=windows \
    xvfb-run -a -s "-screen 0 1366x768x24" wine "$build/tests/mainfrm_test.exe" screenshot >"$build/paint.log" 2>&1 ||
    { cat "$build/paint.log" >&2; return 1; }
  [ -s "$build/mainwindow-windows.png" ] && echo "wrote $build/mainwindow-windows.png"
}

pack_zip() {
  local version name dir
  version=$(sed -n 's/^project(Quillmark VERSION \([0-9.]*\).*/\1/p' "$here/CMakeLists.txt")
  name="Quillmark-$version-windows-x64"
  dir="$build/package/Quillmark"
  rm -rf "$build/package" "$build/$name.zip"
  mkdir -p "$dir/platforms" "$dir/imageformats" "$dir/styles" "$dir/help" "$dir/examples"
  for exe in quillmark quillmark-cli; do
    $triple-strip -o "$dir/$exe.exe" "$build/$exe.exe"
  done
  cp "$qt/bin/Qt6Core.dll" "$qt/bin/Qt6Gui.dll" "$qt/bin/Qt6Widgets.dll" "$dir/"
  cp "$gccdir/libstdc++-6.dll" "$gccdir/libgcc_s_seh-1.dll" "/usr/$triple/lib/libwinpthread-1.dll" "$dir/"
  cp "$qt/plugins/platforms/qwindows.dll" "$dir/platforms/"
  cp "$qt"/plugins/imageformats/*.dll "$dir/imageformats/"
  cp "$qt"/plugins/styles/*.dll "$dir/styles/" 2>/dev/null || rmdir "$dir/styles"
  $triple-strip "$dir"/*.dll "$dir"/*/*.dll
  cp "$here"/src/app/help/*.html "$dir/help/"
  cp "$here/docs/cli.md" "$dir/help/command-line.md"
  cp "$here/examples/sample.ged" "$here/examples/entry.json" "$dir/examples/"
  sed "s/@VERSION@/$version/" "$here/scripts/windows-readme.txt" | sed 's/$/\r/' >"$dir/README.txt"
  # Every DLL a program or plugin asks for is in the folder or part of Windows.
  local missing
  missing=$(cd "$dir" && for f in *.exe *.dll */*.dll; do $triple-objdump -p "$f" | sed -n 's/^\tDLL Name: //p'; done |
              sort -u | while read -r dll; do
                [ -f "$dir/$dll" ] || [ -f "/usr/lib/x86_64-linux-gnu/wine/x86_64-windows/${dll,,}" ] ||
                  [[ "${dll,,}" == api-ms-win-* ]] || echo "$dll" # api-ms-win-*: API sets of Windows itself
              done)
  [ -z "$missing" ] || { echo "DLLs missing from the package: $missing" >&2; return 1; }
  (cd "$build/package" && zip -qr9 "../$name.zip" Quillmark)
  echo "$build/$name.zip: $(du -k "$build/$name.zip" | cut -f1) KiB"
}

total_start=$(date +%s)
step packages install_packages
step qt nice -n 15 "$here/scripts/windows-qt.sh"
step build configure_and_build
step tests run_tests "$@"
step examples run_examples
step window paint_window
step zip pack_zip
wineserver -k 2>/dev/null || true
echo "== times"
printf '%s\n' "${times[@]}"
printf '%-12s %5d s\n' total $(($(date +%s) - total_start))

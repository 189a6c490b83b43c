#!/usr/bin/env bash
# Builds the Windows Qt that Quillmark's Windows build links (Core, Gui, Widgets,
# Test and the platforms and imageformats plugins) with MinGW-w64, once, into a
# cache folder outside the repository, then the image formats of the
# qtimageformats module that census images come in beside JPEG and PNG (TIFF
# with its bundled libtiff, TGA; the module adds WBMP and ICNS):
#
#   $QM_WINQT_CACHE (default ~/.cache/quillmark/qt6-mingw)
#     src/      Debian's qt6-base source with its security patches
#     build/    the build tree (kept, so an interrupted build goes on)
#     qt/       the installed Qt; qt/.quillmark-recipe marks it complete
#     qt-build.log
#     imageformats-src/, imageformats-build/, imageformats-build.log
#                qtimageformats, the same way; qt/.quillmark-imageformats-recipe
#
# It takes Debian's own qt6-base source, the same version as the host Qt whose
# tools (moc, rcc, uic) the cross build uses. A finished Qt is reused as long as
# the recipe below is unchanged. The caller installs the packages (windows.sh).
set -euo pipefail
here="$(cd "$(dirname "$0")/.." && pwd)"
cache="${QM_WINQT_CACHE:-$HOME/.cache/quillmark/qt6-mingw}"
prefix="$cache/qt"
log="$cache/qt-build.log"
mkdir -p "$cache"

# Debian's security fixes for 6.4.2; the rest of its patches are for Linux.
cve_patches=(cve-2023-32762.diff cve-2023-32763.diff cve-2023-33285.diff cve-2023-24607.patch)

qt_args=(
  -DCMAKE_BUILD_TYPE=Release
  -DBUILD_SHARED_LIBS=ON
  # Debian's host Qt of the same version lends its tools (moc, rcc, uic).
  -DQT_HOST_PATH=/usr
  -DQT_HOST_PATH_CMAKE_DIR=/usr/lib/x86_64-linux-gnu/cmake
  -DQT_BUILD_TESTS=OFF -DQT_BUILD_EXAMPLES=OFF -DQT_BUILD_BENCHMARKS=OFF
  -DQT_BUILD_TOOLS_WHEN_CROSSCOMPILING=OFF
  -DFEATURE_network=OFF -DFEATURE_sql=OFF -DFEATURE_dbus=OFF -DFEATURE_concurrent=OFF
  -DFEATURE_xml=OFF -DFEATURE_printsupport=OFF -DFEATURE_vulkan=OFF
  # No OpenGL of any kind (FEATURE_opengl=OFF alone leaves dynamic OpenGL on).
  -DINPUT_opengl=no
  -DFEATURE_direct2d=OFF -DFEATURE_icu=OFF -DFEATURE_zstd=OFF -DFEATURE_glib=OFF
  -DFEATURE_pkg_config=OFF
  -DFEATURE_system_zlib=OFF -DFEATURE_system_pcre2=OFF -DFEATURE_system_doubleconversion=OFF
  -DFEATURE_system_png=OFF -DFEATURE_system_jpeg=OFF -DFEATURE_system_harfbuzz=OFF
  # The offscreen platform, on which the window tests run, needs FreeType.
  -DFEATURE_freetype=ON -DFEATURE_system_freetype=OFF
  -DFEATURE_testlib=ON
)
# The wintab.h that Qt's tablet support includes: Wine's, given three macros
# of the Wacom header it stands in for (Debian's tarball leaves that one out).
wintab_h=$(cat <<'EOF'
/* Wine's wintab.h, with the calling convention macro of the Wacom header
   that Qt's code names, and the two Winelib macros Wine's header uses defined
   as Windows' own headers would (the W names when UNICODE is defined). */
#ifndef API
# define API WINAPI
#endif
#ifndef WINELIB_NAME_AW
# ifdef UNICODE
#  define WINELIB_NAME_AW(name) name##W
# else
#  define WINELIB_NAME_AW(name) name##A
# endif
#endif
#ifndef DECL_WINELIB_TYPE_AW
# define DECL_WINELIB_TYPE_AW(type) typedef WINELIB_NAME_AW(type) type;
#endif
#include "wine-wintab.h"
EOF
)

direct2d_guard='s/^#if QT_CONFIG(directwrite3)$/#if QT_CONFIG(directwrite3) \&\& QT_CONFIG(direct2d)/'

hash() { sha256sum | cut -d' ' -f1; }
version=$(dpkg-query -W -f='${Version}' qt6-base-dev)    # e.g. 6.4.2+dfsg-10
source_recipe=$(printf '%s\n' "$version" "${cve_patches[@]}" "$wintab_h" "$direct2d_guard" | hash)
recipe=$( { echo "$source_recipe"; printf '%s\n' "${qt_args[@]}"; cat "$here/cmake/mingw-w64-x86_64.cmake"; } | hash)

# qtimageformats, built against the Qt above into the same prefix.
imageformats_args=(
  -DCMAKE_BUILD_TYPE=Release
  -DQT_HOST_PATH=/usr
  -DQT_HOST_PATH_CMAKE_DIR=/usr/lib/x86_64-linux-gnu/cmake
  -DQT_BUILD_TESTS=OFF -DQT_BUILD_EXAMPLES=OFF
  -DFEATURE_tiff=ON -DFEATURE_system_tiff=OFF
  -DFEATURE_webp=OFF -DFEATURE_jasper=OFF -DFEATURE_mng=OFF
)
imageformats() {
  local v r isrc="$cache/imageformats-src" ibuild="$cache/imageformats-build" ilog="$cache/imageformats-build.log"
  # The same upstream version as the Qt it plugs into.
  v=$(apt-cache showsrc qt6-imageformats | sed -n "s/^Version: \(${version%%+*}[-+].*\)/\1/p" | sort -V | tail -1)
  r=$( { echo "$recipe" "$v"; printf '%s\n' "${imageformats_args[@]}"; } | hash)
  if [ "$(cat "$prefix/.quillmark-imageformats-recipe" 2>/dev/null)" = "$r" ]; then
    echo "Windows Qt image formats: cached"
    return 0
  fi
  echo "Windows Qt image formats: building qt6-imageformats $v (log: $ilog); some minutes"
  rm -rf "$isrc" "$ibuild"
  mkdir -p "$isrc"
  (cd "$isrc" && apt-get source --download-only "qt6-imageformats=$v" >/dev/null 2>&1 &&
     dpkg-source --skip-patches -x ./*.dsc "$isrc/src" >/dev/null 2>&1) ||
    { echo "Windows Qt image formats: could not fetch Debian's qt6-imageformats source" >&2; return 1; }
  { cmake -S "$isrc/src" -B "$ibuild" -G Ninja \
      -DCMAKE_TOOLCHAIN_FILE="$prefix/lib/cmake/Qt6/qt.toolchain.cmake" \
      -DQT_CHAINLOAD_TOOLCHAIN_FILE="$here/cmake/mingw-w64-x86_64.cmake" \
      -DCMAKE_INSTALL_PREFIX="$prefix" "${launcher[@]}" "${imageformats_args[@]}" &&
      cmake --build "$ibuild" -j "${QM_WINQT_JOBS:-2}" && cmake --install "$ibuild"; } >"$ilog" 2>&1 ||
    { echo "Windows Qt image formats: build failed; the end of $ilog:" >&2; tail -30 "$ilog" >&2; return 1; }
  echo "$r" >"$prefix/.quillmark-imageformats-recipe"
  echo "Windows Qt image formats: installed $(cd "$prefix/plugins/imageformats" && echo *.dll)"
}

launcher=()
command -v ccache >/dev/null && launcher=(-DQT_USE_CCACHE=ON)

if [ "$(cat "$prefix/.quillmark-recipe" 2>/dev/null)" = "$recipe" ]; then
  echo "Windows Qt: $prefix (cached)"
  imageformats
  exit
fi

src="$cache/src/qt6-base-${version%%+*}"
build="$cache/build"

if [ "$(cat "$src/.quillmark-recipe" 2>/dev/null)" != "$source_recipe" ]; then
  echo "Windows Qt: fetching Debian's qt6-base $version source"
  rm -rf "$cache/src"
  mkdir -p "$cache/src"
  (cd "$cache/src" && apt-get source --download-only "qt6-base=$version" >/dev/null 2>&1 &&
     dpkg-source --skip-patches -x ./*.dsc "$src" >/dev/null 2>&1)
  for p in "${cve_patches[@]}"; do patch -d "$src" -p1 -s <"$src/debian/patches/$p"; done
  mkdir -p "$src/src/3rdparty/wintab"
  cp /usr/include/wine/wine/windows/wintab.h "$src/src/3rdparty/wintab/wine-wintab.h"
  cp /usr/include/wine/wine/windows/pktdef.h "$src/src/3rdparty/wintab/"
  echo "$wintab_h" >"$src/src/3rdparty/wintab/wintab.h"
  # With Direct2D off Qt Gui has no DirectWrite font database, which the
  # windows platform plugin would still ask for.
  sed -i "$direct2d_guard" "$src/src/plugins/platforms/windows/qwindowsintegration.cpp"
  [ "$(grep -c 'QT_CONFIG(directwrite3) && QT_CONFIG(direct2d)' \
         "$src/src/plugins/platforms/windows/qwindowsintegration.cpp")" = 2 ]
  echo "$source_recipe" >"$src/.quillmark-recipe"
fi

echo "Windows Qt: building into $prefix (log: $log); most of an hour on 2 cores"
# An interrupted build goes on where it stopped; a changed recipe is
# configured over the same tree, so only what it changes is built again.
build_qt() {
  if [ "$(cat "$build/.quillmark-recipe" 2>/dev/null)" != "$recipe" ]; then
    cmake -S "$src" -B "$build" -G Ninja \
      -DCMAKE_TOOLCHAIN_FILE="$here/cmake/mingw-w64-x86_64.cmake" \
      -DCMAKE_INSTALL_PREFIX="$prefix" "${launcher[@]}" "${qt_args[@]}" &&
      echo "$recipe" >"$build/.quillmark-recipe" || return 1
  fi
  cmake --build "$build" -j "${QM_WINQT_JOBS:-2}" && rm -rf "$prefix" && cmake --install "$build"
}
build_qt >"$log" 2>&1 || { echo "Windows Qt: build failed; the end of $log:" >&2; tail -30 "$log" >&2; exit 1; }
echo "$recipe" >"$prefix/.quillmark-recipe"
echo "Windows Qt: installed, $(du -sh "$prefix" | cut -f1)"
imageformats

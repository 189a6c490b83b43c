#!/usr/bin/env bash
# Installs the Debian/Ubuntu packages Quillmark needs to build and test, when
# they are missing. Runs apt-get through sudo when not run as root.
set -euo pipefail

# fonts-noto-core: the desktop fonts with which a system's "monospace" may turn
# out proportional; the window tests check that columns of text line up all the
# same. clang and its runtime build the fuzz targets; acl gives the tests setfacl.
packages=(g++ cmake ninja-build pkg-config qt6-base-dev qt6-base-dev-tools qt6-qpa-plugins
          qt6-image-formats-plugins libgtest-dev libgmock-dev libbenchmark-dev python3 ccache
          fonts-noto-core clang libclang-rt-dev acl)

missing=()
for p in "${packages[@]}"; do
  dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q "install ok installed" || missing+=("$p")
done
[ ${#missing[@]} -eq 0 ] && exit 0

sudo=""
[ "$(id -u)" -ne 0 ] && sudo="sudo"
echo "Installing: ${missing[*]}"
export DEBIAN_FRONTEND=noninteractive
$sudo apt-get update -qq
$sudo apt-get install -y -qq --no-install-recommends "${missing[@]}"

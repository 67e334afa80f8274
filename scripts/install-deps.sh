#!/usr/bin/env bash
# Installs the Debian packages Pandex builds and tests with, skipping those already present.
set -euo pipefail
packages=(cmake ninja-build g++ clang libclang-rt-14-dev googletest libgtest-dev libgmock-dev libbenchmark-dev librsvg2-bin
          libsqlite3-dev libxml2-dev libcli11-dev nlohmann-json3-dev python3 python3-ezdxf)
# Other install scripts name their own packages, and extra apt options in APT_INSTALL_OPTIONS.
if (($#)); then packages=("$@"); fi
missing=()
for package in "${packages[@]}"; do
  dpkg-query -W -f='${Status}' "$package" 2>/dev/null | grep -q "install ok installed" || missing+=("$package")
done
if ((${#missing[@]})); then
  echo "Installing: ${missing[*]}"
  SUDO=""
  [ "$(id -u)" -eq 0 ] || SUDO="sudo"
  $SUDO apt-get update -qq
  DEBIAN_FRONTEND=noninteractive $SUDO apt-get install -y -qq ${APT_INSTALL_OPTIONS:-} "${missing[@]}"
fi

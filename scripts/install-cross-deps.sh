#!/usr/bin/env bash
# Installs what the 32-bit builds need, skipping what is present: the MinGW-w64 cross compiler
# and wine for the Windows plug-in, the multilib compiler, GoogleTest's sources and Debian's i386
# SQLite and libxml2 for the 32-bit Linux suites.
set -euo pipefail
SUDO=""
[ "$(id -u)" -eq 0 ] || SUDO="sudo"
# wine32 and the 32-bit libraries are packages of Debian's i386 architecture.
dpkg --print-foreign-architectures | grep -qx i386 || $SUDO dpkg --add-architecture i386
# Without wine's recommended desktop extras (fonts, sound, graphics): the journey is a console program.
APT_INSTALL_OPTIONS=--no-install-recommends exec "$(dirname "$0")/install-deps.sh" \
  g++-mingw-w64-i686 g++-multilib googletest libsqlite3-dev:i386 libxml2-dev:i386 wine wine32:i386

#!/bin/sh
# Installs what the 32-bit Windows build and its tests need on Debian 12: the mingw-w64
# cross compiler, wine with its 32-bit part, and the source-package entry from which
# Xerces-C is fetched. Idempotent.
set -eu
SUDO=""
[ "$(id -u)" -eq 0 ] || SUDO=sudo
export DEBIAN_FRONTEND=noninteractive
update=""
if ! dpkg --print-foreign-architectures | grep -qx i386; then
  $SUDO dpkg --add-architecture i386
  update=yes
fi
sources=/etc/apt/sources.list.d/kxvfix-deb-src.sources
if [ ! -f "$sources" ]; then
  . /etc/os-release
  printf '%s\n' "Types: deb-src" "URIs: http://deb.debian.org/debian" \
    "Suites: $VERSION_CODENAME" "Components: main" \
    "Signed-By: /usr/share/keyrings/debian-archive-keyring.gpg" | $SUDO tee "$sources" >/dev/null
  update=yes
fi
PACKAGES="g++-mingw-w64-i686-posix binutils-mingw-w64-i686 wine wine32:i386 dpkg-dev cmake python3 googletest"
missing=""
for p in $PACKAGES; do
  dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q "install ok installed" || missing="$missing $p"
done
if [ -n "$update$missing" ]; then
  $SUDO apt-get update -q
fi
if [ -n "$missing" ]; then
  $SUDO apt-get install -y -q --no-install-recommends $missing
fi

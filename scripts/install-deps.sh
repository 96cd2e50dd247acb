#!/bin/sh
# Installs everything the build and the tests need on Debian 12. Idempotent.
set -eu
PACKAGES="build-essential cmake pkg-config python3 time libgtest-dev libgmock-dev libxerces-c-dev libmimalloc-dev clang libclang-rt-14-dev"
missing=""
for p in $PACKAGES; do
  dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q "install ok installed" || missing="$missing $p"
done
[ -z "$missing" ] && exit 0
SUDO=""
[ "$(id -u)" -eq 0 ] || SUDO=sudo
export DEBIAN_FRONTEND=noninteractive
$SUDO apt-get update -q
$SUDO apt-get install -y -q --no-install-recommends $missing

#!/bin/sh
# Peak resident memory of kxvalidate on clean generated files of two sizes; it must not
# grow with the file. Usage: bench/memory.sh [SMALL_MIB] [LARGE_MIB]  (defaults 100, 1024)
set -eu
cd "$(dirname "$0")/.."
small=${1:-100}
large=${2:-1024}
work=${TMPDIR:-/tmp}/kxvfix-bench
mkdir -p "$work"
./scripts/install-deps.sh
command -v /usr/bin/time >/dev/null || { SUDO=""; [ "$(id -u)" -eq 0 ] || SUDO=sudo; $SUDO apt-get install -y -q time >/dev/null; }
cmake -S . -B build-bench -DCMAKE_BUILD_TYPE=Release >/dev/null
cmake --build build-bench -j "$(nproc)" --target kxvalidate >/dev/null
for mib in $small $large; do
  corpus=$work/corpus-${mib}MiB.fix
  [ -f "$corpus" ] || python3 bench/gen_corpus.py --size $((mib * 1048576)) -o "$corpus"
  /usr/bin/time -v build-bench/bin/kxvalidate -q "$corpus" 2>"$work/time" >/dev/null || true
  rss=$(awk -F: '/Maximum resident/ { gsub(/ /, "", $2); print $2 }' "$work/time")
  echo "$mib MiB: peak resident memory $rss KiB"
done

#!/bin/sh
# Throughput of kxvalidate beside a peer validator and the read limit, on one generated
# corpus. Usage: bench/run.sh [SIZE_MIB] [RUNS]   (defaults 200 and 5)
# Figures go to standard output and to bench/results.md.
set -eu
cd "$(dirname "$0")/.."
size_mib=${1:-200}
runs=${2:-5}
build=build-bench
work=${TMPDIR:-/tmp}/kxvfix-bench
mkdir -p "$work"

./scripts/install-deps.sh
# The peer comes from Debian too; installing it is part of the benchmark, not the build.
if ! dpkg-query -W -f='${Status}' libquickfix-dev 2>/dev/null | grep -q "install ok installed"; then
  SUDO=""; [ "$(id -u)" -eq 0 ] || SUDO=sudo
  $SUDO env DEBIAN_FRONTEND=noninteractive apt-get install -y -q --no-install-recommends \
    libquickfix-dev time >/dev/null || echo "peer library not installed: peer column skipped"
fi
cmake -S . -B "$build" -DCMAKE_BUILD_TYPE=Release -DKXVFIX_BENCH=ON >/dev/null
cmake --build "$build" -j "$(nproc)" >/dev/null

corpus=$work/corpus-${size_mib}MiB.fix
[ -f "$corpus" ] || python3 bench/gen_corpus.py --size $((size_mib * 1048576)) -o "$corpus"
bytes=$(stat -c %s "$corpus")
"$build/bin/readlimit" "$corpus" >/dev/null  # warms the page cache
messages=$(python3 -c 'import sys; print(open(sys.argv[1], "rb").read().count(b"\x0110="))' "$corpus")

# The machine is shared and its speed drifts, so each round times every program once, one
# after another, and each program's figure is its median over the rounds.
timed() {  # label, command...: appends "label seconds KiB" to the round log
  label=$1; shift
  /usr/bin/time -f "$label %e %M" -a -o "$work/rounds" "$@" >/dev/null 2>&1 || true
}
: >"$work/rounds"
peer=""
[ -x "$build/bin/peer_validate" ] && peer="$build/bin/peer_validate"
for i in $(seq "$runs"); do
  timed read "$build/bin/readlimit" "$corpus"
  timed kx "$build/bin/kxvalidate" -q "$corpus"
  [ -n "$peer" ] && timed peer "$peer" tools/dictionaries/FIX44.xml "$corpus"
done
median() {  # label, column: the median of that column over the label's rounds
  awk -v l="$1" -v c="$2" '$1 == l { print $c }' "$work/rounds" | sort -n |
    awk '{ v[NR] = $1 } END { if (NR) print v[int((NR + 1) / 2)] }'
}
read_s=$(median read 2)
kx_s=$(median kx 2)
kx_rss=$(median kx 3)
peer_s=$(median peer 2)
schema_ms=$("$build/bin/schema_load_bench" schemas/FIX44.xml | awk '/median/ { print $(NF-1) }')

report() {
  awk -v b="$bytes" -v m="$messages" -v r="$read_s" -v k="$kx_s" -v p="$peer_s" \
      -v rss="$kx_rss" -v sl="$schema_ms" -v runs="$runs" 'BEGIN {
    mb = b / 1e6
    printf "| program | seconds | MB/s | messages/s |\n|---|---|---|---|\n"
    printf "| read limit | %.3f | %.0f | %.0f |\n", r, mb / r, m / r
    printf "| kxvalidate | %.3f | %.0f | %.0f |\n", k, mb / k, m / k
    if (p != "") printf "| peer | %.3f | %.0f | %.0f |\n", p, mb / p, m / p
    printf "\nkxvalidate / read limit: %.2f\n", r / k
    if (p != "") printf "kxvalidate / peer: %.1fx\n", p / k
    printf "kxvalidate peak resident memory: %d KiB\n", rss
    printf "FIX 4.4 schema load (median): %s ms\n", sl
    printf "corpus: %.0f MB, %d messages; median of %d runs\n", mb, m, runs
  }'
}

{
  echo "## $(date -u +%Y-%m-%d) on $(uname -m), $(nproc) cores, $(awk '/MemTotal/ { printf "%.0f GiB", $2 / 1048576 }' /proc/meminfo)"
  echo
  report
  echo
} | tee -a bench/results.md

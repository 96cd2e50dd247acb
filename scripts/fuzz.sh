#!/bin/sh
# Builds the libFuzzer targets with clang in build-fuzz and runs each for SECONDS (default
# 60) on a scratch copy of its seed corpus. Fails when any target crashes, leaks or times out.
# Leaks the XML library makes itself are suppressed by fuzz/lsan.supp, each with its reason.
set -eu
cd "$(dirname "$0")/.."
./scripts/install-deps.sh
seconds=${1:-60}
dir=build-fuzz
targets="fuzz_walk fuzz_schema fuzz_validate"
cmake -S . -B "$dir" -DCMAKE_BUILD_TYPE=RelWithDebInfo -DCMAKE_CXX_COMPILER=clang++ \
  -DCMAKE_CXX_FLAGS=-fsanitize=fuzzer-no-link -DKXVFIX_SANITIZE=ON -DKXVFIX_MIMALLOC=OFF \
  -DKXVFIX_FUZZ=ON >/dev/null
cmake --build "$dir" -j "$(nproc 2>/dev/null || echo 2)" --target $targets
status=0
for t in $targets; do
  run=$dir/fuzz-run/$t
  rm -rf "$run" && mkdir -p "$run/corpus" "$run/artifacts"
  cp fuzz/corpus/$t/* "$run/corpus/"
  echo "== $t ($seconds s)"
  if ASAN_OPTIONS=detect_leaks=1 LSAN_OPTIONS=suppressions=$PWD/fuzz/lsan.supp "$dir/bin/$t" -max_total_time="$seconds" -timeout=10 \
      -rss_limit_mb=2048 -print_final_stats=1 -artifact_prefix="$run/artifacts/" \
      "$run/corpus" >"$run/log" 2>&1; then
    result=ok
  else
    result=FAILED
    status=1
  fi
  grep -E '^#[0-9]+.*(INITED|DONE)' "$run/log" | tail -n 2
  grep -E '^stat::(number_of_executed_units|average_exec_per_sec|peak_rss_mb)' "$run/log"
  echo "$t: $result (log: $run/log)"
  ls "$run/artifacts" | sed "s|^|  artifact: $run/artifacts/|"
done
exit $status

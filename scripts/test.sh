#!/bin/sh
# Installs what is missing, then builds and runs the whole suite twice: a release build,
# and one under AddressSanitizer and UndefinedBehaviorSanitizer. Last, the test of
# validators running side by side runs under ThreadSanitizer.
set -eu
cd "$(dirname "$0")/.."
./scripts/install-deps.sh
jobs=$(nproc 2>/dev/null || echo 2)
for config in release sanitize; do
  dir=build-$config
  case $config in
    release) flags="-DCMAKE_BUILD_TYPE=Release" ;;
    sanitize) flags="-DCMAKE_BUILD_TYPE=RelWithDebInfo -DKXVFIX_SANITIZE=ON" ;;
  esac
  echo "== $config"
  cmake -S . -B "$dir" $flags >/dev/null
  cmake --build "$dir" -j "$jobs"
  ctest --test-dir "$dir" -j "$jobs" --output-on-failure
done
echo "== thread"
cmake -S . -B build-tsan -DCMAKE_BUILD_TYPE=RelWithDebInfo -DKXVFIX_TSAN=ON >/dev/null
cmake --build build-tsan -j "$jobs" --target plugin_tests
TSAN_OPTIONS=halt_on_error=1 ctest --test-dir build-tsan -R '^Threads\.' --output-on-failure

#!/bin/sh
# Installs what is missing, builds, and validates the example files against the bundled
# FIX 4.4 schema: the clean ones must pass, the faulty one must draw its findings.
set -eu
cd "$(dirname "$0")/.."
./scripts/install-deps.sh
cmake -S . -B build -DCMAKE_BUILD_TYPE=Release >/dev/null
cmake --build build -j "$(nproc 2>/dev/null || echo 2)" --target kxvalidate
build/bin/kxvalidate examples/orders.fix examples/executions.fix
status=0
build/bin/kxvalidate examples/faults.fix || status=$?
[ "$status" -eq 1 ]

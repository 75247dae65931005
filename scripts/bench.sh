#!/usr/bin/env bash
# Installs what is missing, builds the benchmarks in Release mode and runs them.
set -euo pipefail
root="$(cd "$(dirname "$0")/.." && pwd)"
"$root/scripts/install-deps.sh"
BUILD_DIR="${BUILD_DIR:-$root/build-bench}" "$root/scripts/build.sh" -DCMAKE_BUILD_TYPE=Release \
  -DQCEDITOR_BUILD_TESTS=OFF -DQCEDITOR_BUILD_BENCHMARKS=ON
cmake --build "${BUILD_DIR:-$root/build-bench}" --target bench

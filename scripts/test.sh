#!/usr/bin/env bash
# Installs what is missing, builds, and runs the whole test suite offscreen.
set -euo pipefail
root="$(cd "$(dirname "$0")/.." && pwd)"
build="${BUILD_DIR:-$root/build}"
"$root/scripts/install-deps.sh"
"$root/scripts/build.sh" -DQCEDITOR_BUILD_TESTS=ON
cd "$build"
QT_QPA_PLATFORM=offscreen ctest --output-on-failure -j2

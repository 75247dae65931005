#!/usr/bin/env bash
# Installs what is missing, builds, and runs the whole test suite offscreen.
set -euo pipefail
root="$(cd "$(dirname "$0")/.." && pwd)"
# Its own build folder, so that switching between running and testing
# rebuilds nothing.
build="${BUILD_DIR:-$root/build-tests}"
"$root/scripts/install-deps.sh"
BUILD_DIR="$build" "$root/scripts/build.sh" -DQCEDITOR_BUILD_TESTS=ON
cd "$build"
QT_QPA_PLATFORM=offscreen ctest --output-on-failure -j2

#!/usr/bin/env bash
# Configures and builds into build/ (or $BUILD_DIR). Extra arguments go to CMake.
# A new build folder gets Ninja; an existing one keeps the generator it was
# configured with, so a folder made by a plain `cmake -B build` works too.
set -euo pipefail
root="$(cd "$(dirname "$0")/.." && pwd)"
build="${BUILD_DIR:-$root/build}"
generator=()
if [ ! -f "$build/CMakeCache.txt" ] && [ -z "${CMAKE_GENERATOR:-}" ]; then
  generator=(-G Ninja)
fi
cmake -S "$root" -B "$build" "${generator[@]}" -DCMAKE_BUILD_TYPE=RelWithDebInfo "$@"
cmake --build "$build" -j2
# A form (.ui) edited since the last build has its header regenerated during
# the build, after the sources that include it may already have been
# compiled; the second pass compiles those again and is a no-op otherwise.
cmake --build "$build" -j2

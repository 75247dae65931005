#!/usr/bin/env bash
# Installs what is missing, builds, and starts the host shell on the default
# store (in the user's data folder). Arguments go to the shell, e.g. --store FILE.
set -euo pipefail
root="$(cd "$(dirname "$0")/.." && pwd)"
"$root/scripts/install-deps.sh"
"$root/scripts/build.sh" -DQCEDITOR_BUILD_TESTS=OFF
exec "${BUILD_DIR:-$root/build}/bin/qchost" "$@"

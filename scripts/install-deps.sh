#!/usr/bin/env bash
# Installs the Debian packages that building, running and testing need.
# Skips apt-get when every package is already there.
set -euo pipefail

packages=(
  build-essential cmake ninja-build ccache pkg-config
  qtbase5-dev qtbase5-dev-tools libqt5sql5-sqlite libqt5sql5-psql postgresql
  libsqlite3-dev liblcms2-dev libbenchmark-dev
  xvfb xauth imagemagick
)

missing=()
for package in "${packages[@]}"; do
  dpkg -s "$package" >/dev/null 2>&1 || missing+=("$package")
done
[ ${#missing[@]} -eq 0 ] && exit 0

sudo=""
[ "$(id -u)" -ne 0 ] && sudo="sudo"
$sudo apt-get update -qq
DEBIAN_FRONTEND=noninteractive $sudo apt-get install -y -qq --no-install-recommends "${missing[@]}"

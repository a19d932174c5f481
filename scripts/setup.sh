#!/usr/bin/env bash
# Installs what the build and the tests need on Debian 12 (does nothing for
# packages that are already there). --build-only installs just what building
# the program needs. Installing takes root: run as root, or have sudo.
set -euo pipefail
packages=(cmake ninja-build g++ pkg-config qt6-base-dev qt6-base-dev-tools)
if [ "${1:-}" != --build-only ]; then
  packages+=(libgtest-dev libgmock-dev libbenchmark-dev xvfb xauth iverilog verilator ghdl)
fi
missing=()
for p in "${packages[@]}"; do
  dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q "install ok installed" || missing+=("$p")
done
if [ ${#missing[@]} -gt 0 ]; then
  as_root=()
  if [ "$(id -u)" -ne 0 ]; then
    if ! command -v sudo >/dev/null; then
      echo "setup: missing packages: ${missing[*]} (run as root, or install sudo, to install them)" >&2
      exit 1
    fi
    as_root=(sudo)
  fi
  echo "setup: installing ${missing[*]}"
  "${as_root[@]}" env DEBIAN_FRONTEND=noninteractive apt-get update -qq
  "${as_root[@]}" env DEBIAN_FRONTEND=noninteractive \
    apt-get install -y -qq --no-install-recommends "${missing[@]}"
fi

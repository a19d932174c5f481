#!/usr/bin/env bash
# Installs what the fuzz programs need on top of scripts/setup.sh (Debian 12,
# as root): clang, its libFuzzer and sanitizer runtimes, and llvm-symbolizer
# for readable stack traces.
set -euo pipefail
cd "$(dirname "$0")/.."
bash scripts/setup.sh
packages=(clang libclang-rt-14-dev llvm)
missing=()
for p in "${packages[@]}"; do
  dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q "install ok installed" || missing+=("$p")
done
if [ ${#missing[@]} -gt 0 ]; then
  if [ "$(id -u)" -ne 0 ]; then
    echo "setup-fuzz: missing packages: ${missing[*]} (run as root to install them)" >&2
    exit 1
  fi
  echo "setup-fuzz: installing ${missing[*]}"
  export DEBIAN_FRONTEND=noninteractive
  apt-get update -qq
  apt-get install -y -qq --no-install-recommends "${missing[@]}"
fi

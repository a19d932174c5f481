#!/usr/bin/env bash
# Sets up the machine, builds, and configures the transceiver of the embedded
# default target (gt10) in batch mode: the finished design data and the run
# report go to out/.
set -euo pipefail
cd "$(dirname "$0")/.."
bash scripts/setup.sh
bash scripts/build.sh -DVELOMUX_BUILD_TESTS=OFF
mkdir -p out
build/bin/velomux-wizard --batch -o out/gt10-design.json --report out/gt10-report.json "$@"
echo "Finished design data: out/gt10-design.json; run report: out/gt10-report.json"

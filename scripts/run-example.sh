#!/usr/bin/env bash
# The main command: sets up the machine, builds the program and configures the
# transceiver of the embedded default target (gt10, a 4-byte "10G Custom"
# transceiver) in a batch run, bonded with three more. Prints the summary and
# writes the finished design data and the run report to out/. Arguments are
# passed on to velomux-wizard (e.g. --set QVZ_CHAN_BOND_NUMBER=0).
set -euo pipefail
cd "$(dirname "$0")/.."
bash scripts/setup.sh --build-only
mkdir -p out
echo "Building into build/ (log: out/build.log) ..."
if ! bash scripts/build.sh -DVELOMUX_BUILD_TESTS=OFF >out/build.log 2>&1; then
  cat out/build.log >&2
  exit 1
fi
design=out/gt10-design.json
report=out/gt10-report.json
args=(--batch --set QVZ_CHAN_BOND_NUMBER=4 -o "$design" --report "$report" "$@")
echo "+ build/bin/velomux-wizard ${args[*]}"
build/bin/velomux-wizard "${args[@]}"
echo "Run report:    $report"

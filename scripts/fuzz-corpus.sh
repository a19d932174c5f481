#!/usr/bin/env bash
# Builds the seed corpora of both fuzz programs into DIR (default
# build-fuzz/seeds): design-data files from the sample targets and the test
# fixtures for fuzz_load_run, short edit scripts for fuzz_mutate_targets.
set -euo pipefail
cd "$(dirname "$0")/.."
out=${1:-build-fuzz/seeds}
rm -rf "$out"
mkdir -p "$out/fuzz_load_run" "$out/fuzz_mutate_targets"

# Fixtures live in nested folders and share file names: flatten the path.
while IFS= read -r -d '' f; do
  cp "$f" "$out/fuzz_load_run/$(echo "${f#./}" | tr '/' '_')"
done < <(find ./data/targets ./tests/data ./docs -name '*.json' -type f -print0 2>/dev/null | sort -z)

# Edit scripts: short byte strings from which the program draws the sample
# target and its edits.
for t in 0 1 2; do
  printf "\\x0$t" > "$out/fuzz_mutate_targets/plain-$t"
  printf "\\x0$t\\x0a\\x14\\x03" > "$out/fuzz_mutate_targets/bond-$t"
  printf "\\x0$t\\x08\\x40\\x01\\x00" > "$out/fuzz_mutate_targets/width-$t"
  printf "\\x0$t\\x00\\x01\\x00\\x04\\x02\\x01\\x05\\x03" > "$out/fuzz_mutate_targets/legal-$t"
done
echo "fuzz-corpus: $(ls "$out/fuzz_load_run" | wc -l) design files, $(ls "$out/fuzz_mutate_targets" | wc -l) edit scripts in $out"

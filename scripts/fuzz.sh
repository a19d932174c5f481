#!/usr/bin/env bash
# Builds both fuzz programs with clang (libFuzzer, AddressSanitizer and
# UndefinedBehaviorSanitizer) into build-fuzz/ and runs each for SECONDS
# (default 60). The working corpora grow in build-fuzz/corpus/; the committed
# ones in fuzz/corpus/ and the seeds are read as well. A finding stops that
# program and leaves the input in build-fuzz/artifacts/; the script then
# exits 1.
#   FUZZ_TARGETS="fuzz_load_run"  run only these programs
#   FUZZ_MERGE=1                  afterwards, minimise everything the runs
#                                 found into fuzz/corpus/ (to commit)
set -euo pipefail
cd "$(dirname "$0")/.."
seconds=${1:-60}
case "$seconds" in
  ''|*[!0-9]*) echo "usage: scripts/fuzz.sh [SECONDS]" >&2; exit 2 ;;
esac
targets=${FUZZ_TARGETS:-fuzz_load_run fuzz_mutate_targets}
build=build-fuzz

# Fail early and plainly when the toolchain cannot build a libFuzzer program.
cxx=${FUZZ_CXX:-clang++}
cc=${FUZZ_CC:-clang}
if ! command -v "$cxx" >/dev/null 2>&1; then
  echo "fuzz: $cxx not found; install clang and libFuzzer first (bash scripts/setup-fuzz.sh)" >&2
  exit 1
fi
probe=$(mktemp -d)
trap 'rm -rf "$probe"' EXIT
printf 'extern "C" int LLVMFuzzerTestOneInput(const unsigned char*, unsigned long) { return 0; }\n' \
  > "$probe/probe.cpp"
if ! "$cxx" -fsanitize=fuzzer,address,undefined "$probe/probe.cpp" -o "$probe/probe" 2> "$probe/log"; then
  cat "$probe/log" >&2
  echo "fuzz: $cxx cannot link libFuzzer programs; install its runtime (bash scripts/setup-fuzz.sh)" >&2
  exit 1
fi

CC=$cc CXX=$cxx cmake -S . -B "$build" -G Ninja -DCMAKE_BUILD_TYPE=RelWithDebInfo \
  -DVELOMUX_BUILD_FUZZ=ON -DVELOMUX_BUILD_TESTS=OFF -DVELOMUX_BUILD_BENCH=OFF >/dev/null
# shellcheck disable=SC2086
cmake --build "$build" --target $targets
bash scripts/fuzz-corpus.sh "$build/seeds" >/dev/null

export ASAN_OPTIONS=${ASAN_OPTIONS:-detect_leaks=1:abort_on_error=1:allocator_may_return_null=1}
export LSAN_OPTIONS=${LSAN_OPTIONS:-suppressions=$PWD/scripts/lsan.supp:print_suppressions=0}
export UBSAN_OPTIONS=${UBSAN_OPTIONS:-print_stacktrace=1:halt_on_error=1}
export QT_QPA_PLATFORM=offscreen

status=0
for t in $targets; do
  mkdir -p "$build/corpus/$t" "$build/artifacts" "fuzz/corpus/$t"
  dict=()
  [ "$t" = fuzz_load_run ] && dict=(-dict=fuzz/design-data.dict)
  echo "fuzz: running $t for ${seconds}s"
  if ! "$build/bin/$t" "${dict[@]}" -max_total_time="$seconds" -timeout=30 -rss_limit_mb=2048 \
      -max_len=65536 -print_final_stats=1 -artifact_prefix="$build/artifacts/$t-" \
      "$build/corpus/$t" "fuzz/corpus/$t" "$build/seeds/$t" 2> "$build/$t.log"; then
    tail -n 60 "$build/$t.log" >&2
    echo "fuzz: $t found a fault; the input is in $build/artifacts/" >&2
    status=1
    continue
  fi
  grep -E '^stat::(number_of_executed_units|peak_rss_mb|new_units_added)' "$build/$t.log" |
    sed "s/^/fuzz: $t: /"
  grep -E '^#[0-9]+ +DONE' "$build/$t.log" | sed "s/^/fuzz: $t: /" || true
  if [ "${FUZZ_MERGE:-0}" = 1 ]; then
    merged=$(mktemp -d)
    "$build/bin/$t" -merge=1 "$merged" "fuzz/corpus/$t" "$build/corpus/$t" "$build/seeds/$t" \
      2> "$build/$t.merge.log"
    rm -rf "fuzz/corpus/$t"
    mv "$merged" "fuzz/corpus/$t"
    chmod 755 "fuzz/corpus/$t"
    echo "fuzz: $t: $(ls "fuzz/corpus/$t" | wc -l) inputs in fuzz/corpus/$t"
  fi
done
exit $status

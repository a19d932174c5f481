#!/usr/bin/env bash
# Sets up the machine, builds, and runs every test. SANITIZE=1 builds into
# build-asan with AddressSanitizer and UndefinedBehaviorSanitizer instead.
set -euo pipefail
cd "$(dirname "$0")/.."
bash scripts/setup.sh
if [ "${SANITIZE:-0}" = 1 ]; then
  export BUILD_DIR=build-asan BUILD_TYPE=Debug
  export ASAN_OPTIONS=${ASAN_OPTIONS:-detect_leaks=1:abort_on_error=0}
  export LSAN_OPTIONS=${LSAN_OPTIONS:-suppressions=$PWD/scripts/lsan.supp:print_suppressions=0}
  export UBSAN_OPTIONS=${UBSAN_OPTIONS:-print_stacktrace=1:halt_on_error=1}
  bash scripts/build.sh -DVELOMUX_BUILD_TESTS=ON -DVELOMUX_SANITIZE=ON
else
  # ON again: the main command may have built this tree without the tests.
  bash scripts/build.sh -DVELOMUX_BUILD_TESTS=ON
fi
export QT_QPA_PLATFORM=offscreen
ctest --test-dir "${BUILD_DIR:-build}" --output-on-failure --timeout 600

#!/usr/bin/env bash
# Compares, side by side in one run, a batch run of velomux-wizard with its
# I/O floor (--check: load, validate and write the same data) on the same
# inputs: wall time (best of RUNS), CPU time (mean of RUNS) and peak memory,
# and their ratios.
#   scripts/bench-floor.sh [DESIGN.json...]   default: the sample targets
#   RUNS=N (default 15)  BIN=path/to/velomux-wizard (default: Release build in
#   build-bench/, built when missing)
set -euo pipefail
cd "$(dirname "$0")/.."
runs=${RUNS:-15}
if [ -z "${BIN:-}" ]; then
  BIN=build-bench/bin/velomux-wizard
  if [ ! -x "$BIN" ]; then
    cmake --preset bench >/dev/null
    cmake --build build-bench --target velomux-wizard
  fi
fi
if [ ! -x /usr/bin/time ]; then
  echo "bench-floor: /usr/bin/time is missing (Debian package 'time')" >&2
  exit 1
fi
inputs=("$@")
[ ${#inputs[@]} -eq 0 ] && inputs=(data/targets/*.json)
work=$(mktemp -d)
trap 'rm -rf "$work"' EXIT
export QT_QPA_PLATFORM=offscreen

# CPU time (user + system, in ms) of the children in a `times` listing.
child_cpu_ms() {
  tail -n 1 "$1" | awk '{
    t = 0
    for (i = 1; i <= 2; ++i) { split($i, p, "m"); t += p[1] * 60 + p[2] }
    printf "%.3f", t * 1000 }'
}

# Prints "<wall ns> <cpu ms> <peak KiB> <exit status>" of one run. `times`
# runs in this shell itself: it reports the children of the shell it runs in.
measure() {
  local start end status
  times > "$work/t0"
  start=$(date +%s%N)
  set +e
  /usr/bin/time -f "%M" -o "$work/rss" "$BIN" "$@" >/dev/null 2>"$work/err"
  status=$?
  set -e
  end=$(date +%s%N)
  times > "$work/t1"
  echo "$((end - start)) $(awk -v a="$(child_cpu_ms "$work/t0")" -v b="$(child_cpu_ms "$work/t1")" \
    'BEGIN { printf "%.3f", b - a }') $(tail -n 1 "$work/rss") $status"
}

printf "%-24s %-6s %12s %12s %10s %5s\n" input mode "best wall ms" "mean cpu ms" "peak KiB" exit
over=0
for f in "${inputs[@]}"; do
  declare -A best=() cpu=() rss=() code=()
  for ((i = 0; i < runs; ++i)); do
    # Interleaved, so both modes see the same machine load.
    for mode in batch check; do
      rm -f "$work/out.json"
      read -r ns ms kib status < <(measure "--$mode" -o "$work/out.json" "$f")
      if [ -z "${best[$mode]:-}" ] || [ "$ns" -lt "${best[$mode]}" ]; then best[$mode]=$ns; fi
      cpu[$mode]=$(awk -v a="${cpu[$mode]:-0}" -v b="$ms" 'BEGIN { print a + b }')
      if [ -z "${rss[$mode]:-}" ] || [ "$kib" -gt "${rss[$mode]}" ]; then rss[$mode]=$kib; fi
      code[$mode]=$status
    done
  done
  for mode in batch check; do
    printf "%-24s %-6s %12.2f %12.2f %10d %5d\n" "$(basename "$f")" "$mode" \
      "$(awk -v n="${best[$mode]}" 'BEGIN { print n / 1e6 }')" \
      "$(awk -v n="${cpu[$mode]}" -v r="$runs" 'BEGIN { print n / r }')" "${rss[$mode]}" "${code[$mode]}"
  done
  wall_ratio=$(awk -v a="${best[batch]}" -v b="${best[check]}" 'BEGIN { print a / b }')
  cpu_ratio=$(awk -v a="${cpu[batch]}" -v b="${cpu[check]}" 'BEGIN { print (b > 0 ? a / b : 0) }')
  rss_ratio=$(awk -v a="${rss[batch]}" -v b="${rss[check]}" 'BEGIN { print a / b }')
  # CPU time decides: on a shared machine wall time mostly measures the others.
  verdict=ok
  if awk -v t="$cpu_ratio" -v m="$rss_ratio" 'BEGIN { exit !(t > 1.5 || m > 2.0) }'; then
    verdict="over (limits: cpu 1.5, memory 2.0)"
    over=1
  fi
  printf "%-24s ratio  wall %.3f  cpu %.3f  memory %.3f  %s\n" "$(basename "$f")" \
    "$wall_ratio" "$cpu_ratio" "$rss_ratio" "$verdict"
  unset best cpu rss code
done
exit $over

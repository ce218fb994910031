#!/usr/bin/env bash
# fuzz.sh [SECONDS] [READER...]: feeds each reader (all, where none is named) with made-up input for
# as many seconds (60), under the address and undefined-behaviour sanitizers, one after the other.
#
# What was met before stays in build/fuzz/corpus, and is where the next run goes on. Inputs that
# failed are in build/fuzz/found: mend the reader, and keep the input as fuzz/corpus/READER/NAME,
# which ./test replays from then on. Ends with 1 where any was found.
#
#   KORA_FUZZ_LOG=FILE  appends the figures to a file
set -euo pipefail
root="$(cd "$(dirname "${BASH_SOURCE[0]}")/.." && pwd)"
cd "$root"
source scripts/packages.sh

seconds=60
if [[ "${1:-}" =~ ^[0-9]+$ ]]; then
  seconds="$1"
  shift
fi
install_missing "${kora_packages[@]}" "${fuzz_packages[@]}"
build_preset fuzz

bin="$root/build/fuzz/bin"
work="$root/build/fuzz"
[[ $# -gt 0 ]] || set -- $(cd "$bin" && printf '%s\n' fuzz_* | sed 's/^fuzz_//')
rm -rf "$work/seeds"
quietly "$bin/kora_fuzz_seeds" "$work/seeds"
mkdir -p "$work/found"

# Half of the time goes into stacks of allocations otherwise.
export ASAN_OPTIONS="${ASAN_OPTIONS:-malloc_context_size=4}"
readonly most_found=5  # of a reader, in one run: the same fault is met again and again
# Room for some records, and no more: long inputs take long.
longest_input() {
  case "$1" in
    names) echo 600 ;;
    charts | scans | script | settings) echo 4096 ;;
    *) echo 2048 ;;
  esac
}

# Executions of a log of libFuzzer.
executions() { awk '/^stat::number_of_executed_units:/ { n = $2 } END { print n + 0 }' "$1"; }

failed=0
line() { printf '%-12s %12s %8s %6s\n' "$@"; }
line reader executions seconds found
for reader in "$@"; do
  if [[ ! -x "$bin/fuzz_$reader" ]]; then
    echo "There is no reader $reader" >&2
    exit 2
  fi
  # The first is where new inputs go.
  folders=("$work/corpus/$reader")
  mkdir -p "${folders[0]}"
  for more in "$root/fuzz/corpus/$reader" "$work/seeds/$reader"; do
    [[ ! -d "$more" ]] || folders+=("$more")
  done
  options=(-print_funcs=0 -entropic=0 -len_control=10 -timeout=25 -rss_limit_mb=2048 -print_final_stats=1 -verbosity=1
    -max_len="$(longest_input "$reader")" -artifact_prefix="$work/found/$reader-")
  [[ ! -f "$root/fuzz/$reader.dict" ]] || options+=(-dict="$root/fuzz/$reader.dict")
  began="$(date +%s)" done=0 found=0
  while left=$((began + seconds - $(date +%s))) && [[ $left -gt 0 && $found -lt $most_found ]]; do
    status=0
    "$bin/fuzz_$reader" "${options[@]}" -max_total_time="$left" \
      "${folders[@]}" >"$work/$reader.log" 2>&1 || status=$?
    done=$((done + $(executions "$work/$reader.log")))
    [[ $status -ne 0 ]] || break
    found=$((found + 1))
    cp "$work/$reader.log" "$work/found/$reader-$(date +%s)-$found.log"
  done
  figures="$(line "$reader" "$done" "$(($(date +%s) - began))" "$found")"
  echo "$figures"
  [[ -z "${KORA_FUZZ_LOG:-}" ]] || echo "$figures" >>"$KORA_FUZZ_LOG"
  failed=$((failed + found))
done
if [[ $failed -gt 0 ]]; then
  echo "Found: $work/found" >&2
  exit 1
fi

#!/usr/bin/env bash
# Runs tests/kills at each change of each operation, where ./test takes some of them:
#   kill_all.sh [STEP]
# STEP takes every STEP-th change (default 1: all). Ends with the counts.
set -euo pipefail
root="$(cd "$(dirname "${BASH_SOURCE[0]}")/.." && pwd)"
program="${TEST_KILLS:-$root/build/release/bin/test_kills}"
if [[ -d /dev/shm ]]; then export TMPDIR="${TMPDIR:-/dev/shm}"; fi
export QT_QPA_PLATFORM="${QT_QPA_PLATFORM:-offscreen}" KORA_KILLS_STEP="${1:-1}"
exec "$program"

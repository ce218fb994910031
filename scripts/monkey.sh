#!/usr/bin/env bash
# Uses the program with windows at random under the sanitizers:
#   monkey.sh [EVENTS] [SEED]
# 200,000 events from seed 1 where nothing is said. Clicks, types, drags, resizes and closes on
# invented markets in a folder of its own, without a screen; nothing of it is part of ./test, which
# does some hundred events.
set -euo pipefail
root="$(cd "$(dirname "${BASH_SOURCE[0]}")/.." && pwd)"
cd "$root"
source scripts/packages.sh
build_preset asan kora_monkey
exec nice -n 10 build/asan/bin/kora_monkey --events "${1:-200000}" --seed "${2:-1}"

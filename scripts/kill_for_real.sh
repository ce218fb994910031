#!/usr/bin/env bash
# Kills koractl by signal at random times while it works on a demo market on a real disk, runs the
# same command again, and compares what stands there in the end with an undisturbed run:
#   kill_for_real.sh [TIMES] [FOLDER]
# Each operation is killed TIMES times (default 50). Nothing of it is part of ./test.
set -euo pipefail
root="$(cd "$(dirname "${BASH_SOURCE[0]}")/.." && pwd)"
koractl="${KORACTL:-$root/build/release/bin/koractl}"
times="${1:-50}"
work="$(mktemp -d "${2:-$root/build}/kills.XXXXXX")"
trap 'rm -rf "$work"' EXIT
RANDOM="${SEED:-1}"

run() { "$koractl" --home "$work/home" "$@" >/dev/null 2>"$work/err"; }
lay() {
  rm -rf "$work/home"
  cp -r "$work/$1" "$work/home"
}
# All files with their bytes, but for the lock's.
bytes() { (cd "$work/home" && find . -type f ! -name Kora.lock -print0 | sort -z | xargs -0 sha256sum); }
now_ms() { date +%s%3N; }

"$koractl" --home "$work/market" demo --securities 200 --years 2 >/dev/null
for code in $("$koractl" --home "$work/market" names | awk -F'\t' 'NR > 1 { print $3 }'); do
  printf '%s,20261105,1,2,1,2,1000,0\r\n' "$code"
done >"$work/in.csv"
first="$("$koractl" --home "$work/market" names | awk -F'\t' '$4 == 4 { print $3; exit }')"

kills=0 wrong=0
# try NAME COMMAND...: over the scene "scene", which the caller has laid.
try() {
  local name="$1" whole took began at pid status
  shift
  lay scene
  began="$(now_ms)"
  run "$@" || { echo "$name fails undisturbed: $(cat "$work/err")" >&2; exit 1; }
  took=$(($(now_ms) - began))
  whole="$(bytes)"
  local before killed=0 bad=0
  lay scene
  before="$(bytes)"
  for _ in $(seq "$times"); do
    lay scene
    "$koractl" --home "$work/home" "$@" >/dev/null 2>&1 &
    pid=$!
    at=$((RANDOM % (took + 2)))
    sleep "$(printf '%d.%03d' $((at / 1000)) $((at % 1000)))"
    if kill -KILL "$pid" 2>/dev/null; then killed=$((killed + 1)); fi
    wait "$pid" 2>/dev/null || true
    # What was cut short is done or not once the next writer came by; what is not is run again.
    run lines "$first" compact || true
    [[ "$(bytes)" == "$whole" ]] || run "$@" || true
    [[ "$(bytes)" == "$whole" ]] || bad=$((bad + 1))
  done
  printf '%-28s %5d ms %5d killed %5d wrong\n' "$name" "$took" "$killed" "$bad"
  kills=$((kills + killed)) wrong=$((wrong + bad))
}

cp -r "$work/market" "$work/scene"
try "import" import "$work/in.csv"
try "update of a day" update
try "update of all days" update --all
try "a code changed" change-code "$first" NEWC
try "names sorted" edit-names sort class
try "a date removed" remove-date 30/10/26
try "backup" backup
echo "$kills killed, $wrong wrong"
[[ "$wrong" == 0 ]]

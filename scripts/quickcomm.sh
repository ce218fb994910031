#!/bin/sh
# Stands in for the comms program of the market snapshot: answers a request with prices invented
# near the last close of each security. The demo market has a copy of it in its program folder.
set -eu
cd "$(dirname "$0")"
[ -f dlsys/Snap.Snd ] || { echo "there is no request" >dlsys/Comm.Stt; exit 1; }

# The close of the last record of a price file: four bytes, 20 behind the record's start.
last_close() {
  file="data/$1.WDT"
  [ -f "$file" ] || return 1
  records=$(($(wc -c <"$file") / 50))
  [ "$records" -gt 0 ] || return 1
  od -An -j $(((records - 1) * 50 + 20)) -N 4 -t f4 "$file"
}

while IFS=, read -r kind code; do
  code=$(printf %s "$code" | tr -d '\r')
  close=$(last_close "$code") || continue
  echo "$code $close"
done <dlsys/Snap.Snd | awk -v seed="$(date +%s)" '
  BEGIN { srand(seed) }
  {
    close_ = $2
    places = close_ < 2 ? 3 : 2
    last = close_ * (0.98 + 0.04 * rand())
    step = last < 2 ? 0.005 : 0.01
    line = "%s,%." places "f,%." places "f,%." places "f,%." places "f,%d,%d,%." places "f\r\n"
    printf line, $1, last, last - step, last + step, close_, 1000 * int(1 + 900 * rand()), \
      int(1 + 300 * rand()), last - close_
  }' >dlsys/Snap.tmp
mv dlsys/Snap.tmp dlsys/Snap.Lst
echo "OK" >dlsys/Comm.Stt

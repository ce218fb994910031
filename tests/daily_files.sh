#!/bin/sh
# Turns price histories into the daily files of a data service.
#
#   daily_files.sh OUT DAYS HISTORY.csv...
#
# A history has lines CODE,yyyymmdd,open,high,low,close,volume,spare. Of the dates that all of
# them have, the last DAYS each become one file OUT/15SEP98.d with a line a security; the rows
# before go to OUT/CODE.csv, and OUT/all/CODE.csv has both.
set -eu
out=$1
days=$2
shift 2
mkdir -p "$out/all"
awk -F, -v out="$out" -v days="$days" '
  BEGIN { split("JAN FEB MAR APR MAY JUN JUL AUG SEP OCT NOV DEC", month, " ") }
  { sub(/\r$/, "") }
  FNR == 1 { ++files }
  { row[NR] = $0; ++seen[$2] }
  END {
    n = 0
    for (date in seen) if (seen[date] == files) common[++n] = date
    if (n < days) {
      print "only " n " dates in common" > "/dev/stderr"
      exit 1
    }
    # The dates in order: few enough for the plainest of sorts.
    for (i = 2; i <= n; ++i) {
      date = common[i]
      for (j = i - 1; j >= 1 && common[j] > date; --j) common[j + 1] = common[j]
      common[j + 1] = date
    }
    for (i = n - days + 1; i <= n; ++i) daily[common[i]] = 1
    first = common[n - days + 1]
    last = common[n]
    for (i = 1; i <= NR; ++i) {
      split(row[i], field, ",")
      date = field[2]
      if (date > last) continue
      if (date >= first && !(date in daily)) continue
      print row[i] > (out "/all/" field[1] ".csv")
      if (date in daily) {
        name = substr(date, 7, 2) month[substr(date, 5, 2) + 0] substr(date, 3, 2) ".d"
        printf "%s\r\n", row[i] > (out "/" name)
      } else {
        print row[i] > (out "/" field[1] ".csv")
      }
    }
  }' "$@"

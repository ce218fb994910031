#!/usr/bin/env bash
# Draws charts of the dearest share, the cheapest share and an index of an installation:
#   demo_charts.sh KORACTL HOME FOLDER
set -euo pipefail
koractl="$1" home="$2" folder="$3"
mkdir -p "$folder"

# Code and last close of the shares; options and warrants have longer codes.
closes() {
  "$koractl" --home "$home" names | awk -F'\t' '$4 == 4 && length($3) <= 4 { print $3 }' |
    while read -r code; do
      last="$("$koractl" --home "$home" prices "$code" 2>/dev/null |
        awk -F'\t' 'NR > 1 && $6 > 0 { last = $6 } END { print last }')" || continue
      [[ -z "$last" ]] || printf '%s\t%s\n' "$last" "$code"
    done | sort -g
}
shares="$(closes)"
index="$("$koractl" --home "$home" names | awk -F'\t' '$4 == 5 && !found { print $3; found = 1 }')"
count=0
for code in $(awk 'END { print $2 }' <<<"$shares") $(awk 'NR == 1 { print $2 }' <<<"$shares") $index; do
  for style in B:bar C:candle L:line; do
    for period in A:daily W:weekly M:monthly; do
      "$koractl" --home "$home" chart "$code" --style "${style%%:*}" --period "${period%%:*}" \
        --spacing 4 --out "$folder/$code-${style##*:}-${period##*:}.png"
      count=$((count + 1))
    done
  done
done
echo "No display: $count charts are in $folder"

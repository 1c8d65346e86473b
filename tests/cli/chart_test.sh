#!/usr/bin/env bash
# kori chart and kori scale: pictures, pages, the stream and the chart numbers of a sample chart.
set -euo pipefail
kori="$1"
root=$(mktemp -d)
trap 'rm -rf "$root"' EXIT
"$kori" init --sample --root "$root/k" >/dev/null
out=$("$kori" chart krm --root "$root/k" --png "$root/a.png" --pdf "$root/a.pdf" --svg "$root/a.svg" \
      --stream "$root/a.cht" --json 2>/dev/null)
keys=$(grep -o '"[a-z_]*":' <<<"$out" | tr -d '":\n')
[ "$keys" = "first_recordlast_recordlast_barplot_leftplot_rightplot_topplot_bottomchart_basechart_ceilinggrid_stepgrid_countmax_highmin_low" ] \
  || { echo "unexpected keys: $keys"; exit 1; }
head -c 4 "$root/a.png" >"$root/magic"; grep -q PNG "$root/magic"
head -c 4 "$root/a.pdf" >"$root/magic"; grep -q '%PDF' "$root/magic"
grep -q '<svg' "$root/a.svg"
# The stream names the security and plays back through the saved-chart player.
grep -q 'KRM' "$root/a.cht"
"$kori" play "$root/a.cht" --png "$root/b.png" 2>/dev/null
# Weekly charts have fewer bars than daily ones over the same records.
daily=$("$kori" chart KRM --root "$root/k" --json 2>/dev/null | grep -o '"last_bar":[0-9]*' | cut -d: -f2)
weekly=$("$kori" chart KRM --root "$root/k" --period W --json 2>/dev/null | grep -o '"last_bar":[0-9]*' | cut -d: -f2)
[ "$weekly" -lt "$daily" ] || { echo "weekly $weekly not below daily $daily"; exit 1; }
if "$kori" chart NOSUCH --root "$root/k" --json 2>/dev/null; then echo "unknown code accepted"; exit 1; fi
scale=$("$kori" scale --high 12.34 --low 9.8 --json)
grep -q '"grid_count"' <<<"$scale"
echo "chart: ok"

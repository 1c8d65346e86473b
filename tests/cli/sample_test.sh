#!/usr/bin/env bash
# The sample library: names as JSON, bars in the documented form, lists, and clear refusals.
set -euo pipefail
kori="$1"
root=$(mktemp -d)
trap 'rm -rf "$root"' EXIT
"$kori" init --sample --root "$root" >/dev/null
count=$("$kori" names --root "$root" --codes | wc -l)
[ "$count" -ge 40 ] || { echo "only $count securities"; exit 1; }
names=$("$kori" names --root "$root" --json)
grep -q '"code": "XAO"' <<<"$names"
# The bars contract: field names in this order.
out=$("$kori" bars XAO --root "$root" --period W --first 1500 --json)
keys=$(grep -o '"[a-z_]*":' <<<"$out" | sed -n 1,12p | tr -d '":\n')
[ "$keys" = "codeperiodfirst_recordlast_recordlast_barhighest_pricelowest_pricehighest_volumelowest_volumeaverage_volumevolumes_presentbars" ] \
  || { echo "unexpected keys: $keys"; exit 1; }
grep -q '"date":"2026112' <<<"$out" # the last week ends in the week of 20 November
# Lower-case codes are found; unknown codes and bad ranges are refused.
table=$("$kori" bars krm --root "$root" --last 3)
grep -q 'records 1 to 3, 3 bars' <<<"$table"
if "$kori" bars NOSUCH --root "$root" 2>/dev/null; then echo "unknown code accepted"; exit 1; fi
if "$kori" bars KRM --first 0 --root "$root" 2>/dev/null; then echo "record 0 accepted"; exit 1; fi
lists=$("$kori" lists --root "$root")
grep -q '^A  Banks and Finance: HBK' <<<"$lists"
echo "sample: ok"

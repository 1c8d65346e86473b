#!/usr/bin/env bash
# Two kori chart runs at once on one library: each gives exactly what it gives alone.
set -euo pipefail
kori="$1"
root=$(mktemp -d)
trap 'rm -rf "$root"' EXIT
"$kori" init --sample --root "$root/k" >/dev/null
draw() { "$kori" chart "$1" --root "$root/k" --osc RSI --stream "$2.cht" --svg "$2.svg" --json >"$2.json" 2>/dev/null; }
for code in KRM HBK; do draw "$code" "$root/serial-$code"; done
cmp -s "$root/serial-KRM.cht" "$root/serial-HBK.cht" && { echo "the two charts are alike"; exit 1; }
for i in $(seq 1 25); do
  draw KRM "$root/p-KRM" & a=$!
  draw HBK "$root/p-HBK" & b=$!
  wait $a || { echo "run $i: KRM failed"; exit 1; }
  wait $b || { echo "run $i: HBK failed"; exit 1; }
  for code in KRM HBK; do
    for kind in cht svg json; do
      cmp -s "$root/serial-$code.$kind" "$root/p-$code.$kind" ||
        { echo "run $i: $code .$kind differs from the serial run"; exit 1; }
    done
  done
done
# Nothing of the runs is left in the temporary folder.
left=$(find "$root/k/temp" -type f | wc -l)
[ "$left" -eq 0 ] || { echo "$left files left in temp"; exit 1; }
echo "parallel: ok"

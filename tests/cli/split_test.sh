#!/usr/bin/env bash
# kori chart --split: two securities on one area, in one stream that prints and plays back.
set -euo pipefail
kori="$1"
root=$(mktemp -d)
trap 'rm -rf "$root"' EXIT
"$kori" init --sample --root "$root/k" >/dev/null
"$kori" chart alx --root "$root/k" --split krm:w --png "$root/s.png" --pdf "$root/s.pdf" \
    --stream "$root/s.cht" 2>/dev/null
# The two titles at 4 x PlotLeft: the upper at 10 + 2, the lower at 700 x 51% + 2.
grep -q '^T, 9.75, 20, 12,ALX,' "$root/s.cht" || { echo "no upper title"; exit 1; }
grep -q '^T, 9.75, 20, 359,KRM,' "$root/s.cht" || { echo "no lower title"; exit 1; }
grep -q 'WEEKLY - ' "$root/s.cht" || { echo "the lower half is not weekly"; exit 1; }
head -c 4 "$root/s.pdf" >"$root/magic"; grep -q '%PDF' "$root/magic"
"$kori" play "$root/s.cht" --png "$root/p.png" 2>/dev/null
# Refusals: an unknown code, a bad period, point and figure, an oscillator panel.
for bad in "--split NOSUCH" "--split KRM:X" "--split KRM --style P" "--split KRM --osc RSI"; do
    # shellcheck disable=SC2086
    if "$kori" chart ALX --root "$root/k" $bad --json >/dev/null 2>&1; then
        echo "accepted: $bad"; exit 1
    fi
done
echo "split: ok"

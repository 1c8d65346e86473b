#!/usr/bin/env bash
# kori adjlist --apply killed outright leaves every history whole and either before or after
# each item; the same list run again to the end gives exactly the files of a run never stopped.
set -euo pipefail
kori="$1"
# shellcheck source=kill_checks.sh
source "$(dirname "$0")/kill_checks.sh"
root=$(mktemp -d)
trap 'rm -rf "$root"' EXIT
# Two copies of the same sample: one run undisturbed, one killed again and again.
"$kori" init --sample --root "$root/ref" >/dev/null
"$kori" init --sample --root "$root/k" >/dev/null
"$kori" names --codes --root "$root/ref" >"$root/codes"
# A dividend a month over two years on every security: some thousand history rewrites.
awk '{ for (y = 2024; y <= 2025; y++) for (m = 1; m <= 12; m++)
         printf "DI,%s,X,0,Y,%d%02d10,,,1\r\n", $1, y, m }' "$root/codes" >"$root/list"
cp "$root/list" "$root/ref/data/Adjust.Lst"
cp "$root/list" "$root/k/data/Adjust.Lst"
"$kori" adjlist --apply --root "$root/ref" >/dev/null

kill_after_each "$root/k/data" "0.3 0.8 1.5" "$kori" adjlist --apply --root "$root/k"
((killed > 0)) || { echo "the run ended before any kill; nothing was proved"; exit 1; }
"$kori" adjlist --apply --root "$root/k" >/dev/null
check_whole "$root/k/data"
for f in "$root/ref/data/"*.WDT "$root/ref/data/Names.dat" "$root/ref/data/Adjust.Lst"; do
  cmp -s "$f" "$root/k/data/$(basename "$f")" || { echo "$(basename "$f") differs"; exit 1; }
done
echo "adjlist kill: ok ($killed kills)"

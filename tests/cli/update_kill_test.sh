#!/usr/bin/env bash
# A long kori update killed outright leaves every file whole: each price file a whole number of
# 50-byte records with a last record that reads as a date, Names.dat whole 96-byte records.
set -euo pipefail
kori="$1"
# shellcheck source=kill_checks.sh
source "$(dirname "$0")/kill_checks.sh"
root=$(mktemp -d)
trap 'rm -rf "$root"' EXIT
"$kori" init --sample --root "$root/k" >/dev/null
data="$root/k/data"
dl="$root/k/download/Out"
rm -f "$dl"/*.D
# Thousands of new securities and every sample security on one day: a run of some seconds.
awk 'BEGIN { for (i = 0; i < 3000; i++) printf "N%05d,20261123,1.5,1.6,1.4,1.55,1000,0\r\n", i }' \
  >"$dl/23NOV26.D"
"$kori" names --codes --root "$root/k" | awk '{ printf "%s,20261123,2,2.2,1.8,2.1,500,250\r\n", $1 }' \
  >>"$dl/23NOV26.D"

kill_after_each "$data" "0.2 0.5 1.0" "$kori" update --yes --root "$root/k"
((killed > 0)) || { echo "the update ended before any kill; nothing was proved"; exit 1; }
# After the kills a run to the end still works from the file that stayed waiting.
if [[ -f "$dl/23NOV26.D" ]]; then
  "$kori" update --yes --root "$root/k" >/dev/null 2>&1 || true
  check_whole "$data"
fi
echo "update kill: ok ($killed kills)"

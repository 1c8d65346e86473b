#!/usr/bin/env bash
# Refusals at the limits of the file formats: record numbers past 16 bits, files past 32,767
# records, and codes that would name a file outside the data folder.
set -euo pipefail
kori="$1"
root=$(mktemp -d)
trap 'rm -rf "$root"' EXIT
"$kori" init --sample --root "$root/k" >/dev/null
data="$root/k/data"
expect_refusal() { # expected-text command...
  local want="$1"; shift
  if out=$("$@" 2>&1); then echo "not refused: $*: $out"; exit 1; fi
  grep -qF -- "$want" <<<"$out" || { echo "$*: wanted \"$want\", got: $out"; exit 1; }
}
# A record number is never cut to 16 bits.
expect_refusal "Records 1 to 65537 are not in KRM.WDT" "$kori" bars KRM --last 65537 --root "$root/k"
expect_refusal "Records 1 to 65537 are not in KRM.WDT" "$kori" indicator RSI KRM --csv --last 65537 --root "$root/k"
# A price file past the limit gives the limit, in bars and indicator alike.
cp "$data/KRM.WDT" "$root/KRM.keep"
head -c $((50 * 32768)) /dev/zero >"$data/KRM.WDT"
limit="KRM.WDT holds 32768 records; a file can hold at most 32767."
expect_refusal "$limit" "$kori" bars KRM --root "$root/k"
expect_refusal "$limit" "$kori" indicator RSI KRM --csv --root "$root/k"
cp "$root/KRM.keep" "$data/KRM.WDT"
# A list past the limit is named by kori lists, not dropped in silence.
head -c $((8 * 32768)) /dev/zero >"$data/SubListC.Dat"
expect_refusal "SubListC.Dat holds 32768 records" "$kori" lists --root "$root/k"
rm "$data/SubListC.Dat"
# A name file past the limit gives the limit, not "No File For That Name".
cp "$data/Names.dat" "$root/Names.keep"
head -c $((96 * 32768)) /dev/zero >>"$data/Names.dat"
for cmd in "bars KRM" "chart KRM --png $root/x.png" "indicator RSI KRM --csv"; do
  # shellcheck disable=SC2086
  expect_refusal "Names.dat holds" "$kori" $cmd --root "$root/k"
done
cp "$root/Names.keep" "$data/Names.dat"
# A code that would reach outside the data folder never becomes a path.
expect_refusal "Invalid Code: ../KRM" "$kori" bars ../KRM --root "$root/k"
echo "store limits: ok"

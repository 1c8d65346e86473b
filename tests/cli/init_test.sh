#!/usr/bin/env bash
# kori init makes a root with Kori.ini and the folders; a missing library is a clear error.
set -euo pipefail
kori="$1"
root=$(mktemp -d)
trap 'rm -rf "$root"' EXIT
"$kori" init --root "$root/k" >/dev/null
grep -q '^ChtData=.*/data/' "$root/k/Kori.ini"
for d in data chtmisc chtsave chtbak download/Out; do test -d "$root/k/$d"; done
# Global options may follow the subcommand, and a root without Kori.ini is refused.
if "$kori" init --root "$root/k" >/dev/null; then :; else echo "second init failed"; exit 1; fi
if out=$("$kori" --root "$root/none" names 2>&1); then
  # names may not exist yet in this build; only a clear refusal is acceptable either way
  echo "expected a refusal, got: $out"; exit 1
fi
# The sample is made only where there is no library: an existing one is refused, untouched.
"$kori" init --sample --root "$root/lib" >/dev/null
cp "$root/lib/data/Names.dat" "$root/names.before"
echo keep >"$root/lib/data/mine.txt"
if out=$("$kori" init --sample --root "$root/lib" 2>&1); then
  echo "a second init --sample was not refused: $out"; exit 1
fi
grep -q "already exists" <<<"$out" || { echo "unclear refusal: $out"; exit 1; }
grep -q -- "--root" <<<"$out" || { echo "the refusal does not say how to start anew: $out"; exit 1; }
cmp -s "$root/names.before" "$root/lib/data/Names.dat" || { echo "Names.dat was replaced"; exit 1; }
test -f "$root/lib/data/mine.txt"
# The new root was built beside and moved in whole: nothing of the build is left, and its
# paths name the root itself.
if ls -a "$root" | grep -q kori-init; then echo "a staging folder was left"; exit 1; fi
if grep -q kori-init "$root/lib/Kori.ini"; then echo "Kori.ini names the staging folder"; exit 1; fi
grep -q "^ChtData=$root/lib/data/" "$root/lib/Kori.ini"
echo "init: ok"

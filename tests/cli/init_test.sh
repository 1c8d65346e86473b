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
echo "init: ok"

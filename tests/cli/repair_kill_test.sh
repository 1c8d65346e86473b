#!/usr/bin/env bash
# kori repair dedupe killed mid-run: every price file is still a whole number of records and
# holds either its old or its new content; a second run then finishes the work.
set -euo pipefail
kori="$1"
root=$(mktemp -d)
trap 'rm -rf "$root"' EXIT
"$kori" init --sample --root "$root/k" >/dev/null
data="$root/k/data"
count=200 # every rewrite is synced to disk, so the folder is kept to a test's time
# Each security's file is the sample's KRM twice over: every date twice, so each is rewritten.
head -c $((400 * 50)) "$data/KRM.WDT" >"$root/new.bin"
cat "$root/new.bin" "$root/new.bin" >"$root/old.bin"
krm_record=$(( $("$kori" names --codes --root "$root/k" | grep -nx KRM | cut -d: -f1) - 1 ))
dd if="$data/Names.dat" of="$root/rest.bin" bs=1 skip=$((krm_record * 96 + 8)) count=88 2>/dev/null
rm -f "$data"/*.WDT "$data"/*.wdt "$data/Names.dat"
for i in $(seq 1 "$count"); do
  printf '\0\0%-6s' "D$i" >>"$data/Names.dat"
  cat "$root/rest.bin" >>"$data/Names.dat"
  cp "$root/old.bin" "$data/D$i.WDT"
done
"$kori" repair dedupe --root "$root/k" >/dev/null 2>&1 &
pid=$!
# Kill as soon as the first file has been rewritten.
for _ in $(seq 1 2000); do
  cmp -s "$data/D1.WDT" "$root/new.bin" && break
  sleep 0.005
done
if ! kill -KILL "$pid" 2>/dev/null; then echo "dedupe ended before it could be killed"; exit 1; fi
wait "$pid" 2>/dev/null || true
old=0 new=0
for i in $(seq 1 "$count"); do
  f="$data/D$i.WDT"
  size=$(stat -c %s "$f")
  if (( size % 50 != 0 )); then echo "$f: $size bytes is not a whole number of records"; exit 1; fi
  if cmp -s "$f" "$root/old.bin"; then old=$((old + 1));
  elif cmp -s "$f" "$root/new.bin"; then new=$((new + 1));
  else echo "$f: neither the old nor the new content"; exit 1; fi
done
if (( new == 0 || old == 0 )); then echo "killed outside the run: $old old, $new new"; exit 1; fi
# The run again, to its end.
"$kori" repair dedupe --root "$root/k" >/dev/null 2>&1
for i in $(seq 1 "$count"); do
  cmp -s "$data/D$i.WDT" "$root/new.bin" || { echo "D$i.WDT not finished by the second run"; exit 1; }
done
echo "repair kill: ok ($old old, $new new at the kill)"

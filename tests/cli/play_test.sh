#!/usr/bin/env bash
# kori play draws a saved chart to PNG, SVG and PDF, and refuses a broken one with the format
# message, a non-zero exit and no output.
set -euo pipefail
kori="$1"
dir=$(mktemp -d)
trap 'rm -rf "$dir"' EXIT
printf 'S,12,20,2,TITLE,65535\r\nB,10,30,190,130,16776960\r\nH,50,40,50,120,65280\r\nX,60,40,70,50,255\r\n' >"$dir/a.cht"
"$kori" play "$dir/a.cht" --png "$dir/a.png" --size 200x150
"$kori" play "$dir/a.cht" --svg "$dir/a.svg" --size 200x150
"$kori" play "$dir/a.cht" --pdf "$dir/a.pdf" --size 200x150
head -c 4 "$dir/a.png" | grep -q PNG
grep -q '<svg .*width="200" height="150"' "$dir/a.svg"
grep -q 'TITLE</text>' "$dir/a.svg"
if grep -q '#ff0000' "$dir/a.svg"; then echo "X drawn on the screen"; exit 1; fi
head -c 4 "$dir/a.pdf" | grep -q '%PDF'

printf 'T,8.25,1,1,Hello, world,255\r\n' >"$dir/bad.cht"
for kind in png svg pdf; do
  if out=$("$kori" play "$dir/bad.cht" --$kind "$dir/bad.$kind" 2>&1); then
    echo "a broken chart played to $kind"; exit 1
  fi
  grep -q 'There is problem displaying this chart - format invalid.' <<<"$out"
  test ! -e "$dir/bad.$kind"
done
echo "play: ok"

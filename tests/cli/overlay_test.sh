#!/usr/bin/env bash
# kori chart with overlays, swing lines and point and figure: what each option adds to the stream.
set -euo pipefail
kori="$1"
root=$(mktemp -d)
trap 'rm -rf "$root"' EXIT
"$kori" init --sample --root "$root/k" >/dev/null
stream() { "$kori" chart KRM --root "$root/k" --stream "$root/s.cht" "$@" 2>/dev/null; cat "$root/s.cht"; }
count() { grep -c "$1" || true; }
plain=$(stream | count '^L,')
avg=$(stream --ma1 10 --ma2 30 | count '^L,')
heavy=$(stream --ma1 10 --ma2 30 | count '^H,')
[ "$avg" -gt "$((plain + 300))" ] || { echo "averages: $plain -> $avg L lines"; exit 1; }
[ "$heavy" -gt "$(stream | count '^H,')" ] || { echo "average 2 is not heavy"; exit 1; }
# The parabolic suppresses the averages and leaves its dots and last stop.
para=$(stream --ma1 10 --para)
[ "$(count '^L,' <<<"$para")" -eq "$plain" ] || { echo "averages drawn under PARA"; exit 1; }
grep -q '^K,' <<<"$para"
grep -q 'Parabolic last stop : ' <<<"$para"
[ "$(stream --bands bollinger | count '^L,')" -gt "$((plain + 300))" ]
[ "$(stream --mma | count '^L,')" -gt "$((plain + 3000))" ]
stream --swing NORM | grep -q 'Daily Swing  -  Standard'
stream --swing XDay:5 | grep -q 'Daily Swing 5 - DAY'
if "$kori" chart KRM --root "$root/k" --swing XDay:31 2>"$root/err"; then echo "XDay 31 accepted"; exit 1; fi
grep -q 'Incorrect values entered' "$root/err"
pf=$(stream --style P --reversal 3 --box-value 0.05)
grep -q 'Box Value = 0.05' <<<"$pf"
grep -q '^X,' <<<"$pf"
# A target of the security draws one more line across the plot.
echo "KRM,1.5,U" >"$root/k/Targets.txt"
[ "$(stream | count '^L,')" -eq "$((plain + 1))" ] || { echo "no target line"; exit 1; }
echo "overlay: ok"

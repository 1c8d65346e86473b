#!/usr/bin/env bash
# kori indicator and kori chart --osc on the sample library: the columns of every oscillator,
# one row a bar, RSI checked against its rules worked out here from the closes, --set, and
# the panel under the price chart in the picture and the stream.
set -euo pipefail
kori="$1"
root=$(mktemp -d)
trap 'rm -rf "$root"' EXIT
"$kori" init --sample --root "$root/k" >/dev/null
k=(--root "$root/k")

declare -A cols=([RSI]=rsi [STO]=k,d,slowd [FX]=k,d [MOM]=mom [ROC]=roc
                 [MACD]=ema1,ema2,macd,signal [COP]=coppock [ERY]=bull,bear [ATR]=tr,atr
                 [VTY]=figure,mean [OBV]=obv [DM]=pdi,mdi,dx,adx [WMS]=r [JHG]=col0,col1,col2
                 [RMO]=value [RMX]=value)
for name in "${!cols[@]}"; do
  out=$("$kori" indicator "$name" KRM "${k[@]}" --first 11 --last 260 --csv)
  head=$(head -1 <<<"$out")
  [ "$head" = "index,date,${cols[$name]}" ] || { echo "$name header: $head"; exit 1; }
  rows=$(($(wc -l <<<"$out") - 1))
  [ "$rows" -eq 250 ] || { echo "$name: $rows rows for 250 bars"; exit 1; }
  # Late bars have a value in the first column of every oscillator.
  last=$(tail -1 <<<"$out" | cut -d, -f3)
  [ -n "$last" ] || { echo "$name: no value on the last bar"; exit 1; }
done

# RSI with period 3: the window ends one bar before the bar in hand, holds two differences and
# is divided by 3; a window without a fall keeps the figure before it.
"$kori" bars KRM "${k[@]}" --last 120 | tail -n +3 | awk '{print $5}' >"$root/closes"
"$kori" indicator RSI KRM "${k[@]}" --last 120 --set RsiP=3 --csv | tail -n +2 |
  cut -d, -f3 >"$root/rsi"
awk -v P=3 'NR==FNR { c[n++] = $1; next }
  { i = FNR - 1; want = ""
    if (i >= P) {
      up = 0; dn = 0; nu = 0; nd = 0
      for (j = P; j >= 2; j--) { a = c[i - j]; b = c[i - j + 1]
        if (a == 0) continue
        if (a < b) { nu++; up += b - a } else if (a > b) { nd++; dn += a - b } }
      au = nu ? up / P : 0; ad = nd ? dn / P : 0
      if (ad != 0) { last = 100 - 100 / (1 + au / ad); have = 1 }
      if (have) want = last
    }
    if ((want == "") != ($1 == "")) {
      print "bar " i ": want [" want "] got [" $1 "]"; bad = 1
    } else if (want != "" && (want - $1 > 0.01 || $1 - want > 0.01)) {
      print "bar " i ": " want " vs " $1; bad = 1
    }
  }
  END { exit bad }' "$root/closes" "$root/rsi"

# --set changes one key for the run: RSI 9 has its first figure no earlier than bar 9.
first=$("$kori" indicator RSI KRM "${k[@]}" --set RsiP=9 --csv |
  awk -F, 'NR > 1 && $3 != "" && !seen { print $1; seen = 1 }')
[ "$first" -ge 9 ] || { echo "RSI 9 starts at $first"; exit 1; }
if "$kori" indicator RSI KRM "${k[@]}" --set NoSuchKey=1 --csv 2>/dev/null; then
  echo "bad key accepted"; exit 1
fi
if "$kori" indicator PARA KRM "${k[@]}" --csv 2>/dev/null; then echo "PARA accepted"; exit 1; fi
if "$kori" indicator RMO KRM "${k[@]}" --period W --csv 2>/dev/null; then
  echo "weekly RMO exported"; exit 1
fi

# The panel under the price chart: in the stream after the price chart, and in the picture.
"$kori" chart KRM "${k[@]}" --osc RSI --png "$root/rsi.png" --pdf "$root/rsi.pdf" \
  --stream "$root/rsi.cht" 2>/dev/null
grep -q 'Relative Strength Index Oscillator ( 14 Period)' "$root/rsi.cht"
grep -q '%PDF' <(head -c 4 "$root/rsi.pdf")
"$kori" chart KRM "${k[@]}" --png "$root/plain.png" 2>/dev/null
cmp -s "$root/rsi.png" "$root/plain.png" && { echo "no panel in the picture"; exit 1; }
"$kori" chart ADVDEC "${k[@]}" --osc OBV --stream "$root/obv.cht" 2>/dev/null
grep -q 'No Volume Data' "$root/obv.cht"
msg=$("$kori" chart KRM "${k[@]}" --osc RMO --period W --stream "$root/w.cht" 2>&1 >/dev/null)
grep -q 'RMO only available on Daily Charts' <<<"$msg"
if grep -q 'RMO Oscillator' "$root/w.cht"; then echo "weekly RMO drawn"; exit 1; fi
echo "indicator: ok"

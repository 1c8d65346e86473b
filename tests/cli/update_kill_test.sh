#!/usr/bin/env bash
# A long kori update killed outright leaves every file whole: each price file a whole number of
# 50-byte records with a last record that reads as a date, Names.dat whole 96-byte records.
set -euo pipefail
kori="$1"
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

# One pass over the folder (perl is part of every base system), not a process a file.
check_whole() {
  perl -e '
    my ($dir) = @ARGV; my $bad = 0;
    my $n = -s "$dir/Names.dat";
    if ($n % 96) { print "Names.dat is $n bytes\n"; $bad = 1 }
    for my $f (glob "$dir/*.WDT") {
      my $size = -s $f;
      if ($size % 50) { print "$f is $size bytes\n"; $bad = 1; next }
      next unless $size;
      open my $h, "<:raw", $f or die; seek $h, $size - 50, 0; read $h, my $rec, 50;
      if ($rec !~ /^[0-9]{8}/) { print "$f: last record broken\n"; $bad = 1 }
    }
    exit $bad;' "$data"
}

killed=0
for delay in 0.2 0.5 1.0; do
  "$kori" update --yes --root "$root/k" >/dev/null 2>&1 &
  pid=$!
  sleep "$delay"
  if kill -9 "$pid" 2>/dev/null; then killed=$((killed + 1)); fi
  wait "$pid" 2>/dev/null || true
  check_whole
done
((killed > 0)) || { echo "the update ended before any kill; nothing was proved"; exit 1; }
# After the kills a run to the end still works from the file that stayed waiting.
if [[ -f "$dl/23NOV26.D" ]]; then
  "$kori" update --yes --root "$root/k" >/dev/null 2>&1 || true
  check_whole
fi
echo "update kill: ok ($killed kills)"

# Sourced by the kill tests, not run on its own.

# check_whole DIR: every price file of DIR a whole number of 50-byte records whose last record
# reads as a date, and Names.dat whole 96-byte records. One pass over the folder (perl is part
# of every base system), not a process a file.
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
    exit $bad;' "$1"
}

# kill_after_each DIR "DELAYS" COMMAND...: runs COMMAND once for each delay, kills it outright
# after that long and checks DIR whole; `killed` counts the runs that were still going.
killed=0
kill_after_each() {
  local dir="$1" delays="$2"
  shift 2
  for delay in $delays; do
    "$@" >/dev/null 2>&1 &
    local pid=$!
    sleep "$delay"
    if kill -9 "$pid" 2>/dev/null; then killed=$((killed + 1)); fi
    wait "$pid" 2>/dev/null || true
    check_whole "$dir"
  done
}

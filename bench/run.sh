#!/usr/bin/env bash
# `make bench`: converts the same large generated tracks with molvar-convert and with gpsbabel and
# prints wall time, input throughput and peak memory (medians of RUNS runs), with `wc -l` as the
# floor. BENCH_POINTS (default 1000000) sets the track size, RUNS (default 3) the repetitions.
set -euo pipefail
top=$(cd "$(dirname "$0")/.." && pwd)
build=${1:-build}
convert="$top/$build/molvar-convert"
points=${BENCH_POINTS:-1000000}
runs=${RUNS:-3}
data=${BENCH_DIR:-$top/bench/data}
# Outputs go to memory (tmpfs) when there is one, so the figures measure the programs rather than
# a shared disk's write-back; BENCH_OUT chooses another place.
out=${BENCH_OUT:-/dev/shm/molvar-bench}
mkdir -p "$out" 2>/dev/null || out=$data
mkdir -p "$data/folder"

for fmt in gpx nmea plt; do
  file="$data/track-$points.$fmt"
  [[ -s "$file" ]] || python3 "$top/bench/make-track.py" "$fmt" "$points" "$file"
done

# The first read of a file with bare LF line ends rewrites it with CR LF; do that before timing.
for fmt in gpx nmea plt; do
  type=$fmt; [[ $fmt == plt ]] && type=ozi
  "$convert" --folder "$data/folder" --type "$type" --set chkDetailed=0 "$data/track-$points.$fmt" "$out/warm.kml" >/dev/null
done

# One measurement: "seconds peak-kB" of a command, its output discarded.
measure() {
  /usr/bin/time -f "%e %M" -o "$data/time.txt" "$@" >/dev/null 2>&1 || true
  cat "$data/time.txt"
}

# Median over the runs of "seconds peak-kB".
median() {
  local results=()
  for ((i = 0; i < runs; i++)); do results+=("$(measure "$@")"); done
  printf '%s\n' "${results[@]}" | sort -n | awk '{a[NR]=$0} END {print a[int((NR+1)/2)]}'
}

row() {  # label input-file seconds kB
  local mb
  mb=$(stat -c %s "$2" | awk '{printf "%.1f", $1 / 1e6}')
  awk -v l="$1" -v mb="$mb" -v s="$3" -v kb="$4" \
    'BEGIN {printf "%-34s %8.3f s %9.1f MB/s %8.1f MB peak\n", l, s, (s > 0 ? mb / s : 0), kb / 1024}'
}

compare() {  # label input output-extension molvar-options... -- gpsbabel-args...
  local label=$1 in=$2 ext=$3
  shift 3
  local ours=() theirs=()
  while [[ $1 != -- ]]; do ours+=("$1"); shift; done
  shift
  theirs=("$@")
  read -r s1 k1 < <(median "$convert" --folder "$data/folder" "${ours[@]}" "$in" "$out/out.$ext")
  read -r s2 k2 < <(median gpsbabel "${theirs[@]}")
  row "molvar  $label" "$in" "$s1" "$k1"
  awk -v s="$s1" -v b="$(stat -c %s "$out/out.$ext")" \
    'BEGIN {printf "%-34s %8.1f MB written, %.1f MB/s\n", "  output", b / 1e6, (s > 0 ? b / 1e6 / s : 0)}'
  row "gpsbabel $label" "$in" "$s2" "$k2"
  awk -v a="$s1" -v b="$s2" 'BEGIN {printf "%-34s %8.1fx\n", "  ratio (gpsbabel / molvar)", (a > 0 ? b / a : 0)}'
}

gpx="$data/track-$points.gpx"
nmea="$data/track-$points.nmea"
plt="$data/track-$points.plt"
echo "Tracks of $points points; medians of $runs runs."
read -r s k < <(median wc -l "$gpx")
row "wc -l (floor)" "$gpx" "$s" "$k"
compare "GPX -> KML, details off" "$gpx" kml --set chkDetailed=0 -- -i gpx -f "$gpx" -o kml -F "$out/babel.kml"
compare "GPX -> KML, details on" "$gpx" kml -- -i gpx -f "$gpx" -o kml -F "$out/babel.kml"
compare "GPX -> PLT" "$gpx" plt -- -i gpx -f "$gpx" -o ozi -F "$out/babel.plt"
compare "NMEA -> KML" "$nmea" kml --type nmea --set chkDetailed=0 -- -i nmea -f "$nmea" -o kml -F "$out/babel.kml"
compare "PLT -> KML" "$plt" kml --set chkDetailed=0 -- -i ozi -f "$plt" -o kml -F "$out/babel.kml"
compare "NMEA -> GPX" "$nmea" gpx --type nmea -- -i nmea -f "$nmea" -o gpx -F "$out/babel.gpx"
compare "PLT -> GPX" "$plt" gpx -- -i ozi -f "$plt" -o gpx -F "$out/babel.gpx"
# gpsbabel's own GPX -> GPX (which we refuse) for scale.
read -r s k < <(median gpsbabel -i gpx -f "$gpx" -o gpx -F "$out/babel.gpx")
row "gpsbabel GPX -> GPX (scale)" "$gpx" "$s" "$k"

# Peak memory per stored point above an empty run's baseline.
read -r _ base < <(median "$convert" --folder "$data/folder" "$top/resources/Samples/sample.gpx" "$out/empty.kml")
read -r _ full < <(median "$convert" --folder "$data/folder" --set chkDetailed=0 "$gpx" "$out/out.kml")
awk -v b="$base" -v f="$full" -v n="$points" \
  'BEGIN {printf "%-34s %8.1f bytes per point (%.1f MB baseline)\n", "memory above baseline", (f - b) * 1024 / n, b / 1024}'
echo
"$top/$build/molvar-bench-live" "$out/live"
rm -rf "$out"/out.* "$out"/babel.* "$out"/warm.kml "$out"/empty.kml "$out"/live

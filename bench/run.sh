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
mkdir -p "$data/folder"

for fmt in gpx nmea plt; do
  file="$data/track-$points.$fmt"
  [[ -s "$file" ]] || python3 "$top/bench/make-track.py" "$fmt" "$points" "$file"
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
  read -r s1 k1 < <(median "$convert" --folder "$data/folder" "${ours[@]}" "$in" "$data/out.$ext")
  read -r s2 k2 < <(median gpsbabel "${theirs[@]}")
  row "molvar  $label" "$in" "$s1" "$k1"
  row "gpsbabel $label" "$in" "$s2" "$k2"
  awk -v a="$s1" -v b="$s2" 'BEGIN {printf "%-34s %8.1fx\n", "  ratio (gpsbabel / molvar)", (a > 0 ? b / a : 0)}'
}

gpx="$data/track-$points.gpx"
nmea="$data/track-$points.nmea"
plt="$data/track-$points.plt"
echo "Tracks of $points points; medians of $runs runs."
read -r s k < <(median wc -l "$gpx")
row "wc -l (floor)" "$gpx" "$s" "$k"
compare "GPX -> KML, details off" "$gpx" kml --set chkDetailed=0 -- -i gpx -f "$gpx" -o kml -F "$data/babel.kml"
compare "GPX -> KML, details on" "$gpx" kml -- -i gpx -f "$gpx" -o kml -F "$data/babel.kml"
compare "GPX -> PLT" "$gpx" plt -- -i gpx -f "$gpx" -o ozi -F "$data/babel.plt"
compare "NMEA -> KML" "$nmea" kml --type nmea --set chkDetailed=0 -- -i nmea -f "$nmea" -o kml -F "$data/babel.kml"
compare "PLT -> KML" "$plt" kml --set chkDetailed=0 -- -i ozi -f "$plt" -o kml -F "$data/babel.kml"

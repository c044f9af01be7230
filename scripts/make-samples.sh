#!/usr/bin/env bash
# Regenerates the gpsbabel-made sample files from our own points (resources/Samples/source-points.csv).
set -euo pipefail
cd "$(dirname "$0")/../resources/Samples"
src=source-points.csv
gpsbabel -t -i unicsv -f "$src" -o gpx -F sample.gpx
gpsbabel -i unicsv -f "$src" -o gpx -F sample-waypoints.gpx
gpsbabel -t -i unicsv -f "$src" -o nmea -F sample-nmea.txt
gpsbabel -t -i unicsv -f "$src" -o ozi -F sample.plt
gpsbabel -i unicsv -f "$src" -o ozi -F sample.wpt
gpsbabel -t -i unicsv -f "$src" -o kml -F sample.kml
# gpsbabel stamps GPX files with the time of the run; samples stay the same from run to run.
sed -i '/^  <time>/d' sample.gpx sample-waypoints.gpx

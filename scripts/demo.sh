#!/usr/bin/env bash
# Builds the svy tool (release) and gives the surveyed points of the sample road their station, offset,
# design height and cut or fill.
set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")/.."
source scripts/deps.sh
svy_ensure_packages "${SVY_BUILD_PACKAGES[@]}"

cmake --preset release -DSVYMATH_TESTS=OFF -DSVYMATH_BENCH=OFF >/dev/null
cmake --build --preset release -j2 --target svy

echo
echo "svy align station --landxml examples/road/sample_road.xml examples/road/surveyed_points.csv"
build/release/tools/svy/svy align station --landxml examples/road/sample_road.xml examples/road/surveyed_points.csv

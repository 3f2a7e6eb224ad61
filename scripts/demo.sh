#!/usr/bin/env bash
# Builds the svy tool (release) and computes the legs of the sample traverse: azimuth and distance of each.
set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")/.."
source scripts/deps.sh
svy_ensure_packages "${SVY_BUILD_PACKAGES[@]}"

cmake --preset release -DSVYMATH_TESTS=OFF -DSVYMATH_BENCH=OFF >/dev/null
cmake --build --preset release -j2 --target svy

echo
echo "svy cogo inverse examples/traverse_legs.csv"
build/release/tools/svy/svy cogo inverse examples/traverse_legs.csv

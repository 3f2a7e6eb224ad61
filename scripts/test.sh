#!/usr/bin/env bash
# Builds and runs the whole test suite twice: a normal debug build, then an AddressSanitizer +
# UndefinedBehaviorSanitizer build. Fails when either build or any test fails.
set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")/.."
source scripts/deps.sh
svy_ensure_packages "${SVY_TEST_PACKAGES[@]}"

jobs="${SVY_JOBS:-2}"
for preset in dev asan; do
  echo "=== ${preset}: configure, build, test"
  cmake --preset "${preset}"
  cmake --build --preset "${preset}" -j"${jobs}"
  ctest --preset "${preset}" -j"${jobs}"
done
echo "=== all tests passed in both builds"

#!/usr/bin/env bash
# Builds and runs the whole test suite twice: a normal debug build, then an AddressSanitizer +
# UndefinedBehaviorSanitizer build; then the concurrency tests alone under ThreadSanitizer (only the test
# executables that hold them are built). Fails when any build or any test fails.
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
# Concurrency tests are named *Concurrency.*; their executables are listed here.
echo "=== tsan: configure, build and run the concurrency tests"
cmake --preset tsan
cmake --build --preset tsan -j"${jobs}" --target test_alignments
ctest --preset tsan -j"${jobs}" -R 'Concurrency\.'
echo "=== all tests passed in all builds"

#!/usr/bin/env bash
# Builds and runs the whole test suite twice: a normal debug build, then an AddressSanitizer +
# UndefinedBehaviorSanitizer build; then the concurrency tests alone under ThreadSanitizer (only the test
# executables that hold them are built); then every fuzz target briefly on its corpus. Fails when a build,
# a test or a fuzz target fails, and when a test skips for any reason but absent reference data.
set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")/.."
source scripts/deps.sh
svy_ensure_packages "${SVY_TEST_PACKAGES[@]}" "${SVY_FUZZ_PACKAGES[@]}"
svy_ensure_decimal_comma_locale

jobs="${SVY_JOBS:-2}"
# Seconds per fuzz target: enough to replay the corpus and mutate it a little, so a regression shows at once.
fuzz_seconds="${SVY_FUZZ_SECONDS:-20}"

# Prints the tests a ctest run skipped, with the reason each gave, from its JUnit file. Returns non-zero when
# one skipped for another reason than absent reference data (or for that reason while the data is there).
svy_report_skips() {
  local junit="$1"
  local allowed="reference data absent"
  [ -d ../shared/refdata ] && allowed="(none while ../shared/refdata is present)"
  echo "--- skipped tests (allowed: ${allowed}):"
  awk -v allowed="${allowed}" '
    /<testcase / {
      match($0, /name="[^"]*"/); name = substr($0, RSTART + 6, RLENGTH - 7)
      skipped = ($0 ~ /status="notrun"/)
    }
    skipped && /: Skipped$/ {
      getline reason; count++; print "  " name ": " reason
      if (reason != allowed) bad++
      skipped = 0
    }
    END { if (count == 0) print "  none"; exit bad > 0 }' "${junit}"
}

for preset in dev asan; do
  echo "=== ${preset}: configure, build, test"
  cmake --preset "${preset}"
  cmake --build --preset "${preset}" -j"${jobs}"
  ctest --preset "${preset}" -j"${jobs}" --output-junit "${PWD}/build/${preset}/ctest-junit.xml"
  svy_report_skips "build/${preset}/ctest-junit.xml"
done

# Concurrency tests are named *Concurrency.*; their executables are listed here.
echo "=== tsan: configure, build and run the concurrency tests"
cmake --preset tsan
cmake --build --preset tsan -j"${jobs}" --target test_alignments
ctest --preset tsan -j"${jobs}" -R 'Concurrency\.'

echo "=== fuzz: build, then ${fuzz_seconds} s per target on its corpus"
cmake --preset fuzz
cmake --build --preset fuzz -j"${jobs}"
bash fuzz/run.sh "${fuzz_seconds}"
echo "=== all tests passed in all builds; no fuzz target found anything"

#!/usr/bin/env bash
# Runs every fuzz target of the fuzz build (build/fuzz) on its seed corpus, one after the other.
#   bash fuzz/run.sh SECONDS [RUNS]
# Each target runs for SECONDS, or until RUNS executions when given. New inputs found go into a scratch
# corpus under build/fuzz/corpus/, never into the seeds kept in the repository; a finding is written to
# build/fuzz/findings/ and fails the script. The last line per target gives its executions.
set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")/.."
seconds="${1:?usage: fuzz/run.sh SECONDS [RUNS]}"
runs="${2:--1}"
build=build/fuzz
mkdir -p "${build}/findings"
status=0
for seeds in fuzz/corpus/*/; do
  target="$(basename "${seeds}")"
  scratch="${build}/corpus/${target}"
  mkdir -p "${scratch}"
  # A slow input (timeout) is a hang: no verb may take seconds on one short input.
  if ! "${build}/fuzz/${target}" -max_total_time="${seconds}" -runs="${runs}" -timeout=10 -max_len=4096 \
       -print_final_stats=1 -artifact_prefix="${build}/findings/${target}-" "${scratch}" "${seeds}" \
       >"${build}/${target}.log" 2>&1; then
    echo "${target}: FINDING (see ${build}/${target}.log)"
    tail -40 "${build}/${target}.log"
    status=1
  fi
  echo "${target}: $(grep -m1 'stat::number_of_executed_units' "${build}/${target}.log" | awk '{print $2}') executions"
done
exit "${status}"

#!/usr/bin/env bash
# Points per second of `svy align station` end to end (process start, LandXML load, CSV in, CSV out) on the
# sample road: generates N surveyed points (default 1,000,000) within 20 m of the road, then times the tool.
# Usage: bench/align_station_throughput.sh [N] [path/to/svy]   (build the release preset first)
set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")/.."
count=${1:-1000000}
svy=${2:-build/release/tools/svy/svy}
road=examples/road/sample_road.xml
points=$(mktemp --suffix=.csv)
trap 'rm -f "$points"' EXIT
# Points scattered about the setting-out table of the road (every 2 m, offsets -20..20 m).
"$svy" align stakeout --landxml "$road" --from 0 --to 1910 --interval 2 --offsets -20,-10,-3,0,3,10,20 |
  awk -F, -v n="$count" 'NR > 1 { pn[++m] = $3; pe[m] = $4; ph[m] = $5 }
    END { srand(11); for (i = 1; i <= n; ++i) { k = 1 + int(rand() * m);
          printf "P%d,%.3f,%.3f,%.3f\n", i, pn[k] + rand() - 0.5, pe[k] + rand() - 0.5, ph[k] + rand() - 0.5 } }' \
  >"$points"
start=$(date +%s.%N)
"$svy" align station --landxml "$road" "$points" 2>/dev/null | tail -n 1 >/dev/null
end=$(date +%s.%N)
awk -v n="$count" -v s="$start" -v e="$end" 'BEGIN { t = e - s; printf "%d points in %.3f s: %.0f points/s\n", n, t, n / t }'

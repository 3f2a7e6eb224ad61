#!/usr/bin/env python3
"""Writes examples/road/surveyed_points.csv: a few hundred surveyed points id,n,e,h along the sample road.

Reads the road's setting-out table from the built tool on stdin:
    svy align stakeout --landxml examples/road/sample_road.xml --from 0 --to 1910 --interval 20 \\
        --offsets -7.5,-3.5,0,3.5,7.5 | python3 examples/road/make_surveyed_points.py
and moves every point a few centimetres in plan and up to 0.4 m in height (a road bed under construction:
cut and fill to come), plus two points beyond the ends of the alignment. Fixed seed: the file is reproducible.
"""
import csv
import math
import random
import sys

random.seed(11)
rows = list(csv.DictReader(sys.stdin))
points = []
for row in rows:
    n = float(row["n"]) + random.uniform(-0.03, 0.03)
    e = float(row["e"]) + random.uniform(-0.03, 0.03)
    h = float(row["h"]) + random.uniform(-0.4, 0.4)
    points.append((n, e, h))
# Beyond the ends, along the end tangents.
for row, distance in ((rows[0], -15.0), (rows[-1], 12.0)):
    az = math.radians(float(row["azimuth_deg"]))
    n = float(row["n"]) + distance * math.cos(az)
    e = float(row["e"]) + distance * math.sin(az)
    points.append((n, e, float(row["h"]) + 0.1 if distance < 0 else float(row["h"]) - 0.1))
with open(__file__.replace("make_surveyed_points.py", "surveyed_points.csv"), "w", encoding="utf-8") as f:
    f.write("id,n,e,h\n")
    for i, (n, e, h) in enumerate(points, 1):
        f.write(f"P{i:04d},{n:.3f},{e:.3f},{h:.3f}\n")

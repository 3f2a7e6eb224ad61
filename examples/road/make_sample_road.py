#!/usr/bin/env python3
"""Writes the sample rural road examples/road/sample_road.xml (LandXML 1.2, metres, decimal degrees).

About 1.9 km: tangents, a clothoid curve group to the right, a cubic-parabola group to the left, a second
clothoid group, one station equation (a 0.5 m gap in the displayed stations), and a design profile with
parabolic vertical curves and a circular one. Only the first element carries its start point; the others
follow on from their predecessors' ends, as the reader chains them.
"""

START_N, START_E, START_DIR = 5200000.000, 480000.000, 35.0

# (kind, length, radius start, radius end, rotation, spiral law)
ELEMENTS = [
    ("Line", 320.0),
    ("Spiral", 80.0, "INF", 450.0, "cw", "clothoid"),
    ("Curve", 210.0, 450.0, "cw"),
    ("Spiral", 80.0, 450.0, "INF", "cw", "clothoid"),
    ("Line", 260.0),
    ("Spiral", 70.0, "INF", 600.0, "ccw", "cubicParabola"),
    ("Curve", 180.0, 600.0, "ccw"),
    ("Spiral", 70.0, 600.0, "INF", "ccw", "cubicParabola"),
    ("Line", 200.0),
    ("Spiral", 60.0, "INF", 350.0, "cw", "clothoid"),
    ("Curve", 120.0, 350.0, "cw"),
    ("Spiral", 60.0, 350.0, "INF", "cw", "clothoid"),
    ("Line", 200.0),
]

# (station, height, kind, curve attribute)
PROFILE = [
    (0.0, 312.000, "PVI", ""),
    (420.0, 318.300, "ParaCurve", 'length="160"'),
    (900.0, 309.900, "CircCurve", 'radius="6000"'),
    (1400.0, 316.400, "ParaCurve", 'length="200"'),
    (1910.0, 311.000, "PVI", ""),
]


def main():
    out = ['<?xml version="1.0" encoding="UTF-8"?>',
           '<LandXML xmlns="http://www.landxml.org/schema/LandXML-1.2" version="1.2">',
           '  <Units>',
           '    <Metric linearUnit="meter" areaUnit="squareMeter" volumeUnit="cubicMeter" '
           'angularUnit="decimal degrees" directionUnit="decimal degrees"/>',
           '  </Units>',
           '  <Project name="Sample rural road"/>',
           '  <Alignments name="Sample">']
    length = sum(e[1] for e in ELEMENTS)
    out.append(f'    <Alignment name="Main Road" staStart="0.000" length="{length:.3f}">')
    out.append('      <CoordGeom>')
    station = 0.0
    for i, e in enumerate(ELEMENTS):
        start = f'<Start>{START_N:.3f} {START_E:.3f}</Start>' if i == 0 else ''
        if e[0] == "Line":
            direction = f' dir="{START_DIR:.6f}"' if i == 0 else ''
            out.append(f'        <Line staStart="{station:.3f}" length="{e[1]:.3f}"{direction}>{start}</Line>')
        elif e[0] == "Curve":
            out.append(f'        <Curve staStart="{station:.3f}" length="{e[1]:.3f}" radius="{e[2]:.3f}" '
                       f'rot="{e[3]}" crvType="arc"/>')
        else:
            r1 = e[2] if e[2] == "INF" else f'{e[2]:.3f}'
            r2 = e[3] if e[3] == "INF" else f'{e[3]:.3f}'
            out.append(f'        <Spiral staStart="{station:.3f}" length="{e[1]:.3f}" radiusStart="{r1}" '
                       f'radiusEnd="{r2}" rot="{e[4]}" spiType="{e[5]}"/>')
        station += e[1]
    out.append('      </CoordGeom>')
    out.append('      <StaEquation staBack="1200.000" staAhead="1200.500" staInternal="1200.000" desc="gap"/>')
    out.append('      <Profile name="Main Road">')
    out.append('        <ProfAlign name="Design">')
    for sta, h, kind, attr in PROFILE:
        attr = ' ' + attr if attr else ''
        out.append(f'          <{kind}{attr}>{sta:.3f} {h:.3f}</{kind}>')
    out.append('        </ProfAlign>')
    out.append('      </Profile>')
    out.append('    </Alignment>')
    out.append('  </Alignments>')
    out.append('</LandXML>')
    with open(__file__.replace("make_sample_road.py", "sample_road.xml"), "w", encoding="utf-8") as f:
        f.write("\n".join(out) + "\n")


if __name__ == "__main__":
    main()

#pragma once
// Straight lines in implicit form a*x + b*y + c = 0 and the real roots of a quadratic.
//
// x is component 0 and y component 1 of a point (for a position: x = northing, y = easting). The solvers
// store one of two normalised shapes in CLineCoeffs:
// - slope form: b = -1, so y = a*x + c;
// - constant-x form: a = -1, b = 0, so x = c.
// Their only thresholds guard against dividing by an exact or subnormal zero (twice and three times the
// smallest normal double); they are not geometric tolerances. A false result leaves the output as it was.
// Nothing here logs or throws.
#include "svymath/foundation/abstract_point.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/line_coeffs.h"

// The line through p and q. False when the points coincide (exactly, up to subnormal differences).
SVYMATH_API bool FindLineCoeffs(svy_math::TAbstractPoint2<double> p,
                                svy_math::TAbstractPoint2<double> q, CLineCoeffs& line);

// The line through p perpendicular to `line` (given in one of the normalised shapes). Always true.
SVYMATH_API bool FindPerpendicular(CLineCoeffs line, svy_math::TAbstractPoint2<double> p,
                                   CLineCoeffs& perpendicular);

// The crossing point of two lines. False for parallel lines.
SVYMATH_API bool FindLinesIntersection(CLineCoeffs l1, CLineCoeffs l2,
                                       svy_math::TAbstractPoint2<double>& point);

// Real roots of a*x^2 + b*x + c = 0; returns their number (0, 1 or 2). Both roots are first set to 0.
// The tests run in this order:
// 1. discriminant D = b^2 - 4ac below -1e-13: no root;
// 2. |D| < 1e-13: a double root -b/(2a), written to both (this test comes before any test of a, so
//    a = b = 0 gives NaN roots and the count 1);
// 3. |a| >= 1e-13: two roots, x1 = (-b + sqrt D)/(2a), x2 = (-b - sqrt D)/(2a);
// 4. otherwise the linear equation: no root when |b| < 1e-5, else x1 = x2 = -c/b.
SVYMATH_API int SolutionTo2ndDegreePolynomial(double a, double b, double c, double& x1, double& x2);

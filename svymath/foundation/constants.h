#pragma once
// The library's tolerances and unit factors, each named once with its unit and the reason for its value.
//
// Conventions of the whole library, stated once:
// - plan positions are (northing, easting): component 0 is N, component 1 is E;
// - azimuths are radians measured clockwise from north: azimuth = atan2(dE, dN);
//   the unit direction of azimuth a is (N = cos a, E = sin a);
// - offsets are positive to the right of the direction of travel; radii are positive turning right;
// - angles inside objects are radians; plain-number angle functions take decimal degrees unless their
//   name says Rad, Grad, Mil or a DMS form; grades are percent; lengths are metres.
#include <cstdint>
#include <cstring>

namespace svy_math {
namespace tol {

// Zero test for lengths, angles and determinants: strict on both sides (-kZero < x < kZero).
constexpr double kZero = 1e-12;
// An offset smaller than this (metres) is treated as lying on the element.
constexpr double kOffsetZero = 1e-05;
// Snap of a length or chainage to an element's end, and the tie-break between elements (metres).
constexpr double kSnap = 0.001;
// Geodetic latitude iteration (Cartesian to geodetic): stops when tan(latitude) changes by at most this.
// The iteration contracts by about e^2 per step near the surface, so the remaining error is ~1e-12 rad.
constexpr double kGeodeticIteration = 1e-10;
// A point closer than this to the polar axis (metres) is taken as on the axis: longitude 0, latitude +-90 deg.
constexpr double kPolarAxisDistance = 1e-10;
// Safety cap of the latitude iteration. Surface points converge in under 10 steps; points deep inside the
// earth near the equatorial plane (where the map's slope approaches 1) need up to a few million. Reaching
// the cap ends with NaN instead of looping.
constexpr int kGeodeticIterationCap = 100000000;
// Geodesic inverse: Newton's method on the azimuth at the first point stops once the longitude misclosure
// is within this (radians: the spacing of doubles at 1, 1.4e-9 m on the earth); it is 8 times this
// after a Newton step already judged converged, where rounding can hold the misclosure a few ulps away.
constexpr double kGeodesicLongitude = 2.220446049250313e-16;
// Newton steps before the solver falls back to bisection alone, and the cap of all steps. Newton converges
// in 2 to 5 steps from the starting azimuth (antipodal pairs included); each bisection halves the bracket
// of the azimuth, so 63 more reach the resolution of a double.
constexpr int kGeodesicNewtonSteps = 20;
constexpr int kGeodesicSolverSteps = 83;
// A bisection bracket narrower than this (radians, epsilon^1.5) cannot shrink further.
constexpr double kGeodesicBracket = 3.308722450212111e-24;
// Guard against dividing by an exact zero: the cosine of a latitude at a pole, an equatorial azimuth
// (sqrt of the smallest normal double).
constexpr double kGeodesicTiny = 1.4916681462400413e-154;
// Pairs closer than this on the auxiliary sphere (radians, about 0.2 m) are solved in closed form on a
// sphere scaled at their mean latitude: its error there, of order f sigma^3, is below a double's resolution.
constexpr double kGeodesicShortLine = 3.6e-08;
// Starting azimuth near the antipode: pairs within kGeodesicAntipodalStrip (radians of reduced latitude,
// 200 epsilon) of the equatorial cut, and no more than kGeodesicCutMargin (a fraction of the cut's
// half-length) beyond its end, start from the meridian-like azimuth; the others from the astroid.
constexpr double kGeodesicAntipodalStrip = 4.440892098500626e-14;
constexpr double kGeodesicCutMargin = 1.4901161193847656e-05;

}  // namespace tol

namespace units {

constexpr double kPi = 3.14159265358979323846;
constexpr double kTwoPi = 6.283185307179586;
constexpr double kHalfPi = 1.5707963267948966;
// Degrees <-> radians, the exact double constants the angle functions multiply by.
constexpr double kDegToRad = 0.017453292519943295;
constexpr double kRadToDeg = 57.29577951308232;
// Time of day and GPS weeks.
constexpr double kSecondsPerDay = 86400.0;
constexpr double kSecondsPerHour = 3600.0;
constexpr double kSecondsPerMinute = 60.0;
constexpr double kMinutesPerDay = 1440.0;
constexpr double kHoursPerDay = 24.0;
constexpr int kDaysPerWeek = 7;

}  // namespace units

// An undefined value: a double with all bits set (a quiet NaN). Records use it for "not given".
inline double undefinedValue() {
  const std::uint64_t allBits = ~std::uint64_t{0};
  double value;
  std::memcpy(&value, &allBits, sizeof value);
  return value;
}
inline bool isUndefined(double x) { return x != x; }

// Coordinate geometry (inverse, radiation, implicit lines, line and circle intersections).
namespace tol {

// Two coordinate records are the same point for an azimuth when N and E agree within this (metres).
constexpr double kSamePoint = 1e-10;
// A 3-D line shorter than this (metres) has no usable direction to extend along.
constexpr double kMinLineLength3D = 1e-5;
// A plane vector whose squared length is below this (square metres, i.e. shorter than 1e-8 m) has no
// direction to rotate.
constexpr double kVectorLengthSqZero = 1e-16;
// Radius of a parallel of latitude (metres) below which a point counts as at the pole: no longitude step.
constexpr double kPoleParallelRadius = 1e-6;
// Guards against division by an exact or subnormal zero in the implicit-line solvers: twice and three
// times the smallest normal double. Not geometric tolerances.
constexpr double kTwoMinNormal = 4.450147717014403e-308;
constexpr double kThreeMinNormal = 6.675221575521604e-308;
// Quadratic roots: a discriminant within +-1e-13 is a double root; a leading coefficient below 1e-13
// leaves a linear equation, which has no root when its slope is below 1e-5.
constexpr double kDiscriminantZero = 1e-13;
constexpr double kLeadingCoeffZero = 1e-13;
constexpr double kLinearCoeffZero = 1e-5;
// A line or circle that misses or overlaps a circle by at most this (metres) touches it: one solution.
// Doubles near survey coordinates are up to 1.9e-9 m apart (N 10 000 000), and a tangent constructed
// there is off by a few such spacings; 1e-8 m recognises it. An overlap this small puts each true crossing
// up to sqrt(2 R 1e-8) from the touching point (1.4 mm for R = 100 m): the precision to which data
// rounded at that level defines a touching point anyway.
constexpr double kTangency = 1e-8;
// Control points of a plane localization spread (root mean square about their centroid) over less than this
// (metres) fix no rotation or scale: they count as coincident.
constexpr double kControlSpread = 1e-3;
// A localization control point is flagged when its externally studentized residual exceeds this: a 2-D
// residual beyond three of its standard deviations, 1.1% likely for a good point (chi-square, 2 degrees).
constexpr double kOutlierFactor = 3.0;
// A residual shorter than this (metres) is rounding of exact control, never a blunder: doubles at
// N 10 000 000 are 2e-9 m apart and a fit over a few of them loses a few hundred such steps.
constexpr double kResidualZero = 1e-6;

// Two bearings whose unit directions have a cross product (the sine of the angle between them) strictly
// within +-1e-12 are parallel: their crossing would lie more than 1e12 times the points' separation away.
constexpr double kParallelSine = 1e-12;

}  // namespace tol

namespace units {

// Refraction coefficient of the line of sight over land by day (the ratio of the earth's radius to that
// of the light path), the usual default of trigonometric heighting.
constexpr double kRefractionCoefficient = 0.13;
// Default a-priori accuracies of a total station: 3 seconds of arc for directions and zenith angles
// (radians), 2 mm + 2 ppm for distances.
constexpr double kDefaultAngleSd = 1.454441043328608e-05;
constexpr double kDefaultDistanceSd = 0.002;
constexpr double kDefaultDistancePpm = 2.0;
constexpr double kPartsPerMillion = 1e-6;
// Radius of the spherical earth used for small steps in latitude and longitude (metres).
constexpr double kSphereEarthRadius = 6.371e6;
// Degrees of latitude per metre on that sphere: 180 / (pi * 6.371e6).
constexpr double kSphereDegPerMetre = 8.993216059187306e-6;

}  // namespace units

// Sexagesimal splits of angles.
namespace tol {

// Nudge (minutes of arc) added before truncating the minutes of a degree value, so that 12.5 degrees stored
// as 12.4999999999 still gives 30 minutes; it can make the minutes 60 just below a whole degree.
constexpr double kDmsMinuteNudge = 1e-4;
// A packed D.MMSS seconds field above this is floating noise below the next minute (12.3059999999...) and is
// carried into the minutes.
constexpr double kPackedSecondsNoise = 99.99999;

}  // namespace tol

// Angle units and the unit conversions of single values. The conversion factors are fixed double constants
// applied as written (not recomputed from definitions); some differ in their last digits from the exact ratio
// and some pairs are not exact inverses of each other. They are kept as they are so that results agree to the
// last bit with data computed by earlier releases.
namespace units {

// Angles: degrees in a circle, half circle and right angle; minutes and seconds of arc per degree.
constexpr double kFullCircleDeg = 360.0;
constexpr double kHalfCircleDeg = 180.0;
constexpr double kRightAngleDeg = 90.0;
constexpr double kArcMinutesPerDegree = 60.0;
constexpr double kArcSecondsPerDegree = 3600.0;
// Degrees per grad (400 grads to the circle).
constexpr double kDegPerGrad = 0.9;
// Mils per degree and degrees per mil (6400 mils to the circle).
constexpr double kMilPerDeg = 17.77777777777778;
constexpr double kDegPerMil = 0.05625;
// Seconds of arc and centesimal seconds (1e-4 grad) in one grad.
constexpr double kArcSecondsPerGrad = 3240.0;
constexpr double kCentesimalSecondsPerGrad = 10000.0;

// Feet: the US survey foot is 1200/3937 m, the international foot 0.3048 m.
constexpr double kUsFootToMetre = 0.3048006096012192;     // metres per US survey foot
constexpr double kIntFootToMetre = 0.3048;                // metres per international foot
constexpr double kMetreToUsFoot = 3.2808333333333333;     // US survey feet per metre
// Feet per metre used when packing feet-inches-eighths (the US factor ends in 7 there, unlike above).
constexpr double kMetreToUsFootPacked = 3.2808333333333337;
constexpr double kMetreToIntFootPacked = 3.280839895013123;
// Feet, inches and eighths of an inch.
constexpr double kInchesPerFoot = 12.0;
constexpr double kEighthsPerInch = 8.0;
constexpr double kEighthsPerFoot = 96.0;

// Gunter's chain (66 ft): chains per metre and metres per chain, US survey and international.
constexpr double kMetreToUsChain = 0.04970959595959596;
constexpr double kMetreToIntChain = 0.049709695378986715;
constexpr double kUsChainToMetre = 20.116840233680467;
constexpr double kIntChainToMetre = 20.1168;
// Areas: square feet and square chains per square metre, square metres and acres per square chain.
constexpr double kSqMetreToUsSqFoot = 10.76386736111111;
constexpr double kSqMetreToIntSqFoot = 10.76391041670972;
constexpr double kSqMetreToUsSqChain = 0.002471043930466279;
constexpr double kSqMetreToIntSqChain = 0.002471053814671653;
constexpr double kUsSqChainToSqMetre = 404.6872609874252;
constexpr double kIntSqChainToSqMetre = 404.68564224000005;
constexpr double kUsSqChainToAcre = 0.1000004000012;
constexpr double kIntSqChainToAcre = 0.1;
// Volumes: cubic yards, cubic feet and cubic chains per cubic metre.
constexpr double kCuMetreToUsCuYard = 1.3079427716263718;
constexpr double kCuMetreToIntCuYard = 1.3079506193143915;
constexpr double kCuMetreToUsCuFoot = 35.31445483391203;
constexpr double kCuMetreToIntCuFoot = 35.31466672148858;
constexpr double kCuMetreToUsCuChain = 0.00012283459538189068;
constexpr double kCuMetreToIntCuChain = 0.00012283533239241097;

// Pressure: millimetres of mercury per hectopascal and back; inches of mercury per hectopascal and back
// (the inch pair is two independently rounded factors whose product is not 1).
constexpr double kHpaToMmHg = 0.7500615758456564;
constexpr double kMmHgToHpa = 1.33322387415;
constexpr double kHpaToInHg = 0.02953;
constexpr double kInHgToHpa = 33.8639;
// Temperature: degrees Fahrenheit per degree Celsius and the Fahrenheit reading of 0 degrees Celsius.
constexpr double kFahrenheitPerCelsius = 1.8;
constexpr double kFahrenheitAtZeroCelsius = 32.0;

}  // namespace units

// Matrices, covariance and least squares.
namespace tol {

// A symmetric 3x3 coordinate covariance (square metres) whose determinant is below this has no inverse.
// Variances of 1e-14 m^2 (0.1 micrometre standard deviations) still give determinants of 1e-42 and above,
// so only covariances that are singular in substance are refused.
constexpr double kCovDeterminantZero = 1e-40;
// A packed symmetric 3x3 matrix with |determinant| below this is singular for InvertSMatr3.
constexpr double kPackedDeterminantZero = 1e-60;
// Elements of a packed matrix within +-1e-15 are structural zeros to the Cholesky test and are skipped.
constexpr double kCholeskySparseZero = 1e-15;
// Relative precision of the Jacobi eigenvalue sweeps: rotations stop once every off-diagonal element is
// below 1e-12 of the matrix's off-diagonal norm (divided by the order).
constexpr double kJacobiRange = 1e-12;
// A Cholesky pivot of a normal matrix at or below this fraction of its original diagonal element marks the
// matrix as singular: the unknown is (to 14 digits) a combination of the earlier ones. For a line
// n = m e + b the ratio is var(e) / mean(e^2), so at E 500 000 eastings with a standard deviation above
// 5 cm still pass.
constexpr double kPivotRelativeZero = 1e-14;
// A design column taken relative to its mean whose widest entry is at or below this fraction of its largest
// raw entry is refused as singular: the rounding of the data (1.1e-16 of each value) would then make up more
// than a millionth of the differences that define its unknown. At E 500 000 that is 50 micrometres.
constexpr double kCentredSpreadRelativeZero = 1e-10;
// Eigenvalues of a symmetric matrix at or below this fraction of the largest (in absolute value) are
// zero to the pseudo-inverse.
constexpr double kPseudoInverseRelativeZero = 1e-12;

}  // namespace tol

namespace limits {

// Sweeps of the Jacobi method at one threshold. Each sweep with rotations removes at least the square of
// the threshold from the off-diagonal norm and 3x3 covariances need 2 to 4; the cap only ends sweeps that
// make no progress (values at the edge of the double range).
constexpr int kJacobiSweepCap = 100;
// Gauss-Newton iterations of one solve. Well-posed fits (circle, radius) converge in 3 to 10; the cap,
// a hundred times that, only ends a problem whose convergence criteria can never be met.
constexpr int kGaussNewtonIterationCap = 1000;
// A Gauss-Newton correction within this many times the rounding of the misclosures carried into an unknown
// is noise. Near a solution the corrections of a fit whose misclosures round at level r wander by about
// r times that gain; a factor of 10 ends them there and leaves any real step (orders of magnitude larger)
// alone.
constexpr double kRoundingNoiseFactor = 10.0;
// Units of the last place of the radius in which a circle fit's misclosure d - r rounds: the distance d
// from the difference of coordinates (exact near each other), its square root, and the subtraction.
constexpr double kCircleMisclosureUlps = 2.0;

// Orientations tried for the starting position (a half-degree grid): Gauss-Newton converges from within a
// few degrees of any sound geometry.
constexpr int kResectionOrientationSteps = 720;

}  // namespace limits

namespace tol {

// Free-station resection: Gauss-Newton stops once the station moves by less than kResectionPosition
// (metres) and the orientation turns by less than kResectionOrientation (radians, 1e-12 rad is 0.001 mm at
// 1000 km), far below survey precision and well above the rounding of local coordinates.
constexpr double kResectionPosition = 1e-9;
constexpr double kResectionOrientation = 1e-12;

}  // namespace tol

// Circular-curve formulas (radius, deflection, degree of curve, tangent, external, middle ordinate).
namespace tol {

// A radius below this (metres) defines no curve: degree of curve, deflection from length and spiral length
// give 0 for it.
constexpr double kCurveRadiusZero = 1e-05;
// A degree of curve below this (radians, 5e-7 degrees: a radius beyond 11 000 km) defines no curve.
constexpr double kDegOfCurveZeroRad = 8.726646259971647e-09;
// A deflection within this of a half turn (degrees) has an infinite tangent and external distance.
constexpr double kHalfTurnDeg = 1e-05;

}  // namespace tol

namespace units {

// Degree of curve on a 100 m (or 100 ft) base: arc definition R = 100 / D_rad, chord definition
// R = 50 / sin(D_rad / 2); 100 * (180 / pi) is the radius of a curve of one degree (arc definition).
constexpr double kDegOfCurveBase = 100.0;
constexpr double kDegOfCurveHalfBase = 50.0;
constexpr double kRadiusOfOneDegreeCurve = 5729.5779513082325;

}  // namespace units

// Curve elements: chord steps, foot-point searches, undefined arcs.
namespace tol {

// No chord step along an arc turns the direction by more than a sixteenth of a half turn (pi/16 rad): the
// chord of such a step stays within 2% of the arc length, so stepping never skips a bend.
constexpr double kMaxChordStepTurn = 0.19634954084936207;
// A foot-point search on a curve stops when the length moves by less than this (metres): a thousandth of
// a micrometre, far below survey precision but well above the rounding of lengths of a few kilometres.
constexpr double kProjectionLength = 1e-9;
// Radius returned (and cached) for an arc record that knows neither its radius nor its length (metres):
// deliberately tiny but not zero, so that divisions by it stay finite.
constexpr double kUndefinedArcRadius = 1e-6;

}  // namespace tol

// Views of targets on a field screen.
namespace tol {

// A direction on the edge of a viewing cone, computed through sines and cosines of the view angles, lands
// within a few units in the last place of the edge; directions within this fraction of the edge tangent
// beyond it count as inside.
constexpr double kViewConeEdge = 1e-12;

}  // namespace tol

// Alignments.
namespace tol {

// Two alignment elements are equal (isEqual) when their lengths and radii agree within this (metres) and
// their fixed start azimuths within this (radians): far below survey precision, above the rounding of
// values computed from the same input in a different order.
constexpr double kElementEqual = 1e-9;
// The batch point-to-chainage search grows each element's plan box by this (metres) in its spatial index:
// an element accepts the foot of a point up to tol::kSnap beyond its ends, so an element whose box lies
// farther than the margin minus that snap from the point cannot offer it a smaller offset.
constexpr double kSearchIndexMargin = 2.0 * kSnap;
// An intersection-point element whose previous ST lies beyond its TS by no more than this (metres) still
// counts as touching it: ST and TS come from different IPs at survey coordinates, where a double resolves
// about 1e-9 m and each is off by a few such spacings.
constexpr double kIpTangentOverlap = 1e-8;
// First search radius (metres) beyond the nearest element box: the radius then doubles until no element
// outside it can change the answer.
constexpr double kSearchStartRadius = 1.0;
// Doublings of the search radius before the search falls back to all elements (2^64 m exceeds any plan).
constexpr int kSearchRadiusDoublings = 64;

}  // namespace tol

// Vertical alignments (profiles).
namespace units {

// Grades are percent: a grade g rises g / kPercent metres per metre of chainage.
constexpr double kPercent = 100.0;

}  // namespace units

namespace limits {

// Regular stations one chainage iteration yields at most: a million (20 MB of points) covers 10 000 km at
// 10 m; an absurd interval or range ends the stations there instead of exhausting memory.
constexpr double kMaxChainageStations = 1.0e6;

}  // namespace limits

}  // namespace svy_math

// Road cross-sections and slopes.
namespace svy_math {
namespace tol {

// Rise over run reported between two section points at the same offset (a vertical face such as a kerb
// face given by two points): a finite stand-in for an infinite slope, signed by the rise.
constexpr double kVerticalSlopeRatio = 1.0e6;

}  // namespace tol
}  // namespace svy_math

// Areas bounded by lines and arcs, and their subdivision by a known area.
namespace svy_math {
namespace tol {

// Two boundary coordinates are the same vertex when north and east agree within this (metres): a closing
// line is added to a point list only beyond it, and two arcs share a centre within it.
constexpr double kAreaSameVertex = 2e-09;
// Heights of two arc centres agree within this (metres) for the centres to be the same.
constexpr double kAreaSameHeight = 0.0001;
// A single arc is a whole circle when its length is 2 pi r within this (metres).
constexpr double kAreaFullCircle = 0.0001;
// Two arcs of a two-segment boundary meet end to start within this (metres).
constexpr double kAreaArcsMeet = 0.0001;
// A circular segment or a boundary area within this of zero (square metres) is logged as suspicious.
constexpr double kAreaNearZero = 1e-10;
// Two radii of arcs on one circle agree within this (metres): the double epsilon, i.e. equal radii.
constexpr double kAreaSameRadius = 2.220446049250313e-16;
// Points of cuts and crossings are the same, and a point lies on a segment, within this (metres): a
// thousandth of a millimetre, far below survey precision and far above the rounding of coordinates at
// N 5 000 000 after a few operations.
constexpr double kAreaPoint = 1e-06;
// A piece's area is accepted within this of the requested area (square metres).
constexpr double kSubdivisionArea = 0.001;
// Two successive trials whose areas differ by less than this (square metres) mean the search has stalled.
constexpr double kSubdivisionStall = 0.0001;
// A hinge point of a subdivision lies on the boundary within this (metres): a corner typed to the millimetre
// is found; the hinge is then moved onto the boundary.
constexpr double kHingeOnBoundary = 0.001;
// Starting values of the extent of a boundary in the frame of a cut direction (metres): any coordinate
// replaces them.
constexpr double kExtentStartMax = 1e-40;
constexpr double kExtentStartMin = 1e+40;
// Starting value of the smallest distance of a boundary point from the base line of a cut (metres).
constexpr double kCutDistanceStart = 100000.0;

}  // namespace tol

namespace limits {

// Probing levels of the bracketing search after values that cannot be evaluated: level k tries 2k values,
// so 100 levels try ~10 000, with a step of 2^-101 of the bracket, beyond double precision.
constexpr int kSearchProbeLevels = 100;

}  // namespace limits
}  // namespace svy_math

#include "svymath/curves/spiral_fresnel.h"

#include <array>
#include <cmath>
#include <cstddef>

#include "svymath/foundation/constants.h"

namespace svy_math {
namespace {

// Below this argument the power series applies; from here on the auxiliary functions.
constexpr double kSeriesLimit = 1.5;
// Below this argument only the leading terms C = x and S = pi*x^3/6 are kept: the next terms are smaller by
// a factor of x^4 <= 2^-56, below the rounding unit 2^-53 of the leading terms.
constexpr double kSeriesLeadingOnly = 1.0 / 16384.0;  // 2^-14
// From here on the asymptotic series of the auxiliary functions, nine terms, is exact to 1e-17.
constexpr double kAsymptoticFrom = 7.0;
// From here on C and S are 1/2 to the last bit: the auxiliary function f ~ 1/(pi x) is below 3.2e-18, a
// sixteenth of the rounding unit of 1/2.
constexpr double kHalfFrom = 1e17;
// Veltkamp's splitting factor 2^27 + 1: cuts a double into two halves of 26 bits whose products are exact.
constexpr double kSplitFactor = 134217729.0;

// Power series in z = x^4, |x| < 1.5: C = x * sum(kSeriesC[k] z^k), S = x^3 * sum(kSeriesS[k] z^k), with
//   kSeriesC[k] = (-1)^k (pi/2)^(2k) / ((2k)! (4k+1)),  kSeriesS[k] = (-1)^k (pi/2)^(2k+1) / ((2k+1)! (4k+3)),
// rounded to double. Sixteen terms: the last ones are below 1e-17 of the sums at x = 1.5.
constexpr std::size_t kSeriesTerms = 16;
constexpr double kSeriesC[kSeriesTerms] = {
    1.0, -0.24674011002723398, 0.028185500877894225, -0.0016048831356425355, 5.4074133814083916e-05,
    -1.2000972558600288e-06, 1.8843499115272686e-08, -2.2022769254454663e-10, 1.989685792418022e-12,
    -1.4309189731715198e-14, 8.384729705118554e-17, -4.079981449233878e-19, 1.6748476126215183e-21,
    -5.877896118036892e-24, 1.7837783103437512e-26, -4.727226384742681e-29};
constexpr double kSeriesS[kSeriesTerms] = {
    0.5235987755982989, -0.09228058535803518, 0.007244784204197004, -0.0003121169423545792, 8.444272883545254e-06,
    -1.564714450092211e-07, 2.1082121933214546e-09, -2.1574306805843444e-11, 1.7334102088874846e-13,
    -1.1223244787983955e-15, 5.980053239210405e-18, -2.6678713628413992e-20, 1.011069642466722e-22,
    -3.295271477907068e-25, 9.334382689020993e-28, -2.3192836677213777e-30};

// Between 1.5 and 7 the auxiliary functions f and g (see fresnelAuxiliary) are written as
//   f = F / (pi x),  g = G / (pi^2 x^3),
// F and G smooth and near 1, each approximated on a piece of the axis by a polynomial of degree 12 in
// v = (2u - uLow - uHigh) / (uHigh - uLow), u = 1/x^2 in [uLow, uHigh] (a Chebyshev fit to 40-digit values;
// the fit is within 3e-18 of F and G on every piece).
constexpr std::size_t kPieceTerms = 13;
struct TAuxiliaryPiece {
  double xEnd;   // the piece covers x below this (and at or above the previous piece's end)
  double uLow;   // 1 / xEnd^2
  double uHigh;  // 1 / xStart^2
  double f[kPieceTerms];
  double g[kPieceTerms];
};
constexpr TAuxiliaryPiece kPieces[] = {
    {1.75, 0.32653061224489793, 0.4444444444444444,
     {
         0.9667724550633038, -0.008023500072432445, -0.00018685971779888312, 2.6389533973244623e-05,
         -1.7952304702072372e-06, 8.593049970240308e-08, -1.5468626256891386e-09, -2.900988213645613e-10,
         5.184073102017654e-11, -5.842382754198208e-12, 5.360475032525834e-13, -4.150369032926529e-14,
         2.4313062047201358e-15
     },
     {
         0.861849761808418, -0.028957600528960424, 0.0001009831284176755, 9.082237475546858e-05,
         -1.0538541561500341e-05, 8.238662769250566e-07, -4.6664402027426804e-08, 1.0718515828187048e-09,
         1.9366343128913892e-10, -4.0902184920556434e-11, 5.3117477659431056e-12, -5.748838720956732e-13,
         5.173682468701817e-14
     }},
    {2.1, 0.22675736961451246, 0.32653061224489793,
     {
         0.9807594226711764, -0.0059344770046506, -0.00026863299319259586, 2.5786774270393792e-05,
         -1.3020953652992697e-06, 2.2420271065050726e-08, 4.419751381088822e-09, -7.37487977807469e-10,
         7.516560809738736e-11, -5.726449369732712e-12, 2.7649918097191193e-13, 9.478741527153035e-15,
         -4.4282254251221494e-15
     },
     {
         0.9149406777105061, -0.02376219922658758, -0.0004851686584229439, 0.00012274173459624716,
         -1.0475552318071284e-05, 5.407373437617839e-07, 2.0074528050444037e-10, -4.393073601802198e-09,
         7.065067785511273e-10, -7.814366573003727e-11, 6.6743963046396724e-12, -3.6838364924271744e-13,
         -5.8452514659495185e-15
     }},
    {2.6, 0.14792899408284022, 0.22675736961451246,
     {
         0.9903602854251633, -0.0037090174514417505, -0.0002699037607135831, 1.724244595697672e-05,
         -4.183145800724581e-07, -3.295975829706787e-08, 5.7064647295376395e-09, -4.831037099914746e-10,
         2.2660384423400272e-11, 7.659262037552282e-13, -3.3775214222878494e-13, 5.0575847516504066e-14,
         -5.0896820464357915e-15
     },
     {
         0.9551009450569894, -0.01625866938780736, -0.0008577789192979138, 0.00010479048728441592,
         -5.331471635180745e-06, -3.7070309998998536e-08, 4.203600289051271e-08, -5.523199606500361e-09,
         4.508779631857594e-10, -1.7566193502477797e-11, -1.922036802513293e-12, 5.869426175149458e-13,
         -8.437015669641037e-14
     }},
    {3.4, 0.08650519031141869, 0.14792899408284022,
     {
         0.996004492736038, -0.002008640497604298, -0.00022281293681091722, 8.679996580869177e-06,
         9.282675345145791e-08, -3.724578127359222e-08, 2.70201588649934e-09, -4.166766470882145e-11,
         -1.557974438239915e-11, 2.431101212297526e-12, -1.979515514681479e-13, 2.9402694212117287e-15,
         1.859792040487085e-15
     },
     {
         0.9806718702709918, -0.009427532328126216, -0.0009152927623519249, 6.359428627110113e-05,
         -5.861065476153739e-07, -2.8595126405321185e-07, 3.2899812549136684e-08, -1.5764240860815624e-09,
         -9.794221895416261e-11, 3.108735624740515e-11, -3.809300806558091e-12, 2.3528807364516065e-13,
         9.87974388311027e-15
     }},
    {4.6, 0.047258979206049156, 0.08650519031141869,
     {
         0.9986609825120017, -0.0007740835607223765, -0.00010698664244327704, 1.7835451229533192e-06,
         8.351089590086754e-08, -6.343212705081883e-09, 5.756315548386203e-11, 2.0786825508752155e-11,
         -1.7691692591348891e-12, 2.752048357651981e-14, 9.476294754639035e-15, -1.220272980271401e-15,
         5.845240012061917e-17
     },
     {
         0.9933843129064108, -0.0037808352408104733, -0.0004984597144519979, 1.47618796222374e-05,
         5.354002301832849e-07, -6.742100669994467e-08, 1.7401985337499364e-09, 2.1532369440117604e-10,
         -2.838640380365726e-11, 1.168846831359384e-12, 1.0643752479756002e-13, -2.3280921908601655e-14,
         1.8474597271355178e-15
     }},
    {7.0, 0.02040816326530612, 0.047258979206049156,
     {
         0.9996534463302372, -0.0002739339986066521, -5.3489231535888595e-05, 3.339275709192543e-07,
         2.956045320356452e-08, -7.842888994236055e-10, -3.226274933240937e-11, 2.696911504102782e-12,
         2.667341315808886e-15, -1.0462818695983124e-14, 5.300994495212865e-16, 2.695237155815774e-17,
         -5.186472401444173e-18
     },
     {
         0.9982727560039267, -0.0013609980424518448, -0.00026239694251226764, 2.933458915045047e-06,
         2.4627909708876234e-07, -9.60284793683448e-09, -3.242643811629375e-10, 4.056123242725967e-11,
         -4.292325894190655e-13, -1.7208394093450912e-13, 1.2589463029964853e-14, 3.0965775613438844e-16,
         -1.162135350175235e-16
     }},
};

// The map u -> v of each piece as v = u * scale - shift, so that evaluating it takes no division.
struct TPieceMap {
  double scale;
  double shift;
};
constexpr std::size_t kPieceCount = sizeof(kPieces) / sizeof(kPieces[0]);
constexpr std::array<TPieceMap, kPieceCount> makePieceMaps() {
  std::array<TPieceMap, kPieceCount> maps{};
  for (std::size_t p = 0; p < kPieceCount; ++p) {
    const double width = kPieces[p].uHigh - kPieces[p].uLow;
    maps[p] = {2.0 / width, (kPieces[p].uHigh + kPieces[p].uLow) / width};
  }
  return maps;
}
constexpr std::array<TPieceMap, kPieceCount> kPieceMaps = makePieceMaps();
constexpr double kInversePi = 0.3183098861837907;

// Asymptotic series of F and G in w = 1/(pi x^2)^2:
//   F = sum (-1)^k 1*3*5*...*(4k-1) w^k,  G = sum (-1)^k 1*3*5*...*(4k+1) w^k.
constexpr std::size_t kAsymptoticTerms = 9;
constexpr double kAsymptoticF[kAsymptoticTerms] = {1.0, -3.0, 105.0, -10395.0, 2027025.0, -654729075.0,
                                                   316234143225.0, -213458046676875.0, 1.9189878396251062e17};
constexpr double kAsymptoticG[kAsymptoticTerms] = {1.0, -15.0, 945.0, -135135.0, 34459425.0, -13749310575.0,
                                                   7905853580625.0, -6190283353629375.0, 6.332659870762851e18};

// Taylor series of sin(a) / a and cos(a) in a^2 for |a| <= pi/4: the first omitted terms are below 1e-19.
constexpr double kSinSeries[9] = {1.0, -0.16666666666666666, 0.008333333333333333, -0.0001984126984126984,
                                  2.7557319223985893e-06, -2.505210838544172e-08, 1.6059043836821613e-10,
                                  -7.647163731819816e-13, 2.8114572543455206e-15};
constexpr double kCosSeries[10] = {1.0, -0.5, 0.041666666666666664, -0.001388888888888889,
                                   2.48015873015873e-05, -2.755731922398589e-07, 2.08767569878681e-09,
                                   -1.1470745597729725e-11, 4.779477332387385e-14, -1.5619206968586225e-16};

// A polynomial sum(c[k] v^k) by Estrin's scheme: neighbouring coefficients are paired first,
// c[2k] + c[2k+1] v, and the pairs form a polynomial in v^2, down to one value. The dependency chain is
// log2(N) multiply-adds long instead of Horner's N, and an alternating series cancels within each pair
// while its terms are still small.
template <std::size_t N>
double polynomial(const double (&c)[N], double v) {
  if constexpr (N == 1) {
    return c[0];
  } else {
    double pairs[(N + 1) / 2];
    for (std::size_t k = 0; k < N / 2; ++k) pairs[k] = c[2 * k] + c[2 * k + 1] * v;
    if constexpr (N % 2 != 0) pairs[N / 2] = c[N - 1];
    return polynomial(pairs, v * v);
  }
}

void fresnelSeries(double x, double& S, double& C) {
  if (x < kSeriesLeadingOnly) {
    C = x;
    S = x * (units::kHalfPi * x * x) / 3.0;
    return;
  }
  const double x2 = x * x;
  const double z = x2 * x2;
  C = x * polynomial(kSeriesC, z);
  S = x * x2 * polynomial(kSeriesS, z);
}

// x^2 as the unevaluated sum hi + lo, exact (Dekker's product).
void exactSquare(double x, double& hi, double& lo) {
  hi = x * x;
  const double t = kSplitFactor * x;
  const double xh = t - (t - x);
  const double xl = x - xh;
  lo = ((xh * xh - hi) + 2.0 * xh * xl) + xl * xl;
}

// Cosine and sine of pi x^2 / 2. The phase is reduced exactly: its period is 4 in x^2, so only x^2 modulo 4
// (taken on the exact square) matters, and the remaining quarter turn is rotated in without rounding. A
// phase formed as pi*x*x/2 would lose its accuracy as x grows (1e-8 rad at x = 1e4).
void phaseCosSin(double x, double& c, double& s) {
  double hi = 0.0;
  double lo = 0.0;
  exactSquare(x, hi, lo);
  // Both parts modulo 4, exactly: lo is below half a unit of hi's last place, which exceeds 4 once x^2
  // passes 2^54; below 4 it is left as it is (adding 4 to a tiny lo would round it away).
  const double rHi = hi - 4.0 * std::floor(0.25 * hi);
  const double rLo = std::fabs(lo) < 4.0 ? lo : lo - 4.0 * std::floor(0.25 * lo);
  const double quarter = std::floor(rHi + rLo + 0.5);
  const double angle = units::kHalfPi * ((rHi - quarter) + rLo);  // |angle| <= pi/4 (plus rounding)
  const double angle2 = angle * angle;
  const double ca = polynomial(kCosSeries, angle2);
  const double sa = angle * polynomial(kSinSeries, angle2);
  switch (static_cast<int>(quarter) & 3) {
    case 0: c = ca, s = sa; break;
    case 1: c = -sa, s = ca; break;
    case 2: c = -ca, s = -sa; break;
    default: c = sa, s = -ca; break;
  }
}

// x >= 1.5 by the auxiliary functions f and g:
//   C = 1/2 + f sin(pi x^2/2) - g cos(pi x^2/2),  S = 1/2 - f cos(pi x^2/2) - g sin(pi x^2/2).
void fresnelAuxiliary(double x, double& S, double& C) {
  if (x >= kHalfFrom) {
    S = C = 0.5;
    return;
  }
  // One division: 1/(pi x); then u = 1/x^2 = (pi / (pi x))^2 and w = 1/(pi x^2)^2 = (u / pi)^2.
  const double inversePiX = 1.0 / (units::kPi * x);
  const double u = (units::kPi * inversePiX) * (units::kPi * inversePiX);
  double bigF = 0.0;
  double bigG = 0.0;
  if (x < kAsymptoticFrom) {
    std::size_t p = 0;
    while (x >= kPieces[p].xEnd) ++p;
    const TAuxiliaryPiece& piece = kPieces[p];
    const double v = u * kPieceMaps[p].scale - kPieceMaps[p].shift;
    bigF = polynomial(piece.f, v);
    bigG = polynomial(piece.g, v);
  } else {
    const double w = (inversePiX * inversePiX) * (inversePiX * inversePiX) * (units::kPi * units::kPi);
    bigF = polynomial(kAsymptoticF, w);
    bigG = polynomial(kAsymptoticG, w);
  }
  const double f = bigF * inversePiX;
  const double g = bigG * inversePiX * u * kInversePi;
  double c = 0.0;
  double s = 0.0;
  phaseCosSin(x, c, s);
  C = 0.5 + (f * s - g * c);
  S = 0.5 - (f * c + g * s);
}

}  // namespace

void fresnelCS(double t, double& S, double& C) {
  const double x = std::fabs(t);
  if (std::isnan(x)) {
    S = C = x;
    return;
  }
  if (x < kSeriesLimit) {
    fresnelSeries(x, S, C);
  } else {
    fresnelAuxiliary(x, S, C);
  }
  if (t < 0.0) {
    S = -S;
    C = -C;
  }
}

}  // namespace svy_math

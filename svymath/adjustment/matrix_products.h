#pragma once
// Products of general (R, a TMatrix) and symmetric (S, a TSMatrix) matrices, written into a result with an
// accumulation operator: '=' assigns the product, '+' adds it to the result, '-' subtracts it. In the
// names, t marks a transposed operand. Each returns 0, or -1 when the shapes do not agree or the operator
// is unknown; the result is then unchanged. The result must not be one of the operands.
#include "svymath/adjustment/matrix_storage.h"
#include "svymath/foundation/export.h"

namespace svy_math {

// Accumulation operators of the products.
constexpr char kOpAssign = '=';
constexpr char kOpAdd = '+';
constexpr char kOpSubtract = '-';

// result op r1 * r2
SVYMATH_API int MATRopR1_R2(TMatrix& result, const TMatrix& r1, const TMatrix& r2, char op);
// result op r1 * r2^T
SVYMATH_API int MATRopR1_R2t(TMatrix& result, const TMatrix& r1, const TMatrix& r2, char op);
// result op r1^T * r2
SVYMATH_API int MATRopR1t_R2(TMatrix& result, const TMatrix& r1, const TMatrix& r2, char op);
// result op r1 * r2 * r3^T
SVYMATH_API int MATRopR1_R2_R3t(TMatrix& result, const TMatrix& r1, const TMatrix& r2, const TMatrix& r3,
                                char op);
// result op r1 * s * r2^T
SVYMATH_API int MATRopR1_S_R2t(TMatrix& result, const TMatrix& r1, const TSMatrix& s, const TMatrix& r2,
                               char op);
// result op r * s
SVYMATH_API int MATRopR_S(TMatrix& result, const TMatrix& r, const TSMatrix& s, char op);
// result op s * r
SVYMATH_API int MATRopS_R(TMatrix& result, const TSMatrix& s, const TMatrix& r, char op);
// result op a^T * q * l: the right-hand side A^T P l of normal equations with a symmetric weight q.
SVYMATH_API int MRAtQL(TMatrix& result, const TMatrix& a, const TSMatrix& q, const TMatrix& l, char op);
// result op (a * b^T + b * a^T) / 2, the symmetric part of a * b^T (a * b^T itself when it is symmetric).
SVYMATH_API int SMATRopABti(TSMatrix& result, const TMatrix& a, const TMatrix& b, char op);
// result op r * s * r^T
SVYMATH_API int SMATRopR_S_Rt(TSMatrix& result, const TMatrix& r, const TSMatrix& s, char op);
// result op r^T * r
SVYMATH_API int SMATRopRt_R(TSMatrix& result, const TMatrix& r, char op);
// result op r^T * s * r
SVYMATH_API int SMATRopRt_S_R(TSMatrix& result, const TMatrix& r, const TSMatrix& s, char op);
// result = s1 op s2, element by element, with op '+' or '-' (the sum or difference of two symmetric
// matrices is symmetric, their product in general is not).
SVYMATH_API int SMATRopS1_S2(TSMatrix& result, const TSMatrix& s1, const TSMatrix& s2, char op);

}  // namespace svy_math

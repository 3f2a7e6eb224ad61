#include "svymath/adjustment/matrix_products.h"

#include "svymath/adjustment/matrix_accumulate.h"

namespace svy_math {

namespace {

constexpr int kShapeMismatch = -1;

// Read-only views of an operand, 1-based, optionally transposed, so that one product routine serves every
// combination of general, symmetric and transposed operands.
struct GeneralView {
  const TMatrix& m;
  bool transposed;
  int rows() const { return transposed ? m.cols() : m.rows(); }
  int cols() const { return transposed ? m.rows() : m.cols(); }
  double operator()(int i, int j) const { return transposed ? m(j, i) : m(i, j); }
};

struct SymmetricView {
  const TSMatrix& s;
  int rows() const { return s.order(); }
  int cols() const { return s.order(); }
  double operator()(int i, int j) const { return s(i, j); }
};

struct MatrixView {
  const TMatrix& m;
  int rows() const { return m.rows(); }
  int cols() const { return m.cols(); }
  double operator()(int i, int j) const { return m(i, j); }
};

GeneralView plain(const TMatrix& m) { return GeneralView{m, false}; }
GeneralView transposed(const TMatrix& m) { return GeneralView{m, true}; }
SymmetricView symmetric(const TSMatrix& s) { return SymmetricView{s}; }

template <class A, class B>
bool conformable(const A& a, const B& b) {
  return a.cols() == b.rows();
}

// The product a * b (shapes already checked).
template <class A, class B>
TMatrix product(const A& a, const B& b) {
  TMatrix p(a.rows(), b.cols());
  for (int j = 1; j <= b.cols(); ++j)
    for (int i = 1; i <= a.rows(); ++i) {
      double sum = 0.0;
      for (int k = 1; k <= a.cols(); ++k) sum += a(i, k) * b(k, j);
      p(i, j) = sum;
    }
  return p;
}

int applyGeneral(TMatrix& result, const TMatrix& value, char op) {
  if (result.rows() != value.rows() || result.cols() != value.cols()) return kShapeMismatch;
  for (int j = 1; j <= value.cols(); ++j)
    for (int i = 1; i <= value.rows(); ++i) detail::accumulate(result(i, j), value(i, j), op);
  return 0;
}

// Applies the lower triangle of a square product that is symmetric by construction.
int applySymmetric(TSMatrix& result, const TMatrix& value, char op) {
  if (value.rows() != value.cols() || result.order() != value.rows()) return kShapeMismatch;
  for (int i = 1; i <= value.rows(); ++i)
    for (int j = 1; j <= i; ++j) detail::accumulate(result(i, j), value(i, j), op);
  return 0;
}

template <class A, class B>
int generalProduct(TMatrix& result, const A& a, const B& b, char op) {
  if (!detail::isAccumulationOperator(op) || !conformable(a, b)) return kShapeMismatch;
  if (result.rows() != a.rows() || result.cols() != b.cols()) return kShapeMismatch;
  return applyGeneral(result, product(a, b), op);
}

template <class A, class B, class C>
int generalProduct(TMatrix& result, const A& a, const B& b, const C& c, char op) {
  if (!detail::isAccumulationOperator(op) || !conformable(a, b) || !conformable(b, c)) return kShapeMismatch;
  if (result.rows() != a.rows() || result.cols() != c.cols()) return kShapeMismatch;
  const TMatrix ab = product(a, b);
  return applyGeneral(result, product(MatrixView{ab}, c), op);
}

template <class A, class B>
int symmetricProduct(TSMatrix& result, const A& a, const B& b, char op) {
  if (!detail::isAccumulationOperator(op) || !conformable(a, b)) return kShapeMismatch;
  if (a.rows() != b.cols() || result.order() != a.rows()) return kShapeMismatch;
  return applySymmetric(result, product(a, b), op);
}

template <class A, class B, class C>
int symmetricProduct(TSMatrix& result, const A& a, const B& b, const C& c, char op) {
  if (!detail::isAccumulationOperator(op) || !conformable(a, b) || !conformable(b, c)) return kShapeMismatch;
  if (a.rows() != c.cols() || result.order() != a.rows()) return kShapeMismatch;
  const TMatrix ab = product(a, b);
  return applySymmetric(result, product(MatrixView{ab}, c), op);
}

}  // namespace

int MATRopR1_R2(TMatrix& result, const TMatrix& r1, const TMatrix& r2, char op) {
  return generalProduct(result, plain(r1), plain(r2), op);
}

int MATRopR1_R2t(TMatrix& result, const TMatrix& r1, const TMatrix& r2, char op) {
  return generalProduct(result, plain(r1), transposed(r2), op);
}

int MATRopR1t_R2(TMatrix& result, const TMatrix& r1, const TMatrix& r2, char op) {
  return generalProduct(result, transposed(r1), plain(r2), op);
}

int MATRopR1_R2_R3t(TMatrix& result, const TMatrix& r1, const TMatrix& r2, const TMatrix& r3, char op) {
  return generalProduct(result, plain(r1), plain(r2), transposed(r3), op);
}

int MATRopR1_S_R2t(TMatrix& result, const TMatrix& r1, const TSMatrix& s, const TMatrix& r2, char op) {
  return generalProduct(result, plain(r1), symmetric(s), transposed(r2), op);
}

int MATRopR_S(TMatrix& result, const TMatrix& r, const TSMatrix& s, char op) {
  return generalProduct(result, plain(r), symmetric(s), op);
}

int MATRopS_R(TMatrix& result, const TSMatrix& s, const TMatrix& r, char op) {
  return generalProduct(result, symmetric(s), plain(r), op);
}

int MRAtQL(TMatrix& result, const TMatrix& a, const TSMatrix& q, const TMatrix& l, char op) {
  return generalProduct(result, transposed(a), symmetric(q), plain(l), op);
}

int SMATRopABti(TSMatrix& result, const TMatrix& a, const TMatrix& b, char op) {
  if (!detail::isAccumulationOperator(op)) return kShapeMismatch;
  if (a.rows() != b.rows() || a.cols() != b.cols() || result.order() != a.rows()) return kShapeMismatch;
  const TMatrix abt = product(plain(a), transposed(b));
  TMatrix symmetricPart(a.rows(), a.rows());
  for (int i = 1; i <= a.rows(); ++i)
    for (int j = 1; j <= a.rows(); ++j) symmetricPart(i, j) = 0.5 * (abt(i, j) + abt(j, i));
  return applySymmetric(result, symmetricPart, op);
}

int SMATRopR_S_Rt(TSMatrix& result, const TMatrix& r, const TSMatrix& s, char op) {
  return symmetricProduct(result, plain(r), symmetric(s), transposed(r), op);
}

int SMATRopRt_R(TSMatrix& result, const TMatrix& r, char op) {
  return symmetricProduct(result, transposed(r), plain(r), op);
}

int SMATRopRt_S_R(TSMatrix& result, const TMatrix& r, const TSMatrix& s, char op) {
  return symmetricProduct(result, transposed(r), symmetric(s), plain(r), op);
}

int SMATRopS1_S2(TSMatrix& result, const TSMatrix& s1, const TSMatrix& s2, char op) {
  if (op != kOpAdd && op != kOpSubtract) return kShapeMismatch;
  if (s1.order() != s2.order() || result.order() != s1.order()) return kShapeMismatch;
  for (int k = 0; k < s1.packedSize(); ++k)
    result.data()[k] = op == kOpAdd ? s1.data()[k] + s2.data()[k] : s1.data()[k] - s2.data()[k];
  return 0;
}

}  // namespace svy_math

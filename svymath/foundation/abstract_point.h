#pragma once
// Fixed-size points of doubles: exactly N contiguous components and nothing else, so that an array of points
// is an array of doubles and a point can be handed to numerical code as a pointer to its components.
//
// A 2-component point that carries a plan position is (northing, easting): component 0 is N, component 1 is
// E. The third component of a 3-component point is the height. Component access has no range check.
#include <cmath>
#include <cstdint>
#include <limits>
#include <type_traits>

#include "svymath/foundation/class_new.h"

#if defined(_WIN32)
#include <windows.h>
#else
// The integer screen point of the Windows API, for hosts without its headers.
struct POINT {
  long x;
  long y;
};
#endif

namespace svy_math {

template <class T, int N>
class TAbstractPoint {
  static_assert(N > 0, "a point has at least one component");

 public:
  SVY_CLASS_NEW_DELETE

  TAbstractPoint() = default;

  T& operator[](int i) { return m_comp[i]; }
  const T& operator[](int i) const { return m_comp[i]; }
  operator T*() { return m_comp; }
  operator const T*() const { return m_comp; }

  TAbstractPoint& operator=(T scalar) {
    for (int i = 0; i < N; ++i) m_comp[i] = scalar;
    return *this;
  }

  TAbstractPoint operator+(const TAbstractPoint& p) const {
    TAbstractPoint r(*this);
    return r += p;
  }
  TAbstractPoint operator-(const TAbstractPoint& p) const {
    TAbstractPoint r(*this);
    return r -= p;
  }
  TAbstractPoint operator-() const {
    TAbstractPoint r(*this);
    r.uminus();
    return r;
  }
  TAbstractPoint& operator+=(const TAbstractPoint& p) {
    for (int i = 0; i < N; ++i) m_comp[i] += p.m_comp[i];
    return *this;
  }
  TAbstractPoint& operator-=(const TAbstractPoint& p) {
    for (int i = 0; i < N; ++i) m_comp[i] -= p.m_comp[i];
    return *this;
  }

  TAbstractPoint operator*(T k) const {
    TAbstractPoint r(*this);
    return r *= k;
  }
  TAbstractPoint operator/(T k) const {
    TAbstractPoint r(*this);
    return r /= k;
  }
  TAbstractPoint& operator*=(T k) {
    for (int i = 0; i < N; ++i) m_comp[i] *= k;
    return *this;
  }
  TAbstractPoint& operator/=(T k) {
    for (int i = 0; i < N; ++i) m_comp[i] /= k;
    return *this;
  }

  // Component-wise product and quotient.
  TAbstractPoint& operator*=(const TAbstractPoint& p) {
    for (int i = 0; i < N; ++i) m_comp[i] *= p.m_comp[i];
    return *this;
  }
  TAbstractPoint operator/(const TAbstractPoint& p) const {
    TAbstractPoint r(*this);
    return r /= p;
  }
  TAbstractPoint& operator/=(const TAbstractPoint& p) {
    for (int i = 0; i < N; ++i) m_comp[i] /= p.m_comp[i];
    return *this;
  }

  // Dot product.
  T operator*(const TAbstractPoint& p) const {
    T s = T(0);
    for (int i = 0; i < N; ++i) s += m_comp[i] * p.m_comp[i];
    return s;
  }

  T ModuleSq() const { return (*this) * (*this); }
  T Module() const { return std::sqrt(ModuleSq()); }
  T sum() const {
    T s = T(0);
    for (int i = 0; i < N; ++i) s += m_comp[i];
    return s;
  }
  TAbstractPoint abs() const {
    TAbstractPoint r;
    for (int i = 0; i < N; ++i) r.m_comp[i] = std::fabs(m_comp[i]);
    return r;
  }
  TAbstractPoint maximum(const TAbstractPoint& p) const {
    TAbstractPoint r;
    for (int i = 0; i < N; ++i) r.m_comp[i] = m_comp[i] < p.m_comp[i] ? p.m_comp[i] : m_comp[i];
    return r;
  }
  TAbstractPoint minimum(const TAbstractPoint& p) const {
    TAbstractPoint r;
    for (int i = 0; i < N; ++i) r.m_comp[i] = p.m_comp[i] < m_comp[i] ? p.m_comp[i] : m_comp[i];
    return r;
  }
  void uminus() {
    for (int i = 0; i < N; ++i) m_comp[i] = -m_comp[i];
  }

  // Exact comparison of every component, no tolerance: a NaN component makes points unequal.
  bool operator==(const TAbstractPoint& p) const {
    for (int i = 0; i < N; ++i)
      if (!(m_comp[i] == p.m_comp[i])) return false;
    return true;
  }
  bool operator!=(const TAbstractPoint& p) const { return !(*this == p); }
  // True when every component equals the scalar exactly.
  bool operator==(T scalar) const {
    for (int i = 0; i < N; ++i)
      if (!(m_comp[i] == scalar)) return false;
    return true;
  }
  bool operator!=(T scalar) const { return !(*this == scalar); }

 protected:
  T m_comp[N];
};

template <class T>
class TAbstractPoint2 : public TAbstractPoint<T, 2> {
 public:
  using Base = TAbstractPoint<T, 2>;
  using Base::operator=;

  // Components undefined until set.
  TAbstractPoint2() = default;
  explicit TAbstractPoint2(T scalar) { this->m_comp[0] = this->m_comp[1] = scalar; }
  TAbstractPoint2(T c0, T c1) {
    this->m_comp[0] = c0;
    this->m_comp[1] = c1;
  }
  TAbstractPoint2(const Base& p) : Base(p) {}  // NOLINT: results of the base operators convert back
  // x to component 0, y to component 1.
  explicit TAbstractPoint2(const POINT& p) {
    this->m_comp[0] = static_cast<T>(p.x);
    this->m_comp[1] = static_cast<T>(p.y);
  }

  // A point holding a copy of the two values at p.
  static TAbstractPoint2 CreateFromPointer(const T* p) { return TAbstractPoint2(p[0], p[1]); }

  // Each component truncated toward zero to a 32-bit integer, no rounding. NaN gives 0 and values
  // beyond the 32-bit range are clamped to it, so that the conversion is always defined.
  explicit operator POINT() const {
    POINT p;
    p.x = truncateToInt32(this->m_comp[0]);
    p.y = truncateToInt32(this->m_comp[1]);
    return p;
  }

 private:
  static std::int32_t truncateToInt32(T v) {
    const double d = static_cast<double>(v);
    if (d != d) return 0;
    if (d >= 2147483647.0) return std::numeric_limits<std::int32_t>::max();
    if (d <= -2147483648.0) return std::numeric_limits<std::int32_t>::min();
    return static_cast<std::int32_t>(d);
  }
};

template <class T>
class TAbstractPoint3 : public TAbstractPoint<T, 3> {
 public:
  using Base = TAbstractPoint<T, 3>;
  using Base::operator=;

  // Components undefined until set.
  TAbstractPoint3() = default;
  explicit TAbstractPoint3(T scalar) { this->m_comp[0] = this->m_comp[1] = this->m_comp[2] = scalar; }
  TAbstractPoint3(T c0, T c1, T c2) { set(c0, c1, c2); }
  TAbstractPoint3(const Base& p) : Base(p) {}  // NOLINT: results of the base operators convert back

  static TAbstractPoint3 CreateFromPointer(const T* p) { return TAbstractPoint3(p[0], p[1], p[2]); }

  void set(const TAbstractPoint3& p) { *this = p; }
  void set(T c0, T c1, T c2) {
    this->m_comp[0] = c0;
    this->m_comp[1] = c1;
    this->m_comp[2] = c2;
  }

  // The cross product this x p.
  TAbstractPoint3 VectorProduct(const TAbstractPoint3& p) const {
    const T* a = this->m_comp;
    return TAbstractPoint3(a[1] * p[2] - a[2] * p[1], a[2] * p[0] - a[0] * p[2], a[0] * p[1] - a[1] * p[0]);
  }
  // Component-wise square root.
  TAbstractPoint3 sqrt() const {
    return TAbstractPoint3(std::sqrt(this->m_comp[0]), std::sqrt(this->m_comp[1]), std::sqrt(this->m_comp[2]));
  }
};

// A 2-D size: width cx (component 0) and height cy (component 1).
template <class T>
class TAbstractSize2 : public TAbstractPoint<T, 2> {
 public:
  using Base = TAbstractPoint<T, 2>;
  using Base::operator=;

  TAbstractSize2() = default;
  TAbstractSize2(T width, T height) {
    this->m_comp[0] = width;
    this->m_comp[1] = height;
  }
  // Component 0 becomes cx, component 1 cy.
  TAbstractSize2(const Base& p) : Base(p) {}  // NOLINT: results of the base operators convert back

  T& cx() { return this->m_comp[0]; }
  T cx() const { return this->m_comp[0]; }
  T& cy() { return this->m_comp[1]; }
  T cy() const { return this->m_comp[1]; }
};

// The layout guarantees numerical code relies on: the components and nothing else, no virtual table.
static_assert(sizeof(TAbstractPoint2<double>) == 2 * sizeof(double), "2-D point is two doubles");
static_assert(sizeof(TAbstractPoint3<double>) == 3 * sizeof(double), "3-D point is three doubles");
static_assert(sizeof(TAbstractSize2<double>) == 2 * sizeof(double), "size is two doubles");
static_assert(std::is_trivially_copyable<TAbstractPoint2<double>>::value, "points copy as bytes");
static_assert(std::is_trivially_copyable<TAbstractPoint3<double>>::value, "points copy as bytes");
static_assert(std::is_trivially_copyable<TAbstractSize2<double>>::value, "sizes copy as bytes");
static_assert(!std::is_polymorphic<TAbstractPoint3<double>>::value, "points have no virtual table");
static_assert(std::is_standard_layout<TAbstractPoint2<double>>::value, "points are plain arrays");

}  // namespace svy_math

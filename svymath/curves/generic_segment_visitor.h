#pragma once
// Visitors over the three kinds of plan-view segment, for double dispatch: a segment's Accept calls the
// Visit overload of its own kind (lines, including tangents and svy_math::TLine; arcs; spirals).
#include "svymath/foundation/export.h"

class CGenericLine;
class CGenericArc;
class CGenericSpiral;

class SVYMATH_API CGenericSegmentVisitor {
 public:
  virtual ~CGenericSegmentVisitor();
  virtual void Visit(CGenericLine& line) = 0;
  virtual void Visit(CGenericArc& arc) = 0;
  virtual void Visit(CGenericSpiral& spiral) = 0;
};

class SVYMATH_API CGenericSegmentVisitor_const {
 public:
  virtual ~CGenericSegmentVisitor_const();
  virtual void Visit(const CGenericLine& line) = 0;
  virtual void Visit(const CGenericArc& arc) = 0;
  virtual void Visit(const CGenericSpiral& spiral) = 0;
};

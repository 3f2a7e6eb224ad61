#pragma once
// Visitors over the four kinds of vertical element, for double dispatch: an element's Accept calls the
// Visit overload of its own kind.
#include "svymath/foundation/export.h"

class CVerticalElement;
class CVerticalLSElement;
class CAlntVeArc;
class CAlntVeLsWithArc;

class SVYMATH_API CAlntVeVisitor {
 public:
  virtual ~CAlntVeVisitor();
  virtual void Visit(CVerticalElement& element) = 0;
  virtual void Visit(CVerticalLSElement& element) = 0;
  virtual void Visit(CAlntVeArc& element) = 0;
  virtual void Visit(CAlntVeLsWithArc& element) = 0;
};

class SVYMATH_API CAlntVeVisitor_const {
 public:
  virtual ~CAlntVeVisitor_const();
  virtual void Visit(const CVerticalElement& element) = 0;
  virtual void Visit(const CVerticalLSElement& element) = 0;
  virtual void Visit(const CAlntVeArc& element) = 0;
  virtual void Visit(const CAlntVeLsWithArc& element) = 0;
};

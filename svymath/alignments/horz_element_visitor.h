#pragma once
// Visitors over the four kinds of horizontal alignment element, for double dispatch: an element's Accept
// calls the Visit overload of its own kind.
#include "svymath/foundation/export.h"

class CAlntHeSegment;
class CAlntHeArc;
class CAlntHeSpiral;
class CAlntHeIp;

class SVYMATH_API CAlntHeVisitor {
 public:
  virtual ~CAlntHeVisitor();
  virtual void Visit(CAlntHeSegment& element) = 0;
  virtual void Visit(CAlntHeArc& element) = 0;
  virtual void Visit(CAlntHeSpiral& element) = 0;
  virtual void Visit(CAlntHeIp& element) = 0;
};

class SVYMATH_API CAlntHeVisitor_const {
 public:
  virtual ~CAlntHeVisitor_const();
  virtual void Visit(const CAlntHeSegment& element) = 0;
  virtual void Visit(const CAlntHeArc& element) = 0;
  virtual void Visit(const CAlntHeSpiral& element) = 0;
  virtual void Visit(const CAlntHeIp& element) = 0;
};

#pragma once
// The small records of a profile (vertical alignment): the element kinds, the result codes of a height
// query, and one vertical intersection point.
//
// A profile is a function of chainage: chainages, lengths and heights are metres, grades percent (a grade
// of 2.5 rises 2.5 m per 100 m). Lengths along a vertical element are horizontal (chainage) distances from
// its start.
#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"

// The kind of a vertical element (getType).
enum TAlntVeType : int {
  eAlntVeStraight = 0,   // CVerticalElement holding a straight grade (or a zero-length height step)
  eAlntVeParabola = 1,   // CVerticalElement holding a symmetric parabola
  eAlntVeLs = 2,         // CVerticalLSElement: a grade and the parabola at the next intersection point
  eAlntVeArc = 3,        // CAlntVeArc: a circular vertical curve
  eAlntVeLsWithArc = 4,  // CAlntVeLsWithArc: a grade and the circular curve at its intersection point
};

// Result of a height query at a length from an element's start.
enum errCodes : int {
  eVeHtOk = 0,           // a height was computed
  eVeHtBeforeStart = 1,  // the length lies before the element (beyond the end snap): no height
  eVeHtAfterEnd = 2,     // the length lies after the element, or the element is undefined: no height
};

// One vertical intersection point (VIP): where the grade lines before and after it meet, and the vertical
// curve about it.
class SVYMATH_API CLsInfo {
 public:
  SVY_CLASS_NEW_DELETE

  // All values undefined (NaN).
  CLsInfo();
  CLsInfo(double ipChainage, double ipHeight, double curveLength, double curveStartChainage, double radius);

  // The chainage and height of the intersection point are defined.
  bool isok() const;

  double ipChainage;          // metres
  double ipHeight;            // metres
  double curveLength;         // horizontal length of the vertical curve about the point (0: none)
  double curveStartChainage;  // where that curve begins
  double radius;              // circular curves: the signed radius (negative crest); parabolas and grades: 0
};

#pragma once
// The transition-spiral laws the library knows. The numeric values are part of the interface: hosts store
// them with their alignment elements.

enum AlntMathSpiralType : int {
  eMathSpiralEuler = 1,  // clothoid: curvature grows linearly with length (CEulerSpiralTStoSC)
  eMathSpiralCubic = 2,  // cubic parabola: offset from the tangent is a*x^3 (CCubicSpiralTStoSC)
};

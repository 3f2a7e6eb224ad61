#pragma once
// Where a target lies on a field screen: an observer looks along a viewing azimuth and elevation with a
// rectangular field of view, and a target's direction lands on the screen or outside it.
//
// Conventions:
// - world positions are (northing, easting, height) in metres; azimuths are radians clockwise from north,
//   elevations radians up from the horizontal plane;
// - the observer's frame is (right, up, forward): forward along the view axis, right horizontal and to the
//   right of it (the view azimuth plus a quarter turn), up completing the frame (tilted back with the
//   elevation, so that it stays in the vertical plane of the view azimuth);
// - the screen is in pixels with its origin at the top-left corner, x to the right and y down; the view
//   axis meets it at the centre (width / 2, height / 2) and the cone's edges are the screen's edges
//   (x = 0 and x = width, y = 0 and y = height). Pixels are square, so the vertical field of view follows
//   from the horizontal one and the screen's shape: tan(vertical / 2) = tan(horizontal / 2) height / width.
#include "svymath/foundation/abstract_point.h"
#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"

namespace svy_math {

struct SVYMATH_API TViewParams {
  SVY_CLASS_NEW_DELETE

  // The observer's eye (N, E, H), metres.
  TAbstractPoint3<double> observer{0.0, 0.0, 0.0};
  // Direction of the view axis: azimuth (radians from north, clockwise) and elevation (radians up,
  // -pi/2 to pi/2).
  double azimuth = 0.0;
  double elevation = 0.0;
  // Horizontal field of view: the full angle between the screen's left and right edges (radians, between 0
  // and pi, both excluded).
  double fieldOfView = 0.0;
  // Screen size in pixels.
  int screenWidth = 0;
  int screenHeight = 0;

  // Finite values in the ranges above and a screen of at least one pixel each way.
  bool isValid() const;
  // The full angle between the screen's top and bottom edges (radians); NaN for an invalid view.
  double verticalFieldOfView() const;
};

// A target turned into the observer's frame (right, up, forward).
class SVYMATH_API T3dPosAndDirRotated {
 public:
  SVY_CLASS_NEW_DELETE

  // At the observer: position and direction zero.
  T3dPosAndDirRotated();
  // The target position (N, E, H) seen from the view's observer. The difference to the observer is taken
  // first, so survey coordinates lose no digits.
  T3dPosAndDirRotated(const TViewParams& view, const TAbstractPoint3<double>& target);
  // A target known by its direction only (a satellite's azimuth and elevation, radians): position and
  // direction are the unit vector.
  static T3dPosAndDirRotated FromDirection(const TViewParams& view, double azimuth, double elevation);

  // Target minus observer in the observer's frame (metres).
  TAbstractPoint3<double> pos;
  // pos as a unit vector; zero when the target is at the observer (it has no direction), NaN when the view
  // or the target is not finite.
  TAbstractPoint3<double> dir;

 private:
  T3dPosAndDirRotated(const TViewParams& view, double dN, double dE, double dH);
};

// The rectangular viewing cone of a view: its apex at the observer, its four faces through the screen's
// edges.
class SVYMATH_API TRectCone {
 public:
  SVY_CLASS_NEW_DELETE

  explicit TRectCone(const TViewParams& view);

  // False when the view is not valid; such a cone contains nothing and projects nothing.
  bool isValid() const { return m_valid; }
  // Whether a direction in the observer's frame (any length) lies inside the cone or on its faces
  // (within kViewConeEdge of the edge tangent). Directions behind the observer or zero are outside.
  bool contains(const TAbstractPoint3<double>& direction) const;
  bool contains(const T3dPosAndDirRotated& target) const { return contains(target.dir); }
  // The screen position (pixels, see the conventions above) where a direction in the observer's frame
  // lands. Directions in front of the observer but outside the cone land off the screen (negative or
  // beyond the size), which lets a caller draw an arrow toward them. False, x and y untouched, for a
  // direction not in front of the observer (forward <= 0) or one too close to the side for a finite
  // position, and for an invalid cone.
  bool toScreen(const TAbstractPoint3<double>& direction, double& x, double& y) const;
  bool toScreen(const T3dPosAndDirRotated& target, double& x, double& y) const {
    return toScreen(target.dir, x, y);
  }

 private:
  bool m_valid = false;
  // Tangents of half the horizontal and vertical fields of view.
  double m_tanHalfWidth = 0.0;
  double m_tanHalfHeight = 0.0;
  // Pixels per unit of tangent (the focal length in pixels) and the screen centre.
  double m_focal = 0.0;
  double m_centreX = 0.0;
  double m_centreY = 0.0;
};

}  // namespace svy_math

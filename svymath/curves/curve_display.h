#pragma once
// How the user entered an element's radius and length, so that an editor can show them again the same way.
// Both codes ride in the flags word of the arc and spiral curve data: bits 4-6 the radius display, bits 7-9
// the length display (3 bits each); the other bits belong to the host and are never touched here.
#include <cstdint>

// The form of the curvature value.
enum AlntElementRadiusDisplay : std::uint32_t {
  eRadiusDisplayRadius = 0,              // the radius itself
  eRadiusDisplayDegreeOfCurveArc = 1,    // degree of curve, arc definition: angle subtended by a 100-unit arc
  eRadiusDisplayDegreeOfCurveChord = 2,  // degree of curve, chord definition: angle subtended by a 100-unit chord
  eRadiusDisplaySpiralParameter = 3,     // spiral parameter A = sqrt(R L) (spirals)
};

// The form of the length value.
enum AlntElementLengthDisplay : std::uint32_t {
  eLengthDisplayArc = 0,           // length along the element
  eLengthDisplayChord = 1,         // straight start-to-end chord
  eLengthDisplayCentralAngle = 2,  // angle subtended at the centre (arcs)
  eLengthDisplayTangent = 3,       // tangent length from an end to the tangents' intersection (arcs)
};

namespace svy_math {

constexpr std::uint32_t kRadiusDisplayShift = 4;
constexpr std::uint32_t kLengthDisplayShift = 7;
constexpr std::uint32_t kDisplayFieldMask = 0x7;

inline AlntElementRadiusDisplay getRadiusDisplay(std::uint32_t flags) {
  return static_cast<AlntElementRadiusDisplay>((flags >> kRadiusDisplayShift) & kDisplayFieldMask);
}

inline AlntElementLengthDisplay getLengthDisplay(std::uint32_t flags) {
  return static_cast<AlntElementLengthDisplay>((flags >> kLengthDisplayShift) & kDisplayFieldMask);
}

// The flags word with the radius display replaced; the other bits are kept.
inline std::uint32_t withRadiusDisplay(std::uint32_t flags, AlntElementRadiusDisplay display) {
  return (flags & ~(kDisplayFieldMask << kRadiusDisplayShift)) |
         ((static_cast<std::uint32_t>(display) & kDisplayFieldMask) << kRadiusDisplayShift);
}

// The flags word with the length display replaced; the other bits are kept.
inline std::uint32_t withLengthDisplay(std::uint32_t flags, AlntElementLengthDisplay display) {
  return (flags & ~(kDisplayFieldMask << kLengthDisplayShift)) |
         ((static_cast<std::uint32_t>(display) & kDisplayFieldMask) << kLengthDisplayShift);
}

}  // namespace svy_math

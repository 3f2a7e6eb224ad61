#pragma once
// Source names under which the alignment code logs unexpected internal states (vertical arcs log a
// length outside the element).
namespace svy_math {

constexpr const char* kAlntElementsLogSource = "mathAlntElements";
constexpr const char* kAlntsLogSource = "mathAlnts";

}  // namespace svy_math

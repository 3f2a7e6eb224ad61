#pragma once
// Source name under which the road code logs unexpected internal states.
namespace svy_math {

constexpr const char* kRoadTemplLogSource = "roadtempl";

}  // namespace svy_math

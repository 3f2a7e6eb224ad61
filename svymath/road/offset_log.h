#pragma once
// Source name under which the offset points and offset alignments log unexpected internal states.
namespace svy_math {

constexpr const char* kOffsetPointsLogSource = "offsetpoints";

}  // namespace svy_math

#pragma once
// Source name under which the position caches and the control-coded lines log unexpected internal states.
namespace svy_math {

constexpr const char* kAlntCacheLogSource = "mathAlntCache";

}  // namespace svy_math

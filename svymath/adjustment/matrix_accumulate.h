#pragma once
// The accumulation operators of the matrix products ('=', '+', '-'), applied to one element.
namespace svy_math {
namespace detail {

inline bool isAccumulationOperator(char op) { return op == '=' || op == '+' || op == '-'; }

// target = value, target += value or target -= value; op must be an accumulation operator.
inline void accumulate(double& target, double value, char op) {
  if (op == '=')
    target = value;
  else if (op == '+')
    target += value;
  else
    target -= value;
}

}  // namespace detail
}  // namespace svy_math

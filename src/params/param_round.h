#pragma once

#include <climits>
#include <cmath>

namespace plugcore {

// Rounding used by parameter mappings and texts: nearest, halves upward.
inline double round_half_up(double x) { return std::floor(x + 0.5); }

// The same, as an int for "%d" texts; saturates instead of overflowing, and a
// NaN reads as 0, so no text conversion can reach undefined behaviour.
inline int round_half_up_int(double x) {
  double r = std::floor(x + 0.5);
  if (!(r == r)) {
    return 0;
  }
  if (r >= static_cast<double>(INT_MAX)) {
    return INT_MAX;
  }
  if (r <= static_cast<double>(INT_MIN)) {
    return INT_MIN;
  }
  return static_cast<int>(r);
}

}  // namespace plugcore

#pragma once

#include <cfenv>

namespace plugcore {

// Rounds to nearest for the lifetime of the guard and restores the caller's mode:
// the host's own rounding mode must not leak into the engine's arithmetic.
class RoundingModeGuard {
 public:
  RoundingModeGuard() : saved_(std::fegetround()) {
    if (saved_ != FE_TONEAREST) {
      std::fesetround(FE_TONEAREST);
    }
  }
  ~RoundingModeGuard() {
    if (saved_ != FE_TONEAREST) {
      std::fesetround(saved_);
    }
  }
  RoundingModeGuard(const RoundingModeGuard&) = delete;
  RoundingModeGuard& operator=(const RoundingModeGuard&) = delete;

 private:
  int saved_;
};

}  // namespace plugcore

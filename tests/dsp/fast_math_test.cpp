#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "dsp/fast_math.h"

namespace {

// The same quadratic in double, from frexp instead of bit fields.
double reference_log2(double v) {
  int e;
  const double m = 2.0 * std::frexp(v, &e);  // 1 <= m < 2, v = m 2^(e-1)
  return (2.0 - m * double(1.0f / 3.0f)) * m - double(2.0f / 3.0f) + (e - 2);
}

double reference_exp2(double t) {
  const double j = std::floor(t);
  const double u = 1.0 + (t - j);
  return std::ldexp(u * u * double(1.0f / 3.0f) + double(2.0f / 3.0f), int(j));
}

}  // namespace

TEST(FastMath, Exp2IsExactAtIntegers) {
  for (int n = -126; n <= 127; ++n) EXPECT_EQ(fast_exp2(float(n)), std::ldexp(1.0f, n)) << n;
}

TEST(FastMath, Log2AtPowersOfTwo) {
  // The float constants 1/3 and 2/3 sum to 1 + 2^-25, so the mantissa part at
  // m = 1 is 1 - 2^-24; that survives only in the octaves 0 and 1.
  for (int n = -126; n <= 127; ++n) {
    const float v = std::ldexp(1.0f, n);
    if (n == 0 || n == 1) {
      EXPECT_NEAR(fast_log2(v), double(n), std::ldexp(1.0, -24)) << n;
    } else {
      EXPECT_EQ(fast_log2(v), float(n)) << n;
    }
  }
}

TEST(FastMath, MatchesDoubleReferenceAcrossRange) {
  for (double v = 1e-30; v < 1e30; v *= 1.37) {
    EXPECT_NEAR(fast_log2(float(v)), reference_log2(double(float(v))), 1e-6 * (1.0 + std::fabs(std::log2(v))))
        << v;
  }
  for (double t = -125.9; t < 127.0; t += 0.173) {
    const double r = reference_exp2(double(float(t)));
    EXPECT_NEAR(fast_exp2(float(t)) / r, 1.0, 1e-6) << t;
  }
}

TEST(FastMath, InvertEachOtherOnAnOctave) {
  for (int octave : {-20, 0, 7}) {
    for (int i = 0; i < 64; ++i) {
      const float v = std::ldexp(1.0f + i / 64.0f, octave);
      const float back = fast_exp2(fast_log2(v));
      EXPECT_NEAR(back / v, 1.0, 0.01) << v;  // two quadratics, not exact inverses
      EXPECT_NEAR(fast_log2(v), std::log2(double(v)), 0.01) << v;
    }
  }
}

TEST(FastMath, Exp2StaysContinuousJustBelowZero) {
  // t - floor(t) rounds up to 1 here; the result must stay near 1, not halve.
  for (float t : {-1e-9f, -1e-8f, -2.9e-8f, -6e-8f}) EXPECT_NEAR(fast_exp2(t), 1.0, 1e-6) << t;
  EXPECT_NEAR(fast_exp2(-1.0f - 1e-9f), 0.5, 1e-6);
}

TEST(FastMath, Exp2IsSafeOutOfRangeAndOnNan) {
  const float inf = std::numeric_limits<float>::infinity();
  const float nan = std::numeric_limits<float>::quiet_NaN();
  for (float t : {-127.0f, -200.0f, -1e30f, -inf}) {
    const float r = fast_exp2(t);
    EXPECT_TRUE(r == 0.0f || r == std::numeric_limits<float>::min()) << t;
  }
  for (float t : {127.99f, 128.0f, 300.0f, 1e30f, inf}) {
    const float r = fast_exp2(t);
    EXPECT_TRUE(std::isfinite(r)) << t;
    EXPECT_GE(r, std::ldexp(1.0f, 127)) << t;
  }
  const float r = fast_exp2(nan);
  EXPECT_TRUE(std::isfinite(r));
  EXPECT_GE(r, 0.0f);
}

TEST(FastMath, Log2OfOddInputsIsDefined) {
  EXPECT_TRUE(std::isfinite(fast_log2(0.0f)));
  EXPECT_LT(fast_log2(0.0f), -126.0f);
  EXPECT_TRUE(std::isfinite(fast_log2(std::numeric_limits<float>::infinity())));
  EXPECT_TRUE(std::isfinite(fast_log2(std::numeric_limits<float>::denorm_min())));
}

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <vector>

#include "dsp/distortion_curves.h"
#include "dsp/shaper_table.h"

namespace {

const double kPi = 3.14159265358979323846;

// The curves written out again, independently of the tables.
double curve(int c, double x) {
  switch (c) {
    case 0: return 2.0 / kPi * std::atan(kPi * x / 2.0);
    case 1: return x / (1.0 + std::fabs(x));
    case 2: return std::copysign(std::log1p(std::fabs(x)), x);
    case 3: return x >= 0 ? 1.0 - std::cos(x) * std::exp(-x) : std::exp(x) * std::cos(x) - 1.0;
    case 4: {
      const double k = 1.0 + std::exp(-0.75 * std::sqrt(std::fabs(x)));
      return (std::exp(x) - std::exp(-k * x)) / (std::exp(x) + std::exp(-x));
    }
    case 5: return (std::exp(x - 1) - std::exp(-x) + 1 - std::exp(-1.0)) / (std::exp(x - 1) + std::exp(-x));
    case 9: return std::sin(x);
    case 10: {
      auto sinc = [](double u) { return u == 0 ? 1.0 : std::sin(kPi * u) / (kPi * u); };
      return x < 0 ? std::expm1(x) - sinc(x + 3) : -std::expm1(-x) + sinc(x - 3);
    }
  }
  return 0.0;
}

struct Tabulated {
  int curve, h;
  double f1, fm1, fh, fmh;  // reference values of the curve at 1, -1, h, -h
  double interp_bound;      // largest error of the cubic between knots
};

const Tabulated kTabulated[] = {
    {0, 32, 0.639093, -0.639093, 0.987337, -0.987337, 0.02},
    {1, 16, 0.5, -0.5, 0.941176, -0.941176, 0.015},
    {2, 32, 0.693147, -0.693147, 3.496508, -3.496508, 0.005},
    {3, 16, 0.801234, -0.801234, 1.000000, -1.000000, 0.008},
    {4, 7, 0.806471, -1.293406, 0.999999, -2.617772, 0.02},
    {5, 8, 0.924234, -0.683633, 1.000576, -0.999788, 0.008},
    {9, 4, 0.841471, -0.841471, -0.756802, 0.756802, 0.004},
    {10, 32, 0.632121, -0.632121, 1.000000, -1.000000, 0.035},
};

float run_curve(int c, float x, float gain = 1.0f) {
  float memory = 0.0f;
  apply_curve(c, &x, 1, gain, 1e9f, memory);
  return x;
}

}  // namespace

TEST(ShaperTable, KnotsMatchReferenceValues) {
  for (const Tabulated& t : kTabulated) {
    const ShaperTable* table = curve_table(t.curve);
    ASSERT_NE(table, nullptr);
    ASSERT_EQ(table->half_range(), t.h);
    EXPECT_NEAR(table->lookup(1.0f), t.f1, 1.5e-6) << t.curve;
    EXPECT_NEAR(table->lookup(-1.0f), t.fm1, 1.5e-6) << t.curve;
    EXPECT_NEAR(table->high_end(), t.fh, 1.5e-6) << t.curve;
    EXPECT_NEAR(table->low_end(), t.fmh, 1.5e-6) << t.curve;
  }
}

TEST(ShaperTable, EveryKnotFromBothSegmentsAndSlopes) {
  for (const Tabulated& t : kTabulated) {
    const ShaperTable* table = curve_table(t.curve);
    for (int j = -t.h; j <= t.h; ++j) {
      const double f = curve(t.curve, j);
      const double slope = (curve(t.curve, j + 1e-6) - curve(t.curve, j - 1e-6)) / 2e-6;
      // Segment on the left ends at j, segment on the right starts at j.
      for (int seg : {j - 1, j}) {
        if (seg < -t.h || seg >= t.h) continue;
        const double c0 = table->coef(seg, 0), c1 = table->coef(seg, 1), c2 = table->coef(seg, 2),
                     c3 = table->coef(seg, 3);
        const double value = ((c3 * j + c2) * j + c1) * j + c0;
        const double deriv = (3 * c3 * j + 2 * c2) * j + c1;
        EXPECT_NEAR(value, f, 3e-5) << "curve " << t.curve << " knot " << j << " segment " << seg;
        // The slope is a central difference over +-2^-11; curves 1, 2 and 4 are
        // not smooth at 0, where the two differ.
        const bool rough = j == 0 && (t.curve == 1 || t.curve == 2 || t.curve == 4);
        if (!rough) {
          EXPECT_NEAR(deriv, slope, 2e-3 * (1.0 + std::fabs(j) * std::fabs(j))) << "curve " << t.curve << " knot " << j;
        }
      }
    }
  }
}

TEST(ShaperTable, InterpolationErrorIsBoundedBetweenKnots) {
  for (const Tabulated& t : kTabulated) {
    const ShaperTable* table = curve_table(t.curve);
    double worst = 0.0;
    for (int i = -t.h * 200; i < t.h * 200; ++i) {
      const float x = float((i + 0.37) / 200.0);
      worst = std::max(worst, std::fabs(table->lookup(x) - curve(t.curve, x)));
    }
    EXPECT_LT(worst, t.interp_bound) << "curve " << t.curve;
    EXPECT_GT(worst, 0.0) << "curve " << t.curve;  // a cubic is not the curve itself
  }
}

TEST(ShaperTable, HoldsEndValuesAndSurvivesNanAndEdges) {
  const float inf = std::numeric_limits<float>::infinity();
  for (const Tabulated& t : kTabulated) {
    const ShaperTable* table = curve_table(t.curve);
    const float h = float(t.h);
    for (float x : {h, h + 0.5f, 1e30f, inf}) EXPECT_EQ(table->lookup(x), table->high_end()) << t.curve;
    for (float x : {-h, -h - 0.5f, -1e30f, -inf}) EXPECT_EQ(table->lookup(x), table->low_end()) << t.curve;
    const float below = std::nextafter(h, 0.0f);
    EXPECT_NEAR(table->lookup(below), t.fh, 1e-4) << t.curve;
    const float above = std::nextafter(-h, 0.0f);
    EXPECT_NEAR(table->lookup(above), t.fmh, 1e-4) << t.curve;
    EXPECT_TRUE(std::isfinite(table->lookup(std::numeric_limits<float>::quiet_NaN()))) << t.curve;
  }
  EXPECT_NEAR(run_curve(kCurvePuncher, 5.0f, 2.0f), 2.0 * std::sin(4.0), 2e-6);
  EXPECT_NEAR(run_curve(kCurveTubeSym1, 100.0f), 2.0 / kPi * std::atan(16.0 * kPi), 1e-6);
  EXPECT_NEAR(run_curve(kCurveTubeSym2, -40.0f), -16.0 / 17.0, 1e-6);
  EXPECT_NEAR(run_curve(kCurveTubeSym3, 1e6f), std::log(33.0), 1e-6);
}

TEST(ShaperTable, RejectsHalfRangeItCannotHold) {
  EXPECT_THROW(ShaperTable([](double x) { return x; }, 0), std::runtime_error);
  EXPECT_THROW(ShaperTable([](double x) { return x; }, 33), std::runtime_error);
  const ShaperTable line([](double x) { return 0.5 * x - 1.0; }, 3);  // cubic reproduces a line
  for (float x : {-2.9f, -0.4f, 0.0f, 1.25f, 2.99f}) EXPECT_NEAR(line.lookup(x), 0.5 * x - 1.0, 1e-6);
}

TEST(DistortionCurves, TableCurvesScaleByGain) {
  const std::vector<float> input = {-40.0f, -3.3f, -1.0f, -0.2f, 0.0f, 0.01f, 0.7f, 2.5f, 9.0f};
  for (int c : {0, 1, 2, 3, 4, 5, 9, 10}) {
    std::vector<float> buf = input;
    float memory = 0.0f;
    apply_curve(c, buf.data(), int(buf.size()), 0.3f, 0.01f, memory);
    for (size_t i = 0; i < input.size(); ++i) EXPECT_EQ(buf[i], curve_table(c)->lookup(input[i]) * 0.3f) << c;
    EXPECT_EQ(memory, 0.0f);
  }
}

TEST(DistortionCurves, DirectCurves) {
  // Hardclip: gain after clipping.
  EXPECT_EQ(run_curve(kCurveHardclip, 3.0f, 0.5f), 0.5f);
  EXPECT_EQ(run_curve(kCurveHardclip, -1.5f, 0.5f), -0.5f);
  EXPECT_EQ(run_curve(kCurveHardclip, 0.25f, 2.0f), 0.5f);
  // SmartE 2: zero at |x| = 0.5 and one at x = 1.
  EXPECT_EQ(run_curve(kCurveSmartE2, 0.5f, 3.0f), 0.0f);
  EXPECT_EQ(run_curve(kCurveSmartE2, -0.5f, 3.0f), 0.0f);
  EXPECT_NEAR(run_curve(kCurveSmartE2, 1.0f, 0.8f), 0.8, 1e-7);
  for (double x : {-7.0, -1.1, -0.3, 0.0, 0.2, 0.75, 1.9, 12.0}) {
    const double a = std::fabs(x);
    EXPECT_NEAR(run_curve(kCurveSmartE1, float(x), 0.9f), 0.9 * x * (a + 0.5) / (x * x - 0.5 * a + 1.0), 1e-6);
    EXPECT_NEAR(run_curve(kCurveSmartE2, float(x), 0.9f), 0.9 * x * (a - 0.5) / (x * x - 1.5 * a + 1.0), 1e-6);
  }
}

TEST(DistortionCurves, FactorsByCurve) {
  for (int c = 0; c < kCurveCount; ++c) {
    const bool boosted = c == kCurveTubeAsym2 || c == kCurveHardclip;
    EXPECT_EQ(kCurveDriveFactor[c], boosted ? 1.25f : 1.0f) << c;
    EXPECT_EQ(kCurveOutputFactor[c], boosted ? 0.8f : 1.0f) << c;
    EXPECT_EQ(curve_drive_factor(c), kCurveDriveFactor[c]);
  }
  EXPECT_EQ(curve_drive_factor(-3), kCurveDriveFactor[0]);
  EXPECT_EQ(curve_output_factor(99), kCurveOutputFactor[12]);
  EXPECT_EQ(curve_table(kCurveSlewRate1), curve_table(kCurveTubeSym1));
  EXPECT_EQ(curve_table(kCurveSlewRate2), curve_table(kCurveTubeSym1));
  EXPECT_EQ(curve_table(kCurveHardclip), nullptr);
}

TEST(DistortionCurves, SlewRate1ReachesHalfAfter23SamplesAt44100) {
  const float step = 1000.0f / 44100.0f;
  std::vector<float> buf(40, 1.0f);
  buf[0] = 0.0f;
  float memory = 0.0f;
  apply_curve(kCurveSlewRate1, buf.data(), 20, 1.0f, step, memory);  // split call: memory carries
  apply_curve(kCurveSlewRate1, buf.data() + 20, 20, 1.0f, step, memory);
  EXPECT_EQ(buf[0], 0.0f);
  // The step arrives at sample 1; 22 samples later the output is still below 0.5.
  EXPECT_LT(buf[22], 0.5f);
  EXPECT_GE(buf[23], 0.5f);
  for (int i = 1; i <= 28; ++i) EXPECT_NEAR(buf[i], i * step, 1e-5) << i;
  EXPECT_NEAR(buf[39], curve(0, 1.0), 1e-6);  // settled on the curve value
  EXPECT_EQ(memory, buf[39]);
}

TEST(DistortionCurves, SlewRate2LimitsBeforeTheCurveAndScalesAfter) {
  const float step = 0.05f;
  std::vector<float> buf(30, 1.0f);
  float memory = 0.0f;
  apply_curve(kCurveSlewRate2, buf.data(), 30, 2.0f, step, memory);
  for (int i = 0; i < 19; ++i) EXPECT_NEAR(buf[i], 2.0 * curve(0, (i + 1) * 0.05), 2 * 0.02) << i;
  EXPECT_NEAR(buf[29], 2.0 * curve(0, 1.0), 1e-5);
  EXPECT_NEAR(memory, 1.0f, 1e-6);
  // Falling: the limiter moves down by the step too.
  std::vector<float> down(3, -1.0f);
  apply_curve(kCurveSlewRate2, down.data(), 3, 1.0f, step, memory);
  EXPECT_NEAR(memory, 1.0f - 3 * step, 1e-6);
}

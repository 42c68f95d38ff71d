#include <gtest/gtest.h>

#include <cmath>
#include <vector>

#include "dsp/half_band_decimator.h"
#include "dsp/response_helpers.h"

using namespace dsp_test;

namespace {

HalfBandDecimator make(double attenuation, double transition) {
  HalfBandDecimator d;
  d.set_coefs(HalfBandDecimator::design(attenuation, transition));
  return d;
}

// Output level in dB of a unit sine at f (fraction of the input rate).
double sine_gain_db(HalfBandDecimator& d, double f) {
  d.reset();
  const int m = 8192;
  std::vector<float> in = sine(f, 1.0, 2 * m);
  std::vector<float> out(m);
  d.process(in.data(), out.data(), m);
  double power = 0.0;
  for (int i = m / 2; i < m; ++i) power += double(out[i]) * out[i];
  return 10.0 * std::log10(power / (m / 2) / 0.5);
}

}  // namespace

TEST(HalfBandDecimator, DesignReproducesKnownCoefficients) {
  const std::vector<double> stage1 = HalfBandDecimator::design(69.0, 0.2);
  const double expected1[] = {0.081430023, 0.315659840, 0.709770800};
  ASSERT_EQ(stage1.size(), 3u);
  for (int i = 0; i < 3; ++i) EXPECT_NEAR(stage1[i], expected1[i], 2e-9) << i;

  const std::vector<double> stage2 = HalfBandDecimator::design(69.0, 0.01);
  const double expected2[] = {0.077115080, 0.265968527, 0.482070625, 0.665104153,
                              0.796820471, 0.884101509, 0.941251428, 0.982005414};
  ASSERT_EQ(stage2.size(), 8u);
  for (int i = 0; i < 8; ++i) EXPECT_NEAR(stage2[i], expected2[i], 2e-9) << i;
}

TEST(HalfBandDecimator, DesignOrderAndBadInput) {
  // A loose filter still gets order 3: one coefficient.
  EXPECT_EQ(HalfBandDecimator::design(10.0, 0.45).size(), 1u);
  // Coefficients of a design lie in (0, 1) and rise.
  const std::vector<double> c = HalfBandDecimator::design(96.0, 0.05);
  ASSERT_GT(c.size(), 3u);
  for (size_t i = 0; i < c.size(); ++i) {
    EXPECT_GT(c[i], 0.0);
    EXPECT_LT(c[i], 1.0);
    if (i > 0) {
      EXPECT_GT(c[i], c[i - 1]);
    }
  }
  EXPECT_THROW(HalfBandDecimator::design(69.0, 0.0), std::runtime_error);
  EXPECT_THROW(HalfBandDecimator::design(69.0, 0.5), std::runtime_error);
  HalfBandDecimator d;
  EXPECT_THROW(d.set_coefs(std::vector<double>(9, 0.5)), std::runtime_error);
}

TEST(HalfBandDecimator, ConstantSettlesToOne) {
  for (double t : {0.2, 0.01}) {
    HalfBandDecimator d = make(69.0, t);
    std::vector<float> buf(4000, 1.0f);
    d.process(buf.data(), buf.data(), 2000);  // in place
    EXPECT_NEAR(buf[1999], 1.0f, 3e-6) << t;  // float rounding inside the allpasses
  }
}

TEST(HalfBandDecimator, PassbandFlatStopbandAttenuated) {
  HalfBandDecimator s1 = make(69.0, 0.2);  // pass up to 0.15, stop from 0.35 of the input rate
  EXPECT_NEAR(sine_gain_db(s1, 0.05), 0.0, 0.01);
  EXPECT_NEAR(sine_gain_db(s1, 0.14), 0.0, 0.05);
  for (double f : {0.36, 0.4, 0.45, 0.49}) EXPECT_LT(sine_gain_db(s1, f), -68.0) << f;

  HalfBandDecimator s2 = make(69.0, 0.01);  // pass up to 0.245, stop from 0.255
  EXPECT_NEAR(sine_gain_db(s2, 0.1), 0.0, 0.01);
  EXPECT_NEAR(sine_gain_db(s2, 0.24), 0.0, 0.05);
  for (double f : {0.256, 0.3, 0.4, 0.47}) EXPECT_LT(sine_gain_db(s2, f), -68.0) << f;
}

TEST(HalfBandDecimator, MatchesDoubleAllpassReferenceAndResets) {
  HalfBandDecimator d = make(69.0, 0.2);
  const std::vector<float> in = noise(600, 21);
  std::vector<float> out(300);
  d.process(in.data(), out.data(), 100);
  d.process(in.data() + 200, out.data() + 100, 200);

  double xp[3] = {0, 0, 0}, yp[3] = {0, 0, 0};
  auto allpass = [&](int k, double x) {
    const double y = d.get_coef(k) * (x - yp[k]) + xp[k];
    xp[k] = x;
    yp[k] = y;
    return y;
  };
  for (int i = 0; i < 300; ++i) {
    const double a = allpass(2, allpass(0, in[2 * i + 1]));
    const double b = allpass(1, in[2 * i]);
    ASSERT_NEAR(out[i], 0.5 * (a + b), 1e-5) << i;
  }

  d.reset();
  std::vector<float> again(300);
  d.process(in.data(), again.data(), 300);
  EXPECT_EQ(again, out);
}

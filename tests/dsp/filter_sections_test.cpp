#include <gtest/gtest.h>

#include <cmath>
#include <vector>

#include "dsp/biquad_section.h"
#include "dsp/first_order_section.h"
#include "dsp/response_helpers.h"

using namespace dsp_test;

namespace {

double section_magnitude(const BiquadSection& s, double f, double rate) {
  return digital_magnitude(s.b0(), s.b1(), s.b2(), s.a1(), s.a2(), f, rate);
}

// Direct-form recursion in double on the section's own float coefficients;
// offset_at[i] says whether 1e-20 joins b0*x at sample i.
std::vector<double> reference_run(const BiquadSection& s, const std::vector<float>& x,
                                  const std::vector<bool>& offset_at) {
  std::vector<double> y(x.size());
  double x1 = 0, x2 = 0, y1 = 0, y2 = 0;
  for (size_t i = 0; i < x.size(); ++i) {
    const double v = s.b0() * double(x[i]) + (offset_at[i] ? double(1e-20f) : 0.0) + s.b1() * x1 +
                     s.b2() * x2 - (s.a1() * y1 + s.a2() * y2);
    x2 = x1;
    x1 = x[i];
    y2 = y1;
    y1 = v;
    y[i] = v;
  }
  return y;
}

}  // namespace

TEST(BiquadSection, TypedResponsesMatchAnalogPrototypeUnderBilinearMap) {
  struct Case {
    int type;
    float p, q, freq, rate;
  };
  const Case cases[] = {{0, 0.7071068f, 1.0f, 1000.0f, 44100.0f}, {0, 1.847759f, 1.0f, 250.0f, 48000.0f},
                        {1, 0.7071068f, 1.0f, 3000.0f, 44100.0f}, {2, 4.0f, 2.0f, 1500.0f, 44100.0f},
                        {2, 0.25f, 0.7f, 8000.0f, 96000.0f},      {3, 1.0f, 3.0f, 500.0f, 22050.0f}};
  for (const Case& c : cases) {
    TypedBiquadSection s;
    s.set_type(c.type);
    s.set_p(c.p);
    s.set_q(c.q);
    s.set_sample_rate(c.rate);
    s.set_frequency(c.freq);
    s.set_type_coefs();
    s.compute_coefs();
    // Prototype by type, written out independently.
    double n[3], d[3] = {1.0, 0.0, 1.0};
    const double p = c.p, q = c.q;
    switch (c.type) {
      case 0: n[0] = 1, n[1] = 0, n[2] = 0, d[1] = 1 / p; break;
      case 1: n[0] = 0, n[1] = 0, n[2] = 1, d[1] = 1 / p; break;
      case 2: n[0] = 1, n[1] = p / q, n[2] = 1, d[1] = 1 / q; break;
      default: n[0] = 0, n[1] = p / q, n[2] = 0, d[1] = 1 / q; break;
    }
    for (double f : {20.0, 0.3 * c.freq, 0.9 * c.freq, double(c.freq), 1.7 * c.freq, 0.4 * c.rate}) {
      const double expected = analog_magnitude(n[0], n[1], n[2], d[0], d[1], d[2], warped(f, c.freq, c.rate));
      EXPECT_NEAR(section_magnitude(s, f, c.rate), expected, 1e-5 + 1e-4 * expected)
          << "type " << c.type << " at " << f << " Hz";
    }
  }
}

TEST(BiquadSection, ButterworthLowPassPassesDcAndHalfPowerAtCutoff) {
  TypedBiquadSection s;
  s.set_type(TypedBiquadSection::kLowPass);
  s.set_p(float(1.0 / std::sqrt(2.0)));
  s.set_type_coefs();
  s.compute_coefs();  // 1000 Hz at 44100 Hz from construction
  // Float coefficients leave a few parts per million.
  EXPECT_NEAR(section_magnitude(s, 0.0, 44100.0), 1.0, 1e-5);
  EXPECT_NEAR(section_magnitude(s, 1000.0, 44100.0), 1.0 / std::sqrt(2.0), 1e-5);
  // The recursion itself, measured with a sine at the cut-off.
  std::vector<float> x = sine(1000.0, 44100.0, 44100);
  std::vector<float> y(x.size());
  s.process(x.data(), y.data(), int(x.size()));
  EXPECT_NEAR(amplitude_at(y, 1000.0, 44100.0, 4410), 1.0 / std::sqrt(2.0), 2e-4);
}

TEST(BiquadSection, ConstructionIsIdentityAndTypedVariantDesignsAtConstruction) {
  BiquadSection plain;
  std::vector<float> x = noise(64, 3);
  std::vector<float> y(64);
  plain.process(x.data(), y.data(), 64);
  EXPECT_EQ(x, y);

  TypedBiquadSection peaking;  // type 2 with p = q = 1 is flat: (1 + s + s^2)/(1 + s + s^2)
  for (double f : {50.0, 1000.0, 15000.0}) EXPECT_NEAR(section_magnitude(peaking, f, 44100.0), 1.0, 1e-6);
}

TEST(BiquadSection, UnknownTypeOnlyNormalisesDenominator) {
  TypedBiquadSection s;
  s.set_prototype(0.5f, 0.25f, 3.0f, 7.0f, 0.125f, 9.0f);
  s.set_type(9);
  s.set_type_coefs();
  EXPECT_EQ(s.n0(), 0.5f);
  EXPECT_EQ(s.n1(), 0.25f);
  EXPECT_EQ(s.n2(), 3.0f);
  EXPECT_EQ(s.d0(), 1.0f);
  EXPECT_EQ(s.d1(), 0.125f);
  EXPECT_EQ(s.d2(), 1.0f);
}

TEST(BiquadSection, ProcessMatchesDoubleRecursionInPlaceAndAcrossCalls) {
  TypedBiquadSection s;
  s.set_type(TypedBiquadSection::kPeaking);
  s.set_p(3.0f);
  s.set_q(0.8f);
  s.set_frequency(700.0f);
  s.set_type_coefs();
  s.compute_coefs();
  const std::vector<float> x = noise(1000, 11);
  const std::vector<double> ref = reference_run(s, x, std::vector<bool>(x.size(), false));

  std::vector<float> buf = x;  // in place, in uneven pieces
  int pos = 0;
  for (int len : {1, 2, 3, 250, 7, 737}) {
    s.process(buf.data() + pos, buf.data() + pos, len);
    pos += len;
  }
  ASSERT_EQ(pos, 1000);
  for (int i = 0; i < 1000; ++i) ASSERT_NEAR(buf[i], ref[i], 2e-5) << i;

  s.reset();
  std::vector<float> out(x.size());
  s.process(x.data(), out.data(), 1000);
  EXPECT_EQ(out, buf);
}

TEST(BiquadSection, OffsetLandsOnFirstSampleOfEachPairWithinACall) {
  TypedBiquadSection s;
  s.set_type(TypedBiquadSection::kLowPass);
  s.set_p(0.765367f);
  s.set_frequency(300.0f);
  s.set_type_coefs();
  s.compute_coefs();

  // Silence, so the output is the response to the offsets alone.
  const int pieces[] = {3, 1, 4, 5, 2, 1, 1, 6};
  std::vector<float> x;
  std::vector<bool> offset_at;
  int start_parity = 0;  // the sample count so far decides which slot is newer
  for (int len : pieces) {
    const int lead = start_parity;
    for (int i = 0; i < len; ++i) {
      const bool paired_first = i >= lead && (i - lead) % 2 == 0 && i + 1 < len;
      offset_at.push_back(paired_first);
      x.push_back(0.0f);
    }
    start_parity = (start_parity + len) % 2;
  }
  const std::vector<double> ref = reference_run(s, x, offset_at);

  std::vector<float> y(x.size());
  int pos = 0;
  for (int len : pieces) {
    s.process_offset(x.data() + pos, y.data() + pos, len);
    pos += len;
  }
  EXPECT_EQ(y[0], 1e-20f);  // b0 * 0 + 1e-20, no history yet
  for (size_t i = 0; i < y.size(); ++i)
    ASSERT_NEAR(y[i], ref[i], 1e-5 * std::fabs(ref[i]) + 1e-30) << "sample " << i;
  EXPECT_GT(std::fabs(y.back()), 1e-22f);
}

TEST(FirstOrderSection, PrototypesMatchUnderBilinearMap) {
  const double rate = 48000.0;
  for (float g : {0.0f, 0.25f, 2.0f}) {
    FirstOrderSection s;
    s.set_sample_rate(float(rate));
    s.set_frequency(200.0f);
    s.set_dc_gain(g);
    s.set_high_pass();
    for (double f : {0.0, 20.0, 200.0, 2000.0, 20000.0}) {
      const double w = warped(f, 200.0, rate);
      const double expected = std::abs(std::complex<double>(g, w) / std::complex<double>(1.0, w));
      const std::complex<double> z1 = std::polar(1.0, -2.0 * kPi * f / rate);
      const double got = std::abs((double(s.b0()) + double(s.b1()) * z1) / (1.0 + double(s.a1()) * z1));
      EXPECT_NEAR(got, expected, 1e-6 + 1e-5 * expected) << "g " << g << " f " << f;
    }
  }
  FirstOrderSection lp;  // construction: 1/(1 + s) at 1000 Hz, 44100 Hz
  const double w = warped(5000.0, 1000.0, 44100.0);
  const std::complex<double> z1 = std::polar(1.0, -2.0 * kPi * 5000.0 / 44100.0);
  EXPECT_NEAR(std::abs((double(lp.b0()) + double(lp.b1()) * z1) / (1.0 + double(lp.a1()) * z1)),
              1.0 / std::sqrt(1.0 + w * w), 1e-6);
}

TEST(FirstOrderSection, HighPassAtTenHertzBlocksDcExactly) {
  FirstOrderSection s;
  s.set_frequency(10.0f);
  s.set_dc_gain(0.0f);
  s.set_high_pass();
  EXPECT_EQ(s.b0() + s.b1(), 0.0f);
  std::vector<float> buf(44100, 0.75f);
  s.process(buf.data(), buf.data(), int(buf.size()));
  EXPECT_NEAR(buf[0], 0.75f * s.b0(), 1e-7);
  EXPECT_LT(std::fabs(buf.back()), 1e-6f);

  // Same recursion in double, after a reset.
  s.reset();
  const std::vector<float> x = noise(500, 5);
  std::vector<float> y(500);
  s.process(x.data(), y.data(), 500);
  double x1 = 0, y1 = 0;
  for (int i = 0; i < 500; ++i) {
    const double v = s.b0() * double(x[i]) + s.b1() * x1 - s.a1() * y1;
    x1 = x[i];
    y1 = v;
    ASSERT_NEAR(y[i], v, 1e-5) << i;
  }
}

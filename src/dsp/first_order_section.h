#pragma once

// First-order section designed from an analog prototype (s normalised to the
// section frequency) by the bilinear transform with prewarping.
class FirstOrderSection {
 public:
  FirstOrderSection();

  void set_sample_rate(float rate) { sample_rate_ = rate; }
  void set_frequency(float freq) { frequency_ = freq; }
  // Gain at DC of the (g + s)/(1 + s) form written by set_high_pass.
  void set_dc_gain(float g) { g_ = g; }
  // Numerator n0 + n1*s over denominator d0 + d1*s.
  void set_prototype(float n0, float n1, float d0, float d1);

  void compute_coefs();
  // Prototype (g + s)/(1 + s), then the coefficients; g = 0 is a high-pass.
  void set_high_pass();

  // In place allowed.
  void process(const float* in, float* out, int count);
  void reset();

  float b0() const { return b0_; }
  float b1() const { return b1_; }
  float a0() const { return a0_; }
  float a1() const { return a1_; }

 private:
  float b0_ = 1.0f, b1_ = 0.0f, a0_ = 1.0f, a1_ = 0.0f;
  float x1_ = 0.0f, y1_ = 0.0f;
  float n0_ = 1.0f, n1_ = 0.0f, d0_ = 1.0f, d1_ = 1.0f;
  float sample_rate_ = 44100.0f;
  float frequency_ = 1000.0f;
  float g_ = 0.0f;
};

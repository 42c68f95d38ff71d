#pragma once

#include <vector>

// Polyphase IIR half-band decimator: two chains of first-order allpasses in
// z^2, one on the odd and one on the even input samples, averaged.
class HalfBandDecimator {
 public:
  static const int kMaxCoefs = 8;

  // Coefficients from an elliptic prototype, for a stopband attenuation in dB
  // and a transition width as a fraction of the input rate (0 < t < 0.5).
  static std::vector<double> design(double attenuation_db, double transition);

  HalfBandDecimator();

  // At most kMaxCoefs coefficients; the states are kept.
  void set_coefs(const std::vector<double>& coefs);
  int get_coef_count() const { return count_; }
  float get_coef(int i) const { return coefs_[i]; }

  // 2m input samples give m output samples; in == out allowed.
  void process(const float* in, float* out, int m);
  void reset();

 private:
  int count_;
  float coefs_[kMaxCoefs];
  float x_prev_[kMaxCoefs];
  float y_prev_[kMaxCoefs];
};

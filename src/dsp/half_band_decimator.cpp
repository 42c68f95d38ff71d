#include "dsp/half_band_decimator.h"

#include <cmath>
#include <stdexcept>

namespace {
const long double kPiL = 3.141592653589793238462643383279502884L;
}

std::vector<double> HalfBandDecimator::design(double attenuation_db, double transition) {
  if (!(transition > 0.0 && transition < 0.5) || !(attenuation_db > 0.0))
    throw std::runtime_error("HalfBandDecimator::design() : Invalid attenuation or transition width.");
  const long double t = transition;
  const long double tk = std::tan((1.0L - 2.0L * t) * kPiL / 4.0L);
  const long double k = tk * tk;
  const long double kp = std::pow(1.0L - k * k, 0.25L);
  const long double e = 0.5L * (1.0L - kp) / (1.0L + kp);
  const long double e4 = e * e * e * e;
  const long double q = e * (1.0L + e4 * (2.0L + e4 * (15.0L + 150.0L * e4)));

  const long double r = std::pow(10.0L, -(long double)attenuation_db / 10.0L);
  const long double a = r / (1.0L - r);
  int order = int(std::ceil(std::log(a * a / 16.0L) / std::log(q)));
  if (order % 2 == 0) ++order;
  if (order == 1) order = 3;

  std::vector<double> coefs;
  const int n = (order - 1) / 2;
  for (int i = 1; i <= n; ++i) {
    long double num = 0.0L;
    for (int m = 0;; ++m) {
      const long double sign = (m % 2 == 0) ? 1.0L : -1.0L;
      const long double term = sign * std::pow(q, (long double)(m * (m + 1))) *
                               std::sin((2 * m + 1) * i * kPiL / order);
      num += term;
      if (std::fabs(term) <= 1e-100L || m > 1000) break;
    }
    long double den = 0.0L;
    for (int m = 1;; ++m) {
      const long double sign = (m % 2 == 0) ? 1.0L : -1.0L;
      const long double term = sign * std::pow(q, (long double)(m * m)) * std::cos(2 * m * i * kPiL / order);
      den += term;
      if (std::fabs(term) <= 1e-100L || m > 1000) break;
    }
    const long double w = std::pow(q, 0.25L) * num / (den + 0.5L);
    const long double u = w * w;
    const long double x = std::sqrt((1.0L - u * k) * (1.0L - u / k)) / (1.0L + u);
    coefs.push_back(double((1.0L - x) / (1.0L + x)));
  }
  return coefs;
}

HalfBandDecimator::HalfBandDecimator() : count_(kMaxCoefs) {
  for (int i = 0; i < kMaxCoefs; ++i) coefs_[i] = 1.0f;
  reset();
}

void HalfBandDecimator::set_coefs(const std::vector<double>& coefs) {
  if (coefs.size() > std::size_t(kMaxCoefs))
    throw std::runtime_error("HalfBandDecimator::set_coefs() : Too many coefficients.");
  count_ = int(coefs.size());
  for (int i = 0; i < count_; ++i) coefs_[i] = float(coefs[i]);
}

void HalfBandDecimator::process(const float* in, float* out, int m) {
  for (int i = 0; i < m; ++i) {
    float a = in[2 * i + 1];
    float b = in[2 * i];
    for (int c = 0; c < count_; c += 2) {
      const float y = coefs_[c] * (a - y_prev_[c]) + x_prev_[c];
      x_prev_[c] = a;
      y_prev_[c] = y;
      a = y;
    }
    for (int c = 1; c < count_; c += 2) {
      const float y = coefs_[c] * (b - y_prev_[c]) + x_prev_[c];
      x_prev_[c] = b;
      y_prev_[c] = y;
      b = y;
    }
    out[i] = 0.5f * (a + b);
  }
}

void HalfBandDecimator::reset() {
  for (int i = 0; i < kMaxCoefs; ++i) {
    x_prev_[i] = 0.0f;
    y_prev_[i] = 0.0f;
  }
}

#pragma once

// Double-precision references shared by the filter tests.

#include <cmath>
#include <complex>
#include <vector>

namespace dsp_test {

const double kPi = 3.14159265358979323846;

// |H(e^jw)| of b0 + b1 z^-1 + b2 z^-2 over 1 + a1 z^-1 + a2 z^-2 at f hertz.
inline double digital_magnitude(double b0, double b1, double b2, double a1, double a2, double f, double rate) {
  const std::complex<double> z1 = std::polar(1.0, -2.0 * kPi * f / rate);
  const std::complex<double> z2 = z1 * z1;
  return std::abs((b0 + b1 * z1 + b2 * z2) / (1.0 + a1 * z1 + a2 * z2));
}

// Normalised analog frequency that the bilinear map with prewarping at f0
// sends to the digital frequency f.
inline double warped(double f, double f0, double rate) {
  return std::tan(kPi * f / rate) / std::tan(kPi * f0 / rate);
}

// |N(jW)/D(jW)| of a second-order prototype.
inline double analog_magnitude(double n0, double n1, double n2, double d0, double d1, double d2, double w) {
  const std::complex<double> s(0.0, w);
  return std::abs((n0 + n1 * s + n2 * s * s) / (d0 + d1 * s + d2 * s * s));
}

// A sine of amplitude 1 at f hertz, n samples.
inline std::vector<float> sine(double f, double rate, int n) {
  std::vector<float> v(n);
  for (int i = 0; i < n; ++i) v[i] = float(std::sin(2.0 * kPi * f * i / rate));
  return v;
}

// Amplitude of the component at f hertz in v[from..end), by correlation.
inline double amplitude_at(const std::vector<float>& v, double f, double rate, int from) {
  double re = 0.0, im = 0.0;
  const int n = int(v.size()) - from;
  for (int i = from; i < int(v.size()); ++i) {
    const double ph = 2.0 * kPi * f * i / rate;
    re += v[i] * std::cos(ph);
    im += v[i] * std::sin(ph);
  }
  return 2.0 * std::sqrt(re * re + im * im) / n;
}

inline double db(double g) { return 20.0 * std::log10(g); }

// Deterministic noise in [-1, 1).
inline std::vector<float> noise(int n, unsigned seed) {
  std::vector<float> v(n);
  unsigned s = seed;
  for (int i = 0; i < n; ++i) {
    s = s * 1664525u + 1013904223u;
    v[i] = float((s >> 8) * (1.0 / 8388608.0) - 1.0);
  }
  return v;
}

}  // namespace dsp_test

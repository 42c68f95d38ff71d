#include "dsp/shaper_table.h"

#include <stdexcept>

ShaperTable::ShaperTable(double (*f)(double), int half_range)
    : half_range_(half_range), half_range_f_(float(half_range)), low_(0.0f), high_(0.0f), coefs_{} {
  if (half_range < 1 || half_range > kMaxHalfRange)
    throw std::runtime_error("ShaperTable::ShaperTable() : Invalid half range.");
  const double delta = 1.0 / 2048.0;
  const int h = half_range;
  for (int j = -h; j < h; ++j) {
    const double x0 = j;
    const double x1 = j + 1;
    const double p0 = f(x0);
    const double p1 = f(x1);
    const double d0 = (f(x0 + delta) - f(x0 - delta)) * 1024.0;
    const double d1 = (f(x1 + delta) - f(x1 - delta)) * 1024.0;
    // Hermite cubic A t^3 + B t^2 + d0 t + p0 in t = x - j, re-expressed in x.
    const double a = d0 + d1 - 2.0 * (p1 - p0);
    const double b = 3.0 * (p1 - p0) - 2.0 * d0 - d1;
    const double jd = j;
    const double j2 = jd * jd;
    const double j3 = j2 * jd;
    float* c = coefs_[j + h];
    c[3] = float(a);
    c[2] = float(b - 3.0 * a * jd);
    c[1] = float(d0 - 2.0 * b * jd + 3.0 * a * j2);
    c[0] = float(p0 - d0 * jd + b * j2 - a * j3);
  }
  low_ = float(f(-double(h)));
  high_ = float(f(double(h)));
}

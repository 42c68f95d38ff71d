#pragma once

// A curve on [-h, h] as one cubic per unit segment, in the absolute input x,
// held at its end values outside the range.
class ShaperTable {
 public:
  static const int kMaxHalfRange = 32;

  // f is evaluated in double at the integer knots and 2^-11 either side of
  // them (for the slopes); 1 <= half_range <= kMaxHalfRange.
  ShaperTable(double (*f)(double), int half_range);

  float lookup(float x) const {
    if (x <= -half_range_f_) return low_;
    if (!(x < half_range_f_)) return high_;  // also NaN
    // Segment floor(x); truncation corrected for negative inputs.
    const int t = int(x);
    const int j = t - (x < float(t) ? 1 : 0);
    const float* c = coefs_[j + half_range_];
    return ((c[3] * x + c[2]) * x + c[1]) * x + c[0];
  }

  int half_range() const { return half_range_; }
  float low_end() const { return low_; }
  float high_end() const { return high_; }
  // Coefficient k (0..3) of the segment starting at knot j (-h..h-1).
  float coef(int j, int k) const { return coefs_[j + half_range_][k]; }

 private:
  int half_range_;
  float half_range_f_;
  float low_;
  float high_;
  float coefs_[2 * kMaxHalfRange][4];
};

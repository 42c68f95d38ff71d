#pragma once

// One-pole mean-square detector: the bilinear one-pole low-pass at 1/T hertz
// run on the squared input.
class RmsDetector {
 public:
  RmsDetector();

  void set_sample_rate(float rate);
  void set_time(float seconds);

  // Runs the recursion over the block and returns the RMS level after it.
  float process(const float* in, int count);
  // One sample of the recursion; returns the mean square (no root, sign kept).
  float step_mean_square(float x) {
    const float xx = x * x;
    y_ = b_ * (xx + p_) - a_ * y_;
    p_ = xx;
    return y_;
  }
  void reset();

  float get_b() const { return b_; }
  float get_a() const { return a_; }

 private:
  void compute_coefs();

  float sample_rate_ = 44100.0f;
  float time_ = 0.03f;
  float b_ = 0.0f;
  float a_ = 0.0f;
  float p_ = 0.0f;  // previous squared input
  float y_ = 0.0f;
};

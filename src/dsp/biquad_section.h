#pragma once

// Second-order section designed from an analog prototype (s normalised to the
// section frequency) by the bilinear transform with prewarping.
class BiquadSection {
 public:
  BiquadSection() = default;
  virtual ~BiquadSection() = default;

  // Numerator n0 + n1*s + n2*s^2 over denominator d0 + d1*s + d2*s^2.
  void set_prototype(float n0, float n1, float n2, float d0, float d1, float d2);
  void set_sample_rate(float rate) { sample_rate_ = rate; }
  void set_frequency(float freq) { frequency_ = freq; }
  float get_sample_rate() const { return sample_rate_; }
  float get_frequency() const { return frequency_; }

  void compute_coefs();

  // Both allow in == out.
  void process(const float* in, float* out, int count);
  // As process, with a tiny offset on every other sample so that the
  // recursion never decays into denormals on silence.
  void process_offset(const float* in, float* out, int count);
  void reset();

  float b0() const { return b0_; }
  float b1() const { return b1_; }
  float b2() const { return b2_; }
  float a0() const { return a0_; }
  float a1() const { return a1_; }
  float a2() const { return a2_; }
  float n0() const { return n0_; }
  float n1() const { return n1_; }
  float n2() const { return n2_; }
  float d0() const { return d0_; }
  float d1() const { return d1_; }
  float d2() const { return d2_; }

 protected:
  float step(float x) {
    const int newer = ring_;
    const int older = 1 - ring_;
    const float y = b0_ * x + b1_ * x_[newer] + b2_ * x_[older] - (a1_ * y_[newer] + a2_ * y_[older]);
    x_[older] = x;
    y_[older] = y;
    ring_ = older;
    return y;
  }
  float step_offset(float x, float offset) {
    const int newer = ring_;
    const int older = 1 - ring_;
    const float y =
        b0_ * x + offset + b1_ * x_[newer] + b2_ * x_[older] - (a1_ * y_[newer] + a2_ * y_[older]);
    x_[older] = x;
    y_[older] = y;
    ring_ = older;
    return y;
  }

  float b0_ = 1.0f, b1_ = 0.0f, b2_ = 0.0f, a0_ = 1.0f, a1_ = 0.0f, a2_ = 0.0f;
  float x_[2] = {0.0f, 0.0f};
  float y_[2] = {0.0f, 0.0f};
  int ring_ = 0;  // which history slot holds the newer value
  float n0_ = 1.0f, n1_ = 2.0f, n2_ = 1.0f, d0_ = 1.0f, d1_ = 2.0f, d2_ = 1.0f;
  float sample_rate_ = 44100.0f;
  float frequency_ = 1000.0f;
};

// Second-order section whose prototype follows from a filter type.
class TypedBiquadSection : public BiquadSection {
 public:
  enum Type { kLowPass = 0, kHighPass = 1, kPeaking = 2, kBandPass = 3 };

  TypedBiquadSection();

  void set_type(int type) { type_ = type; }
  // Quality factor for low- and high-pass, gain for peaking and band-pass.
  void set_p(float p) { p_ = p; }
  // Quality factor for peaking and band-pass.
  void set_q(float q) { q_ = q; }
  int get_type() const { return type_; }
  float get_p() const { return p_; }
  float get_q() const { return q_; }

  // Writes the prototype of the current type; compute_coefs must follow.
  void set_type_coefs();

 private:
  int type_ = kPeaking;
  float p_ = 1.0f;
  float q_ = 1.0f;
};

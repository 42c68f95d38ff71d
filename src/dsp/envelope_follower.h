#pragma once

// Per-sample attack/hold/release follower of a power signal.
class EnvelopeFollower {
 public:
  EnvelopeFollower();

  void set_sample_rate(float rate);
  void set_attack(float seconds);
  void set_hold(float seconds);
  void set_release(float seconds);

  float step(float power) {
    const float e = power - envelope_;
    if (e > 0.0f) {
      envelope_ += e * attack_coef_;
      hold_counter_ = hold_length_;
    } else if (hold_counter_ > 0) {
      --hold_counter_;
    } else {
      envelope_ += e * release_coef_;
    }
    return envelope_;
  }

  float get_envelope() const { return envelope_; }
  // Keeps the follower consistent when the signal feeding it is rescaled.
  void scale_envelope(float factor) { envelope_ *= factor; }
  void reset();

  float get_attack_coef() const { return attack_coef_; }
  float get_release_coef() const { return release_coef_; }
  int get_hold_length() const { return hold_length_; }

 private:
  void compute_coefs();

  float sample_rate_ = 44100.0f;
  float attack_ = 0.005f;
  float hold_ = 0.02f;
  float release_ = 0.25f;
  float envelope_ = 0.0f;
  float attack_coef_ = 1.0f;
  float release_coef_ = 1.0f;
  int hold_length_ = 0;
  int hold_counter_ = 0;
};

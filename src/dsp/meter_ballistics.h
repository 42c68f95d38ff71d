#pragma once

// Block-wise meter follower: attack towards a rising target, hold, then
// exponential release; one update per block.
class MeterBallistics {
 public:
  MeterBallistics() = default;

  void set_sample_rate(float rate);
  void set_attack(float seconds) { attack_ = seconds; }
  void set_hold(float seconds);
  void set_release(float seconds) { release_ = seconds; }

  // Moves the value towards target over a block of count samples.
  float update(float target, int count);
  float get_value() const { return value_; }
  void reset();

 private:
  void compute_hold_length();

  float sample_rate_ = 44100.0f;
  float attack_ = 0.0f;
  float hold_ = 0.0f;
  float release_ = 0.0f;
  float sample_period_ = 1.0f / 44100.0f;
  float value_ = 0.0f;
  int hold_length_ = 0;
  int hold_counter_ = 0;
};

#pragma once

#include <atomic>

#include "params/notifier.h"

namespace plugcore {

// Base of every parameter: the value in natural units (double) and its image
// under the parameter's mapping, normalised to 0..1 (float). Writers on other
// threads store both; the engine reads them at block start, so both are atomics
// used with relaxed ordering.
class NormalizedParamInterface : public NotifierInterface {
 public:
  NormalizedParamInterface() = default;
  NormalizedParamInterface(const NormalizedParamInterface&) = delete;
  NormalizedParamInterface& operator=(const NormalizedParamInterface&) = delete;
  ~NormalizedParamInterface() override = default;

  virtual void init(double default_value, int priority);
  virtual void get_name(char* text, int capacity) const = 0;
  virtual void get_unit(char* text, int capacity) const = 0;
  virtual int get_type() const { return 0; }
  virtual void update() {}
  virtual double get_value() const { return value_.load(std::memory_order_relaxed); }
  virtual void apply() {}
  virtual void unnamed_op() {}
  virtual double conv_norm_to_value(float norm) const = 0;
  virtual float conv_value_to_norm(double value) const = 0;
  virtual void conv_value_to_text(char* text, int capacity, double value) const = 0;
  virtual double conv_text_to_value(const char* text, bool& ok) const = 0;

  // Field access.
  float get_norm() const { return normalized_.load(std::memory_order_relaxed); }
  int get_priority() const { return priority_; }
  NotifiedInterface* get_notified() const { return notified_; }
  void set_notified(NotifiedInterface* notified) { notified_ = notified; }

  // The two ways a value is written: from a normalised value (host, MIDI,
  // programs) or straight from a natural value (default state). Both keep the
  // pair consistent, run apply and update, then notify.
  void set_norm_and_notify(float norm);
  void set_value_and_notify(double value);

 protected:
  NotifiedInterface* notified_ = nullptr;
  std::atomic<double> value_{0.0};
  std::atomic<float> normalized_{0.0f};
  int priority_ = -1;
  int state_ = 0;
};

}  // namespace plugcore

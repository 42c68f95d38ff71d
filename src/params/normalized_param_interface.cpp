#include "params/normalized_param_interface.h"

namespace plugcore {

void NormalizedParamInterface::init(double default_value, int priority) {
  value_.store(default_value, std::memory_order_relaxed);
  normalized_.store(conv_value_to_norm(default_value), std::memory_order_relaxed);
  state_ = 0;
  priority_ = priority;
}

void NormalizedParamInterface::set_norm_and_notify(float norm) {
  normalized_.store(norm, std::memory_order_relaxed);
  value_.store(conv_norm_to_value(norm), std::memory_order_relaxed);
  apply();
  update();
  if (notified_ != nullptr) {
    notified_->notify(this);
  }
}

void NormalizedParamInterface::set_value_and_notify(double value) {
  value_.store(value, std::memory_order_relaxed);
  normalized_.store(conv_value_to_norm(value), std::memory_order_relaxed);
  apply();
  update();
  if (notified_ != nullptr) {
    notified_->notify(this);
  }
}

}  // namespace plugcore

#include "editor/param_follower.h"

#include "guikit/messages.h"
#include "guikit/window_interface.h"

ParamFollower::ParamFollower(int nbr_params, TargetInterface& target)
    : nbr_params_(nbr_params > 0 ? nbr_params : 0), slots_(new Slot[static_cast<size_t>(nbr_params_)]), target_(target) {}

ParamFollower::~ParamFollower() { stop(); }

void ParamFollower::post(int index, float norm, int priority) {
  if (index < 0 || index >= nbr_params_) return;
  Slot& slot = slots_[static_cast<size_t>(index)];
  slot.norm.store(norm, std::memory_order_relaxed);
  slot.priority.store(priority, std::memory_order_relaxed);
  // Release: whoever sees the flag sees the value and the priority stored above.
  slot.pending.store(true, std::memory_order_release);
  any_pending_.store(true, std::memory_order_release);
}

void ParamFollower::collect() {
  // Cleared first: a change posted while collecting raises it again for the next tick.
  if (!any_pending_.exchange(false, std::memory_order_acquire)) return;
  for (int i = 0; i < nbr_params_; ++i) {
    Slot& slot = slots_[static_cast<size_t>(i)];
    if (!slot.pending.exchange(false, std::memory_order_acquire)) continue;
    target_.follow_param(i, slot.norm.load(std::memory_order_relaxed), slot.priority.load(std::memory_order_relaxed));
  }
}

void ParamFollower::start(guikit::WindowInterface& window) {
  stop();
  int32_t id = -1;
  guikit::SetTimer set(kPeriod, this, &id);
  if (window.process_message(set) == 0) {
    window_ = &window;
    timer_id_ = id;
  }
}

void ParamFollower::stop() {
  if (timer_id_ < 0 || window_ == nullptr) return;
  guikit::ClearTimer clear(timer_id_);
  timer_id_ = -1;
  window_->process_message(clear);
  window_ = nullptr;
}

int32_t ParamFollower::process_message(guikit::MessageInterface& message) {
  if (dynamic_cast<guikit::Notify*>(&message) == nullptr) return -1;
  collect();
  return 0;
}

#pragma once

#include <atomic>
#include <cstdint>
#include <memory>

#include "guikit/message_handler_interface.h"

namespace guikit {
class WindowInterface;
}

// Parameter changes that reach the editor away from its own thread wait here
// until the editor thread takes them over. Writers (audio, MIDI or host threads)
// only store a value, a priority and a flag per parameter, so they never wait,
// allocate or call the system; the editor thread collects them on a toolkit
// timer while the window is open.
class ParamFollower : public guikit::MessageHandlerInterface {
 public:
  // Called on the editor thread for each waiting change, the latest one per parameter.
  class TargetInterface {
   public:
    virtual ~TargetInterface() = default;
    virtual void follow_param(int index, float norm, int priority) = 0;
  };

  static constexpr float kPeriod = 0.02f;  // seconds between collections

  ParamFollower(int nbr_params, TargetInterface& target);
  ~ParamFollower() override;

  // Any thread. Out-of-range indices are ignored.
  void post(int index, float norm, int priority);
  // Editor thread: hands every waiting change to the target.
  void collect();
  bool has_pending() const { return any_pending_.load(std::memory_order_acquire); }

  // The timer runs in the window while it is open.
  void start(guikit::WindowInterface& window);
  void stop();
  bool is_running() const { return timer_id_ >= 0; }

  // Timer ticks.
  int32_t process_message(guikit::MessageInterface& message) override;

 private:
  struct Slot {
    std::atomic<float> norm{0.0f};
    std::atomic<int> priority{0};
    std::atomic<bool> pending{false};
  };

  int nbr_params_;
  std::unique_ptr<Slot[]> slots_;
  std::atomic<bool> any_pending_{false};
  TargetInterface& target_;
  guikit::WindowInterface* window_ = nullptr;
  int32_t timer_id_ = -1;
};

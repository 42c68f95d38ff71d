#pragma once

#include <atomic>
#include <thread>

namespace plugcore {

// The MIDI manager's hold on one device, switched on the editor thread while
// the audio thread (begin_block, end_block) and the host's processEvents use
// it. Device switching is an atomic pointer swap plus a handshake: a user
// announces itself in a counter before loading the pointer, and the switcher,
// after swapping the pointer, waits until the counter is back to zero before
// it closes the old device; all four steps are sequentially consistent, so a
// user either sees the new pointer or is waited for. Only the editor thread
// ever waits; users never lock, block or allocate.
template <class Device>
class MidiDeviceSlot {
 public:
  class Use {
   public:
    explicit Use(MidiDeviceSlot& slot) : slot_(slot) {
      slot_.users_.fetch_add(1, std::memory_order_seq_cst);
      device_ = slot_.device_.load(std::memory_order_seq_cst);
    }
    ~Use() { slot_.users_.fetch_sub(1, std::memory_order_release); }
    Use(const Use&) = delete;
    Use& operator=(const Use&) = delete;
    Device* get() const { return device_; }
    Device* operator->() const { return device_; }
    explicit operator bool() const { return device_ != nullptr; }

   private:
    MidiDeviceSlot& slot_;
    Device* device_;
  };

  // Editor thread. Returns the previous device, which no user holds any more.
  Device* swap(Device* next) {
    Device* previous = device_.exchange(next, std::memory_order_seq_cst);
    while (users_.load(std::memory_order_seq_cst) != 0) {
      std::this_thread::yield();
    }
    return previous;
  }

  Device* peek() const { return device_.load(std::memory_order_acquire); }

 private:
  std::atomic<Device*> device_{nullptr};
  std::atomic<int> users_{0};
};

}  // namespace plugcore

// The lock-free queues and device switching under two real threads.
#include <gtest/gtest.h>

#include <atomic>
#include <chrono>
#include <memory>
#include <thread>
#include <vector>

#include "midi/bounded_mpsc_queue.h"
#include "midi/lock_free_ring_fifo.h"
#include "midi/mci_midi_dev_sel_comp.h"
#include "midi/midi_dev_sel_dispatcher.h"
#include "midi/midi_mgr.h"
#include "midi_test_support.h"

namespace {

// A driver with one input and one output port whose "driver thread" the test runs.
class FakeDriver : public sys::MidiPortDriverInterface {
 public:
  int list_inputs(std::vector<std::string>& names) override {
    names.push_back("Fake Port In");
    return 0;
  }
  int list_outputs(std::vector<std::string>& names) override {
    names.push_back("Fake Port Out");
    return fail_output_listing ? -1 : 0;
  }
  int open_input(int port, sys::MidiInputSinkInterface* s) override {
    sink.store(s);
    return 0;
  }
  int close_input() override {
    sink.store(nullptr);
    return 0;
  }
  int open_output(int) override { return 0; }
  int send_short(uint32_t message) override {
    sent.push_back(message);
    return 0;
  }
  int close_output() override { return 0; }
  std::atomic<sys::MidiInputSinkInterface*> sink{nullptr};
  std::vector<uint32_t> sent;
  bool fail_output_listing = false;
};

uint32_t short_message(int status, int d1, int d2) { return static_cast<uint32_t>(status | d1 << 8 | d2 << 16); }

}  // namespace

TEST(MidiQueueThreads, RingDeliversInOrderAcrossThreads) {
  static basic::LockFreeRingFifo<uint32_t, 64> ring;  // small, so both sides wrap many times
  constexpr uint32_t kCount = 50000;
  std::thread producer([] {
    for (uint32_t i = 0; i < kCount; ++i) {
      while (!ring.push(i)) std::this_thread::yield();
    }
  });
  uint32_t expected = 0;
  uint32_t value = 0;
  while (expected < kCount) {
    if (ring.pop(value)) {
      ASSERT_EQ(value, expected);
      ++expected;
    } else {
      std::this_thread::yield();
    }
  }
  producer.join();
  EXPECT_FALSE(ring.pop(value));
}

TEST(MidiQueueThreads, StormBetweenTwoBlocksKeepsTheFirst3999) {
  // The driver's thread sends 5000 controller messages while the audio thread
  // is between blocks; the next block decodes what the queue held, in order.
  plugcore::MidiMgr mgr;
  RecordingReceiver receiver;
  mgr.init(&receiver, nullptr, nullptr, nullptr);
  FakeDriver driver;
  plugcore::MciMidiIn input(&receiver, &mgr, &driver, 0);
  ASSERT_EQ(input.open(), 0);
  std::thread driver_thread([&] {
    for (int i = 0; i < 5000; ++i) {
      driver.sink.load()->on_midi_short(short_message(0xB0 | (i % 16), (i / 16) % 128, i % 128), i);
    }
  });
  driver_thread.join();
  std::thread audio_thread([&] { input.begin_block(); });
  audio_thread.join();
  std::vector<std::string> expected;
  for (int i = 0; i < 3999; ++i) {
    expected.push_back("raw " + std::to_string(i % 16) + " 11 " + std::to_string((i / 16) % 128) + " " +
                       std::to_string(i % 128));
  }
  std::vector<std::string> raw;
  for (const auto& e : receiver.events) {
    if (e.rfind("raw", 0) == 0) raw.push_back(e);
  }
  EXPECT_EQ(raw, expected);
  // The queue is empty again and takes new messages.
  receiver.events.clear();
  driver.sink.load()->on_midi_short(short_message(0x90, 60, 1), 0);
  input.begin_block();
  EXPECT_EQ(receiver.decoded(), std::vector<std::string>{"on 0 60"});
  EXPECT_EQ(input.close(), 0);
}

TEST(MidiQueueThreads, StreamingWhileTheAudioThreadDrains) {
  plugcore::MidiMgr mgr;
  RecordingReceiver receiver;
  mgr.init(&receiver, nullptr, nullptr, nullptr);
  FakeDriver driver;
  plugcore::MciMidiIn input(&receiver, &mgr, &driver, 0);
  input.open();
  std::atomic<bool> done{false};
  std::thread driver_thread([&] {
    for (int i = 0; i < 3000; ++i) {
      driver.sink.load()->on_midi_short(short_message(0x80, i % 128, 0), 0);
      if (i % 500 == 0) std::this_thread::sleep_for(std::chrono::microseconds(200));
    }
    done = true;
  });
  while (!done.load()) input.begin_block();
  driver_thread.join();
  input.begin_block();
  const auto decoded = receiver.decoded();
  ASSERT_EQ(decoded.size(), 3000u);  // never more than 3999 waiting at once, so nothing dropped
  for (int i = 0; i < 3000; ++i) ASSERT_EQ(decoded[static_cast<size_t>(i)], "off 0 " + std::to_string(i % 128));
}

TEST(MidiQueueThreads, SeveralProducersOneConsumer) {
  static basic::BoundedMpscQueue<uint32_t, 256> queue;
  constexpr uint32_t kPerProducer = 20000;
  std::vector<std::thread> producers;
  for (uint32_t p = 0; p < 2; ++p) {
    producers.emplace_back([p] {
      for (uint32_t i = 0; i < kPerProducer; ++i) {
        while (!queue.push(p << 24 | i)) std::this_thread::yield();
      }
    });
  }
  uint32_t next[2] = {0, 0};
  uint32_t value = 0;
  while (next[0] < kPerProducer || next[1] < kPerProducer) {
    if (!queue.pop(value)) {
      std::this_thread::yield();
      continue;
    }
    const uint32_t producer = value >> 24;
    ASSERT_LT(producer, 2u);
    ASSERT_EQ(value & 0xFFFFFF, next[producer]);  // each producer's values stay in order
    ++next[producer];
  }
  for (auto& t : producers) t.join();
  EXPECT_FALSE(queue.pop(value));
}

namespace {

// A device that fails the test when used after it was closed.
class GuardedInput : public plugcore::MidiInInterface {
 public:
  explicit GuardedInput(std::atomic<int>& misuse) : misuse_(misuse) {}
  int open() override {
    open_.store(true);
    return 0;
  }
  int close() override {
    open_.store(false);
    return 0;
  }
  void begin_block() override {
    if (!open_.load()) misuse_++;
    blocks_++;
  }
  void end_block() override {
    if (!open_.load()) misuse_++;
  }
  std::atomic<int> blocks_{0};

 private:
  std::atomic<bool> open_{false};
  std::atomic<int>& misuse_;
};

class GuardedComponent : public plugcore::MidiDevSelCompInterface {
 public:
  explicit GuardedComponent(std::atomic<int>& misuse) : misuse_(misuse) {}
  int init() override { return 0; }
  int list_inputs(int, std::vector<std::string>& names) override {
    names.insert(names.end(), {"A", "B"});
    return 0;
  }
  int list_outputs(int, std::vector<std::string>&) override { return 0; }
  int open_input(int, plugcore::MidiInInterface*& device) override {
    device_ = std::make_unique<GuardedInput>(misuse_);
    device = device_.get();
    return 0;
  }
  int open_output(int, plugcore::MidiOutInterface*&) override { return -1; }
  int close_input() override {
    if (device_) device_->close();
    device_.reset();  // freed: a use after this would also trip the sanitizers
    return 0;
  }
  int close_output() override { return 0; }

 private:
  std::atomic<int>& misuse_;
  std::unique_ptr<GuardedInput> device_;
};

}  // namespace

TEST(MidiQueueThreads, DeviceSwitchingIsSafeAgainstTheAudioThread) {
  std::atomic<int> misuse{0};
  plugcore::MidiMgr mgr;
  plugcore::MidiDevSelDispatcher dispatcher(&mgr);
  GuardedComponent component(misuse);
  dispatcher.add_component(&component);
  ASSERT_EQ(dispatcher.list_inputs(), 0);
  std::atomic<bool> stop{false};
  std::atomic<int> blocks{0};
  std::thread audio([&] {
    while (!stop.load()) {
      mgr.begin_block();
      mgr.end_block();
      blocks++;
    }
  });
  // Switch until the audio thread has run many blocks across the switches.
  for (int i = 0; i < 2000 || blocks.load() < 2000; ++i) {
    ASSERT_EQ(dispatcher.select_input(i % 3 == 2 ? -1 : i % 2), 0);
  }
  stop = true;
  audio.join();
  dispatcher.close_all();
  EXPECT_EQ(misuse.load(), 0);
  EXPECT_GT(blocks.load(), 0);
  EXPECT_EQ(mgr.set_input_device(nullptr), nullptr);
}

TEST(MidiSystemPorts, ComponentListsOpensAndSends) {
  plugcore::MidiMgr mgr;
  mgr.use_settings().set_values(1, 1);
  RecordingReceiver receiver;
  RecordingCmd cmd;
  mgr.init(&receiver, nullptr, nullptr, &cmd);
  auto driver = std::make_unique<FakeDriver>();
  FakeDriver* fake = driver.get();
  plugcore::MciMidiDevSelComp component(&mgr, std::move(driver));  // outlives the dispatcher that uses it
  plugcore::MidiDevSelDispatcher dispatcher(&mgr);
  dispatcher.add_component(&component);
  ASSERT_EQ(dispatcher.list_inputs(), 0);
  ASSERT_EQ(dispatcher.list_outputs(), 0);
  EXPECT_EQ(dispatcher.get_input_name(0), "Fake Port In");
  ASSERT_EQ(dispatcher.select_default(true), 0);
  ASSERT_NE(fake->sink.load(), nullptr);
  EXPECT_EQ(mgr.nrpn(2, 300, 8192), 1);
  ASSERT_EQ(fake->sent.size(), 4u);
  EXPECT_EQ(fake->sent[0], short_message(0xB2, 99, 2));
  EXPECT_EQ(fake->sent[3], short_message(0xB2, 38, 0));
  EXPECT_EQ(dispatcher.select_input(-1), 0);
  EXPECT_EQ(fake->sink.load(), nullptr);
  EXPECT_EQ(dispatcher.select_input(5), -1);  // no such device
  EXPECT_EQ(dispatcher.get_selected_input(), -1);
  fake->fail_output_listing = true;
  EXPECT_NE(dispatcher.list_outputs(), 0);
}

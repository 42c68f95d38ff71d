// The system MIDI driver against the machine's sequencer, where there is one.
#include <gtest/gtest.h>

#include <unistd.h>

#include <atomic>
#include <chrono>
#include <cstdio>
#include <string>
#include <thread>
#include <vector>

#include "midi/midi_port_driver_interface.h"

namespace {

bool have_sequencer() { return access("/dev/snd/seq", R_OK | W_OK) == 0; }

class Collect : public sys::MidiInputSinkInterface {
 public:
  void on_midi_short(uint32_t message, uint32_t) override {
    messages[count.load() % 64] = message;
    count++;
  }
  uint32_t messages[64] = {};
  std::atomic<int> count{0};
};

}  // namespace

TEST(AlsaSequencer, WithoutADeviceNothingIsListed) {
  if (have_sequencer()) GTEST_SKIP() << "this machine has /dev/snd/seq; the port test below covers it";
  auto driver = sys::make_system_midi_driver();
  std::vector<std::string> inputs, outputs;
  EXPECT_EQ(driver->list_inputs(inputs), 0);
  EXPECT_EQ(driver->list_outputs(outputs), 0);
  EXPECT_TRUE(inputs.empty());
  EXPECT_TRUE(outputs.empty());
  Collect sink;
  EXPECT_EQ(driver->open_input(0, &sink), -1);
  EXPECT_EQ(driver->open_output(0), -1);
  EXPECT_EQ(driver->send_short(0x7F07B0), -1);
}

// Two instances' clients see each other's ports: what one sends from its
// output port arrives at the other's input port.
TEST(AlsaSequencer, OneInstanceSendsToAnother) {
  if (!have_sequencer()) {
    GTEST_SKIP() << "no /dev/snd/seq on this machine (no sequencer module such as snd-seq-dummy loaded)";
  }
  auto sender = sys::make_system_midi_driver();
  auto receiver = sys::make_system_midi_driver();
  std::vector<std::string> inputs, outputs;
  ASSERT_EQ(receiver->list_inputs(inputs), 0);
  ASSERT_EQ(sender->list_outputs(outputs), 0);
  int source = -1, target = -1;
  for (size_t i = 0; i < inputs.size(); ++i)
    if (inputs[i].find("Brakmorph MIDI Out") != std::string::npos) source = static_cast<int>(i);
  for (size_t i = 0; i < outputs.size(); ++i)
    if (outputs[i].find("Brakmorph MIDI In") != std::string::npos) target = static_cast<int>(i);
  if (source < 0 || target < 0) GTEST_SKIP() << "the sequencer lists no port of the other client";
  Collect sink;
  ASSERT_EQ(receiver->open_input(source, &sink), 0);
  ASSERT_EQ(sender->open_output(target), 0);
  EXPECT_EQ(sender->send_short(0x4007B3), 0);  // CC 7 = 64 on channel 3
  for (int i = 0; i < 200 && sink.count.load() == 0; ++i) std::this_thread::sleep_for(std::chrono::milliseconds(5));
  EXPECT_EQ(receiver->close_input(), 0);
  EXPECT_EQ(sender->close_output(), 0);
  ASSERT_GE(sink.count.load(), 1);
  EXPECT_EQ(sink.messages[0], 0x4007B3u);
}

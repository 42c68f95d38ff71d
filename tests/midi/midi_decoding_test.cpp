// Channel-message and controller decoding of an input, against values worked out here.
#include <gtest/gtest.h>

#include <cmath>

#include "midi/midi_controller_key.h"
#include "midi/vst2_midi_ports.h"
#include "midi_test_support.h"

using plugcore::make_midi_key;

namespace {

class Decoding : public ::testing::Test {
 protected:
  void send(int s, int d1, int d2, int offset = 0, int detune = 0) { input_.decode_message(s, d1, d2, offset, detune); }
  void send_cc(int channel, int n, int v) { send(0xB0 | channel, n, v); }
  RecordingReceiver receiver_;
  RecordingSink sink_;
  plugcore::Vst2MidiIn input_{&receiver_, &sink_};
};

}  // namespace

TEST_F(Decoding, NrpnInBothByteOrders) {
  // Standard order: CC 99 carries the high 7 bits.
  sink_.compatibility = 1;
  send_cc(0, 99, 0);
  send_cc(0, 98, 5);
  send_cc(0, 6, 127);
  send_cc(0, 38, 127);
  ASSERT_EQ(sink_.steps.size(), 2u);  // selectors have no key of their own
  EXPECT_EQ(sink_.steps[0], std::make_pair(make_midi_key(99, 5), 127 * 128));
  EXPECT_EQ(sink_.steps[1], std::make_pair(make_midi_key(99, 5), 16383));
  // The old order reads the same bytes as NRPN 5 × 128, which has no stored value.
  sink_.steps.clear();
  sink_.compatibility = 0;
  send_cc(1, 99, 0);
  send_cc(1, 98, 5);
  send_cc(1, 6, 127);
  send_cc(1, 38, 127);
  ASSERT_EQ(sink_.steps.size(), 2u);
  EXPECT_EQ(sink_.steps[1], std::make_pair(make_midi_key(99, 640), 0));
  EXPECT_EQ(receiver_.decoded().back(), "nrpn 1 640 0");
}

TEST_F(Decoding, NrpnValuesAreKeptPerNumberAndChannel) {
  sink_.compatibility = 1;
  auto select = [&](int channel, int number) {
    send_cc(channel, 99, number >> 7);
    send_cc(channel, 98, number & 127);
  };
  select(0, 200);
  send_cc(0, 6, 10);
  select(0, 201);
  send_cc(0, 6, 20);
  select(0, 200);
  send_cc(0, 38, 3);  // only the low bits change: the high bits of NRPN 200 stay
  EXPECT_EQ(sink_.steps.back(), std::make_pair(make_midi_key(99, 200), 10 * 128 + 3));
  select(2, 200);
  send_cc(2, 38, 1);  // another channel keeps its own table
  EXPECT_EQ(sink_.steps.back(), std::make_pair(make_midi_key(99, 200), 1));
  // Above the table: the key still comes, the value is 0 and nothing is stored.
  select(0, 16383);
  send_cc(0, 6, 127);
  EXPECT_EQ(sink_.steps.back(), std::make_pair(make_midi_key(99, 16383), 0));
}

TEST_F(Decoding, RpnBendRangeTuningAndReset) {
  sink_.compatibility = 1;
  EXPECT_DOUBLE_EQ(input_.get_channel_state(0).bend_range, 2.0);
  EXPECT_DOUBLE_EQ(input_.get_channel_state(0).tuning, 0.0);
  send_cc(0, 101, 0);
  send_cc(0, 100, 0);
  send_cc(0, 6, 64 + 12);
  send_cc(0, 38, 50);
  EXPECT_NEAR(input_.get_channel_state(0).bend_range, 12.5, 1e-12);
  EXPECT_EQ(sink_.steps.back(), std::make_pair(make_midi_key(101, 0), (76 << 7) | 50));
  // A bend at full deflection reaches the range: ((127 - 64) × 128 + 127) × range / 8192.
  send(0xE0, 127, 127);
  EXPECT_NEAR(receiver_.last_bend, ((127 - 64) * 128 + 127) * 12.5 / 8192.0, 1e-5);
  // RPN 2: coarse tuning from CC 6 only.
  send_cc(0, 100, 2);
  send_cc(0, 6, 64 - 3);
  EXPECT_NEAR(input_.get_channel_state(0).tuning, -3.0, 1e-12);
  EXPECT_EQ(sink_.steps.back().second, 61);
  send(0x90, 60, 100);
  EXPECT_NEAR(receiver_.last_pitch, 57.0, 1e-6);
  // The null RPN resets the numbers and values.
  send_cc(0, 101, 127);
  send_cc(0, 100, 127);
  send_cc(0, 6, 0);
  EXPECT_DOUBLE_EQ(input_.get_channel_state(0).bend_range, 2.0);
  EXPECT_DOUBLE_EQ(input_.get_channel_state(0).tuning, 0.0);
  EXPECT_EQ(input_.get_channel_state(0).rpn_number, 0);
}

TEST_F(Decoding, PlainControllersCarryTheirValueInTheHighBits) {
  send_cc(3, 7, 64);
  ASSERT_EQ(sink_.steps.size(), 1u);
  EXPECT_EQ(sink_.steps[0], std::make_pair(make_midi_key(7, 0), 64 * 128));
  EXPECT_NEAR(sink_.steps[0].second / 16383.0, 0.50003, 1e-5);
  // Data bytes are masked to 7 bits.
  send(0xB3, 0x80 | 7, 0xFF);
  EXPECT_EQ(sink_.steps.back(), std::make_pair(make_midi_key(7, 0), 127 * 128));
}

TEST_F(Decoding, NotesPressureProgramAndRawCopies) {
  send(0x91, 60, 64, 17, 25);
  EXPECT_EQ(receiver_.events[0], "time 17");
  EXPECT_EQ(receiver_.events[1], "on 1 60");
  EXPECT_NEAR(receiver_.last_pitch, 60.25, 1e-6);
  EXPECT_FLOAT_EQ(receiver_.last_velocity, 1.0f);
  EXPECT_EQ(receiver_.events[2], "raw 1 9 60 64");
  send(0x91, 62, 1);
  send(0x91, 60, 0);  // velocity 0 is a note off
  EXPECT_EQ(receiver_.decoded()[2], "off 1 60");
  send(0xD1, 32, 0);  // channel pressure reaches the one note still held
  EXPECT_EQ(receiver_.decoded()[3], "pressure 1 62");
  EXPECT_FLOAT_EQ(receiver_.last_pressure, 0.5f);
  send(0xC1, 300 & 0xFF, 0);  // masked to program 44
  EXPECT_EQ(receiver_.decoded()[4], "program 1 44");
  const size_t before = receiver_.events.size();
  send(0xF8, 0, 0);  // system messages are not decoded
  send(0x40, 1, 2);  // nor stray data bytes
  EXPECT_EQ(receiver_.events.size(), before);
  EXPECT_EQ(receiver_.decoded().size(), 5u);
}

// The MIDI file reader: timing through the tempo map, track merging, bad files.
#include <gtest/gtest.h>

#include <random>
#include <stdexcept>

#include "cli/midi_file.h"
#include "smf_builder.h"

namespace {
basic::MidiFileData parse(const std::vector<uint8_t>& bytes) { return basic::parse_midi_file(bytes.data(), bytes.size()); }
}  // namespace

TEST(MidiFileReader, TempoMapOfAFormat1File) {
  SmfBuilder smf(1, 480);
  // Conductor track: 60 bpm, then 240 bpm from beat 1.
  smf.add_track({{0, SmfBuilder::tempo(1000000)}, {480, SmfBuilder::tempo(250000)}});
  smf.add_track({{240, {0xB0, 7, 100}}, {720, {0xB1, 10, 1}}, {1920, {0x90, 60, 90}}, {0, {60, 0}}});
  const auto file = parse(smf.bytes());
  EXPECT_EQ(file.format, 1);
  EXPECT_EQ(file.tracks, 2);
  ASSERT_EQ(file.events.size(), 4u);
  // Tick 240: half a beat at 1 s per beat. Tick 960: 1 s + 480 ticks at 0.25 s per beat.
  // Tick 2880: 1 s + 2400 × 0.25 / 480. The last event reuses the note-on status.
  const double expected[] = {0.5, 1.0 + 480 * 0.25 / 480, 1.0 + 2400 * 0.25 / 480, 1.0 + 2400 * 0.25 / 480};
  for (int i = 0; i < 4; ++i) EXPECT_NEAR(file.events[static_cast<size_t>(i)].seconds, expected[i], 1e-12) << i;
  EXPECT_EQ(file.events[1].bytes[0], 0xB1);
  EXPECT_EQ(file.events[3].bytes[0], 0x90);
  EXPECT_EQ(file.events[3].bytes[1], 60);
  EXPECT_EQ(file.events[3].bytes[2], 0);
}

TEST(MidiFileReader, Format0WithSysexMetaAndProgramChange) {
  SmfBuilder smf(0, 96);
  smf.add_track({{0, {0xF0, 0x03, 0x7E, 0x7F, 0xF7}},
                 {0, {0xFF, 0x03, 0x04, 'n', 'a', 'm', 'e'}},
                 {96, {0xC2, 5}},
                 {96, {0xD2, 40}}});
  const auto file = parse(smf.bytes());
  ASSERT_EQ(file.events.size(), 2u);
  EXPECT_NEAR(file.events[0].seconds, 0.5, 1e-12);  // default 120 bpm
  EXPECT_EQ(file.events[0].bytes[0], 0xC2);
  EXPECT_EQ(file.events[0].bytes[1], 5);
  EXPECT_NEAR(file.events[1].seconds, 1.0, 1e-12);
}

TEST(MidiFileReader, TracksMergeInTimeOrderKeepingTrackOrderOnTies) {
  SmfBuilder smf(1, 100);
  smf.add_track({{10, {0xB0, 1, 1}}, {10, {0xB0, 1, 2}}});
  smf.add_track({{10, {0xB0, 2, 1}}, {5, {0xB0, 2, 2}}});
  const auto file = parse(smf.bytes());
  ASSERT_EQ(file.events.size(), 4u);
  const int order[][2] = {{1, 1}, {2, 1}, {2, 2}, {1, 2}};
  for (int i = 0; i < 4; ++i) {
    EXPECT_EQ(file.events[static_cast<size_t>(i)].bytes[1], order[i][0]) << i;
    EXPECT_EQ(file.events[static_cast<size_t>(i)].bytes[2], order[i][1]) << i;
  }
}

TEST(MidiFileReader, SmpteDivision) {
  SmfBuilder smf(0, (256 - 25) << 8 | 40);  // 25 frames per second, 40 ticks per frame
  smf.add_track({{1000, {0xB0, 7, 1}}});
  const auto file = parse(smf.bytes());
  ASSERT_EQ(file.events.size(), 1u);
  EXPECT_NEAR(file.events[0].seconds, 1000.0 / (25 * 40), 1e-12);
}

TEST(MidiFileReader, RefusesBadFiles) {
  auto refused = [](const std::vector<uint8_t>& bytes) {
    EXPECT_THROW(basic::parse_midi_file(bytes.data(), bytes.size()), std::runtime_error);
  };
  refused({});
  refused({'M', 'T', 'h', 'x', 0, 0, 0, 6, 0, 0, 0, 1, 0, 96});
  SmfBuilder format2(2, 96);
  format2.add_track({{0, {0xB0, 1, 1}}});
  refused(format2.bytes());
  SmfBuilder zero_division(0, 0);
  zero_division.add_track({});
  refused(zero_division.bytes());
  SmfBuilder running(0, 96);
  running.add_track({{0, {0x40, 0x40}}});  // data without any status
  refused(running.bytes());
  SmfBuilder missing(1, 96);
  missing.add_track({{0, {0xB0, 1, 1}}});
  refused(missing.bytes(2));  // header promises two tracks
  SmfBuilder long_number(0, 96);
  long_number.add_track({{0, {0xFF, 0x01, 0xFF, 0xFF, 0xFF, 0xFF, 0x7F}}});
  refused(long_number.bytes());
  // Every truncation of a good file is refused or read in part, never read past.
  SmfBuilder good(1, 480);
  good.add_track({{0, SmfBuilder::tempo(400000)}, {10, {0xB0, 7, 1}}, {10, {0xE0, 0, 64}}});
  const auto bytes = good.bytes();
  for (size_t n = 0; n < bytes.size(); ++n) {
    std::vector<uint8_t> cut(bytes.begin(), bytes.begin() + static_cast<long>(n));
    EXPECT_THROW(basic::parse_midi_file(cut.data(), cut.size()), std::runtime_error) << n;
  }
  EXPECT_EQ(parse(bytes).events.size(), 2u);
}

TEST(MidiFileReader, RandomBytesNeverCrash) {
  std::mt19937 random(7);
  SmfBuilder good(1, 480);
  good.add_track({{0, SmfBuilder::tempo(400000)}, {10, {0xB0, 7, 1}}, {10, {0xC0, 3}}, {10, {0xE0, 0, 64}}});
  const auto bytes = good.bytes();
  for (int round = 0; round < 2000; ++round) {
    std::vector<uint8_t> damaged = bytes;
    for (int k = 0; k < 3; ++k) damaged[14 + random() % (damaged.size() - 14)] = static_cast<uint8_t>(random());
    try {
      const auto file = basic::parse_midi_file(damaged.data(), damaged.size());
      for (const auto& event : file.events) ASSERT_GE(event.bytes[0], 0x80);
    } catch (const std::runtime_error&) {
    }
  }
}

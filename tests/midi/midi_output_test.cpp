// Packet forms of outputs and the host output's hand-over at block start.
#include <gtest/gtest.h>

#include <atomic>
#include <thread>

#include "host/audio_effect_x.h"
#include "midi/midi_settings.h"
#include "midi/vst2_midi_ports.h"
#include "midi_test_support.h"

TEST(MidiPackets, ProgramChangeAndNumberedControllers) {
  plugcore::MidiSettings settings;
  settings.set_values(1, 1);
  PacketRecorder out(&settings);
  EXPECT_EQ(out.program_change(0, 300), 1);
  ASSERT_EQ(out.packets.size(), 3u);
  EXPECT_EQ(out.packets[0], cc(0, 0, 2));
  EXPECT_EQ(out.packets[1], cc(0, 32, 0));
  EXPECT_EQ(out.packets[2], (std::vector<int>{0xC0, 44, 0, 0}));
  out.packets.clear();
  EXPECT_EQ(out.nrpn(3, 300, 8192), 1);
  ASSERT_EQ(out.packets.size(), 4u);
  EXPECT_EQ(out.packets[0], cc(3, 99, 2));
  EXPECT_EQ(out.packets[1], cc(3, 98, 44));
  EXPECT_EQ(out.packets[2], cc(3, 6, 64));
  EXPECT_EQ(out.packets[3], cc(3, 38, 0));
  // The old order swaps which selector carries the high bits, for both kinds.
  settings.set_values(0, 1);
  out.packets.clear();
  out.nrpn(3, 300, 8192);
  EXPECT_EQ(out.packets[0], cc(3, 98, 2));
  EXPECT_EQ(out.packets[1], cc(3, 99, 44));
  out.packets.clear();
  out.rpn(0, 1, 0x2000);
  EXPECT_EQ(out.packets[0], cc(0, 100, 0));
  EXPECT_EQ(out.packets[1], cc(0, 101, 1));
  EXPECT_EQ(out.packets[2], cc(0, 6, 64));
  out.packets.clear();
  EXPECT_EQ(out.channel_message(5, 14, 0x7F, 0x40), 1);
  EXPECT_EQ(out.single_byte_message(0xF8), 1);
  EXPECT_EQ(out.three_byte_message(0x90, 60, 100), 1);
  EXPECT_EQ(out.note_on(0, 60, 60.0f, 0, 1.0f, 1), 0);  // notes are not sent
  ASSERT_EQ(out.packets.size(), 3u);
  EXPECT_EQ(out.packets[0], (std::vector<int>{0xE5, 0x7F, 0x40, 0}));
  EXPECT_EQ(out.packets[1], (std::vector<int>{0xF8, 0, 0, 0}));
  EXPECT_EQ(out.packets[2], (std::vector<int>{0x90, 60, 100, 0}));
  // A slot answers false as soon as one packet is refused.
  out.accept_limit = 5;
  EXPECT_EQ(out.nrpn(0, 1, 1), 0);
}

namespace {

// A bare plug-in base whose host records the event lists it is handed.
struct EventHost {
  static intptr_t VST2_CALL callback(AEffect*, int32_t opcode, int32_t, intptr_t, void* ptr, float) {
    if (opcode == audioMasterProcessEvents && current != nullptr) {
      const auto* list = static_cast<const VstEvents*>(ptr);
      current->lists.push_back(list);
      for (int i = 0; i < list->numEvents; ++i) {
        const auto* event = reinterpret_cast<const VstMidiEvent*>(list->events[i]);
        EXPECT_EQ(event->type, kVstMidiType);
        EXPECT_EQ(event->byteSize, 32);
        current->bytes.push_back(static_cast<uint8_t>(event->midiData[1]));
      }
      return 1;
    }
    return opcode == audioMasterVersion ? 2400 : 0;
  }
  std::vector<const VstEvents*> lists;
  std::vector<uint8_t> bytes;
  static EventHost* current;
};
EventHost* EventHost::current = nullptr;

}  // namespace

TEST(HostMidiOut, PacketsReachTheHostAtTheNextBlockStart) {
  EventHost host;
  EventHost::current = &host;
  AudioEffectX plugin(&EventHost::callback, 1, 1);
  plugcore::MidiSettings settings;
  plugcore::Vst2MidiOut out(&settings);
  out.set_plugin(&plugin);
  EXPECT_EQ(out.send_packet(0xB0, 1, 2, 0), 0);  // closed: refused
  ASSERT_EQ(out.open(), 0);
  out.begin_block();
  EXPECT_TRUE(host.lists.empty());  // nothing queued, nothing handed over
  for (int i = 0; i < 1030; ++i) {
    EXPECT_EQ(out.send_packet(0xB0, i & 127, 0, 0), i < 1024 ? 1 : 0) << i;
  }
  out.begin_block();
  ASSERT_EQ(host.lists.size(), 1u);
  EXPECT_EQ(host.lists[0]->numEvents, 1024);
  for (int i = 0; i < 1024; ++i) ASSERT_EQ(host.bytes[static_cast<size_t>(i)], i & 127);
  out.send_packet(0xB0, 9, 9, 0);
  out.begin_block();
  ASSERT_EQ(host.lists.size(), 2u);
  EXPECT_NE(host.lists[0], host.lists[1]);  // the lists alternate
  EXPECT_EQ(host.lists[1]->numEvents, 1);
  out.close();
  EventHost::current = nullptr;
}

TEST(HostMidiOut, EditorThreadSendsWhileTheAudioThreadHandsOver) {
  EventHost host;
  EventHost::current = &host;
  AudioEffectX plugin(&EventHost::callback, 1, 1);
  plugcore::MidiSettings settings;
  plugcore::Vst2MidiOut out(&settings);
  out.set_plugin(&plugin);
  out.open();
  out.begin_block();
  constexpr int kPackets = 20000;
  std::atomic<bool> done{false};
  std::thread editor([&] {
    for (int i = 0; i < kPackets; ++i) {
      while (out.send_packet(0xB0, i & 127, 0, 0) == 0) std::this_thread::yield();
    }
    done = true;
  });
  while (!done.load() || host.bytes.size() < static_cast<size_t>(kPackets)) {
    out.begin_block();
  }
  editor.join();
  ASSERT_EQ(host.bytes.size(), static_cast<size_t>(kPackets));
  for (int i = 0; i < kPackets; ++i) ASSERT_EQ(host.bytes[static_cast<size_t>(i)], i & 127) << i;
  EventHost::current = nullptr;
}

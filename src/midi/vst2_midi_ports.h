#pragma once

#include <array>
#include <atomic>
#include <cstdint>

#include "host/vst2_abi.h"
#include "midi/bounded_mpsc_queue.h"
#include "midi/midi_in_chn.h"
#include "midi/midi_out_4b_packet_mixin.h"

class AudioEffectX;

namespace plugcore {

// Holds the plug-in for the devices that talk to the host.
class Vst2Component {
 public:
  void set_plugin(AudioEffectX* plugin) { plugin_ = plugin; }
  AudioEffectX* get_plugin() const { return plugin_; }

 protected:
  AudioEffectX* plugin_ = nullptr;
};

// Host MIDI in: the host's events are decoded as processEvents hands them
// over; open and close only switch it on and off.
class Vst2MidiIn : public MidiInChn, public Vst2Component {
 public:
  using MidiInChn::MidiInChn;
  int open() override;
  int close() override;
  void begin_block() override {}
  void end_block() override {}
  int receive_host_event(const unsigned char bytes[3], int sample_offset, int detune_cents) override;
  bool is_open() const { return open_.load(std::memory_order_relaxed); }

 private:
  std::atomic<bool> open_{false};
};

// Host MIDI out: packets from any thread are queued without a lock; at the
// start of each audio block the queue is emptied into one of two event
// lists, which is handed to the host, so what was sent during one block
// reaches the host at the start of the next. The two lists alternate so the
// one the host was last given stays intact for a whole block.
class Vst2MidiOut : public MidiOut4BPacketMixin, public Vst2Component {
 public:
  static constexpr int kCapacity = 1024;

  explicit Vst2MidiOut(const MidiSettings* settings);
  int open() override;
  int close() override;
  void begin_block() override;
  void end_block() override {}
  int send_packet(int b0, int b1, int b2, int b3) override;

 private:
  // The list header has room for every event of a full list.
  struct EventList {
    int32_t numEvents = 0;
    intptr_t reserved = 0;
    std::array<VstEvent*, kCapacity> events{};
  };
  struct Buffer {
    std::array<VstMidiEvent, kCapacity> midi{};
    EventList list;
  };

  std::array<Buffer, 2> buffers_;
  int current_ = 0;
  basic::BoundedMpscQueue<uint32_t, kCapacity> queue_;
  std::atomic<bool> open_{false};
};

}  // namespace plugcore

#pragma once

#include <cstdint>

#include "midi/lock_free_ring_fifo.h"
#include "midi/midi_in_chn.h"
#include "midi/midi_out_4b_packet_mixin.h"
#include "midi/midi_port_driver_interface.h"

namespace plugcore {

// A system MIDI input: the driver's thread queues each short message, the
// audio thread decodes the queue at the start of each block.
class MciMidiIn : public MidiInChn, public sys::MidiInputSinkInterface {
 public:
  static constexpr size_t kQueueCapacity = 4000;  // holds at most 3999 messages
  struct Entry {
    uint32_t status;
    uint32_t data1;
    uint32_t data2;
    uint32_t time_stamp;
  };

  MciMidiIn(MidiReceiverInterface* receiver, MidiControllerSinkInterface* sink, sys::MidiPortDriverInterface* driver,
            int port);
  ~MciMidiIn() override;

  int open() override;
  int close() override;
  void begin_block() override;
  void end_block() override {}
  // Driver thread. A full queue drops the newest message.
  void on_midi_short(uint32_t message, uint32_t time_stamp) override;

  int get_port() const { return port_; }

 private:
  sys::MidiPortDriverInterface* driver_;
  int port_;
  bool is_open_ = false;
  basic::LockFreeRingFifo<Entry, kQueueCapacity> queue_;
};

// A system MIDI output: each packet goes straight to the driver.
class MciMidiOut : public MidiOut4BPacketMixin {
 public:
  MciMidiOut(const MidiSettings* settings, sys::MidiPortDriverInterface* driver, int port);
  ~MciMidiOut() override;
  int open() override;
  int close() override;
  void begin_block() override {}
  void end_block() override {}
  int send_packet(int b0, int b1, int b2, int b3) override;

 private:
  sys::MidiPortDriverInterface* driver_;
  int port_;
  bool is_open_ = false;
};

}  // namespace plugcore

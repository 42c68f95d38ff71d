#pragma once

#include "midi/midi_receiver_interface.h"

namespace plugcore {

// Common base of MIDI devices. open and close answer 0 or -1; the block
// steps run on the audio thread.
class MidiDevInterface {
 public:
  virtual ~MidiDevInterface() = default;
  virtual int open() = 0;
  virtual int close() = 0;
  virtual void begin_block() = 0;
  virtual void end_block() = 0;
};

class MidiInInterface : public MidiDevInterface {
 public:
  // Host MIDI: one event of the host's list, decoded at once. Only the host
  // input takes them; other inputs answer -1.
  virtual int receive_host_event(const unsigned char bytes[3], int sample_offset, int detune_cents) { return -1; }
};

// An output device: the events it receives are sent.
class MidiOutInterface : public MidiDevInterface, public MidiReceiverInterface {};

}  // namespace plugcore

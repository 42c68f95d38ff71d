#pragma once

#include <array>

#include "midi/midi_channel_state.h"
#include "midi/midi_dev_interface.h"

namespace plugcore {

class MidiControllerSinkInterface;

// An input that decodes channel messages with one state per MIDI channel:
// notes, pressure, program, bend go to the receiver, controllers to the sink.
class MidiInChn : public MidiInInterface {
 public:
  MidiInChn(MidiReceiverInterface* receiver, MidiControllerSinkInterface* sink);

  // One message (status s, data d1, d2) at the sample offset; detune in
  // hundredths of a semitone from the host, 0 for system input. Data bytes
  // are masked to 7 bits; system messages and stray data bytes are ignored.
  void decode_message(int s, int d1, int d2, int sample_offset, int detune_cents);

  const MidiChannelState& get_channel_state(int channel) const { return channels_[static_cast<size_t>(channel & 15)]; }

 protected:
  MidiReceiverInterface* receiver_;
  MidiControllerSinkInterface* sink_;
  std::array<MidiChannelState, 16> channels_;
};

}  // namespace plugcore

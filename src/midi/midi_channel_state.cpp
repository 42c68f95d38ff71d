#include "midi/midi_channel_state.h"

namespace plugcore {

void MidiChannelState::reset_rpn() {
  rpn_number = 0;
  rpn0_value = kRpn0Start;
  rpn12_value = kRpn12Start;
  update_bend_range();
  update_tuning();
}

// Both values carry 64 as the zero of their high 7 bits and hundredths of a
// semitone in the low 7 bits, so the start values mean 2 semitones and 0.
void MidiChannelState::update_bend_range() {
  bend_range = (rpn0_value >> 7) - 64 + (rpn0_value & 127) * 0.01;
  bend_scale = bend_range / 8192.0;
}

void MidiChannelState::update_tuning() { tuning = (rpn12_value >> 7) - 64 + (rpn12_value & 127) * 0.01; }

}  // namespace plugcore

#include "midi/midi_in_chn.h"

#include "midi/midi_controller_sink_interface.h"
#include "midi/midi_in_cc_mixin.h"

namespace plugcore {

namespace {
// Decoded events go nowhere when no receiver is given.
MidiReceiverInterface g_no_receiver;
}  // namespace

MidiInChn::MidiInChn(MidiReceiverInterface* receiver, MidiControllerSinkInterface* sink)
    : receiver_(receiver != nullptr ? receiver : &g_no_receiver), sink_(sink) {
  for (int c = 0; c < 16; ++c) {
    channels_[static_cast<size_t>(c)].receiver = receiver_;
    channels_[static_cast<size_t>(c)].channel = c;
  }
}

void MidiInChn::decode_message(int s, int d1, int d2, int sample_offset, int detune_cents) {
  s &= 0xFF;
  if (s < 0x80 || s >= 0xF0) {
    return;
  }
  d1 &= 127;
  d2 &= 127;
  const int channel = s & 15;
  const int nibble = s >> 4;
  MidiChannelState& state = channels_[static_cast<size_t>(channel)];
  receiver_->set_time_stamp(sample_offset);
  switch (nibble) {
    case 8:
      state.held_notes.reset(static_cast<size_t>(d1));
      receiver_->note_off(channel, d1, d2 / 64.0f);
      break;
    case 9:
      if (d2 > 0) {
        state.held_notes.set(static_cast<size_t>(d1));
        const double pitch = d1 + detune_cents * 0.01 + state.tuning;
        receiver_->note_on(channel, d1, static_cast<float>(pitch), 0, d2 / 64.0f, 1);
      } else {
        state.held_notes.reset(static_cast<size_t>(d1));
        receiver_->note_off(channel, d1, 0.0f);
      }
      break;
    case 10:
      receiver_->key_pressure(channel, d1, d2 / 64.0f);
      break;
    case 11: {
      int32_t key = 0;
      int value = 0;
      const int compatibility = sink_ != nullptr ? sink_->get_nrpn_compatibility() : 0;
      if (MidiInCcMixin::decode_controller(state, d1, d2, compatibility, key, value) && sink_ != nullptr) {
        sink_->controller_step(key, value);
      }
      break;
    }
    case 12:
      state.program = d1;
      receiver_->program_change(channel, state.bank * 128 + state.program);
      break;
    case 13:
      for (int note = 0; note < 128; ++note) {
        if (state.held_notes.test(static_cast<size_t>(note))) {
          receiver_->key_pressure(channel, note, d1 / 64.0f);
        }
      }
      break;
    case 14:
      state.bend_position = ((d2 - 64) * 128 + d1) * state.bend_scale;
      receiver_->pitch_bend(channel, static_cast<float>(state.bend_position));
      break;
    default:
      break;
  }
  receiver_->channel_message(channel, nibble, d1, d2);
}

}  // namespace plugcore

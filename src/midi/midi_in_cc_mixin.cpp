#include "midi/midi_in_cc_mixin.h"

#include "midi/midi_channel_state.h"
#include "midi/midi_controller_key.h"
#include "midi/midi_receiver_interface.h"

namespace plugcore {

namespace {

int with_high(int number, int v) { return (number & 127) | (v << 7); }
int with_low(int number, int v) { return (number & ~127) | v; }

void store_data_entry(MidiChannelState& state, bool high, int v) {
  if (state.selected_kind == 1) {
    if (state.nrpn_number < MidiChannelState::kNbrNrpnValues) {
      uint16_t& slot = state.nrpn_values[static_cast<size_t>(state.nrpn_number)];
      slot = static_cast<uint16_t>(high ? with_high(slot, v) : with_low(slot, v));
    }
    return;
  }
  switch (state.rpn_number) {
    case 0:
      state.rpn0_value = high ? with_high(state.rpn0_value, v) : with_low(state.rpn0_value, v);
      state.update_bend_range();
      break;
    case 1:
      state.rpn12_value = high ? with_high(state.rpn12_value, v) : with_low(state.rpn12_value, v);
      state.update_tuning();
      break;
    case 2:
      if (high) {
        state.rpn12_value = v * 128;
        state.update_tuning();
      }
      break;
    case MidiChannelState::kNullRpn:
      state.reset_rpn();
      break;
    default:
      break;
  }
}

}  // namespace

bool MidiInCcMixin::decode_controller(MidiChannelState& state, int n, int v, int nrpn_compatibility, int32_t& key,
                                      int& value) {
  n &= 127;
  v &= 127;
  const bool standard = nrpn_compatibility != 0;
  switch (n) {
    case 99:
      state.nrpn_number = standard ? with_high(state.nrpn_number, v) : with_low(state.nrpn_number, v);
      state.selected_kind = 1;
      return false;
    case 98:
      state.nrpn_number = standard ? with_low(state.nrpn_number, v) : with_high(state.nrpn_number, v);
      state.selected_kind = 1;
      return false;
    case 101:
      state.rpn_number = standard ? with_high(state.rpn_number, v) : with_low(state.rpn_number, v);
      state.selected_kind = 0;
      return false;
    case 100:
      state.rpn_number = standard ? with_low(state.rpn_number, v) : with_high(state.rpn_number, v);
      state.selected_kind = 0;
      return false;
    default:
      break;
  }
  if (n == 6 || n == 38) {
    store_data_entry(state, n == 6, v);
    if (state.selected_kind == 1) {
      const int number = state.nrpn_number;
      value = number < MidiChannelState::kNbrNrpnValues ? state.nrpn_values[static_cast<size_t>(number)] : 0;
      if (state.receiver != nullptr) state.receiver->nrpn(state.channel, number, value);
      key = make_midi_key(kMidiKindNrpn, number);
    } else {
      const int number = state.rpn_number;
      value = number == 0 ? state.rpn0_value : number == 1 ? state.rpn12_value : number == 2 ? state.rpn12_value >> 7 : 0;
      if (state.receiver != nullptr) state.receiver->rpn(state.channel, number, value);
      key = make_midi_key(kMidiKindRpn, number);
    }
    return true;
  }
  key = make_midi_key(n, 0);
  value = v * 128;
  return true;
}

}  // namespace plugcore

#pragma once

#include <array>
#include <bitset>
#include <cstdint>

namespace plugcore {

class MidiReceiverInterface;

// What one MIDI channel of one input remembers between messages: held notes,
// the selected RPN/NRPN numbers and their values, the bend range and tuning.
struct MidiChannelState {
  static constexpr int kNbrNrpnValues = 256;  // NRPN numbers from here up keep no value
  static constexpr int kRpn0Start = 0x2100;
  static constexpr int kRpn12Start = 0x2000;
  static constexpr int kNullRpn = 16383;

  MidiChannelState() { reset_rpn(); }
  void reset_rpn();
  // Derived values of RPN 0 (bend range) and RPN 1/2 (fine tuning).
  void update_bend_range();
  void update_tuning();

  MidiReceiverInterface* receiver = nullptr;
  int channel = 0;
  std::bitset<128> held_notes;
  int selected_kind = 0;  // 0: RPN, 1: NRPN
  int32_t bank = 0;
  int32_t program = 0;
  int rpn_number = 0;
  int rpn0_value = kRpn0Start;
  int rpn12_value = kRpn12Start;
  int nrpn_number = 0;
  std::array<uint16_t, kNbrNrpnValues> nrpn_values{};
  double bend_position = 0.0;
  double bend_range = 2.0;
  double bend_scale = 2.0 / 8192.0;
  double tuning = 0.0;
};

}  // namespace plugcore

#include "midi/midi_out_4b_packet_mixin.h"

#include "midi/midi_settings.h"

namespace plugcore {

int MidiOut4BPacketMixin::send_cc(int channel, int controller, int value) {
  return send_packet(0xB0 + (channel & 15), controller & 127, value & 127, 0) != 0 ? 1 : 0;
}

// Sends the high 7 bits of the number, then the low 7 bits, each on the
// selector that the byte order gives it, then data entry high and low; true
// only when all four packets were accepted. a is CC 99 (NRPN) or 101 (RPN),
// b its partner 98 or 100: the standard order puts the high bits on a.
int MidiOut4BPacketMixin::send_numbered(int channel, int a, int b, int number, int value) {
  const bool standard = settings_ != nullptr && settings_->get_nrpn_compatibility() != 0;
  int ok = send_cc(channel, standard ? a : b, (number >> 7) & 127);
  ok &= send_cc(channel, standard ? b : a, number & 127);
  ok &= send_cc(channel, 6, (value >> 7) & 127);
  ok &= send_cc(channel, 38, value & 127);
  return ok;
}

int MidiOut4BPacketMixin::program_change(int channel, int program) {
  int ok = send_cc(channel, 0, (program >> 7) & 127);
  ok &= send_cc(channel, 32, (program >> 14) & 127);
  ok &= send_packet(0xC0 + (channel & 15), program & 127, 0, 0) != 0 ? 1 : 0;
  return ok;
}

int MidiOut4BPacketMixin::rpn(int channel, int number, int value) { return send_numbered(channel, 101, 100, number, value); }

int MidiOut4BPacketMixin::nrpn(int channel, int number, int value) { return send_numbered(channel, 99, 98, number, value); }

int MidiOut4BPacketMixin::channel_message(int channel, int status, int data1, int data2) {
  return send_packet(((status & 15) << 4) + (channel & 15), data1 & 127, data2 & 127, 0) != 0 ? 1 : 0;
}

int MidiOut4BPacketMixin::single_byte_message(int status) { return send_packet(status & 0xFF, 0, 0, 0) != 0 ? 1 : 0; }

int MidiOut4BPacketMixin::three_byte_message(int byte1, int byte2, int byte3) {
  return send_packet(byte1 & 0xFF, byte2 & 0xFF, byte3 & 0xFF, 0) != 0 ? 1 : 0;
}

}  // namespace plugcore

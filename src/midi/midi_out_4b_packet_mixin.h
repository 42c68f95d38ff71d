#pragma once

#include "midi/midi_dev_interface.h"

namespace plugcore {

class MidiSettings;

// Turns the events an output receives into 4-byte MIDI packets (byte 3
// always 0) for send_packet. RPN/NRPN numbers go out in the selector order
// that the NRPN compatibility setting names.
class MidiOut4BPacketMixin : public MidiOutInterface {
 public:
  explicit MidiOut4BPacketMixin(const MidiSettings* settings) : settings_(settings) {}

  // Nonzero when the packet was accepted.
  virtual int send_packet(int b0, int b1, int b2, int b3) = 0;

  int program_change(int channel, int program) override;
  int rpn(int channel, int number, int value) override;
  int nrpn(int channel, int number, int value) override;
  int channel_message(int channel, int status, int data1, int data2) override;
  int single_byte_message(int status) override;
  int three_byte_message(int byte1, int byte2, int byte3) override;

 private:
  int send_cc(int channel, int controller, int value);
  int send_numbered(int channel, int a, int b, int number, int value);

  const MidiSettings* settings_;
};

}  // namespace plugcore

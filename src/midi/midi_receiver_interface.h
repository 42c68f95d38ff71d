#pragma once

namespace plugcore {

// Sink for decoded MIDI events: the engine, the MIDI manager and the output ports.
// Every operation answers 0 unless a receiver does something with the event.
class MidiReceiverInterface {
 public:
  virtual ~MidiReceiverInterface() = default;
  virtual int set_time_stamp(int sample_offset) { return 0; }
  virtual int note_on(int channel, int note, float pitch, int zero, float velocity, int one) { return 0; }
  virtual int note_off(int channel, int note, float velocity) { return 0; }
  virtual int key_pressure(int channel, int note, float pressure) { return 0; }
  virtual int pitch_bend(int channel, float semitones) { return 0; }
  virtual int program_change(int channel, int program) { return 0; }
  virtual int rpn(int channel, int number, int value) { return 0; }
  virtual int nrpn(int channel, int number, int value) { return 0; }
  virtual int channel_message(int channel, int status, int data1, int data2) { return 0; }
  virtual int single_byte_message(int status) { return 0; }
  virtual int three_byte_message(int byte1, int byte2, int byte3) { return 0; }
  virtual int unnamed_pair(int a, int b) { return 0; }
  virtual int unnamed_plain() { return 0; }
};

}  // namespace plugcore

#include "midi/mci_midi_ports.h"

namespace plugcore {

MciMidiIn::MciMidiIn(MidiReceiverInterface* receiver, MidiControllerSinkInterface* sink,
                     sys::MidiPortDriverInterface* driver, int port)
    : MidiInChn(receiver, sink), driver_(driver), port_(port) {}

MciMidiIn::~MciMidiIn() { close(); }

int MciMidiIn::open() {
  if (is_open_ && close() != 0) return -1;
  if (driver_ == nullptr || driver_->open_input(port_, this) != 0) return -1;
  is_open_ = true;
  return 0;
}

int MciMidiIn::close() {
  if (!is_open_) return 0;
  if (driver_->close_input() != 0) return -1;
  is_open_ = false;  // forgotten only once the driver let go
  return 0;
}

void MciMidiIn::on_midi_short(uint32_t message, uint32_t time_stamp) {
  queue_.push(Entry{message & 0xFF, (message >> 8) & 0xFF, (message >> 16) & 0xFF, time_stamp});
}

void MciMidiIn::begin_block() {
  Entry entry;
  while (queue_.pop(entry)) {
    decode_message(static_cast<int>(entry.status), static_cast<int>(entry.data1), static_cast<int>(entry.data2), 0, 0);
  }
}

MciMidiOut::MciMidiOut(const MidiSettings* settings, sys::MidiPortDriverInterface* driver, int port)
    : MidiOut4BPacketMixin(settings), driver_(driver), port_(port) {}

MciMidiOut::~MciMidiOut() { close(); }

int MciMidiOut::open() {
  if (is_open_) return 0;
  if (driver_ == nullptr || driver_->open_output(port_) != 0) return -1;
  is_open_ = true;
  return 0;
}

int MciMidiOut::close() {
  if (!is_open_) return 0;
  is_open_ = false;
  return driver_->close_output();
}

int MciMidiOut::send_packet(int b0, int b1, int b2, int b3) {
  if (!is_open_) return 0;
  const uint32_t message = static_cast<uint32_t>(b0 & 0xFF) | static_cast<uint32_t>(b1 & 0xFF) << 8 |
                           static_cast<uint32_t>(b2 & 0xFF) << 16 | static_cast<uint32_t>(b3 & 0xFF) << 24;
  return driver_->send_short(message) == 0 ? 1 : 0;
}

}  // namespace plugcore

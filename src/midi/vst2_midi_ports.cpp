#include "midi/vst2_midi_ports.h"

#include <cstddef>
#include <cstring>

#include "host/audio_effect_x.h"

namespace plugcore {

int Vst2MidiIn::open() {
  open_.store(true, std::memory_order_relaxed);
  return 0;
}

int Vst2MidiIn::close() {
  open_.store(false, std::memory_order_relaxed);
  return 0;
}

int Vst2MidiIn::receive_host_event(const unsigned char bytes[3], int sample_offset, int detune_cents) {
  if (!is_open()) return -1;
  decode_message(bytes[0], bytes[1], bytes[2], sample_offset, detune_cents);
  return 0;
}

Vst2MidiOut::Vst2MidiOut(const MidiSettings* settings) : MidiOut4BPacketMixin(settings) {
  static_assert(offsetof(EventList, events) == offsetof(VstEvents, events), "event list header layout");
  for (auto& buffer : buffers_) {
    for (int i = 0; i < kCapacity; ++i) {
      buffer.list.events[static_cast<size_t>(i)] = reinterpret_cast<VstEvent*>(&buffer.midi[static_cast<size_t>(i)]);
    }
  }
}

int Vst2MidiOut::open() {
  open_.store(true, std::memory_order_release);
  return 0;
}

// The dispatcher closes a device only after the MIDI manager let go of it, so
// no audio thread drains the queue any more: what was not handed over is
// stale and goes here, on the closing thread.
int Vst2MidiOut::close() {
  open_.store(false, std::memory_order_release);
  uint32_t packet = 0;
  while (queue_.pop(packet)) {
  }
  return 0;
}

int Vst2MidiOut::send_packet(int b0, int b1, int b2, int b3) {
  if (!open_.load(std::memory_order_acquire)) return 0;
  const uint32_t packet = static_cast<uint32_t>(b0 & 0xFF) | static_cast<uint32_t>(b1 & 0xFF) << 8 |
                          static_cast<uint32_t>(b2 & 0xFF) << 16 | static_cast<uint32_t>(b3 & 0xFF) << 24;
  return queue_.push(packet) ? 1 : 0;
}

void Vst2MidiOut::begin_block() {
  uint32_t packet = 0;
  if (!open_.load(std::memory_order_relaxed) || plugin_ == nullptr) return;
  Buffer& buffer = buffers_[static_cast<size_t>(current_)];
  int count = 0;
  while (count < kCapacity && queue_.pop(packet)) {
    VstMidiEvent& event = buffer.midi[static_cast<size_t>(count)];
    std::memset(&event, 0, sizeof(event));
    event.type = kVstMidiType;
    event.byteSize = sizeof(VstMidiEvent);
    event.deltaFrames = 0;
    for (int b = 0; b < 4; ++b) event.midiData[b] = static_cast<char>((packet >> (8 * b)) & 0xFF);
    ++count;
  }
  if (count == 0) return;
  buffer.list.numEvents = count;
  plugin_->sendVstEventsToHost(reinterpret_cast<VstEvents*>(&buffer.list));
  current_ ^= 1;
}

}  // namespace plugcore

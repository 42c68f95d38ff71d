#include "cli/midi_file.h"

#include <algorithm>
#include <fstream>
#include <iterator>
#include <map>
#include <stdexcept>

namespace basic {

namespace {

constexpr uint32_t kDefaultTempo = 500000;  // microseconds per quarter note: 120 bpm

class ByteReader {
 public:
  ByteReader(const uint8_t* data, size_t size) : data_(data), size_(size) {}
  bool done() const { return pos_ >= size_; }
  size_t left() const { return size_ - pos_; }
  uint8_t peek() const {
    need(1);
    return data_[pos_];
  }
  uint8_t byte() {
    need(1);
    return data_[pos_++];
  }
  uint32_t big_endian(int count) {
    uint32_t value = 0;
    for (int i = 0; i < count; ++i) value = value << 8 | byte();
    return value;
  }
  uint32_t variable_length() {
    uint32_t value = 0;
    for (int i = 0; i < 4; ++i) {
      const uint8_t b = byte();
      value = value << 7 | (b & 0x7F);
      if ((b & 0x80) == 0) return value;
    }
    throw std::runtime_error("MIDI file: variable-length number longer than 4 bytes");
  }
  void skip(size_t count) {
    need(count);
    pos_ += count;
  }
  ByteReader sub(size_t count) {
    need(count);
    ByteReader inner(data_ + pos_, count);
    pos_ += count;
    return inner;
  }

 private:
  void need(size_t count) const {
    if (count > size_ - pos_) throw std::runtime_error("MIDI file: data ends inside a chunk or event");
  }
  const uint8_t* data_;
  size_t size_;
  size_t pos_ = 0;
};

struct TickEvent {
  uint64_t tick;
  MidiFileEvent event;
};

int data_bytes(uint8_t status) { return (status & 0xF0) == 0xC0 || (status & 0xF0) == 0xD0 ? 1 : 2; }

void read_track(ByteReader track, std::vector<TickEvent>& events, std::map<uint64_t, uint32_t>& tempos) {
  uint64_t tick = 0;
  uint8_t running = 0;
  while (!track.done()) {
    tick += track.variable_length();
    uint8_t status = track.peek();
    if (status >= 0x80) {
      track.byte();
    } else if (running == 0) {
      throw std::runtime_error("MIDI file: data byte without a status");
    } else {
      status = running;
    }
    if (status == 0xFF) {
      const uint8_t type = track.byte();
      const uint32_t length = track.variable_length();
      ByteReader meta = track.sub(length);
      if (type == 0x2F) return;  // end of track
      if (type == 0x51) {
        if (length != 3) throw std::runtime_error("MIDI file: tempo event of wrong length");
        const uint32_t tempo = meta.big_endian(3);
        if (tempo == 0) throw std::runtime_error("MIDI file: zero tempo");
        tempos[tick] = tempo;  // a later change at the same tick wins
      }
      running = 0;
    } else if (status == 0xF0 || status == 0xF7) {
      track.skip(track.variable_length());  // system exclusive: not sent
      running = 0;
    } else if (status >= 0xF0) {
      throw std::runtime_error("MIDI file: system message inside a track");
    } else {
      running = status;
      TickEvent timed{tick, {}};
      timed.event.bytes[0] = status;
      for (int i = 0; i < data_bytes(status); ++i) {
        const uint8_t data = track.byte();
        if (data >= 0x80) throw std::runtime_error("MIDI file: status byte where a data byte belongs");
        timed.event.bytes[1 + i] = data;
      }
      events.push_back(timed);
    }
  }
}

}  // namespace

MidiFileData parse_midi_file(const uint8_t* data, size_t size) {
  ByteReader file(data, size);
  if (size < 14 || file.big_endian(4) != 0x4D546864) throw std::runtime_error("MIDI file: no MThd header");
  const uint32_t header_length = file.big_endian(4);
  if (header_length < 6) throw std::runtime_error("MIDI file: header too short");
  ByteReader header = file.sub(header_length);
  MidiFileData result;
  result.format = static_cast<int>(header.big_endian(2));
  result.tracks = static_cast<int>(header.big_endian(2));
  const uint32_t division = header.big_endian(2);
  result.division = static_cast<int>(division);
  if (result.format > 1) throw std::runtime_error("MIDI file: only formats 0 and 1 are read");
  if (result.format == 0 && result.tracks != 1) throw std::runtime_error("MIDI file: format 0 needs one track");
  // Ticks per quarter note, or frames per second times ticks per frame.
  double seconds_per_tick_fixed = 0.0;
  if (division & 0x8000) {
    const int fps = 256 - static_cast<int>((division >> 8) & 0xFF);
    const int per_frame = static_cast<int>(division & 0xFF);
    if (fps <= 0 || per_frame == 0) throw std::runtime_error("MIDI file: bad time division");
    seconds_per_tick_fixed = 1.0 / ((fps == 29 ? 29.97 : fps) * per_frame);
  } else if (division == 0) {
    throw std::runtime_error("MIDI file: zero ticks per quarter note");
  }

  std::vector<TickEvent> events;
  std::map<uint64_t, uint32_t> tempos;
  int found = 0;
  while (!file.done() && found < result.tracks) {
    if (file.left() < 8) throw std::runtime_error("MIDI file: data ends inside a chunk header");
    const uint32_t type = file.big_endian(4);
    const uint32_t length = file.big_endian(4);
    ByteReader chunk = file.sub(length);
    if (type != 0x4D54726B) continue;  // unknown chunks are skipped
    read_track(chunk, events, tempos);
    ++found;
  }
  if (found < result.tracks) throw std::runtime_error("MIDI file: fewer tracks than the header says");

  std::stable_sort(events.begin(), events.end(),
                   [](const TickEvent& a, const TickEvent& b) { return a.tick < b.tick; });
  // Walk the tempo map alongside the sorted events.
  auto tempo = tempos.begin();
  uint64_t segment_tick = 0;
  double segment_seconds = 0.0;
  uint32_t current = kDefaultTempo;
  result.events.reserve(events.size());
  for (const TickEvent& timed : events) {
    MidiFileEvent event = timed.event;
    if (seconds_per_tick_fixed > 0.0) {
      event.seconds = static_cast<double>(timed.tick) * seconds_per_tick_fixed;
    } else {
      while (tempo != tempos.end() && tempo->first <= timed.tick) {
        segment_seconds += static_cast<double>(tempo->first - segment_tick) * current * 1e-6 / division;
        segment_tick = tempo->first;
        current = tempo->second;
        ++tempo;
      }
      event.seconds = segment_seconds + static_cast<double>(timed.tick - segment_tick) * current * 1e-6 / division;
    }
    result.events.push_back(event);
  }
  return result;
}

MidiFileData read_midi_file(const std::string& path) {
  std::ifstream in(path, std::ios::binary);
  if (!in) throw std::runtime_error("cannot open MIDI file " + path);
  const std::vector<uint8_t> bytes((std::istreambuf_iterator<char>(in)), std::istreambuf_iterator<char>());
  return parse_midi_file(bytes.data(), bytes.size());
}

}  // namespace basic

#pragma once

#include <cstdint>
#include <string>
#include <vector>

// Writes Standard MIDI Files for the tests, independently of the reader.
class SmfBuilder {
 public:
  explicit SmfBuilder(int format, int division) : format_(format), division_(division) {}

  // A track from (delta ticks, raw event bytes after the delta) pairs; an end
  // of track is appended unless told otherwise.
  void add_track(const std::vector<std::pair<uint32_t, std::vector<uint8_t>>>& events, bool end = true) {
    std::vector<uint8_t> body;
    for (const auto& event : events) {
      append_vlq(body, event.first);
      body.insert(body.end(), event.second.begin(), event.second.end());
    }
    if (end) body.insert(body.end(), {0x00, 0xFF, 0x2F, 0x00});
    tracks_.push_back(body);
  }
  static std::vector<uint8_t> tempo(uint32_t microseconds) {
    return {0xFF, 0x51, 0x03, uint8_t(microseconds >> 16), uint8_t(microseconds >> 8), uint8_t(microseconds)};
  }
  std::vector<uint8_t> bytes(int declared_tracks = -1) const {
    std::vector<uint8_t> out = {'M', 'T', 'h', 'd', 0, 0, 0, 6};
    append16(out, format_);
    append16(out, declared_tracks < 0 ? static_cast<int>(tracks_.size()) : declared_tracks);
    append16(out, division_);
    for (const auto& track : tracks_) {
      out.insert(out.end(), {'M', 'T', 'r', 'k'});
      append32(out, static_cast<uint32_t>(track.size()));
      out.insert(out.end(), track.begin(), track.end());
    }
    return out;
  }
  static void append_vlq(std::vector<uint8_t>& out, uint32_t value) {
    uint8_t groups[5];
    int n = 0;
    do {
      groups[n++] = value & 0x7F;
      value >>= 7;
    } while (value != 0);
    while (n > 1) out.push_back(groups[--n] | 0x80);
    out.push_back(groups[0]);
  }

 private:
  static void append16(std::vector<uint8_t>& out, int v) { out.insert(out.end(), {uint8_t(v >> 8), uint8_t(v)}); }
  static void append32(std::vector<uint8_t>& out, uint32_t v) {
    out.insert(out.end(), {uint8_t(v >> 24), uint8_t(v >> 16), uint8_t(v >> 8), uint8_t(v)});
  }
  int format_;
  int division_;
  std::vector<std::vector<uint8_t>> tracks_;
};

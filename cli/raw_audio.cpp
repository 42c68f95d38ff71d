#include "cli/raw_audio.h"

#include <cstdint>
#include <cstdio>
#include <cstring>
#include <stdexcept>

namespace basic {
namespace {

float float_from_le(const unsigned char* bytes) {
  const uint32_t bits = uint32_t{bytes[0]} | (uint32_t{bytes[1]} << 8) |
                        (uint32_t{bytes[2]} << 16) | (uint32_t{bytes[3]} << 24);
  float value;
  std::memcpy(&value, &bits, sizeof(value));
  return value;
}

void float_to_le(float value, unsigned char* bytes) {
  uint32_t bits;
  std::memcpy(&bits, &value, sizeof(bits));
  for (int k = 0; k < 4; ++k) bytes[k] = static_cast<unsigned char>(bits >> (8 * k));
}

}  // namespace

std::vector<std::vector<float>> read_raw_float(const std::string& path, int channel_count) {
  std::FILE* file = std::fopen(path.c_str(), "rb");
  if (file == nullptr) {
    throw std::runtime_error("cannot open " + path);
  }
  std::vector<unsigned char> bytes;
  unsigned char chunk[65536];
  size_t got;
  while ((got = std::fread(chunk, 1, sizeof(chunk), file)) > 0) {
    bytes.insert(bytes.end(), chunk, chunk + got);
  }
  const bool failed = std::ferror(file) != 0;
  std::fclose(file);
  const size_t frame_bytes = 4 * static_cast<size_t>(channel_count);
  if (failed) {
    throw std::runtime_error("cannot read " + path);
  }
  if (bytes.size() % frame_bytes != 0) {
    throw std::runtime_error(path + " is not a whole number of " + std::to_string(channel_count) +
                             "-channel float frames");
  }
  const size_t frames = bytes.size() / frame_bytes;
  std::vector<std::vector<float>> channels(static_cast<size_t>(channel_count),
                                           std::vector<float>(frames));
  for (size_t frame = 0; frame < frames; ++frame) {
    for (size_t channel = 0; channel < channels.size(); ++channel) {
      channels[channel][frame] = float_from_le(&bytes[frame * frame_bytes + 4 * channel]);
    }
  }
  return channels;
}

void write_raw_float(const std::string& path, const std::vector<std::vector<float>>& channels) {
  const size_t frames = channels.empty() ? 0 : channels[0].size();
  std::vector<unsigned char> bytes(frames * channels.size() * 4);
  size_t offset = 0;
  for (size_t frame = 0; frame < frames; ++frame) {
    for (const auto& channel : channels) {
      float_to_le(channel[frame], &bytes[offset]);
      offset += 4;
    }
  }
  std::FILE* file = std::fopen(path.c_str(), "wb");
  if (file == nullptr) {
    throw std::runtime_error("cannot create " + path);
  }
  const size_t written = std::fwrite(bytes.data(), 1, bytes.size(), file);
  const bool closed = std::fclose(file) == 0;
  if (written != bytes.size() || !closed) {
    throw std::runtime_error("cannot write " + path);
  }
}

}  // namespace basic

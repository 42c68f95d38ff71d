// Reading any audio file format the platform's audio file library knows and
// writing 32-bit float WAV.
#pragma once

#include <string>
#include <vector>

namespace basic {

struct AudioData {
  double sample_rate = 0.0;
  int file_channels = 0;                    // channels in the file
  std::vector<std::vector<float>> channels; // planar, at most the first two
};

// Throws std::runtime_error with the reason (missing file, unsupported format).
AudioData read_audio_file(const std::string& path);

// Writes planar channels as 32-bit float WAV. Throws std::runtime_error.
void write_float_wav(const std::string& path, double sample_rate,
                     const std::vector<std::vector<float>>& channels);

}  // namespace basic

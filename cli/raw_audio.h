// Headerless audio: interleaved 32-bit little-endian floats, as exchanged with
// the Windows test host.
#pragma once

#include <string>
#include <vector>

namespace basic {

// Reads interleaved frames of channel_count channels into planar channels.
// Throws std::runtime_error when the file cannot be read or its size is not a
// whole number of frames.
std::vector<std::vector<float>> read_raw_float(const std::string& path, int channel_count);

// Writes planar channels interleaved. Throws std::runtime_error on failure.
void write_raw_float(const std::string& path, const std::vector<std::vector<float>>& channels);

}  // namespace basic

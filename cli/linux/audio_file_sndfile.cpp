// Audio files through libsndfile.
#include <sndfile.h>

#include <stdexcept>

#include "cli/audio_file.h"

namespace basic {

AudioData read_audio_file(const std::string& path) {
  SF_INFO info{};
  SNDFILE* file = sf_open(path.c_str(), SFM_READ, &info);
  if (file == nullptr) {
    throw std::runtime_error("cannot read " + path + ": " + sf_strerror(nullptr));
  }
  AudioData data;
  data.sample_rate = info.samplerate;
  data.file_channels = info.channels;
  const size_t used = info.channels >= 2 ? 2 : 1;
  data.channels.assign(used, std::vector<float>());
  std::vector<float> interleaved(4096 * static_cast<size_t>(info.channels));
  sf_count_t frames;
  while ((frames = sf_readf_float(file, interleaved.data(), 4096)) > 0) {
    for (sf_count_t frame = 0; frame < frames; ++frame) {
      for (size_t channel = 0; channel < used; ++channel) {
        data.channels[channel].push_back(
            interleaved[static_cast<size_t>(frame) * static_cast<size_t>(info.channels) + channel]);
      }
    }
  }
  const int error = sf_error(file);
  std::string reason = error != 0 ? sf_strerror(file) : "";
  sf_close(file);
  if (error != 0) {
    throw std::runtime_error("cannot read " + path + ": " + reason);
  }
  return data;
}

void write_float_wav(const std::string& path, double sample_rate,
                     const std::vector<std::vector<float>>& channels) {
  SF_INFO info{};
  info.samplerate = static_cast<int>(sample_rate + 0.5);
  info.channels = static_cast<int>(channels.size());
  info.format = SF_FORMAT_WAV | SF_FORMAT_FLOAT;
  SNDFILE* file = sf_open(path.c_str(), SFM_WRITE, &info);
  if (file == nullptr) {
    throw std::runtime_error("cannot create " + path + ": " + sf_strerror(nullptr));
  }
  const size_t frames = channels.empty() ? 0 : channels[0].size();
  std::vector<float> interleaved(frames * channels.size());
  for (size_t frame = 0; frame < frames; ++frame) {
    for (size_t channel = 0; channel < channels.size(); ++channel) {
      interleaved[frame * channels.size() + channel] = channels[channel][frame];
    }
  }
  const sf_count_t written =
      sf_writef_float(file, interleaved.data(), static_cast<sf_count_t>(frames));
  const std::string reason = sf_strerror(file);
  const bool closed = sf_close(file) == 0;
  if (written != static_cast<sf_count_t>(frames) || !closed) {
    throw std::runtime_error("cannot write " + path + ": " + reason);
  }
}

}  // namespace basic

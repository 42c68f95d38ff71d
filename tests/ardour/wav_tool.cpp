// Helper for the end-to-end session test: joins the two mono files a host
// records for a stereo track into one stereo file, and compares two sound
// files with an optional search for a constant offset between them.
//
//   wav_tool join LEFT.wav RIGHT.wav OUT.wav
//   wav_tool compare REFERENCE OTHER TOLERANCE [MAX_SHIFT]
//   wav_tool differ FIRST SECOND MINIMUM
//
// compare tries every shift of OTHER against REFERENCE in -MAX_SHIFT..MAX_SHIFT
// (default 0) and keeps the one with the smallest largest difference over the
// overlap; it prints that shift and difference and exits 1 when the difference
// exceeds the tolerance, when the channel counts differ, when the overlap is
// shorter than the reference less the shift, when any sample is not finite or
// when the reference is silent (agreeing on silence proves nothing).
// differ exits 1 unless the largest difference reaches MINIMUM.
#include <sndfile.h>

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <vector>

namespace {

struct Sound {
  int channels = 0;
  int rate = 0;
  long frames = 0;
  std::vector<float> samples;  // interleaved
  float at(long frame, int channel) const { return samples[frame * channels + channel]; }
};

bool read_sound(const std::string& path, Sound& sound) {
  SF_INFO info{};
  SNDFILE* file = sf_open(path.c_str(), SFM_READ, &info);
  if (file == nullptr) {
    std::fprintf(stderr, "cannot read %s: %s\n", path.c_str(), sf_strerror(nullptr));
    return false;
  }
  sound.channels = info.channels;
  sound.rate = info.samplerate;
  sound.frames = static_cast<long>(info.frames);
  sound.samples.assign(static_cast<size_t>(info.frames) * info.channels, 0.0f);
  const sf_count_t got = sf_readf_float(file, sound.samples.data(), info.frames);
  sf_close(file);
  if (got != info.frames) {
    std::fprintf(stderr, "%s: read %lld of %lld frames\n", path.c_str(), static_cast<long long>(got),
                 static_cast<long long>(info.frames));
    return false;
  }
  for (float value : sound.samples) {
    if (!std::isfinite(value)) {
      std::fprintf(stderr, "%s holds a non-finite sample\n", path.c_str());
      return false;
    }
  }
  return true;
}

bool write_float_wav(const std::string& path, const Sound& sound) {
  SF_INFO info{};
  info.channels = sound.channels;
  info.samplerate = sound.rate;
  info.format = SF_FORMAT_WAV | SF_FORMAT_FLOAT;
  SNDFILE* file = sf_open(path.c_str(), SFM_WRITE, &info);
  if (file == nullptr) {
    std::fprintf(stderr, "cannot write %s: %s\n", path.c_str(), sf_strerror(nullptr));
    return false;
  }
  const sf_count_t put = sf_writef_float(file, sound.samples.data(), sound.frames);
  sf_close(file);
  return put == sound.frames;
}

int join(const std::string& left_path, const std::string& right_path, const std::string& out_path) {
  Sound left, right;
  if (!read_sound(left_path, left) || !read_sound(right_path, right)) return 1;
  if (left.channels != 1 || right.channels != 1 || left.frames != right.frames ||
      left.rate != right.rate) {
    std::fprintf(stderr, "join needs two mono files of one length and rate\n");
    return 1;
  }
  Sound out;
  out.channels = 2;
  out.rate = left.rate;
  out.frames = left.frames;
  out.samples.resize(static_cast<size_t>(2 * out.frames));
  for (long i = 0; i < out.frames; ++i) {
    out.samples[2 * i] = left.samples[i];
    out.samples[2 * i + 1] = right.samples[i];
  }
  if (!write_float_wav(out_path, out)) return 1;
  std::printf("joined %ld frames at %d Hz\n", out.frames, out.rate);
  return 0;
}

// Largest difference of OTHER shifted by `shift` frames against REFERENCE,
// over the frames both hold; `overlap` receives their number.
double largest_difference(const Sound& reference, const Sound& other, long shift, long& overlap) {
  const long first = std::max(0L, -shift);
  const long last = std::min(reference.frames, other.frames - shift);
  overlap = std::max(0L, last - first);
  double largest = 0.0;
  for (long i = first; i < last; ++i) {
    for (int c = 0; c < reference.channels; ++c) {
      largest = std::max(largest, std::fabs(static_cast<double>(reference.at(i, c)) -
                                            static_cast<double>(other.at(i + shift, c))));
    }
  }
  return largest;
}

double peak(const Sound& sound) {
  double largest = 0.0;
  for (float value : sound.samples) largest = std::max(largest, std::fabs(static_cast<double>(value)));
  return largest;
}

int compare(const std::string& reference_path, const std::string& other_path, double tolerance,
            long max_shift) {
  Sound reference, other;
  if (!read_sound(reference_path, reference) || !read_sound(other_path, other)) return 1;
  if (reference.channels != other.channels || reference.rate != other.rate) {
    std::fprintf(stderr, "FAIL: %d channels at %d Hz against %d channels at %d Hz\n", reference.channels,
                 reference.rate, other.channels, other.rate);
    return 1;
  }
  if (peak(reference) < 1e-3) {
    std::fprintf(stderr, "FAIL: the reference is silent\n");
    return 1;
  }
  long best_shift = 0;
  long best_overlap = 0;
  double best = INFINITY;
  for (long shift = -max_shift; shift <= max_shift; ++shift) {
    long overlap = 0;
    const double difference = largest_difference(reference, other, shift, overlap);
    if (overlap >= reference.frames - std::labs(shift) && difference < best) {
      best = difference;
      best_shift = shift;
      best_overlap = overlap;
    }
  }
  std::printf("frames %ld / %ld, shift %ld, overlap %ld, largest difference %.3g (tolerance %.3g)\n",
              reference.frames, other.frames, best_shift, best_overlap, best, tolerance);
  if (!(best <= tolerance)) {
    std::fprintf(stderr, "FAIL: the files differ by %.3g\n", best);
    return 1;
  }
  return 0;
}

int differ(const std::string& first_path, const std::string& second_path, double minimum) {
  Sound first, second;
  if (!read_sound(first_path, first) || !read_sound(second_path, second)) return 1;
  if (first.channels != second.channels) {
    std::printf("channel counts differ\n");
    return 0;
  }
  long overlap = 0;
  const double difference = largest_difference(first, second, 0, overlap);
  std::printf("largest difference %.3g over %ld frames (at least %.3g wanted)\n", difference, overlap,
              minimum);
  return difference >= minimum && overlap > 0 ? 0 : 1;
}

}  // namespace

int main(int argc, char** argv) {
  const std::string command = argc > 1 ? argv[1] : "";
  if (command == "join" && argc == 5) return join(argv[2], argv[3], argv[4]);
  if (command == "compare" && (argc == 5 || argc == 6)) {
    return compare(argv[2], argv[3], std::atof(argv[4]), argc == 6 ? std::atol(argv[5]) : 0);
  }
  if (command == "differ" && argc == 5) return differ(argv[2], argv[3], std::atof(argv[4]));
  std::fprintf(stderr,
               "usage: wav_tool join LEFT RIGHT OUT | compare REFERENCE OTHER TOLERANCE [MAX_SHIFT]"
               " | differ FIRST SECOND MINIMUM\n");
  return 2;
}

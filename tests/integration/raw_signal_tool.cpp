// Helper for the cross-build comparison: writes the fixed test signal as
// headerless interleaved stereo float32 little-endian audio, and compares two
// such files sample by sample.
//
//   raw_signal_tool generate OUT.raw [RATE [SECONDS]]
//   raw_signal_tool compare REFERENCE.raw OTHER.raw TOLERANCE
//   raw_signal_tool differ FIRST.raw SECOND.raw MINIMUM
//
// compare prints the largest absolute difference and exits 1 when it exceeds
// the tolerance, when the lengths differ, when any sample is not finite or
// when the reference is silent (agreeing on silence proves nothing). differ
// exits 1 unless the largest difference reaches the minimum: it shows that
// two settings really produced different sound.
#include <algorithm>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

namespace {

constexpr double kPi = 3.14159265358979323846;

// A fixed-seed generator so the signal is the same on every machine.
class NoiseSource {
 public:
  double next() {
    state_ = state_ * 6364136223846793005ull + 1442695040888963407ull;
    return static_cast<double>(state_ >> 11) / 9007199254740992.0 * 2.0 - 1.0;
  }

 private:
  uint64_t state_ = 0x2545F4914F6CDD1Dull;
};

// Four sections of the input, each meant to exercise something else:
// a logarithmic sweep over the whole band (crossovers, tone filter), decaying
// chords with noise (band dynamics, distortion), overdriven bursts (clipping,
// oversampling) and near silence with a single click (feedback ringing, the
// engine's behaviour on tiny values).
std::vector<float> make_signal(double rate, double seconds) {
  const size_t frames = static_cast<size_t>(std::llround(rate * seconds));
  std::vector<float> interleaved(2 * frames);
  NoiseSource noise;
  const double sweep_length = seconds / 3.0;
  const double f0 = 30.0;
  const double f1 = std::min(16000.0, 0.45 * rate);
  const double sweep_rate = std::log(f1 / f0) / sweep_length;
  for (size_t i = 0; i < frames; ++i) {
    const double t = static_cast<double>(i) / rate;
    const double n = noise.next();
    double left = 0.0;
    double right = 0.0;
    if (t < sweep_length) {
      const double phase = 2.0 * kPi * f0 * (std::exp(sweep_rate * t) - 1.0) / sweep_rate;
      left = 0.7 * std::sin(phase);
      right = 0.6 * std::cos(phase);
    } else if (t < 2.0 * sweep_length) {
      const double beat = std::fmod(t - sweep_length, 0.25);
      const double envelope = std::exp(-beat * 9.0);
      const double chord = std::sin(2.0 * kPi * 110.0 * t) + 0.7 * std::sin(2.0 * kPi * 165.0 * t) +
                           0.5 * std::sin(2.0 * kPi * 277.2 * t);
      left = 0.35 * envelope * chord + 0.08 * n;
      right = 0.3 * envelope * chord - 0.05 * n + 0.1 * std::sin(2.0 * kPi * 3520.0 * t);
    } else if (t < 2.5 * sweep_length) {
      const double gate = std::fmod(t, 0.1) < 0.05 ? 1.0 : 0.2;
      left = gate * (1.2 * std::sin(2.0 * kPi * 82.4 * t) + 0.3 * n);
      right = gate * (1.1 * std::sin(2.0 * kPi * 82.4 * t + 0.5) + 0.3 * n);
    } else {
      const size_t click = static_cast<size_t>((2.75 * sweep_length) * rate);
      left = i == click ? 0.9 : 1e-4 * n;
      right = i == click ? -0.9 : 0.0;
    }
    interleaved[2 * i] = static_cast<float>(left);
    interleaved[2 * i + 1] = static_cast<float>(right);
  }
  return interleaved;
}

bool write_floats(const std::string& path, const std::vector<float>& samples) {
  std::ofstream out(path, std::ios::binary);
  for (float sample : samples) {
    uint32_t bits = 0;
    std::memcpy(&bits, &sample, sizeof bits);
    const unsigned char bytes[4] = {static_cast<unsigned char>(bits),
                                    static_cast<unsigned char>(bits >> 8),
                                    static_cast<unsigned char>(bits >> 16),
                                    static_cast<unsigned char>(bits >> 24)};
    out.write(reinterpret_cast<const char*>(bytes), 4);
  }
  return static_cast<bool>(out);
}

bool read_floats(const std::string& path, std::vector<float>& samples) {
  std::ifstream in(path, std::ios::binary);
  if (!in) {
    return false;
  }
  const std::vector<unsigned char> bytes((std::istreambuf_iterator<char>(in)),
                                         std::istreambuf_iterator<char>());
  if (bytes.size() % 8 != 0) {
    std::fprintf(stderr, "%s: %zu bytes is not a whole number of stereo frames\n", path.c_str(),
                 bytes.size());
    return false;
  }
  samples.resize(bytes.size() / 4);
  for (size_t i = 0; i < samples.size(); ++i) {
    const uint32_t bits = static_cast<uint32_t>(bytes[4 * i]) |
                          static_cast<uint32_t>(bytes[4 * i + 1]) << 8 |
                          static_cast<uint32_t>(bytes[4 * i + 2]) << 16 |
                          static_cast<uint32_t>(bytes[4 * i + 3]) << 24;
    std::memcpy(&samples[i], &bits, sizeof bits);
  }
  return true;
}

int generate(int argc, char** argv) {
  if (argc < 3) {
    std::fprintf(stderr, "usage: raw_signal_tool generate OUT.raw [RATE [SECONDS]]\n");
    return 2;
  }
  const double rate = argc > 3 ? std::atof(argv[3]) : 48000.0;
  const double seconds = argc > 4 ? std::atof(argv[4]) : 3.0;
  if (!(rate >= 8000.0) || !(seconds > 0.0)) {
    std::fprintf(stderr, "generate: bad rate or length\n");
    return 2;
  }
  if (!write_floats(argv[2], make_signal(rate, seconds))) {
    std::fprintf(stderr, "generate: cannot write %s\n", argv[2]);
    return 1;
  }
  return 0;
}

struct Difference {
  size_t frames = 0;
  double max_difference = 0.0;
  size_t worst = 0;
  double peak = 0.0;
  size_t non_finite = 0;
};

// Reads both files and measures them; false (with a message) when they cannot
// be read or differ in length.
bool measure(const char* first_path, const char* second_path, Difference& result) {
  std::vector<float> first;
  std::vector<float> second;
  if (!read_floats(first_path, first) || !read_floats(second_path, second)) {
    std::fprintf(stderr, "cannot read %s or %s\n", first_path, second_path);
    return false;
  }
  if (first.size() != second.size()) {
    std::fprintf(stderr, "%zu frames against %zu frames\n", first.size() / 2, second.size() / 2);
    return false;
  }
  result.frames = first.size() / 2;
  for (size_t i = 0; i < first.size(); ++i) {
    if (!std::isfinite(first[i]) || !std::isfinite(second[i])) {
      ++result.non_finite;
      continue;
    }
    const double difference = std::fabs(static_cast<double>(first[i]) - second[i]);
    if (difference > result.max_difference) {
      result.max_difference = difference;
      result.worst = i;
    }
    result.peak = std::max(result.peak, std::fabs(static_cast<double>(first[i])));
  }
  std::printf("frames %zu, reference peak %.6f, max |difference| %.3e at frame %zu channel %zu\n",
              result.frames, result.peak, result.max_difference, result.worst / 2,
              result.worst % 2);
  if (result.non_finite != 0) {
    std::fprintf(stderr, "%zu samples are not finite\n", result.non_finite);
    return false;
  }
  return true;
}

int compare(int argc, char** argv) {
  if (argc != 5) {
    std::fprintf(stderr, "usage: raw_signal_tool compare REFERENCE.raw OTHER.raw TOLERANCE\n");
    return 2;
  }
  const double tolerance = std::atof(argv[4]);
  Difference result;
  if (!measure(argv[2], argv[3], result)) {
    return 1;
  }
  if (result.peak < 1e-3) {
    std::fprintf(stderr, "compare: the reference is silent\n");
    return 1;
  }
  if (result.max_difference > tolerance) {
    std::fprintf(stderr, "compare: difference %.3e exceeds the tolerance %.1e\n",
                 result.max_difference, tolerance);
    return 1;
  }
  return 0;
}

int differ(int argc, char** argv) {
  if (argc != 5) {
    std::fprintf(stderr, "usage: raw_signal_tool differ FIRST.raw SECOND.raw MINIMUM\n");
    return 2;
  }
  const double minimum = std::atof(argv[4]);
  Difference result;
  if (!measure(argv[2], argv[3], result)) {
    return 1;
  }
  if (!(result.max_difference >= minimum)) {
    std::fprintf(stderr, "differ: the files differ by only %.3e\n", result.max_difference);
    return 1;
  }
  return 0;
}

}  // namespace

int main(int argc, char** argv) {
  const std::string command = argc > 1 ? argv[1] : "";
  if (command == "generate") {
    return generate(argc, argv);
  }
  if (command == "compare") {
    return compare(argc, argv);
  }
  if (command == "differ") {
    return differ(argc, argv);
  }
  std::fprintf(stderr,
               "usage: raw_signal_tool generate OUT.raw [RATE [SECONDS]]\n"
               "       raw_signal_tool compare REFERENCE.raw OTHER.raw TOLERANCE\n"
               "       raw_signal_tool differ FIRST.raw SECOND.raw MINIMUM\n");
  return 2;
}

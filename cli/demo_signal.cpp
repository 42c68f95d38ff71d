#include "cli/demo_signal.h"

#include <algorithm>
#include <cmath>
#include <cstdint>

namespace basic {
namespace {

constexpr double kPi = 3.14159265358979323846;
constexpr double kBeat = 0.5;  // seconds per beat at 120 bpm
constexpr double kEighth = kBeat / 2.0;
constexpr int kBars = 3;
constexpr int kBeatsPerBar = 4;

// A 32-bit linear congruential generator: fixed seed, same noise everywhere.
class Noise {
 public:
  explicit Noise(uint32_t seed) : state_(seed) {}
  double next() {
    state_ = state_ * 1664525u + 1013904223u;
    return static_cast<double>(state_ >> 8) / 8388608.0 - 1.0;
  }

 private:
  uint32_t state_;
};

struct Mix {
  std::vector<double> left;
  std::vector<double> right;
  double rate;

  void add(size_t frame, double value, double pan) {  // pan 0 left .. 1 right
    if (frame >= left.size()) return;
    left[frame] += value * std::cos(pan * kPi / 2.0);
    right[frame] += value * std::sin(pan * kPi / 2.0);
  }
  size_t frame_at(double seconds) const { return static_cast<size_t>(seconds * rate + 0.5); }
};

// Chord roots per bar (the guitar's low string); the bass plays an octave down.
const double kBarRoots[kBars] = {82.41, 98.00, 110.00};  // E2, G2, A2

// Bass line in eighths as multiples of the bass root: root, octave and fifth.
const double kBassPattern[8] = {1.0, 1.0, 2.0, 1.0, 1.5, 1.0, 2.0, 1.0};

void add_kick(Mix& mix, double start) {
  const size_t first = mix.frame_at(start);
  const size_t length = mix.frame_at(0.4);
  double phase = 0.0;
  for (size_t n = 0; n < length; ++n) {
    const double t = static_cast<double>(n) / mix.rate;
    const double frequency = 45.0 + 110.0 * std::exp(-t / 0.03);  // pitched sweep down
    phase += 2.0 * kPi * frequency / mix.rate;
    const double envelope = std::exp(-t / 0.22) * std::min(1.0, t / 0.002);
    mix.add(first + n, 0.9 * envelope * std::sin(phase), 0.5);
  }
}

void add_snare(Mix& mix, double start, Noise& noise) {
  const size_t first = mix.frame_at(start);
  const size_t length = mix.frame_at(0.3);
  double lowpassed = 0.0;
  for (size_t n = 0; n < length; ++n) {
    const double t = static_cast<double>(n) / mix.rate;
    lowpassed += 0.5 * (noise.next() - lowpassed);  // takes the fizz off the burst
    const double rattle = lowpassed * std::exp(-t / 0.09);
    const double tone = std::sin(2.0 * kPi * 185.0 * t) * std::exp(-t / 0.05);
    mix.add(first + n, 0.45 * rattle + 0.35 * tone, 0.52);
  }
}

void add_hat(Mix& mix, double start, double level, Noise& noise) {
  const size_t first = mix.frame_at(start);
  const size_t length = mix.frame_at(0.12);
  double previous = 0.0;
  double previous_diff = 0.0;
  for (size_t n = 0; n < length; ++n) {
    const double t = static_cast<double>(n) / mix.rate;
    const double white = noise.next();
    const double diff = white - previous;  // two first differences: a steep high-pass
    const double high = diff - previous_diff;
    previous = white;
    previous_diff = diff;
    mix.add(first + n, level * 0.5 * high * std::exp(-t / 0.025), 0.35);
  }
}

void add_bass_note(Mix& mix, double start, double length, double frequency) {
  const size_t first = mix.frame_at(start);
  const size_t count = mix.frame_at(length + 0.03);
  double phase = 0.0;
  double smoothed = 0.0;
  const double smoothing = 1.0 - std::exp(-2.0 * kPi * 500.0 / mix.rate);
  for (size_t n = 0; n < count; ++n) {
    const double t = static_cast<double>(n) / mix.rate;
    phase += frequency / mix.rate;
    phase -= std::floor(phase);
    const double saw = 2.0 * phase - 1.0;
    const double sine = std::sin(2.0 * kPi * phase);
    smoothed += smoothing * (0.6 * saw + 0.8 * sine - smoothed);
    const double attack = std::min(1.0, t / 0.004);
    const double decay = 0.6 + 0.4 * std::exp(-t / 0.08);
    const double release = t > length ? std::exp(-(t - length) / 0.008) : 1.0;
    mix.add(first + n, 0.5 * smoothed * attack * decay * release, 0.5);
  }
}

// A plucked string by the Karplus-Strong method: a noise burst circulating in
// a delay line one period long, averaged each pass so the highs die first.
class PluckedString {
 public:
  PluckedString(double rate, double frequency)
      : line_(std::max<size_t>(2, static_cast<size_t>(rate / frequency + 0.5))) {}

  void pluck(Noise& noise, double strength) {
    double smooth = 0.0;
    for (double& sample : line_) {
      smooth += 0.6 * (noise.next() - smooth);
      sample += strength * smooth;
    }
  }

  double next() {
    const size_t following = (index_ + 1) % line_.size();
    const double out = line_[index_];
    line_[index_] = 0.996 * 0.5 * (line_[index_] + line_[following]);
    index_ = following;
    return out;
  }

 private:
  std::vector<double> line_;
  size_t index_ = 0;
};

// Strums a chord twice per bar; the strings sound until the next chord takes over.
void add_guitar(Mix& mix, Noise& noise) {
  const double bar_seconds = kBeat * kBeatsPerBar;
  for (int bar = 0; bar < kBars; ++bar) {
    const double root = kBarRoots[bar];
    // Power chord (root, fifth, octave) in the first bars, a major triad on the last.
    std::vector<double> notes = {root, root * 1.5, root * 2.0};
    if (bar == kBars - 1) notes.push_back(root * 2.52);
    std::vector<PluckedString> strings;
    for (double frequency : notes) strings.emplace_back(mix.rate, frequency);
    const double bar_start = bar * bar_seconds;
    const size_t first = mix.frame_at(bar_start);
    const size_t count = mix.frame_at(bar_seconds + (bar == kBars - 1 ? 0.0 : 0.02));
    const double strums[] = {0.0, 2.5 * kBeat, 3.0 * kBeat};
    const double strengths[] = {1.0, 0.7, 0.8};
    for (size_t n = 0; n < count; ++n) {
      const double t = static_cast<double>(n) / mix.rate;
      for (size_t s = 0; s < strings.size(); ++s) {
        for (int k = 0; k < 3; ++k) {
          // 12 ms between strings: a downward strum.
          if (n == mix.frame_at(strums[k] + 0.012 * static_cast<double>(s))) {
            strings[s].pluck(noise, strengths[k]);
          }
        }
        const double pan = 0.35 + 0.3 * static_cast<double>(s) / static_cast<double>(strings.size());
        const double fade = bar == kBars - 1 ? std::min(1.0, (bar_seconds - t) / 0.3) : 1.0;
        mix.add(first + n, 0.22 * fade * strings[s].next(), pan);
      }
    }
  }
}

}  // namespace

StereoSignal make_demo_signal(double sample_rate) {
  const size_t frames = static_cast<size_t>(kDemoSeconds * sample_rate + 0.5);
  Mix mix{std::vector<double>(frames), std::vector<double>(frames), sample_rate};
  Noise noise(0x5EED1234u);

  for (int bar = 0; bar < kBars; ++bar) {
    const double bar_start = bar * kBeat * kBeatsPerBar;
    for (int beat = 0; beat < kBeatsPerBar; ++beat) {
      const double beat_start = bar_start + beat * kBeat;
      add_kick(mix, beat_start);
      if (beat % 2 == 1) add_snare(mix, beat_start, noise);
    }
    add_kick(mix, bar_start + 3.5 * kBeat);  // a pickup into the next bar
    for (int eighth = 0; eighth < 2 * kBeatsPerBar; ++eighth) {
      const double start = bar_start + eighth * kEighth;
      add_hat(mix, start, eighth % 2 == 0 ? 1.0 : 0.6, noise);
      add_bass_note(mix, start, kEighth * 0.85, kBarRoots[bar] / 2.0 * kBassPattern[eighth]);
    }
  }
  add_guitar(mix, noise);

  double peak = 0.0;
  for (size_t n = 0; n < frames; ++n) {
    peak = std::max({peak, std::fabs(mix.left[n]), std::fabs(mix.right[n])});
  }
  const double gain = peak > 0.0 ? std::pow(10.0, kDemoPeakDbfs / 20.0) / peak : 0.0;
  StereoSignal signal;
  signal.left.resize(frames);
  signal.right.resize(frames);
  for (size_t n = 0; n < frames; ++n) {
    signal.left[n] = static_cast<float>(mix.left[n] * gain);
    signal.right[n] = static_cast<float>(mix.right[n] * gain);
  }
  return signal;
}

}  // namespace basic

// The whole engine on test signals: chain order, chunking, pins, stereo boost,
// solo logic, clip lamp, oversampling and recovery from non-finite input.
#include <gtest/gtest.h>

#include <cmath>
#include <vector>

#include "dsp/brakmorph_dsp.h"
#include "host/host_dsp_interface.h"
#include "params/normalized_param_interface.h"
#include "presets/program_slot.h"

namespace {

class FakeHostDsp : public plugcore::HostDspInterface {
 public:
  bool second_input = true;
  bool second_output = true;
  int init() override { return 0; }
  double get_property_num(const char*) override { return 0.0; }
  void get_tempo(plugcore::TempoQuery& query) override { query.error = true; }
  bool is_input_connected(int, int pin) override { return pin == 0 || second_input; }
  bool is_output_connected(int, int pin) override { return pin == 0 || second_output; }
  plugcore::MidiMgr* use_midi_mgr() override { return nullptr; }
};

enum Index {
  kStereoBoost = 0, kOversampling = 1, kToneFreq = 2, kToneShape = 3, kStereoPhase = 4, kFdbkAmnt = 5,
  kFdbkFreq = 6, kMasterVol = 7, kUpper1 = 9, kUpper2 = 10, kUpper3 = 11,
  kCharacter = 12, kIntensity = 13, kDistAmnt = 14, kDistType = 15, kVolume = 16, kSolo = 17
};

struct Engine {
  BrakmorphDsp dsp;
  FakeHostDsp* host = new FakeHostDsp;  // owned by the engine

  explicit Engine(float rate) {
    dsp.set_host_dsp(host);
    dsp.init();
    dsp.set_default_state();
    dsp.set_sample_rate(rate);
    dsp.request_reset();
  }
  void set(int index, double natural) { dsp.use_param(index).set_value_and_notify(natural); }
  void band(int b, int offset, double natural) { set(12 + 7 * b + (offset - 12), natural); }

  // Processes a stereo signal in blocks; returns left and right outputs.
  void run(const std::vector<float>& left, const std::vector<float>& right, std::vector<float>& out_left,
           std::vector<float>& out_right, int block = 512) {
    out_left.assign(left.size(), 0.0f);
    out_right.assign(left.size(), 0.0f);
    for (size_t pos = 0; pos < left.size(); pos += static_cast<size_t>(block)) {
      const int n = static_cast<int>(std::min<size_t>(static_cast<size_t>(block), left.size() - pos));
      float* in[2] = {const_cast<float*>(left.data() + pos), const_cast<float*>(right.data() + pos)};
      float* out[2] = {out_left.data() + pos, out_right.data() + pos};
      dsp.process_replacing(out, in, n, 0);
    }
  }
  std::vector<float> run_mono(const std::vector<float>& x, int block = 512) {
    std::vector<float> l, r;
    run(x, x, l, r, block);
    return l;
  }
};

std::vector<float> sine(int n, double freq, double rate, double amplitude) {
  std::vector<float> x(static_cast<size_t>(n));
  for (int i = 0; i < n; ++i) {
    x[i] = static_cast<float>(amplitude * std::sin(2.0 * M_PI * freq * i / rate));
  }
  return x;
}

// Magnitude of one frequency in a signal (Goertzel), in double.
double tone_level(const std::vector<float>& x, size_t from, double freq, double rate) {
  const double w = 2.0 * M_PI * freq / rate;
  double s1 = 0, s2 = 0;
  for (size_t i = from; i < x.size(); ++i) {
    const double s = x[i] + 2.0 * std::cos(w) * s1 - s2;
    s2 = s1;
    s1 = s;
  }
  const double re = s1 - s2 * std::cos(w), im = s2 * std::sin(w);
  return 2.0 * std::sqrt(re * re + im * im) / static_cast<double>(x.size() - from);
}

TEST(Engine, DefaultStateIsCurveThenDcBlocker) {
  // Defaults: one band, neutral dynamics, drive 1, "Tube Sym 1", unity gains, tone off.
  const double rate = 44100.0;
  Engine engine(static_cast<float>(rate));
  const std::vector<float> x = sine(8000, 220.0, rate, 0.9);
  const std::vector<float> y = engine.run_mono(x);

  // Reference in double: (2/pi) atan(pi x / 2), then the bilinear 10 Hz high-pass s/(1+s).
  const double k = 1.0 / std::tan(M_PI * 10.0 / rate);
  const double b0 = k / (1.0 + k), b1 = -k / (1.0 + k), a1 = (1.0 - k) / (1.0 + k);
  double x1 = 0, y1 = 0, worst = 0;
  for (size_t i = 0; i < x.size(); ++i) {
    const double shaped = 2.0 / M_PI * std::atan(M_PI * x[i] / 2.0);
    const double ref = b0 * shaped + b1 * x1 - a1 * y1;
    x1 = shaped;
    y1 = ref;
    worst = std::max(worst, std::fabs(ref - y[i]));
  }
  EXPECT_LT(worst, 0.02);  // the curve is a cubic table between integer knots (worst near 0.43)
}

TEST(Engine, FeedbackDelayBoundsTheChunk) {
  Engine engine(44100.0f);
  engine.set(kFdbkAmnt, 0.0);
  engine.set(kFdbkFreq, 1024.0);
  engine.run_mono(std::vector<float>(64, 0.0f));
  EXPECT_EQ(engine.dsp.get_feedback_line().get_max_chunk(), 256);  // feedback off: full chunks
  EXPECT_EQ(engine.dsp.get_feedback_line().get_feedback_delay(), 43);
  engine.set(kFdbkAmnt, 0.5);
  engine.run_mono(std::vector<float>(64, 0.0f));
  EXPECT_EQ(engine.dsp.get_feedback_line().get_max_chunk(), 43);
  engine.set(kFdbkFreq, 16.0);
  engine.run_mono(std::vector<float>(64, 0.0f));
  EXPECT_EQ(engine.dsp.get_feedback_line().get_feedback_delay(), 2756);
  EXPECT_EQ(engine.dsp.get_feedback_line().get_max_chunk(), 256);
}

TEST(Engine, FeedbackDelayAndBufferAtSeveralRates) {
  struct Case {
    float rate;
    int delay_at_256_hz;
    int buffer;
  };
  for (const Case& c : {Case{44100, 172, 4096}, Case{48000, 188, 4096}, Case{96000, 375, 8192},
                        Case{384000, 1500, 32768}, Case{8000, 31, 4096}}) {
    Engine engine(c.rate);
    engine.run_mono(std::vector<float>(8, 0.0f));
    // round(rate / 256) with halves upward
    EXPECT_EQ(engine.dsp.get_feedback_line().get_feedback_delay(), static_cast<int>(std::floor(c.rate / 256.0 + 0.5)));
    EXPECT_EQ(engine.dsp.get_feedback_line().get_feedback_delay(), c.delay_at_256_hz);
    EXPECT_EQ(engine.dsp.get_feedback_line().get_buffer_length(), c.buffer);  // never shrinks below 4096
  }
}

TEST(Engine, StereoBoostIsTheDelayedInvertedOutput) {
  const std::vector<float> x = sine(6000, 330.0, 44100.0, 0.7);
  {
    Engine engine(44100.0f);
    engine.set(kStereoBoost, 1.0);
    engine.set(kStereoPhase, 0.0);
    std::vector<float> l, r;
    engine.run(x, x, l, r, 500);
    for (size_t i = 0; i < l.size(); ++i) {
      ASSERT_EQ(r[i], -l[i]) << i;
    }
  }
  Engine engine(44100.0f);
  engine.set(kStereoBoost, 1.0);
  engine.set(kStereoPhase, 0.01);
  std::vector<float> l, r;
  engine.run(x, x, l, r, 500);
  for (size_t i = 0; i < 441; ++i) {
    ASSERT_EQ(r[i], 0.0f) << i;  // the delay line starts silent
  }
  for (size_t i = 441; i < l.size(); ++i) {
    ASSERT_EQ(r[i], -l[i - 441]) << i;
  }
}

TEST(Engine, WithoutStereoBoostBothOutputsCarryTheSameSignal) {
  Engine engine(48000.0f);
  const std::vector<float> x = sine(3000, 100.0, 48000.0, 0.5);
  std::vector<float> l, r;
  engine.run(x, sine(3000, 1000.0, 48000.0, 0.5), l, r);
  EXPECT_EQ(l, r);
}

TEST(Engine, SplitPointsSetTheBandCount) {
  Engine engine(44100.0f);
  engine.set(kUpper1, 1000.0);
  engine.set(kUpper2, 500.0);
  engine.set(kUpper3, 20480.0);
  engine.run_mono(std::vector<float>(16, 0.0f));
  EXPECT_EQ(engine.dsp.get_band_count(), 3);
  engine.set(kUpper1, 20480.0);  // B1 above 20 kHz: one band whatever the others say
  engine.run_mono(std::vector<float>(16, 0.0f));
  EXPECT_EQ(engine.dsp.get_band_count(), 1);
}

TEST(Engine, RateChangeRecomputesTheSplitAtTheNextBlock) {
  Engine engine(32000.0f);
  engine.set(kUpper1, 19000.0);  // above 0.475 * 32000
  engine.run_mono(std::vector<float>(16, 0.0f));
  EXPECT_EQ(engine.dsp.get_band_count(), 1);
  engine.dsp.set_sample_rate(48000.0f);
  engine.run_mono(std::vector<float>(16, 0.0f));
  EXPECT_EQ(engine.dsp.get_band_count(), 2);
}

TEST(Engine, SoloPlaysOnlySoloedBandsInUse) {
  Engine engine(44100.0f);
  engine.set(kUpper1, 800.0);
  engine.set(kUpper2, 20480.0);  // two bands
  engine.run_mono(std::vector<float>(16, 0.0f));
  ASSERT_EQ(engine.dsp.get_band_count(), 2);
  engine.set(kSolo + 14, 1.0);  // B3 Solo: band 2 is not in use, so it is ignored
  engine.run_mono(std::vector<float>(16, 0.0f));
  EXPECT_TRUE(engine.dsp.is_band_enabled(0));
  EXPECT_TRUE(engine.dsp.is_band_enabled(1));
  engine.set(kSolo + 7, 1.0);  // B2 Solo
  engine.run_mono(std::vector<float>(16, 0.0f));
  EXPECT_FALSE(engine.dsp.is_band_enabled(0));
  EXPECT_TRUE(engine.dsp.is_band_enabled(1));

  // Soloing the upper band is the same as silencing the lower one.
  Engine muted(44100.0f);
  muted.set(kUpper1, 800.0);
  muted.set(kUpper2, 20480.0);
  muted.set(kVolume, 0.0);
  const std::vector<float> x = sine(20000, 100.0, 44100.0, 0.3);
  const std::vector<float> soloed = engine.run_mono(x);
  const std::vector<float> silenced = muted.run_mono(x);
  for (size_t i = 0; i < x.size(); ++i) {
    ASSERT_NEAR(soloed[i], silenced[i], 1e-7f) << i;
  }
}

TEST(Engine, ClipLampLatchesUntilReadThenFollowsTheLatestChunk) {
  Engine engine(44100.0f);
  engine.set(kDistType, 6.0);     // Hardclip
  engine.band(0, kDistAmnt, 10.0);  // drive far into clipping: output at 0.8 * master
  engine.set(kMasterVol, 2.0);
  engine.dsp.set_clip_detection(true);
  engine.run_mono(sine(2048, 200.0, 44100.0, 0.9));
  engine.set(kMasterVol, 0.1);
  engine.run_mono(sine(1024, 200.0, 44100.0, 0.9));
  EXPECT_TRUE(engine.dsp.read_clip());  // latched from the loud blocks
  engine.run_mono(sine(1024, 200.0, 44100.0, 0.9));
  EXPECT_FALSE(engine.dsp.read_clip());
  engine.set(kMasterVol, 2.0);
  engine.run_mono(sine(1024, 200.0, 44100.0, 0.9));
  EXPECT_TRUE(engine.dsp.read_clip());
}

TEST(Engine, MasterVolumeZeroIsSilence) {
  Engine engine(44100.0f);
  engine.set(kMasterVol, 0.0);
  engine.set(kFdbkAmnt, 1.0);
  const std::vector<float> y = engine.run_mono(sine(5000, 300.0, 44100.0, 0.9));
  for (float v : y) {
    ASSERT_LT(std::fabs(v), 1e-12f);
  }
}

TEST(Engine, OversamplingReducesAliasing) {
  // A loud 3 kHz tone through the hard clipper: its 15th harmonic (45 kHz) folds to 900 Hz
  // at 44.1 kHz unless the curve runs oversampled.
  auto alias_level = [](bool oversampling) {
    Engine engine(44100.0f);
    engine.set(kDistType, 6.0);
    engine.band(0, kDistAmnt, 4.0);
    engine.set(kOversampling, oversampling ? 1.0 : 0.0);
    const std::vector<float> y = engine.run_mono(sine(44100, 3000.0, 44100.0, 0.8));
    return tone_level(y, 4410, 900.0, 44100.0);
  };
  const double plain = alias_level(false);
  const double oversampled = alias_level(true);
  EXPECT_GT(plain, 1e-3);
  EXPECT_LT(oversampled, plain * 0.03);  // at least 30 dB less
}

TEST(Engine, ToneShapeTurnsTheFilterOnAndOff) {
  Engine engine(44100.0f);
  engine.run_mono(std::vector<float>(8, 0.0f));
  EXPECT_FALSE(engine.dsp.is_tone_active());
  engine.set(kToneShape, 0.51);
  engine.set(kToneFreq, 2000.0);
  const std::vector<float> y = engine.run_mono(sine(20000, 8000.0, 44100.0, 0.1));
  EXPECT_TRUE(engine.dsp.is_tone_active());
  // An eighth-order low-pass at 2 kHz: 8 kHz is two octaves up, about -96 dB.
  EXPECT_LT(tone_level(y, 10000, 8000.0, 44100.0), 1e-4);
}

TEST(Engine, NonFiniteInputDoesNotPoisonTheEffect) {
  const std::vector<float> music = sine(4096, 150.0, 48000.0, 0.6);
  for (float bad : {std::nanf(""), INFINITY, -INFINITY, 3e38f}) {
    Engine poisoned(48000.0f);
    poisoned.set(kFdbkAmnt, 0.4);
    poisoned.set(kToneShape, 0.3);
    poisoned.set(kOversampling, 1.0);
    Engine fresh(48000.0f);
    fresh.set(kFdbkAmnt, 0.4);
    fresh.set(kToneShape, 0.3);
    fresh.set(kOversampling, 1.0);
    std::vector<float> spoiled = music;
    spoiled[100] = bad;
    poisoned.run_mono(spoiled, 4096);
    fresh.run_mono(std::vector<float>(4096, 0.0f), 4096);
    // The next block of finite input is processed as by an instance that never saw it.
    const std::vector<float> a = poisoned.run_mono(music, 4096);
    const std::vector<float> b = fresh.run_mono(music, 4096);
    for (size_t i = 0; i < a.size(); ++i) {
      ASSERT_TRUE(std::isfinite(a[i])) << bad << " at " << i;
      ASSERT_NEAR(a[i], b[i], 1e-6f) << bad << " at " << i;
    }
  }
}

TEST(Engine, AddingModeAddsToTheHostBuffers) {
  Engine a(44100.0f), b(44100.0f);
  const std::vector<float> x = sine(1000, 440.0, 44100.0, 0.5);
  std::vector<float> l1(x.size(), 0.0f), r1(x.size(), 0.0f), l2(x.size(), 1.0f), r2(x.size(), -1.0f);
  float* in[2] = {const_cast<float*>(x.data()), const_cast<float*>(x.data())};
  float* out1[2] = {l1.data(), r1.data()};
  float* out2[2] = {l2.data(), r2.data()};
  a.dsp.process_replacing(out1, in, 1000, 0);
  b.dsp.process_adding(out2, in, 1000, 0);
  for (size_t i = 0; i < x.size(); ++i) {
    ASSERT_FLOAT_EQ(l2[i], l1[i] + 1.0f);
    ASSERT_FLOAT_EQ(r2[i], r1[i] - 1.0f);
  }
}

TEST(Engine, ProgramsRoundTripThroughTheEngine) {
  Engine engine(44100.0f);
  engine.set(kToneFreq, 3000.0);
  engine.set(kDistType + 21, 9.0);
  plugcore::ProgramSlot program;
  engine.dsp.store_program(program);
  ASSERT_EQ(program.get_nbr_values(), 40);
  Engine other(44100.0f);
  other.dsp.load_program(program);
  for (int i = 0; i < 40; ++i) {
    EXPECT_EQ(other.dsp.use_param(i).get_norm(), engine.dsp.use_param(i).get_norm()) << i;
    // The natural value is recomputed from the stored normalised one.
    EXPECT_NEAR(other.dsp.use_param(i).get_value(), engine.dsp.use_param(i).get_value(),
                1e-6 * (1.0 + std::fabs(engine.dsp.use_param(i).get_value()))) << i;
  }
  EXPECT_DOUBLE_EQ(other.dsp.use_param(kDistType + 21).get_value(), 9.0);
}

TEST(Engine, PropertiesAndPins) {
  Engine engine(44100.0f);
  EXPECT_DOUBLE_EQ(engine.dsp.get_property_num("plugin_version"), 1.24);
  EXPECT_DOUBLE_EQ(engine.dsp.get_property_num("can_mono"), 1.0);
  EXPECT_DOUBLE_EQ(engine.dsp.get_property_num("Plugin_version"), 0.0);  // keys are case-sensitive
  EXPECT_EQ(engine.dsp.get_property_str("plugin_name"), "Brakmorph");
  EXPECT_EQ(engine.dsp.get_property_str("plugin_category"), "effect");
  EXPECT_EQ(engine.dsp.get_property_str("nothing"), "");
  ASSERT_EQ(engine.dsp.get_nbr_input_groups(), 1);
  EXPECT_EQ(engine.dsp.use_input_group(0).name, "Input");
  EXPECT_EQ(engine.dsp.use_output_group(0).pins[1], "Right output");
}

}  // namespace

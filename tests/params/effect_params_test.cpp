#include <gtest/gtest.h>

#include <cctype>
#include <cmath>
#include <cstring>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "dsp/curve_names.h"
#include "dsp/param_band.h"
#include "dsp/param_feedback.h"
#include "dsp/param_flags.h"
#include "dsp/param_master_vol.h"
#include "dsp/param_split_freq.h"
#include "dsp/param_stereo_amount.h"
#include "dsp/param_tone.h"

using plugcore::NormalizedParamInterface;

namespace {

using ParamPtr = std::unique_ptr<NormalizedParamInterface>;

// Reference mappings, written with other functions than the code under test
// (exp/log in place of pow/log2/log10) so a slip in either shows.
struct MappingCase {
  const char* label;
  std::function<ParamPtr()> make;
  std::function<double(double)> value_of_norm;
  std::function<double(double)> norm_of_value;
};

double identity(double x) { return x; }

template <typename T>
ParamPtr make_numbered(int number) {
  auto param = std::make_unique<T>();
  param->init(0.0, 0, number);
  return param;
}

std::vector<MappingCase> continuous_cases() {
  const double ln10 = std::log(10.0);
  return {
      {"Tone Freq", [] { return ParamPtr(new ParamToneFrq); },
       [](double n) { return 2000.0 * std::exp(n * std::log(4.0)); },
       [](double v) { return std::log(v / 2000.0) / std::log(4.0); }},
      {"Tone Shape", [] { return ParamPtr(new ParamToneColor); }, identity, identity},
      {"Stereo Phase", [] { return ParamPtr(new ParamStereoAmount); },
       [ln10](double n) { return (std::exp(n * ln10) - 1.0) / 900.0; },
       [ln10](double v) { return std::log(1.0 + 900.0 * v) / ln10; }},
      {"Fdbk Amnt", [] { return ParamPtr(new ParamFeedbackAmount); }, identity, identity},
      {"Fdbk Freq", [] { return ParamPtr(new ParamFeedbackPitch); },
       [](double n) { return 16.0 * std::exp(n * std::log(64.0)); },
       [](double v) { return std::log(v / 16.0) / std::log(64.0); }},
      {"Master Vol", [] { return ParamPtr(new ParamMasterVol); },
       [](double n) { return 2.0 * (std::exp(n * std::log(64.0)) - 1.0) / 63.0; },
       [](double v) { return std::log(1.0 + 31.5 * v) / std::log(64.0); }},
      {"Upper Freq", [] { return make_numbered<ParamBandSplitFrq>(1); },
       [](double n) { return 20.0 * std::exp(n * 10.0 * std::log(2.0)); },
       [](double v) { return std::log(v / 20.0) / std::log(1024.0); }},
      {"Character", [] { return make_numbered<ParamCharacter>(0); }, identity, identity},
      {"Intensity", [] { return make_numbered<ParamIntensity>(2); }, identity, identity},
      {"Dist Amnt", [] { return make_numbered<ParamDistoAmount>(3); },
       [ln10](double n) { return std::exp((3.0 * n - 1.0) * ln10); },
       [ln10](double v) { return (std::log(v) / ln10 + 1.0) / 3.0; }},
      {"Volume", [] { return make_numbered<ParamBandVolume>(0); },
       [ln10](double n) { return 10.0 * (std::exp(n * 2.0 * ln10) - 1.0) / 99.0; },
       [ln10](double v) {
         double n = std::log(1.0 + 9.9 * v) / ln10 / 2.0;
         return n < 0.0 ? 0.0 : (n > 1.0 ? 1.0 : n);
       }},
  };
}

std::string value_text(const NormalizedParamInterface& param, double value, int capacity = 64) {
  char text[64];
  std::memset(text, '#', sizeof(text));
  param.conv_value_to_text(text, capacity, value);
  return text;
}

double read_text(const NormalizedParamInterface& param, const char* text, bool expect_ok = true) {
  bool ok = false;
  double value = param.conv_text_to_value(text, ok);
  EXPECT_EQ(ok, expect_ok) << "text \"" << text << "\"";
  return value;
}

}  // namespace

TEST(EffectParams, ContinuousMappingsMatchReferenceAndRoundTrip) {
  for (const MappingCase& c : continuous_cases()) {
    ParamPtr param = c.make();
    for (int i = 0; i <= 64; ++i) {
      const float n = static_cast<float>(i) / 64.0f;
      const double v = param->conv_norm_to_value(n);
      const double expected = c.value_of_norm(n);
      EXPECT_NEAR(v, expected, 1e-12 * std::fabs(expected) + 1e-15) << c.label << " n=" << n;
      const float back = param->conv_value_to_norm(v);
      EXPECT_NEAR(back, n, 2e-7) << c.label << " n=" << n;
      EXPECT_NEAR(back, c.norm_of_value(v), 2e-7) << c.label << " n=" << n;
    }
  }
}

TEST(EffectParams, RangeEndsAreTheNaturalRange) {
  struct End {
    ParamPtr param;
    double low, high;
  };
  End ends[] = {
      {ParamPtr(new ParamToneFrq), 2000.0, 8000.0},     {ParamPtr(new ParamStereoAmount), 0.0, 0.01},
      {ParamPtr(new ParamFeedbackPitch), 16.0, 1024.0}, {ParamPtr(new ParamMasterVol), 0.0, 2.0},
      {make_numbered<ParamBandSplitFrq>(0), 20.0, 20480.0}, {make_numbered<ParamDistoAmount>(0), 0.1, 100.0},
      {make_numbered<ParamBandVolume>(0), 0.0, 10.0},
  };
  for (const End& end : ends) {
    EXPECT_NEAR(end.param->conv_norm_to_value(0.0f), end.low, 1e-12 * end.high);
    EXPECT_NEAR(end.param->conv_norm_to_value(1.0f), end.high, 1e-12 * end.high);
  }
  // Silence is exact, not merely small.
  EXPECT_EQ(ParamBandVolume().conv_norm_to_value(0.0f), 0.0);
  EXPECT_EQ(ParamMasterVol().conv_norm_to_value(0.0f), 0.0);
  // The volume mapping clamps what lies beyond its range.
  EXPECT_EQ(ParamBandVolume().conv_value_to_norm(50.0), 1.0f);
  EXPECT_EQ(ParamBandVolume().conv_value_to_norm(-0.5), 0.0f);
}

TEST(EffectParams, DefaultsGiveTheirNormalisedValues) {
  ParamToneFrq tone;
  tone.init(5000.0, 0);
  EXPECT_NEAR(tone.get_norm(), std::log(2.5) / std::log(4.0), 1e-7);
  ParamFeedbackPitch pitch;
  pitch.init(256.0, 0);
  EXPECT_NEAR(pitch.get_norm(), 2.0 / 3.0, 1e-7);
  ParamMasterVol master;
  master.init(1.0, 0);
  EXPECT_NEAR(master.get_norm(), std::log(32.5) / std::log(64.0), 1e-7);
  ParamBandSplitFrq split;
  split.init(20480.0, 0, 2);
  EXPECT_EQ(split.get_norm(), 1.0f);
  ParamDistoAmount amount;
  amount.init(1.0, 0, 0);
  EXPECT_NEAR(amount.get_norm(), 1.0 / 3.0, 1e-7);
  ParamBandVolume volume;
  volume.init(1.0, 0, 0);
  EXPECT_NEAR(volume.get_norm(), std::log10(10.9) / 2.0, 1e-7);
  ParamStereoBoostingFlag boost;
  boost.init(0.0, 1);
  EXPECT_EQ(boost.get_norm(), 0.0f);
  EXPECT_EQ(boost.get_priority(), 1);
}

TEST(EffectParams, NamesUnitsAndTypes) {
  struct Face {
    ParamPtr param;
    const char* name;
    const char* unit;
    int type;
  };
  Face faces[] = {
      {ParamPtr(new ParamStereoBoostingFlag), "Stereo Boost", "", 1},
      {ParamPtr(new ParamOverSamplingFlag), "Oversampling", "", 1},
      {ParamPtr(new ParamToneFrq), "Tone Freq", "Hz", 0},
      {ParamPtr(new ParamToneColor), "Tone Shape", "%", 0},
      {ParamPtr(new ParamStereoAmount), "Stereo Phase", "ms", 0},
      {ParamPtr(new ParamFeedbackAmount), "Fdbk Amnt", "%", 0},
      {ParamPtr(new ParamFeedbackPitch), "Fdbk Freq", "Hz", 0},
      {ParamPtr(new ParamMasterVol), "Master Vol", "dB", 0},
      {make_numbered<ParamBandSplitFrq>(0), "B1 Upper Freq", "Hz", 0},
      {make_numbered<ParamBandSplitFrq>(2), "B3 Upper Freq", "Hz", 0},
      {make_numbered<ParamCharacter>(1), "B2 Character", "%", 0},
      {make_numbered<ParamIntensity>(0), "B1 Intensity", "%", 0},
      {make_numbered<ParamDistoAmount>(2), "B3 Dist Amnt", "dB", 0},
      {make_numbered<ParamDistoType>(3), "B4 Dist Type", "", 1},
      {make_numbered<ParamBandVolume>(0), "B1 Volume", "dB", 0},
      {make_numbered<ParamSolo>(3), "B4 Solo", "", 1},
  };
  for (const Face& face : faces) {
    char text[32];
    face.param->get_name(text, sizeof(text));
    EXPECT_STREQ(text, face.name);
    face.param->get_unit(text, sizeof(text));
    EXPECT_STREQ(text, face.unit) << face.name;
    EXPECT_EQ(face.param->get_type(), face.type) << face.name;
    // Every name obeys the caller's capacity.
    face.param->get_name(text, 3);
    EXPECT_EQ(std::strncmp(text, face.name, 2), 0);
    EXPECT_EQ(text[2], '\0');
  }
}

TEST(EffectParams, SwitchesMapAtOneHalf) {
  ParamStereoBoostingFlag boost;
  EXPECT_EQ(boost.conv_norm_to_value(0.4999f), 0.0);
  EXPECT_EQ(boost.conv_norm_to_value(0.5f), 1.0);
  EXPECT_EQ(boost.conv_value_to_norm(0.5), 1.0f);
  EXPECT_EQ(boost.conv_value_to_norm(0.49), 0.0f);
  EXPECT_EQ(value_text(boost, 1.0), "On");
  EXPECT_EQ(value_text(boost, 0.0), "Off");
  EXPECT_EQ(read_text(boost, "ON"), 1.0);
  EXPECT_EQ(read_text(boost, "on"), 1.0);
  EXPECT_EQ(read_text(boost, "1"), 1.0);
  EXPECT_EQ(read_text(boost, "Off"), 0.0);
  EXPECT_EQ(read_text(boost, "0.3"), 0.0);
  EXPECT_EQ(read_text(boost, "0.7"), 1.0);
  read_text(boost, "yes", false);

  ParamOverSamplingFlag over;
  EXPECT_EQ(read_text(over, "OFF"), 0.0);
  EXPECT_EQ(value_text(over, 0.7), "On");

  ParamSolo solo;
  solo.init(0.0, 0, 0);
  EXPECT_EQ(solo.conv_norm_to_value(0.49f), 0.0);
  EXPECT_EQ(solo.conv_norm_to_value(0.5f), 1.0);  // halves round upward
  EXPECT_EQ(solo.conv_value_to_norm(1.2), 1.0f);
  EXPECT_EQ(value_text(solo, 0.4), "Off");
  EXPECT_EQ(value_text(solo, 0.6), "On");
  EXPECT_EQ(read_text(solo, "oN"), 1.0);
  EXPECT_EQ(read_text(solo, "off"), 0.0);
}

TEST(EffectParams, DistTypeStepsNamesAndNumbers) {
  ParamDistoType type;
  type.init(0.0, 0, 3);
  EXPECT_EQ(type.conv_norm_to_value(0.96f), 12.0);
  EXPECT_EQ(value_text(type, type.conv_norm_to_value(0.96f)), "Slew Rate 2");
  EXPECT_EQ(type.conv_norm_to_value(0.04f), 0.0);
  EXPECT_EQ(value_text(type, type.conv_norm_to_value(0.04f)), "Tube Sym 1");
  for (int k = 0; k <= 12; ++k) {
    const float n = static_cast<float>(k / 12.0);
    EXPECT_EQ(type.conv_norm_to_value(n), k);
    EXPECT_EQ(type.conv_value_to_norm(k), n);
    // Each name reads back to its own number, whatever the case.
    std::string name = distortion_curve_name(k);
    EXPECT_EQ(value_text(type, k), name);
    EXPECT_EQ(read_text(type, name.c_str()), k) << name;
    std::string lower;
    for (char c : name) {
      lower += static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
    }
    EXPECT_EQ(read_text(type, ("curve " + lower).c_str()), k) << lower;
  }
  EXPECT_EQ(read_text(type, "7"), 7.0);
  EXPECT_EQ(read_text(type, "20"), 12.0);
  EXPECT_EQ(read_text(type, "-3"), 0.0);
  read_text(type, "Tube", false);
  EXPECT_STREQ(distortion_curve_name(13), "");
  EXPECT_STREQ(distortion_curve_name(-1), "");
  EXPECT_STREQ(distortion_curve_name(10), "Raphosaure");
}

TEST(EffectParams, FrequencyTexts) {
  ParamBandSplitFrq split;
  split.init(20480.0, 0, 0);
  EXPECT_EQ(value_text(split, 20480.0), "20480");
  EXPECT_EQ(value_text(split, 440.0), "440.0");
  EXPECT_EQ(value_text(split, 1000.0), "1000");
  EXPECT_EQ(value_text(split, 20.0), "20.00");
  EXPECT_EQ(value_text(split, 999.4), "999.4");
  EXPECT_EQ(value_text(split, 999.5), "1000");
  EXPECT_EQ(value_text(split, 20480.0, 4), "204");
  EXPECT_EQ(read_text(split, "440"), 440.0);
  EXPECT_EQ(read_text(split, "5"), 20.0);
  EXPECT_EQ(read_text(split, "1e6"), 20480.0);
  read_text(split, "Hz", false);

  EXPECT_EQ(value_text(ParamToneFrq(), 5000.0), "5000");
  EXPECT_EQ(read_text(ParamToneFrq(), "100"), 2000.0);
  EXPECT_EQ(value_text(ParamFeedbackPitch(), 256.0), "256.0");
  EXPECT_EQ(read_text(ParamFeedbackPitch(), "2000"), 1024.0);
  EXPECT_EQ(read_text(ParamFeedbackPitch(), "100.5 Hz"), 100.5);

  // Shown and read back, a frequency stays within what five characters hold.
  for (int i = 0; i <= 32; ++i) {
    const double hz = split.conv_norm_to_value(static_cast<float>(i) / 32.0f);
    const double back = read_text(split, value_text(split, hz).c_str());
    EXPECT_NEAR(back, hz, hz < 1000.0 ? 0.1 : 0.5) << hz;
  }
}

TEST(EffectParams, PercentAndPhaseTexts) {
  ParamToneColor shape;
  EXPECT_EQ(value_text(shape, 0.0), "0.0");
  EXPECT_EQ(value_text(shape, 1.0), "100.0");
  EXPECT_EQ(value_text(shape, 0.123), "12.3");
  EXPECT_DOUBLE_EQ(read_text(shape, "50"), 0.5);
  EXPECT_EQ(read_text(shape, "150"), 1.0);
  EXPECT_EQ(read_text(shape, "-5"), 0.0);
  ParamIntensity intensity;
  EXPECT_EQ(value_text(intensity, 0.5), "50.0");
  EXPECT_DOUBLE_EQ(read_text(ParamFeedbackAmount(), "25 %"), 0.25);

  ParamStereoAmount phase;
  EXPECT_EQ(value_text(phase, 0.0), "0.000");
  EXPECT_EQ(value_text(phase, 0.01), "10.00");
  EXPECT_DOUBLE_EQ(read_text(phase, "5"), 0.005);
  EXPECT_DOUBLE_EQ(read_text(phase, "20"), 0.01);
  EXPECT_EQ(read_text(phase, "-1"), 0.0);
}

TEST(EffectParams, GainTexts) {
  ParamMasterVol master;
  EXPECT_EQ(value_text(master, 0.0), "-oo");
  EXPECT_EQ(value_text(master, 1e-5), "-oo");
  EXPECT_EQ(value_text(master, 1.0), "0.0");
  EXPECT_EQ(value_text(master, 0.25), "-12.0");
  EXPECT_EQ(value_text(master, 2.0), "6.0");
  EXPECT_EQ(read_text(master, "-oo"), 0.0);
  EXPECT_DOUBLE_EQ(read_text(master, "0"), 1.0);
  EXPECT_EQ(read_text(master, "+10"), 2.0);
  EXPECT_NEAR(read_text(master, "-6"), std::exp(-6.0 / 20.0 * std::log(10.0)), 1e-12);
  read_text(master, "loud", false);

  ParamBandVolume volume;
  volume.init(1.0, 0, 0);
  EXPECT_EQ(read_text(volume, "-OO"), 0.0);
  EXPECT_EQ(read_text(volume, "+30"), 10.0);
  EXPECT_NEAR(read_text(volume, "20"), 10.0, 1e-12);
  EXPECT_EQ(volume.conv_norm_to_value(0.0f), 0.0);
  EXPECT_EQ(value_text(volume, volume.conv_norm_to_value(0.0f)), "-oo");
  EXPECT_EQ(value_text(volume, 10.0), "20.0");
  EXPECT_EQ(value_text(volume, 0.001), "-60.0");
  EXPECT_EQ(value_text(volume, 0.0001), "-80.0");
  EXPECT_EQ(value_text(volume, 1.0, 2), "0");
}

TEST(EffectParams, DistAmountTexts) {
  ParamDistoAmount amount;
  amount.init(1.0, 0, 0);
  EXPECT_EQ(value_text(amount, 1.0), "    0");
  EXPECT_EQ(value_text(amount, 10.0), "+20.0");
  EXPECT_EQ(value_text(amount, 0.1), "-20.0");
  EXPECT_EQ(value_text(amount, 100.0), "+40.0");
  EXPECT_EQ(value_text(amount, 1.005), "    0");  // +0.04 dB
  EXPECT_EQ(value_text(amount, 2.0), "+6.02");
  EXPECT_EQ(read_text(amount, "60"), 100.0);
  EXPECT_EQ(read_text(amount, "-40"), 0.1);
  EXPECT_NEAR(read_text(amount, "6"), std::exp(0.3 * std::log(10.0)), 1e-12);
  EXPECT_NEAR(read_text(amount, "    0"), 1.0, 1e-15);
  read_text(amount, "much", false);
}

TEST(EffectParams, CharacterTexts) {
  ParamCharacter character;
  character.init(0.5, 0, 0);
  EXPECT_EQ(value_text(character, 0.5), "neutral");
  EXPECT_EQ(value_text(character, character.conv_norm_to_value(0.502f)), "neutral");
  EXPECT_EQ(value_text(character, 0.51), "S 2");
  EXPECT_EQ(value_text(character, 0.25), "P 50");
  EXPECT_EQ(value_text(character, 1.0), "S 100");
  EXPECT_EQ(value_text(character, 0.0), "P 100");
  EXPECT_EQ(value_text(character, 0.5, 4), "neu");
  EXPECT_DOUBLE_EQ(read_text(character, "p 50"), 0.25);
  EXPECT_DOUBLE_EQ(read_text(character, "s100"), 1.0);
  EXPECT_DOUBLE_EQ(read_text(character, "Neutral"), 0.5);
  EXPECT_DOUBLE_EQ(read_text(character, "S 300"), 1.0);
  EXPECT_DOUBLE_EQ(read_text(character, "P 300"), 0.0);
  EXPECT_DOUBLE_EQ(read_text(character, "S -20"), 0.5);  // an S value never goes below neutral
  read_text(character, "Q 5", false);
  // Only the first 30 characters are read: the S lies past them.
  read_text(character, "                              S 10", false);
  // Shown and read back, a character keeps its step of 1/200.
  for (int i = 0; i <= 40; ++i) {
    const double v = i / 40.0;
    const double back = read_text(character, value_text(character, v).c_str());
    EXPECT_NEAR(back, v, 0.0051) << v;
  }
}

TEST(EffectParams, TextsObeyTheCallersCapacity) {
  ParamDistoType type;
  type.init(0.0, 0, 0);
  char text[16];
  std::memset(text, '#', sizeof(text));
  type.conv_value_to_text(text, 5, 12.0);
  EXPECT_STREQ(text, "Slew");
  EXPECT_EQ(text[5], '#');
  std::memset(text, '#', sizeof(text));
  type.conv_value_to_text(text, 0, 12.0);
  EXPECT_EQ(text[0], '#');
  ParamMasterVol master;
  std::memset(text, '#', sizeof(text));
  master.conv_value_to_text(text, 3, 0.25);
  EXPECT_STREQ(text, "-1");
  EXPECT_EQ(text[3], '#');
}

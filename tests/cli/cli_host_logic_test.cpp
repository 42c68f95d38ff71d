// The host's portable pieces tested in-process: callback answers, name
// lookup, JSON text, levels, bank file checks, raw audio and the demo signal.
#include <gtest/gtest.h>

#include <cmath>
#include <cstring>

#include "cli/bank_file_check.h"
#include "cli/bench_case.h"
#include "cli/cli_test_support.h"
#include "cli/demo_signal.h"
#include "cli/host_callback.h"
#include "cli/json_text.h"
#include "cli/level_stats.h"
#include "cli/mini_json.h"
#include "cli/param_lookup.h"
#include "cli/raw_audio.h"

namespace cli_test {
namespace {

using plugcore::host_callback;

TEST(HostCallback, AnswersTheQueriesAPluginMakes) {
  AEffect effect{};
  plugcore::HostCallbackContext context;
  context.sample_rate = 96000.0;
  context.block_size = 333;
  context.connected_inputs = 1;
  context.connected_outputs = 2;
  context.sample_pos = 48000.0;
  plugcore::bind_context(&effect, &context);

  EXPECT_EQ(host_callback(nullptr, audioMasterVersion, 0, 0, nullptr, 0.f), 2400);
  EXPECT_EQ(host_callback(&effect, audioMasterGetSampleRate, 0, 0, nullptr, 0.f), 96000);
  EXPECT_EQ(host_callback(&effect, audioMasterGetBlockSize, 0, 0, nullptr, 0.f), 333);
  EXPECT_EQ(host_callback(&effect, audioMasterGetNumAutomatableParameters, 0, 0, nullptr, 0.f), 0);
  // Pin connected answers 0 for a connected pin.
  EXPECT_EQ(host_callback(&effect, audioMasterPinConnected, 0, 0, nullptr, 0.f), 0);
  EXPECT_EQ(host_callback(&effect, audioMasterPinConnected, 1, 0, nullptr, 0.f), 1);
  EXPECT_EQ(host_callback(&effect, audioMasterPinConnected, 1, 1, nullptr, 0.f), 0);
  EXPECT_EQ(host_callback(&effect, audioMasterPinConnected, 2, 1, nullptr, 0.f), 1);
  EXPECT_EQ(host_callback(&effect, audioMasterPinConnected, -1, 0, nullptr, 0.f), 1);
  char time_text[] = "sendVstTimeInfo";
  char window_text[] = "sizeWindow";
  char odd_text[] = "sendVstTimeInfoPlease";
  EXPECT_EQ(host_callback(&effect, audioMasterCanDo, 0, 0, time_text, 0.f), 1);
  EXPECT_EQ(host_callback(&effect, audioMasterCanDo, 0, 0, window_text, 0.f), -1);
  EXPECT_EQ(host_callback(&effect, audioMasterCanDo, 0, 0, odd_text, 0.f), 0);
  EXPECT_EQ(host_callback(&effect, audioMasterCanDo, 0, 0, nullptr, 0.f), 0);
  EXPECT_EQ(host_callback(&effect, audioMasterGetLanguage, 0, 0, nullptr, 0.f), 0);
  EXPECT_EQ(host_callback(&effect, audioMasterIdle, 0, 0, nullptr, 0.f), 0);
  plugcore::unbind_context(&effect);
}

TEST(HostCallback, TimeInfoCarriesTempoOnlyWhenAsked) {
  AEffect effect{};
  plugcore::HostCallbackContext context;
  context.sample_rate = 48000.0;
  context.sample_pos = 72000.0;  // 1.5 s: 3 beats at 120 bpm
  plugcore::bind_context(&effect, &context);
  auto* info = reinterpret_cast<VstTimeInfo*>(
      host_callback(&effect, audioMasterGetTime, 0, kVstTempoValid | kVstPpqPosValid, nullptr, 0.f));
  ASSERT_NE(info, nullptr);
  EXPECT_EQ(info->tempo, 120.0);
  EXPECT_NE(info->flags & kVstTempoValid, 0);
  EXPECT_DOUBLE_EQ(info->ppqPos, 3.0);
  EXPECT_EQ(info->samplePos, 72000.0);
  EXPECT_EQ(info->sampleRate, 48000.0);
  info = reinterpret_cast<VstTimeInfo*>(host_callback(&effect, audioMasterGetTime, 0, 0, nullptr, 0.f));
  ASSERT_NE(info, nullptr);
  EXPECT_EQ(info->flags & (kVstTempoValid | kVstPpqPosValid), 0);
  plugcore::unbind_context(&effect);
}

TEST(ParamLookup, EditDistanceMatchesItsDefinition) {
  EXPECT_EQ(plugcore::edit_distance("kitten", "sitting"), 3u);
  EXPECT_EQ(plugcore::edit_distance("", "abc"), 3u);
  EXPECT_EQ(plugcore::edit_distance("Master Vol", "master vol"), 0u);
  EXPECT_EQ(plugcore::edit_distance("flaw", "lawn"), 2u);
  // Symmetric and bounded by the longer length, checked over many pairs.
  const char* words[] = {"Gain", "B1 Dist Type", "Tone Freq", "x", "Stereo Boost", ""};
  for (const char* a : words) {
    for (const char* b : words) {
      const size_t d = plugcore::edit_distance(a, b);
      EXPECT_EQ(d, plugcore::edit_distance(b, a));
      EXPECT_LE(d, std::max(std::strlen(a), std::strlen(b)));
      EXPECT_GE(d, std::strlen(a) > std::strlen(b) ? std::strlen(a) - std::strlen(b)
                                                   : std::strlen(b) - std::strlen(a));
    }
  }
}

TEST(ParamLookup, FindsNamesIgnoringCaseAndRanksCandidates) {
  const std::vector<std::string> names = {"Stereo Boost", "B1 Dist Type", "B2 Dist Type",
                                          "Master Vol", "Tone Freq"};
  EXPECT_EQ(plugcore::find_name(names, " master VOL "), 3);
  EXPECT_EQ(plugcore::find_name(names, "Master Volume"), -1);
  const auto close = plugcore::closest_names(names, "B1 Dist Typ", 2);
  ASSERT_EQ(close.size(), 2u);
  EXPECT_EQ(close[0], "B1 Dist Type");
  EXPECT_EQ(close[1], "B2 Dist Type");
  EXPECT_EQ(plugcore::closest_names(names, "Master Volume", 1),
            std::vector<std::string>{"Master Vol"});
}

TEST(ParamLookup, AssignmentsAreCheckedStrictly) {
  EXPECT_EQ(plugcore::split_assignment("Master Vol=-6", "--set"),
            (std::pair<std::string, std::string>{"Master Vol", "-6"}));
  EXPECT_EQ(plugcore::split_assignment("A=b=c", "--set").second, "b=c");
  EXPECT_THROW(plugcore::split_assignment("novalue", "--set"), std::runtime_error);
  EXPECT_THROW(plugcore::split_assignment("=3", "--set"), std::runtime_error);
  EXPECT_EQ(plugcore::parse_norm_assignment("12=0.25"), (std::pair<int, float>{12, 0.25f}));
  for (const char* bad : {"1=1.01", "-1=0.5", "x=0.5", "1=", "1=nan", "1=0.5x"}) {
    EXPECT_THROW(plugcore::parse_norm_assignment(bad), std::runtime_error) << bad;
  }
}

TEST(BenchCase, ParsesKeysAndKeepsDefaults) {
  plugcore::BenchCase defaults;
  defaults.plugin_path = "/p.so";
  defaults.block = 256;
  defaults.settings.program = 4;  // top-level settings do not leak into a case
  const auto parsed =
      plugcore::parse_bench_case("os:program=3,set=Oversampling=On,norm=2=0.5,block=64", defaults);
  EXPECT_EQ(parsed.name, "os");
  EXPECT_EQ(parsed.plugin_path, "/p.so");
  EXPECT_EQ(parsed.block, 64);
  EXPECT_EQ(parsed.settings.program, 3);
  ASSERT_EQ(parsed.settings.texts.size(), 1u);
  EXPECT_EQ(parsed.settings.texts[0].first, "Oversampling");
  EXPECT_EQ(parsed.settings.texts[0].second, "On");
  ASSERT_EQ(parsed.settings.norms.size(), 1u);
  EXPECT_EQ(parsed.settings.norms[0].first, 2);
  const auto bare = plugcore::parse_bench_case("plain", defaults);
  EXPECT_EQ(bare.settings.program, -1);
  EXPECT_EQ(bare.block, 256);
  EXPECT_THROW(plugcore::parse_bench_case(":program=1", defaults), std::runtime_error);
  EXPECT_THROW(plugcore::parse_bench_case("a:speed=9", defaults), std::runtime_error);
  EXPECT_THROW(plugcore::parse_bench_case("a:mode=sideways", defaults), std::runtime_error);
}

TEST(JsonText, QuotedTextsReadBackUnchanged) {
  std::vector<std::string> texts = {"", "plain", "quote \" and \\ back", "tab\tnew\nline\r",
                                    std::string("nul\0byte", 8), "\x01\x1f\x7f", "caf\xc3\xa9",
                                    "\xe2\x82\xac sign"};
  // Every single byte below 0x80 on its own.
  for (int c = 0; c < 0x80; ++c) texts.push_back(std::string(1, static_cast<char>(c)));
  for (const std::string& text : texts) {
    const JsonValue value = parse_json(basic::json_quote(text));
    ASSERT_EQ(value.kind, JsonValue::Kind::string);
    EXPECT_EQ(value.text, text) << basic::json_quote(text);
  }
}

TEST(JsonText, InvalidUtf8BecomesReplacementCharacters) {
  const std::string broken = "a\xff" "b\xc3" "c\xe2\x82";
  const JsonValue value = parse_json(basic::json_quote(broken));
  EXPECT_EQ(value.text, "a\xef\xbf\xbd" "b\xef\xbf\xbd" "c\xef\xbf\xbd\xef\xbf\xbd");
  // Over-long encodings and surrogates are not valid either.
  EXPECT_EQ(parse_json(basic::json_quote("\xc0\xaf")).text, "\xef\xbf\xbd\xef\xbf\xbd");
  EXPECT_EQ(parse_json(basic::json_quote("\xed\xa0\x80")).text,
            "\xef\xbf\xbd\xef\xbf\xbd\xef\xbf\xbd");
}

TEST(LevelStats, PeakAndRmsMatchADoubleReference) {
  const std::vector<std::vector<float>> channels = {test_noise(1000, 5u, 0.7f),
                                                    test_noise(1000, 9u, 0.2f)};
  double peak = 0.0, sum = 0.0;
  for (const auto& channel : channels)
    for (float v : channel) peak = std::max(peak, std::fabs(double(v))), sum += double(v) * v;
  const basic::LevelStats stats = basic::measure_levels(channels);
  EXPECT_EQ(stats.peak, peak);
  EXPECT_NEAR(stats.rms, std::sqrt(sum / 2000.0), 1e-12);
  // A full-scale sine has an RMS of -3.01 dBFS.
  std::vector<float> sine(48000);
  for (size_t n = 0; n < sine.size(); ++n) sine[n] = float(std::sin(2 * M_PI * 1000.0 * n / 48000.0));
  const basic::LevelStats sine_stats = basic::measure_levels({sine});
  EXPECT_EQ(basic::format_dbfs(sine_stats.peak), "0.00");
  EXPECT_EQ(basic::format_dbfs(sine_stats.rms), "-3.01");
  EXPECT_EQ(basic::format_dbfs(basic::measure_levels({std::vector<float>(10, 0.f)}).peak), "-inf");
  EXPECT_EQ(basic::format_dbfs(0.5), "-6.02");
}

TEST(BankFileCheck, HeaderAndBlockFaultsGiveTheirStatus) {
  ScratchDir dir;
  const std::vector<uint8_t> block = bank_block({"One", "Two"}, {{0.5f, 0.25f}, {0.0f, 1.0f}});
  write_bytes(dir.file("good.pbk"), bank_file(block));
  std::vector<uint8_t> read;
  ASSERT_EQ(plugcore::read_bank_file_block(dir.file("good.pbk"), read), 0);
  EXPECT_EQ(read, block);
  EXPECT_EQ(read.size(), 8u + 2u * (76u + 8u));
  // 0.5 as a big-endian float: 3F 00 00 00, right after the first name field.
  EXPECT_EQ(read[8 + 76], 0x3F);
  EXPECT_EQ(read[8 + 77], 0x00);

  std::vector<uint8_t> longer = bank_file(block);
  longer.push_back(0xAA);  // bytes beyond L are not part of the block
  write_bytes(dir.file("longer.pbk"), longer);
  ASSERT_EQ(plugcore::read_bank_file_block(dir.file("longer.pbk"), read), 0);
  EXPECT_EQ(read, block);

  std::vector<uint8_t> truncated = bank_file(block);
  truncated.pop_back();
  write_bytes(dir.file("truncated.pbk"), truncated);
  std::vector<uint8_t> magic = bank_file(block);
  magic[3] = 'b';
  write_bytes(dir.file("magic.pbk"), magic);
  write_bytes(dir.file("seven.pbk"), {'V', 'L', 'P', 'B', 0, 0, 0});
  write_bytes(dir.file("huge.pbk"), {'V', 'L', 'P', 'B', 0xFF, 0xFF, 0xFF, 0xFF, 1, 2});
  EXPECT_EQ(plugcore::read_bank_file_block(dir.file("absent.pbk"), read), -1002);
  EXPECT_EQ(plugcore::read_bank_file_block(dir.file("seven.pbk"), read), -1005);
  EXPECT_EQ(plugcore::read_bank_file_block(dir.file("truncated.pbk"), read), -1009);
  EXPECT_EQ(plugcore::read_bank_file_block(dir.file("huge.pbk"), read), -1009);
  EXPECT_EQ(plugcore::read_bank_file_block(dir.file("magic.pbk"), read), -1010);
  EXPECT_EQ(plugcore::bank_status_text(-1010), "the file does not start with \"VLPB\"");
  EXPECT_EQ(plugcore::bank_status_text(-1234), "unknown bank status");
}

TEST(RawAudio, RoundTripsLittleEndianFramesAndRejectsPartialOnes) {
  ScratchDir dir;
  const std::vector<std::vector<float>> channels = {{1.0f, -0.5f, 0.25f}, {0.0f, 2.0f, -1.0f}};
  basic::write_raw_float(dir.file("a.raw"), channels);
  const std::string bytes = read_text(dir.file("a.raw"));
  ASSERT_EQ(bytes.size(), 24u);
  // 1.0f is 00 00 80 3F little-endian, and left comes before right.
  EXPECT_EQ(bytes.substr(0, 4), std::string("\x00\x00\x80\x3f", 4));
  EXPECT_EQ(bytes.substr(4, 4), std::string(4, '\0'));
  EXPECT_EQ(basic::read_raw_float(dir.file("a.raw"), 2), channels);
  write_bytes(dir.file("odd.raw"), std::vector<uint8_t>(12, 0));
  EXPECT_THROW(basic::read_raw_float(dir.file("odd.raw"), 2), std::runtime_error);
  EXPECT_THROW(basic::read_raw_float(dir.file("absent.raw"), 2), std::runtime_error);
}

// Energy of x after a one-pole low-pass (low = true) or its complement.
double band_energy(const std::vector<float>& x, double rate, double corner, bool low) {
  const double a = std::exp(-2.0 * M_PI * corner / rate);
  double state = 0.0, energy = 0.0;
  for (float v : x) {
    state = (1.0 - a) * v + a * state;
    const double y = low ? state : v - state;
    energy += y * y;
  }
  return energy;
}

TEST(DemoSignal, IsDeterministicStereoMusicAtMinusSixDbfs) {
  const basic::StereoSignal a = basic::make_demo_signal(48000.0);
  const basic::StereoSignal b = basic::make_demo_signal(48000.0);
  ASSERT_EQ(a.left.size(), 288000u);
  ASSERT_EQ(a.right.size(), 288000u);
  EXPECT_EQ(a.left, b.left);
  EXPECT_EQ(a.right, b.right);
  EXPECT_EQ(basic::make_demo_signal(44100.0).left.size(), 264600u);

  const basic::LevelStats stats = basic::measure_levels({a.left, a.right});
  EXPECT_NEAR(basic::to_dbfs(stats.peak), -6.0, 0.01);
  EXPECT_GT(basic::to_dbfs(stats.rms), -30.0);

  // Not a mono signal copied twice.
  double difference = 0.0;
  for (size_t n = 0; n < a.left.size(); ++n) difference += std::fabs(a.left[n] - a.right[n]);
  EXPECT_GT(difference / a.left.size(), 1e-3);

  // Bass and kick below 150 Hz, hi-hat and pluck brightness above 5 kHz.
  const double total = band_energy(a.left, 48000, 1.0, false);
  EXPECT_GT(band_energy(a.left, 48000, 150.0, true) / total, 0.2);
  EXPECT_GT(band_energy(a.left, 48000, 5000.0, false) / total, 1e-4);

  // Rhythm: the kick on every beat makes the 20 ms around each beat louder
  // than the 20 ms just before it.
  int louder = 0;
  for (int beat = 1; beat < 12; ++beat) {
    const size_t at = static_cast<size_t>(beat * 24000);
    double on = 0.0, before = 0.0;
    for (size_t n = 0; n < 960; ++n) {
      on += double(a.left[at + n]) * a.left[at + n];
      before += double(a.left[at - 960 + n]) * a.left[at - 960 + n];
    }
    louder += on > before ? 1 : 0;
  }
  EXPECT_GE(louder, 10);
}

}  // namespace
}  // namespace cli_test

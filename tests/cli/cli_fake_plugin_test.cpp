// The command-line host run as a subprocess on the fake gain plug-in: the
// calls it makes, what it writes, and how it fails.
#include <gtest/gtest.h>

#include <cmath>
#include <filesystem>

#include "cli/cli_test_support.h"
#include "cli/mini_json.h"

namespace cli_test {
namespace {

double db_gain(double db) { return std::pow(10.0, db / 20.0); }

class FakePluginCli : public ::testing::Test {
 protected:
  void SetUp() override {
    ASSERT_FALSE(dir.path().empty());
    ASSERT_TRUE(std::filesystem::exists(fake_plugin_path()))
        << "fake plug-in not built: " << fake_plugin_path();
    left = test_noise(kFrames, 11u, 0.5f);
    right = test_noise(kFrames, 23u, 0.3f);
    ASSERT_TRUE(write_wav(in_path(), kRate, {left, right}));
  }
  std::string in_path() const { return dir.file("in.wav"); }
  std::string out_path() const { return dir.file("out.wav"); }
  RunResult render(std::vector<std::string> extra,
                   const std::vector<std::pair<std::string, std::string>>& env = {}) {
    std::vector<std::string> args = {"render", "--plugin", fake_plugin_path()};
    args.insert(args.end(), extra.begin(), extra.end());
    return run_cli(args, dir.path(), env);
  }

  static constexpr int kRate = 44100;
  static constexpr size_t kFrames = 5000;
  ScratchDir dir;
  std::vector<float> left, right;
};

TEST_F(FakePluginCli, InfoJsonDescribesTheRecordAndEscapesTexts) {
  const RunResult run = run_cli({"info", "--plugin", fake_plugin_path(), "--json"}, dir.path());
  ASSERT_EQ(run.status, 0) << run.err;
  const JsonValue info = parse_json(run.out);
  EXPECT_EQ(info["unique_id"].text, "FkGn");
  EXPECT_EQ(info["unique_id_number"].number, double(('F' << 24) | ('k' << 16) | ('G' << 8) | 'n'));
  EXPECT_EQ(info["version"].number, 1003);
  ASSERT_EQ(info["flags"].items.size(), 3u);
  EXPECT_EQ(info["flags"][0].text, "CanMono");
  EXPECT_EQ(info["flags"][1].text, "CanReplacing");
  EXPECT_EQ(info["flags"][2].text, "ProgramChunks");
  EXPECT_EQ(info["inputs"][1]["label"].text, "Fake In R");
  EXPECT_TRUE(info["outputs"][0]["stereo"].boolean);
  const JsonValue& gain = info["parameters"][0];
  EXPECT_EQ(gain["name"].text, "Gain");
  EXPECT_EQ(gain["label"].text, "dB");
  EXPECT_EQ(gain["display"].text, "0.00");
  EXPECT_NEAR(gain["value"].number, 24.0 / 36.0, 1e-7);
  EXPECT_TRUE(gain["automatable"].boolean);
  EXPECT_TRUE(gain["properties"]["can_ramp"].boolean);
  EXPECT_FALSE(gain["properties"]["switch"].boolean);
  const JsonValue& invert = info["parameters"][1];
  EXPECT_FALSE(invert["automatable"].boolean);
  EXPECT_TRUE(invert["properties"]["switch"].boolean);
  ASSERT_EQ(info["programs"].items.size(), 3u);
  EXPECT_EQ(info["programs"][2]["name"].text, "Loud \"Flip\" \\ Six");
}

TEST_F(FakePluginCli, InfoFallsBackToTheOldEntryName) {
  const RunResult run = run_cli({"info", "--plugin", fake_plugin_path(true)}, dir.path());
  ASSERT_EQ(run.status, 0) << run.err;
  EXPECT_NE(run.out.find("'FkGn'"), std::string::npos) << run.out;
  EXPECT_NE(run.out.find("Phase Invert"), std::string::npos);
  EXPECT_NE(run.out.find("switch"), std::string::npos);
}

TEST_F(FakePluginCli, HostCallsArriveInHostOrderWithHostAnswers) {
  const std::string log = dir.file("calls.log");
  const RunResult run = render({"--in", in_path(), "--out", out_path(), "--block", "256",
                                "--tail", "0.1"},
                               {{"FAKE_GAIN_LOG", log}});
  ASSERT_EQ(run.status, 0) << run.err;
  const size_t frames = kFrames + static_cast<size_t>(0.1 * kRate + 0.5);
  const size_t blocks = (frames + 255) / 256;
  const std::vector<std::string> expected = {
      "entry version=2400",
      "open",
      "sample_rate 44100",
      "block_size 256",
      "mains 1",
      "resume rate=44100 block=256 automatable=0 pins_in=0,0 pins_out=0,0 cando_time=1 "
      "cando_unknown=0 other_opcode=0",
      "time tempo=120.000 tempo_valid=1 ppq_valid=1 rate=44100",
      "mains 0",
      "close replacing=" + std::to_string(blocks) + " adding=0 frames=" + std::to_string(frames),
  };
  EXPECT_EQ(lines_of(read_text(log)), expected);
  EXPECT_EQ(read_wav(out_path()).frames(), frames);
}

TEST_F(FakePluginCli, RenderAppliesGainThroughTextAndWritesFloatWav) {
  const RunResult run = render({"--in", in_path(), "--out", out_path(), "--set", "gAIN = -6"});
  ASSERT_EQ(run.status, 0) << run.err;
  const Audio out = read_wav(out_path());
  ASSERT_EQ(out.channels.size(), 2u);
  EXPECT_EQ(out.rate, kRate);
  EXPECT_EQ(out.format, SF_FORMAT_WAV | SF_FORMAT_FLOAT);
  ASSERT_EQ(out.frames(), kFrames);
  double peak = 0.0, sum = 0.0;
  for (size_t n = 0; n < kFrames; ++n) {
    EXPECT_NEAR(out.channels[0][n], left[n] * db_gain(-6.0), 1e-6);
    EXPECT_NEAR(out.channels[1][n], right[n] * db_gain(-6.0), 1e-6);
    for (double v : {double(out.channels[0][n]), double(out.channels[1][n])}) {
      peak = std::max(peak, std::fabs(v));
      sum += v * v;
    }
  }
  char expected[128];
  std::snprintf(expected, sizeof(expected), "%s: peak %.2f dBFS, RMS %.2f dBFS", out_path().c_str(),
                20 * std::log10(peak), 20 * std::log10(std::sqrt(sum / (2.0 * kFrames))));
  EXPECT_EQ(lines_of(run.out), std::vector<std::string>{expected});
}

TEST_F(FakePluginCli, ProgramComesFirstThenTextsThenNorms) {
  // Program 2 is +6 dB with the phase inverted; the text then sets the gain.
  ASSERT_EQ(render({"--in", in_path(), "--out", out_path(), "--program", "2", "--set",
                    "Gain=-12"}).status, 0);
  Audio out = read_wav(out_path());
  ASSERT_EQ(out.frames(), kFrames);
  for (size_t n = 0; n < kFrames; n += 97) {
    EXPECT_NEAR(out.channels[0][n], -left[n] * db_gain(-12.0), 1e-6);
  }
  // A norm after both: 0.5 is -6 dB, and the inversion goes with norm 1=0.
  ASSERT_EQ(render({"--in", in_path(), "--out", out_path(), "--norm", "0=0.5", "--program", "2",
                    "--norm", "1=0", "--set", "Gain=3"}).status, 0);
  out = read_wav(out_path());
  for (size_t n = 0; n < kFrames; n += 97) {
    EXPECT_NEAR(out.channels[1][n], right[n] * db_gain(-24.0 + 36.0 * 0.5), 1e-6);
  }
}

TEST_F(FakePluginCli, MonoFileFeedsBothInputsUnlessMonoIn) {
  const std::string mono = dir.file("mono.wav");
  ASSERT_TRUE(write_wav(mono, kRate, {left}));
  ASSERT_EQ(render({"--in", mono, "--out", out_path()}).status, 0);
  Audio out = read_wav(out_path());
  ASSERT_EQ(out.channels.size(), 2u);
  for (size_t n = 0; n < kFrames; n += 13) {
    EXPECT_FLOAT_EQ(out.channels[1][n], left[n]);
  }
  // Unconnected second input: the host says so and feeds it silence, so the
  // plug-in's mono handling (copy left) shows and the file's right is ignored.
  const std::string log = dir.file("mono.log");
  ASSERT_EQ(render({"--in", in_path(), "--out", out_path(), "--mono-in"}, {{"FAKE_GAIN_LOG", log}})
                .status, 0);
  EXPECT_NE(read_text(log).find("pins_in=0,1 pins_out=0,0"), std::string::npos) << read_text(log);
  out = read_wav(out_path());
  for (size_t n = 0; n < kFrames; n += 13) {
    EXPECT_FLOAT_EQ(out.channels[1][n], left[n]);
  }
}

TEST_F(FakePluginCli, MonoOutWritesOneChannel) {
  const std::string log = dir.file("out.log");
  ASSERT_EQ(render({"--in", in_path(), "--out", out_path(), "--mono-out", "--program", "1"},
                   {{"FAKE_GAIN_LOG", log}}).status, 0);
  EXPECT_NE(read_text(log).find("pins_out=0,1"), std::string::npos);
  const Audio out = read_wav(out_path());
  ASSERT_EQ(out.channels.size(), 1u);
  for (size_t n = 0; n < kFrames; n += 7) {
    EXPECT_NEAR(out.channels[0][n], 0.5 * (left[n] + right[n]) * db_gain(-12.0), 1e-6);
  }
}

TEST_F(FakePluginCli, AddingModeZeroesOutputsAndMatchesReplacing) {
  const std::string log = dir.file("adding.log");
  const std::string replacing = dir.file("replacing.wav");
  ASSERT_EQ(render({"--in", in_path(), "--out", replacing, "--block", "64"}).status, 0);
  ASSERT_EQ(render({"--in", in_path(), "--out", out_path(), "--block", "64", "--mode", "adding"},
                   {{"FAKE_GAIN_LOG", log}}).status, 0);
  EXPECT_NE(read_text(log).find("close replacing=0 adding=" + std::to_string((kFrames + 63) / 64)),
            std::string::npos) << read_text(log);
  const Audio a = read_wav(replacing);
  const Audio b = read_wav(out_path());
  ASSERT_EQ(a.frames(), kFrames);
  EXPECT_EQ(a.channels, b.channels);
}

TEST_F(FakePluginCli, RawInputAndOutputMatchTheWavPath) {
  std::vector<uint8_t> raw;
  for (size_t n = 0; n < kFrames; ++n) {
    for (float v : {left[n], right[n]}) {
      uint32_t bits;
      std::memcpy(&bits, &v, 4);
      for (int k = 0; k < 4; ++k) raw.push_back(static_cast<uint8_t>(bits >> (8 * k)));
    }
  }
  write_bytes(dir.file("in.raw"), raw);
  ASSERT_EQ(render({"--raw-in", dir.file("in.raw"), "--raw-out", dir.file("out.raw"), "--rate",
                    "44100", "--program", "1"}).status, 0);
  ASSERT_EQ(render({"--in", in_path(), "--out", out_path(), "--program", "1"}).status, 0);
  const Audio wav = read_wav(out_path());
  const std::string out_raw = read_text(dir.file("out.raw"));
  ASSERT_EQ(out_raw.size(), kFrames * 8);
  for (size_t n = 0; n < kFrames; n += 11) {
    float l, r;
    std::memcpy(&l, out_raw.data() + 8 * n, 4);
    std::memcpy(&r, out_raw.data() + 8 * n + 4, 4);
    EXPECT_EQ(l, wav.channels[0][n]);
    EXPECT_EQ(r, wav.channels[1][n]);
  }
}

TEST_F(FakePluginCli, BadSettingsNameTheCandidatesAndLeaveNoFile) {
  RunResult run = render({"--in", in_path(), "--out", out_path(), "--set", "Gian=-6"});
  EXPECT_EQ(run.status, 1);
  EXPECT_NE(run.err.find("unknown parameter \"Gian\""), std::string::npos) << run.err;
  EXPECT_NE(run.err.find("closest: \"Gain\""), std::string::npos) << run.err;
  EXPECT_EQ(lines_of(run.err).size(), 1u);

  run = render({"--in", in_path(), "--out", out_path(), "--set", "phase invert=Onn"});
  EXPECT_EQ(run.status, 1);
  EXPECT_NE(run.err.find("refused the text \"Onn\"; closest: \"On\", \"Off\""), std::string::npos)
      << run.err;

  run = render({"--in", in_path(), "--out", out_path(), "--set", "Gain=40"});
  EXPECT_EQ(run.status, 1);
  run = render({"--in", in_path(), "--out", out_path(), "--program", "3"});
  EXPECT_EQ(run.status, 1);
  EXPECT_NE(run.err.find("program 3"), std::string::npos);
  run = render({"--in", in_path(), "--out", out_path(), "--norm", "2=0.5"});
  EXPECT_EQ(run.status, 1);
  EXPECT_EQ(listed_files(dir.path()), std::vector<std::string>{"in.wav"});
}

TEST_F(FakePluginCli, FailedRenderKeepsAnExistingOutput) {
  write_bytes(out_path(), {'o', 'l', 'd'});
  EXPECT_NE(render({"--in", in_path(), "--out", out_path(), "--set", "Nope=1"}).status, 0);
  EXPECT_EQ(read_text(out_path()), "old");
  // The output's directory does not exist: the write fails and nothing is left behind.
  EXPECT_EQ(render({"--in", in_path(), "--out", dir.file("missing/out.wav")}).status, 1);
  EXPECT_FALSE(std::filesystem::exists(dir.file("missing")));
}

TEST_F(FakePluginCli, UnreadableInputsAndBadOptionsFail) {
  write_bytes(dir.file("text.wav"), {'n', 'o', 't', ' ', 'a', 'u', 'd', 'i', 'o'});
  struct Case {
    std::vector<std::string> args;
    int status;
  };
  const Case cases[] = {
      {{"--in", dir.file("absent.wav"), "--out", out_path()}, 1},
      {{"--in", dir.file("text.wav"), "--out", out_path()}, 1},
      {{"--in", in_path()}, 2},
      {{"--in", in_path(), "--out", out_path(), "--mode", "sideways"}, 2},
      {{"--in", in_path(), "--out", out_path(), "--block", "0"}, 2},
      {{"--in", in_path(), "--out", out_path(), "--rate", "48000"}, 2},
      {{"--in", in_path(), "--out", out_path(), "--norm", "0=1.5"}, 2},
      {{"--in", in_path(), "--out", out_path(), "--set", "=3"}, 2},
      {{"--in", in_path(), "--out", out_path(), "--frobnicate"}, 2},
  };
  for (const Case& c : cases) {
    const RunResult run = render(c.args);
    EXPECT_EQ(run.status, c.status) << c.args.back() << ": " << run.err;
    EXPECT_EQ(lines_of(run.err).size(), 1u) << run.err;
  }
  EXPECT_FALSE(std::filesystem::exists(out_path()));
}

TEST_F(FakePluginCli, PluginsThatFailToLoadAreReported) {
  RunResult run = run_cli({"info", "--plugin", fake_plugin_path()}, dir.path(),
                          {{"FAKE_GAIN_FAULT", "null"}});
  EXPECT_EQ(run.status, 1);
  EXPECT_NE(run.err.find("refused to load"), std::string::npos) << run.err;
  run = run_cli({"info", "--plugin", fake_plugin_path()}, dir.path(),
                {{"FAKE_GAIN_FAULT", "bad_magic"}});
  EXPECT_EQ(run.status, 1);
  EXPECT_NE(run.err.find("magic"), std::string::npos) << run.err;
  run = run_cli({"info", "--plugin", dir.file("nothing.so")}, dir.path());
  EXPECT_EQ(run.status, 1);
  EXPECT_NE(run.err.find("cannot load plug-in"), std::string::npos) << run.err;
  // A shared object that is not a plug-in at all.
  run = run_cli({"info", "--plugin", "libsndfile.so.1"}, dir.path());
  EXPECT_EQ(run.status, 1);
  EXPECT_NE(run.err.find("exports neither"), std::string::npos) << run.err;
}

TEST_F(FakePluginCli, BankShowListsProgramsAsThePluginDisplaysThem) {
  const std::vector<std::vector<float>> values = {{0.25f, 0.0f}, {0.5f, 1.0f}, {1.0f, 0.0f}};
  write_bytes(dir.file("good.pbk"), bank_file(bank_block({"Alpha", "Beta", "Gamma"}, values)));
  const RunResult run =
      run_cli({"bank", "show", dir.file("good.pbk"), "--plugin", fake_plugin_path()}, dir.path());
  ASSERT_EQ(run.status, 0) << run.err;
  std::vector<std::string> expected = {dir.file("good.pbk") + ": 3 programs"};
  const char* names[] = {"Alpha", "Beta", "Gamma"};
  for (int p = 0; p < 3; ++p) {
    char gain[64];
    std::snprintf(gain, sizeof(gain), "  0  Gain = %.2f dB", -24.0 + 36.0 * values[p][0]);
    expected.push_back("program " + std::to_string(p) + ": " + names[p]);
    expected.push_back(gain);
    expected.push_back(std::string("  1  Phase Invert = ") + (values[p][1] > 0.5f ? "On" : "Off"));
  }
  EXPECT_EQ(lines_of(run.out), expected);
}

TEST_F(FakePluginCli, BankShowReportsEachFileFault) {
  const std::vector<uint8_t> block =
      bank_block({"A", "B", "C"}, {{0.1f, 0.0f}, {0.2f, 0.0f}, {0.3f, 0.0f}});
  std::vector<uint8_t> truncated = bank_file(block);
  truncated.resize(truncated.size() - 5);
  std::vector<uint8_t> bad_magic = bank_file(block);
  bad_magic[0] = 'X';
  write_bytes(dir.file("short_header.pbk"), {'V', 'L', 'P', 'B', 0, 0});
  write_bytes(dir.file("short_block.pbk"), truncated);
  write_bytes(dir.file("magic.pbk"), bad_magic);
  write_bytes(dir.file("two.pbk"), bank_file(bank_block({"A", "B"}, {{0.1f, 0.f}, {0.2f, 0.f}})));
  const std::pair<std::string, std::string> cases[] = {
      {"absent.pbk", "(code -1002)"},      {"short_header.pbk", "(code -1005)"},
      {"short_block.pbk", "(code -1009)"}, {"magic.pbk", "(code -1010)"},
      {"two.pbk", "(code -1007)"},
  };
  for (const auto& c : cases) {
    const RunResult run =
        run_cli({"bank", "show", dir.file(c.first), "--plugin", fake_plugin_path()}, dir.path());
    EXPECT_EQ(run.status, 1) << c.first;
    EXPECT_NE(run.err.find(c.second), std::string::npos) << c.first << ": " << run.err;
    EXPECT_TRUE(run.out.empty()) << run.out;
  }
}

TEST_F(FakePluginCli, DemoRendersEveryProgramAtItsLevel) {
  const RunResult run =
      run_cli({"demo", "--plugin", fake_plugin_path(), "--out-dir", dir.file("demo")}, dir.path());
  ASSERT_EQ(run.status, 0) << run.err;
  const std::vector<std::string> lines = lines_of(run.out);
  ASSERT_EQ(lines.size(), 3u);
  const double gains_db[] = {0.0, -12.0, 6.0};
  for (int p = 0; p < 3; ++p) {
    const Audio audio = read_wav(dir.file("demo/program-" + std::to_string(p) + ".wav"));
    ASSERT_EQ(audio.channels.size(), 2u);
    EXPECT_EQ(audio.frames(), static_cast<size_t>(6.5 * 48000));
    double peak = 0.0;
    for (const auto& channel : audio.channels)
      for (float v : channel) peak = std::max(peak, double(std::fabs(v)));
    // The demo signal peaks at -6 dBFS before the program's gain.
    EXPECT_NEAR(20 * std::log10(peak), -6.0 + gains_db[p], 0.01);
    EXPECT_EQ(lines[static_cast<size_t>(p)].rfind(dir.file("demo/program-" + std::to_string(p) + ".wav"), 0), 0u);
  }
}

TEST_F(FakePluginCli, BenchReportsEveryCaseAgainstTheFirst) {
  const RunResult run =
      run_cli({"bench", "--plugin", fake_plugin_path(), "--seconds", "0.05", "--runs", "3",
               "--case", "plain:", "--case", "small:program=1,block=32,set=Gain=-3",
               "--compare", fake_plugin_path(true)},
              dir.path());
  ASSERT_EQ(run.status, 0) << run.err;
  const std::vector<std::string> lines = lines_of(run.out);
  ASSERT_EQ(lines.size(), 5u) << run.out;
  EXPECT_EQ(lines[2].rfind("plain", 0), 0u);
  EXPECT_NE(lines[2].find("1.00x"), std::string::npos);
  EXPECT_EQ(lines[3].rfind("small", 0), 0u);
  EXPECT_NE(lines[3].find(" 32 "), std::string::npos);
  EXPECT_EQ(lines[4].rfind("FakeGainMainOnly.so", 0), 0u);
  EXPECT_EQ(run_cli({"bench", "--plugin", fake_plugin_path(), "--case", "x:colour=red"}, dir.path())
                .status, 2);
  EXPECT_EQ(run_cli({"bench", "--plugin", fake_plugin_path(), "--seconds", "0.05", "--case",
                     "x:set=Gian=1"}, dir.path()).status, 1);
}

TEST_F(FakePluginCli, HelpDescribesEveryCommand) {
  const RunResult overview = run_cli({"--help"}, dir.path());
  EXPECT_EQ(overview.status, 0);
  for (const char* command : {"info", "render", "demo", "bench", "bank"}) {
    EXPECT_NE(overview.out.find(std::string("  ") + command + " "), std::string::npos) << command;
    const RunResult own = run_cli({command, "--help"}, dir.path());
    EXPECT_EQ(own.status, 0);
    EXPECT_EQ(own.out.rfind(std::string("usage: brakmorph ") + command, 0), 0u) << own.out;
  }
  EXPECT_EQ(run_cli({"explode"}, dir.path()).status, 2);
}

}  // namespace
}  // namespace cli_test

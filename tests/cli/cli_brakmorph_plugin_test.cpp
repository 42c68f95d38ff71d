// The command-line host on the real Brakmorph module.
#include <gtest/gtest.h>

#include <cmath>
#include <filesystem>

#include "cli/cli_test_support.h"
#include "cli/mini_json.h"

namespace cli_test {
namespace {

class BrakmorphCli : public ::testing::Test {
 protected:
  void SetUp() override {
    if (!std::filesystem::exists(BRAKMORPH_TEST_PLUGIN)) {
      GTEST_SKIP() << "plug-in not built: " << BRAKMORPH_TEST_PLUGIN;
    }
    ASSERT_FALSE(dir.path().empty());
  }
  RunResult run(std::vector<std::string> args) {
    args.push_back("--plugin");
    args.push_back(BRAKMORPH_TEST_PLUGIN);
    return run_cli(args, dir.path());
  }
  ScratchDir dir;
};

TEST_F(BrakmorphCli, InfoShowsTheDeclaredInstance) {
  const RunResult result = run({"info", "--json"});
  ASSERT_EQ(result.status, 0) << result.err;
  const JsonValue info = parse_json(result.out);
  EXPECT_EQ(info["unique_id"].text, "Vbmx");
  EXPECT_EQ(info["unique_id_number"].number, double(0x56626D78));
  EXPECT_EQ(info["parameters"].items.size(), 40u);
  ASSERT_EQ(info["programs"].items.size(), 8u);
  EXPECT_EQ(info["programs"][0]["name"].text, "Light distortion");
  EXPECT_EQ(info["programs"][7]["name"].text, "Blues Breaker");
  ASSERT_EQ(info["inputs"].items.size(), 2u);
  EXPECT_EQ(info["inputs"][0]["label"].text, "Left input");
  EXPECT_EQ(info["outputs"][1]["label"].text, "Right output");
  EXPECT_TRUE(info["outputs"][1]["stereo"].boolean);
  EXPECT_EQ(info["parameters"][7]["name"].text, "Master Vol");
}

TEST_F(BrakmorphCli, RenderTakesSettingsByName) {
  const RunResult result = run({"render", "--out", dir.file("out.wav"), "--program", "3", "--set",
                                "B1 Dist Type=Hardclip", "--set", "Master Vol=-6", "--tail",
                                "0.25"});
  ASSERT_EQ(result.status, 0) << result.err;
  const Audio audio = read_wav(dir.file("out.wav"));
  ASSERT_EQ(audio.channels.size(), 2u);
  EXPECT_EQ(audio.rate, 48000);
  EXPECT_EQ(audio.frames(), static_cast<size_t>(6.25 * 48000));
  double energy = 0.0;
  for (const auto& channel : audio.channels)
    for (float v : channel) {
      ASSERT_TRUE(std::isfinite(v));
      energy += double(v) * v;
    }
  EXPECT_GT(energy, 0.0);
}

TEST_F(BrakmorphCli, UnknownNameSuggestsTheRealOne) {
  const RunResult result = run({"render", "--out", dir.file("out.wav"), "--set", "Master Volume=-6"});
  EXPECT_EQ(result.status, 1);
  EXPECT_NE(result.err.find("\"Master Vol\""), std::string::npos) << result.err;
  EXPECT_FALSE(std::filesystem::exists(dir.file("out.wav")));
}

TEST_F(BrakmorphCli, BankShowListsEightProgramsAndRejectsBadMagic) {
  std::vector<std::string> names;
  std::vector<std::vector<float>> values;
  for (int p = 0; p < 8; ++p) {
    names.push_back("Program " + std::to_string(p));
    values.push_back(std::vector<float>(40, 0.5f));
  }
  std::vector<uint8_t> file = bank_file(bank_block(names, values));
  write_bytes(dir.file("bank.pbk"), file);
  const RunResult result = run({"bank", "show", dir.file("bank.pbk")});
  ASSERT_EQ(result.status, 0) << result.err;
  EXPECT_NE(result.out.find("program 7: Program 7"), std::string::npos) << result.out;
  EXPECT_NE(result.out.find("Master Vol = "), std::string::npos);
  file[1] = 'X';
  write_bytes(dir.file("bad.pbk"), file);
  const RunResult bad = run({"bank", "show", dir.file("bad.pbk")});
  EXPECT_EQ(bad.status, 1);
  EXPECT_NE(bad.err.find("-1010"), std::string::npos);
}

}  // namespace
}  // namespace cli_test

// brakmorph render --midi / --settings as a user runs them.
#include <gtest/gtest.h>

#include <cmath>

#include "cli/cli_test_support.h"
#include "smf_builder.h"

using cli_test::run_cli;

namespace {

double energy(const std::vector<float>& x, size_t from, size_t to) {
  double sum = 0.0;
  for (size_t i = from; i < to; ++i) sum += double(x[i]) * x[i];
  return sum;
}

}  // namespace

TEST(CliMidiRender, ControllerFromAFileMovesTheBoundParameterOnTime) {
  cli_test::ScratchDir dir;
  const std::vector<std::pair<std::string, std::string>> env = {{"XDG_CONFIG_HOME", dir.path()}};
  // CC 7 drives Master Vol (index 7) after the setting file is loaded.
  const std::string settings = dir.file("map.cfg.txt");
  std::ofstream(settings) << "Brakmorph_config_section =\n{\n   midi =\n   {\n      control_map =\n      {\n"
                             "         id_7 = cc_7\n      }\n   }\n}\n";
  // At 3 s through a tempo change: 1 s at 60 bpm, then 2 s at 240 bpm (8 beats).
  SmfBuilder smf(1, 480);
  smf.add_track({{0, SmfBuilder::tempo(1000000)}, {480, SmfBuilder::tempo(250000)}});
  smf.add_track({{480 + 8 * 480, {0xB0, 7, 0}}});
  cli_test::write_bytes(dir.file("fade.mid"), smf.bytes());

  const auto plain = run_cli({"render", "--out", dir.file("plain.wav"), "--block", "512"}, dir.path(), env);
  ASSERT_EQ(plain.status, 0) << plain.err;
  const auto driven = run_cli({"render", "--out", dir.file("driven.wav"), "--block", "512", "--settings", settings,
                               "--midi", dir.file("fade.mid")},
                              dir.path(), env);
  ASSERT_EQ(driven.status, 0) << driven.err;
  const auto a = cli_test::read_wav(dir.file("plain.wav"));
  const auto b = cli_test::read_wav(dir.file("driven.wav"));
  ASSERT_EQ(a.frames(), b.frames());
  // The event belongs to frame 144000; parameters change at block starts,
  // so every block before the one holding that frame is untouched.
  const size_t untouched = 144000 / 512 * 512;
  for (size_t i = 0; i < untouched; ++i) ASSERT_EQ(a.channels[0][i], b.channels[0][i]) << i;
  const size_t end = a.frames();
  EXPECT_GT(energy(a.channels[0], 150000, end), 0.0);
  EXPECT_LT(energy(b.channels[0], 150000, end), 1e-3 * energy(a.channels[0], 150000, end));
  // Without the setting file CC 7 is bound to nothing: the output is unchanged.
  const auto unbound =
      run_cli({"render", "--out", dir.file("unbound.wav"), "--block", "512", "--midi", dir.file("fade.mid")},
              dir.path(), env);
  ASSERT_EQ(unbound.status, 0) << unbound.err;
  EXPECT_EQ(cli_test::read_wav(dir.file("unbound.wav")).channels, a.channels);
}

TEST(CliMidiRender, BadFilesAreReportedNotRendered) {
  cli_test::ScratchDir dir;
  const std::vector<std::pair<std::string, std::string>> env = {{"XDG_CONFIG_HOME", dir.path()}};
  cli_test::write_bytes(dir.file("bad.mid"), {'M', 'T', 'h', 'd', 0, 0, 0, 6, 0, 2, 0, 1, 0, 96});
  const auto bad_midi =
      run_cli({"render", "--out", dir.file("x.wav"), "--midi", dir.file("bad.mid")}, dir.path(), env);
  EXPECT_NE(bad_midi.status, 0);
  EXPECT_NE(bad_midi.err.find("formats 0 and 1"), std::string::npos) << bad_midi.err;
  std::ofstream(dir.file("other.cfg.txt")) << "Other_config_section =\n{\n}\n";
  const auto bad_settings =
      run_cli({"render", "--out", dir.file("y.wav"), "--settings", dir.file("other.cfg.txt")}, dir.path(), env);
  EXPECT_NE(bad_settings.status, 0);
  EXPECT_NE(bad_settings.err.find("refused the setting file"), std::string::npos) << bad_settings.err;
  EXPECT_FALSE(std::filesystem::exists(dir.file("x.wav")));
  EXPECT_FALSE(std::filesystem::exists(dir.file("y.wav")));
}

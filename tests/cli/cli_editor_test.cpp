// The editor commands and the validator's editor checks, through the real
// command-line host in a real X parent window (run under xvfb-run by the
// editor test entry; skipped where there is no display). The fake editor
// paints what it knows (its parameter, whether audio ran), so each picture
// and each answer is checked against values worked out here.
#include <gtest/gtest.h>

#include <cmath>
#include <cstdlib>
#include <filesystem>
#include <regex>
#include <sstream>
#include <string>
#include <vector>

#include "cli/hosted_plugin.h"
#include "cli/png_file.h"
#include "cli_test_support.h"
#include "editor_snapshot_probes.h"

namespace {

using cli_test::run_cli;

bool have_display() {
  const char* display = std::getenv("DISPLAY");
  return display != nullptr && *display != '\0';
}

#define SKIP_WITHOUT_DISPLAY() \
  if (!have_display()) GTEST_SKIP() << "no X display (the xvfb test entry runs these)"

const std::string kFakeEditor = BRAKMORPH_TEST_FAKE_EDITOR;
const std::string kFakeEditorLeak = BRAKMORPH_TEST_FAKE_EDITOR_LEAK;

// The fake editor's face colour for a shade, worked out independently.
uint32_t face_colour(double shade, bool audio_ran) {
  const uint32_t red = static_cast<uint32_t>(std::floor(shade * 255.0 + 0.5));
  return red << 16 | 0x40u << 8 | (audio_ran ? 0xFFu : 0x00u);
}

TEST(EditorHostSnapshot, FakeEditorShowsTheProgramAndParameterAsSet) {
  SKIP_WITHOUT_DISPLAY();
  cli_test::ScratchDir scratch;
  const std::string dir = scratch.path();
  struct Case {
    std::vector<std::string> settings;
    double shade;
  };
  // Settings apply program first, then texts, then normalised values.
  const Case cases[] = {
      {{}, 0.25},
      {{"--program", "1"}, 0.75},
      {{"--norm", "0=0.5"}, 0.5},
      {{"--program", "1", "--set", "Shade=0.1"}, 0.1},
  };
  for (const Case& c : cases) {
    const std::string out = dir + "/fake.png";
    std::filesystem::remove(out);
    std::vector<std::string> args = {"snapshot", "--plugin", kFakeEditor, "--out", out};
    args.insert(args.end(), c.settings.begin(), c.settings.end());
    const cli_test::RunResult result = run_cli(args, dir);
    ASSERT_EQ(result.status, 0) << result.err;
    EXPECT_NE(result.out.find("120x80 editor snapshot"), std::string::npos) << result.out;
    const plugcore::PixelImage image = plugcore::read_png(out);
    ASSERT_EQ(image.width, 120);
    ASSERT_EQ(image.height, 80);
    // Only the square at (5, 5)..(14, 14) is white; the host never processed.
    EXPECT_EQ(image.at(60, 40), face_colour(c.shade, false)) << "shade " << c.shade;
    EXPECT_EQ(image.at(119, 79), face_colour(c.shade, false));
    EXPECT_EQ(image.at(5, 5), 0xFFFFFFu);
    EXPECT_EQ(image.at(14, 14), 0xFFFFFFu);
    EXPECT_EQ(image.at(4, 4), face_colour(c.shade, false));
    EXPECT_EQ(image.at(15, 15), face_colour(c.shade, false));
  }
}

TEST(EditorHostSnapshot, RefusesWhatCannotWork) {
  cli_test::ScratchDir scratch;
  const std::string dir = scratch.path();
  const std::string out = dir + "/none.png";
  cli_test::RunResult no_display =
      run_cli({"snapshot", "--plugin", kFakeEditor, "--out", out}, dir, {{"DISPLAY", ""}});
  EXPECT_EQ(no_display.status, 1);
  EXPECT_NE(no_display.err.find("DISPLAY is not set"), std::string::npos) << no_display.err;

  cli_test::RunResult no_out = run_cli({"snapshot", "--plugin", kFakeEditor}, dir);
  EXPECT_EQ(no_out.status, 2);
  EXPECT_NE(no_out.err.find("--out is required"), std::string::npos) << no_out.err;

  cli_test::RunResult short_idle =
      run_cli({"snapshot", "--plugin", kFakeEditor, "--out", out, "--idle", "0"}, dir);
  EXPECT_EQ(short_idle.status, 2) << "an idle time below one period is a usage error";

  if (have_display()) {
    cli_test::RunResult no_editor =
        run_cli({"snapshot", "--plugin", cli_test::fake_plugin_path(), "--out", out}, dir);
    EXPECT_EQ(no_editor.status, 1);
    EXPECT_NE(no_editor.err.find("has no editor"), std::string::npos) << no_editor.err;
  }
  EXPECT_FALSE(std::filesystem::exists(out));
}

// Grabs survive the trip through a PNG file exactly; what is no PNG is refused.
TEST(EditorHostPng, RoundTripsEveryPixelAndRefusesOtherFiles) {
  cli_test::ScratchDir scratch;
  plugcore::PixelImage image;
  image.width = 37;  // odd sizes catch row padding mistakes
  image.height = 11;
  uint32_t state = 12345;
  for (int i = 0; i < image.width * image.height; ++i) {
    state = state * 1664525u + 1013904223u;
    image.pixels.push_back(state >> 8);
  }
  const std::string path = scratch.file("grab.png");
  plugcore::write_png(path, image);
  const plugcore::PixelImage back = plugcore::read_png(path);
  ASSERT_EQ(back.width, image.width);
  ASSERT_EQ(back.height, image.height);
  EXPECT_EQ(back.pixels, image.pixels);

  cli_test::write_bytes(scratch.file("not.png"), {'n', 'o', 't', ' ', 'a', ' ', 'p', 'n', 'g'});
  EXPECT_THROW(plugcore::read_png(scratch.file("not.png")), std::runtime_error);
  EXPECT_THROW(plugcore::read_png(scratch.file("missing.png")), std::runtime_error);
  EXPECT_THROW(plugcore::write_png(scratch.file("no/such/dir/grab.png"), image), std::runtime_error);
}

// edit plays the file in a loop at the pace of real time while the editor is
// open: far fewer blocks than a free-running loop, about the real-time count.
TEST(EditorHostEdit, PlaysTheInputInRealTimeWhileTheEditorIsOpen) {
  SKIP_WITHOUT_DISPLAY();
  cli_test::ScratchDir scratch;
  const std::string dir = scratch.path();
  const std::string in = dir + "/short.wav";
  // A tenth of a second, so the loop wraps several times.
  ASSERT_TRUE(cli_test::write_wav(in, 48000, {cli_test::test_noise(4800, 7, 0.5f)}));
  const double seconds = 0.6;
  const cli_test::RunResult result =
      run_cli({"edit", "--plugin", kFakeEditor, "--in", in, "--seconds", "0.6"}, dir);
  ASSERT_EQ(result.status, 0) << result.err;
  std::smatch match;
  ASSERT_TRUE(std::regex_search(result.out, match, std::regex("edit: (\\d+) blocks of 512 frames")))
      << result.out;
  const long blocks = std::stol(match[1]);
  const double real_time_blocks = seconds * 48000.0 / 512.0;  // 56.25
  EXPECT_GE(blocks, static_cast<long>(0.7 * real_time_blocks));
  EXPECT_LE(blocks, static_cast<long>(1.3 * real_time_blocks) + 2);
}

TEST(EditorHostValidate, PassesAWellBehavedEditorAndCatchesALeakedWindow) {
  SKIP_WITHOUT_DISPLAY();
  cli_test::ScratchDir scratch;
  const std::string dir = scratch.path();
  const cli_test::RunResult good =
      run_cli({"validate", "--plugin", kFakeEditor, "--only", "editor"}, dir);
  EXPECT_EQ(good.status, 0) << good.out << good.err;
  EXPECT_NE(good.out.find("PASS editor open/idle/close cycles with automation and audio: 50 cycles"),
            std::string::npos)
      << good.out;
  EXPECT_NE(good.out.find("PASS editor two at once"), std::string::npos) << good.out;
  EXPECT_NE(good.out.find("2 passed, 0 failed"), std::string::npos) << good.out;

  const cli_test::RunResult leak =
      run_cli({"validate", "--plugin", kFakeEditorLeak, "--only", "editor"}, dir);
  EXPECT_EQ(leak.status, 1) << leak.out;
  EXPECT_NE(leak.out.find("FAIL editor open/idle/close cycles with automation and audio: cycle 1: 1 "
                          "window(s) left in the parent after effEditClose"),
            std::string::npos)
      << leak.out;
  EXPECT_NE(leak.out.find("FAIL editor two at once: editor 1 left its window"), std::string::npos)
      << leak.out;
}

TEST(EditorHostValidate, SkipsWithoutADesktopOrAnEditor) {
  cli_test::ScratchDir scratch;
  const std::string dir = scratch.path();
  const cli_test::RunResult headless =
      run_cli({"validate", "--plugin", kFakeEditor, "--only", "editor"}, dir, {{"DISPLAY", ""}});
  EXPECT_EQ(headless.status, 0) << headless.out;
  EXPECT_NE(headless.out.find("SKIP editor two at once: DISPLAY is not set"), std::string::npos)
      << headless.out;
  EXPECT_NE(headless.out.find("2 skipped"), std::string::npos) << headless.out;
  if (!have_display()) return;
  const cli_test::RunResult no_editor =
      run_cli({"validate", "--plugin", cli_test::fake_plugin_path(), "--only", "editor"}, dir);
  EXPECT_EQ(no_editor.status, 0) << no_editor.out;
  EXPECT_NE(no_editor.out.find("SKIP editor open/idle/close cycles with automation and audio: the "
                               "plug-in declares no editor"),
            std::string::npos)
      << no_editor.out;
}

// The real editor: snapshots of the default state and of program 5 kept
// under the build tree for people to look at, probed where the skin and the
// parameters say they must show.
bool brakmorph_has_editor() {
  plugcore::HostedPlugin plugin(BRAKMORPH_TEST_PLUGIN, 48000.0, 512);
  return (plugin.flags() & effFlagsHasEditor) != 0;
}

float brakmorph_norm(int program, int index) {
  plugcore::HostedPlugin plugin(BRAKMORPH_TEST_PLUGIN, 48000.0, 512);
  if (program >= 0) plugin.set_program(program);
  return plugin.get_norm(index);
}

TEST(EditorHostBrakmorph, SnapshotsShowTheSkinAndTheControlsAtTheirValues) {
  SKIP_WITHOUT_DISPLAY();
  if (!brakmorph_has_editor()) GTEST_SKIP() << "this build of the plug-in declares no editor";
  cli_test::ScratchDir scratch;
  const std::string dir = scratch.path();
  const std::string kept = BRAKMORPH_TEST_SNAPSHOT_DIR;
  std::filesystem::create_directories(kept);
  const std::string default_png = kept + "/linux-default.png";
  const std::string program_png = kept + "/linux-program5.png";
  const cli_test::RunResult first = run_cli({"snapshot", "--plugin", BRAKMORPH_TEST_PLUGIN, "--out", default_png}, dir);
  ASSERT_EQ(first.status, 0) << first.err;
  const cli_test::RunResult second = run_cli(
      {"snapshot", "--plugin", BRAKMORPH_TEST_PLUGIN, "--program", "5", "--out", program_png}, dir);
  ASSERT_EQ(second.status, 0) << second.err;
  const plugcore::PixelImage base = plugcore::read_png(default_png);
  const plugcore::PixelImage five = plugcore::read_png(program_png);
  // "Tone Freq" is parameter 2.
  const bool tone_moved = std::fabs(brakmorph_norm(-1, 2) - brakmorph_norm(5, 2)) > 0.02f;
  snapshot_probe::expect_snapshots_show_state(base, five, tone_moved, "Linux");
}

// The Windows builds' snapshots, taken under Wine by wine_snapshots.sh, which
// names their folder and the builds in the environment.
TEST(EditorHostWineSnapshots, ShowTheSkinAndTheControlsAtTheirValues) {
  const char* dir = std::getenv("BRAKMORPH_WINE_SNAPSHOTS");
  const char* names = std::getenv("BRAKMORPH_WINE_SNAPSHOT_NAMES");
  if (dir == nullptr || names == nullptr) GTEST_SKIP() << "run by wine_snapshots.sh";
  const bool tone_moved = std::fabs(brakmorph_norm(-1, 2) - brakmorph_norm(5, 2)) > 0.02f;
  std::istringstream list(names);
  int checked = 0;
  for (std::string name; list >> name; ++checked) {
    const std::string stem = std::string(dir) + "/" + name;
    const plugcore::PixelImage base = snapshot_probe::read_bmp(stem + "-default.bmp");
    const plugcore::PixelImage five = snapshot_probe::read_bmp(stem + "-program5.bmp");
    snapshot_probe::expect_snapshots_show_state(base, five, tone_moved, name);
  }
  EXPECT_GT(checked, 0);
}

}  // namespace

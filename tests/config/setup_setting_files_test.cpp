// "Load..." and "Save..." of the setup menu: the dialogs they run, the files
// they write and read through the plug-in's MIDI settings, and every message
// box on the way.
#include <string>

#include "config/temp_dir.h"
#include "midi/midi_mgr.h"
#include "setup_test_support.h"

namespace {

using setup_test::SetupStage;

class SetupFiles : public SetupStage {
 protected:
  void SetUp() override {
    SetupStage::SetUp();
    if (HasFatalFailure()) return;
    init_setup(setup_);
  }
  plugcore::MidiMgr& midi() { return *plugin_->use_midi_mgr(); }

  plugcore::SetupMgr setup_{true, true};
  TempDir dir_;
};

}  // namespace

TEST_F(SetupFiles, SaveThenLoadRestoresTheControlMap) {
  const std::string path = dir_.file("mine.cfg.txt");
  ASSERT_EQ(midi().bind(12, 101, 7), 0);
  ui_.choose_file(path);
  choose("Save...");
  ASSERT_EQ(ui_.dialogs.size(), 1u);
  const sys::FileDialogRequest& request = ui_.dialogs[0];
  EXPECT_TRUE(request.save);
  EXPECT_EQ(request.title, "Save Setting File");
  ASSERT_EQ(request.filters.size(), 1u);
  EXPECT_EQ(request.filters[0].description, "Velmora plug-in setting file (*.cfg.txt)");
  EXPECT_EQ(request.filters[0].pattern, "*.cfg.txt");
  EXPECT_TRUE(ui_.boxes.empty());  // a new file needs no question
  const std::string text = read_whole_file(path);
  EXPECT_EQ(text.rfind("Brakmorph_config_section =\n{\n   version = 1.24\n", 0), 0u) << text;
  EXPECT_NE(text.find("id_12 = rpn_7"), std::string::npos) << text;

  ASSERT_EQ(midi().unbind(12), 0);
  ASSERT_EQ(midi().get_key(12), -1);
  ui_.choose_file(path);
  choose("Load...");
  ASSERT_EQ(ui_.dialogs.size(), 2u);
  EXPECT_FALSE(ui_.dialogs[1].save);
  EXPECT_EQ(ui_.dialogs[1].title, "Load Setting File");
  // The dialog opens where the last file was.
  EXPECT_EQ(ui_.dialogs[1].directory, dir_.path());
  EXPECT_EQ(ui_.dialogs[1].file_name, "mine.cfg.txt");
  EXPECT_TRUE(ui_.boxes.empty());
  EXPECT_EQ(midi().get_key(12), (101 << 16) + 7);
}

TEST_F(SetupFiles, NameWithoutExtensionGetsTheSettingExtension) {
  ui_.choose_file(dir_.file("plain"));
  choose("Save...");
  EXPECT_TRUE(ui_.boxes.empty());
  EXPECT_NE(read_whole_file(dir_.file("plain.cfg.txt")).find("Brakmorph_config_section"), std::string::npos);
}

TEST_F(SetupFiles, CancelledDialogsShowNothingAndTouchNothing) {
  const std::string path = dir_.file("kept.cfg.txt");
  write_whole_file(path, "untouched");
  ui_.cancel_dialog();
  choose("Save...");
  ui_.cancel_dialog();
  choose("Load...");
  EXPECT_EQ(ui_.dialogs.size(), 2u);
  EXPECT_TRUE(ui_.boxes.empty());
  EXPECT_EQ(read_whole_file(path), "untouched");
}

TEST_F(SetupFiles, LoadFailuresShowPathAndCode) {
  const std::string foreign = dir_.file("foreign.cfg.txt");
  write_whole_file(foreign, "Other_config_section =\n{\n   version = 1.24\n}\n");
  const std::string missing = dir_.file("missing.cfg.txt");
  const std::string open_quote = dir_.file("quote.cfg.txt");
  write_whole_file(open_quote, "Brakmorph_config_section =\n{\n   version = \"1.24\n}\n");
  const int32_t map_before = midi().get_key(3);

  ui_.choose_file(foreign);
  choose("Load...");
  ui_.choose_file(missing);
  choose("Load...");
  ui_.choose_file(open_quote);
  choose("Load...");
  // A dialog that fails names the path it was opened with.
  ui_.fail_dialog();
  choose("Load...");

  ASSERT_EQ(ui_.boxes.size(), 4u);
  for (const auto& box : ui_.boxes) {
    EXPECT_EQ(box.title, "Error");
    EXPECT_EQ(box.buttons, 0);
  }
  EXPECT_EQ(ui_.boxes[0].text, "Can't load configuration file\n" + foreign + "\n\nCode -3071");
  EXPECT_EQ(ui_.boxes[1].text, "Can't load configuration file\n" + missing + "\n\nCode -1020");
  EXPECT_EQ(ui_.boxes[2].text, "Can't load configuration file\n" + open_quote + "\n\nCode -2044");
  EXPECT_EQ(ui_.boxes[3].text, "Can't load configuration file\n" + open_quote + "\n\nCode -1024");
  EXPECT_EQ(midi().get_key(3), map_before);
}

TEST_F(SetupFiles, SavingOverAnExistingFileAsksFirst) {
  const std::string path = dir_.file("old.cfg.txt");
  write_whole_file(path, "old content");

  ui_.choose_file(path);
  ui_.box_answers.push_back(1);  // Cancel
  choose("Save...");
  ASSERT_EQ(ui_.boxes.size(), 1u);
  EXPECT_EQ(ui_.boxes[0].title, "Conflict");
  EXPECT_EQ(ui_.boxes[0].text, path + "\nalready exists. Overwrite ?");
  EXPECT_EQ(ui_.boxes[0].buttons, 1);
  EXPECT_EQ(ui_.boxes[0].default_button, 1);  // Cancel preselected
  EXPECT_EQ(read_whole_file(path), "old content");

  // A box that cannot be shown is no permission either.
  ui_.choose_file(path);
  ui_.box_answers.push_back(-1);
  choose("Save...");
  EXPECT_EQ(read_whole_file(path), "old content");

  ui_.choose_file(path);
  ui_.box_answers.push_back(0);  // OK
  choose("Save...");
  ASSERT_EQ(ui_.boxes.size(), 3u);
  EXPECT_EQ(read_whole_file(path).rfind("Brakmorph_config_section =", 0), 0u);
}

TEST_F(SetupFiles, SaveFailuresShowPathAndCode) {
  const std::string unreachable = dir_.file("no/such/folder/x.cfg.txt");
  ui_.choose_file(unreachable);
  choose("Save...");
  ui_.fail_dialog();
  choose("Save...");
  ASSERT_EQ(ui_.boxes.size(), 2u);
  EXPECT_EQ(ui_.boxes[0].title, "Error");
  EXPECT_EQ(ui_.boxes[0].text, "Can't save configuration file\n" + unreachable + "\n\nCode -1018");
  EXPECT_EQ(ui_.boxes[1].title, "Error");
  EXPECT_EQ(ui_.boxes[1].text, "Can't save configuration file\n" + unreachable + "\n\nCode -1024");
}

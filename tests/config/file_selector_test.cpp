#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "config/file_selector.h"
#include "config/simple_message_box.h"
#include "config/system_ui.h"

namespace {

// A desktop whose dialogs answer what the test scripted and remember what they were shown.
class ScriptedUi : public sys::SystemUiInterface {
 public:
  sys::FileDialogResult next;
  std::vector<sys::FileDialogRequest> requests;
  int32_t box_answer = 0;
  std::vector<std::string> boxes;
  int32_t run_file_dialog_calls = 0;

  sys::FileDialogResult run_file_dialog(const sys::FileDialogRequest& request) override {
    ++run_file_dialog_calls;
    requests.push_back(request);
    return next;
  }
  int32_t show_message_box(const std::string& title, const std::string& text, int32_t buttons,
                           int32_t default_button) override {
    boxes.push_back(title + "|" + text + "|" + std::to_string(buttons) + std::to_string(default_button));
    return box_answer;
  }
  int32_t open_url(const std::string& address) override { return address.empty() ? -1 : 0; }
};

class FileSelectorTest : public ::testing::Test {
 protected:
  void SetUp() override { sys::set_system_ui(&ui_); }
  void TearDown() override { sys::set_system_ui(nullptr); }
  void choose(const std::string& path, int32_t filter) {
    ui_.next.status = 0;
    ui_.next.path = path;
    ui_.next.filter_index = filter;
  }
  ScriptedUi ui_;
  sys::FileSelector selector_;
};

TEST_F(FileSelectorTest, ANewSelectorOffersAllFiles) {
  ASSERT_EQ(selector_.get_filters().size(), 1u);
  EXPECT_EQ(selector_.get_filters()[0].description, "All files");
  EXPECT_EQ(selector_.get_filters()[0].pattern, "*.*");
  EXPECT_EQ(selector_.get_filter_index(), 0);
}

TEST_F(FileSelectorTest, TheDialogOpensInThePathsFolderWithItsName) {
  selector_.set_path("/home/user/banks/live.pbk");
  selector_.set_title("Load preset bank");
  choose("/tmp/x.pbk", 0);
  ASSERT_EQ(selector_.run_open(), 0);
  ASSERT_EQ(ui_.requests.size(), 1u);
  const sys::FileDialogRequest& request = ui_.requests[0];
  EXPECT_FALSE(request.save);
  EXPECT_EQ(request.directory, "/home/user/banks");
  EXPECT_EQ(request.file_name, "live.pbk");
  EXPECT_EQ(request.title, "Load preset bank");
  selector_.set_path("C:\\banks\\old.pbk");
  choose("C:\\banks\\new.pbk", 0);
  ASSERT_EQ(selector_.run_save(), 0);
  EXPECT_TRUE(ui_.requests[1].save);
  EXPECT_EQ(ui_.requests[1].directory, "C:\\banks");
  EXPECT_EQ(ui_.requests[1].file_name, "old.pbk");
}

TEST_F(FileSelectorTest, ANameWithoutExtensionTakesTheSelectedFiltersOne) {
  selector_.set_filters({{"All files (*.*)", "*.*"}, {"Preset bank (*.pbk)", "*.pbk"}});
  choose("/tmp/set.d/mybank", 1);  // the dot of the folder is no extension
  ASSERT_EQ(selector_.run_save(), 0);
  EXPECT_EQ(selector_.get_path(), "/tmp/set.d/mybank.pbk");
  EXPECT_EQ(selector_.get_filter_index(), 1);
  choose("/tmp/mybank.bak", 1);
  ASSERT_EQ(selector_.run_save(), 0);
  EXPECT_EQ(selector_.get_path(), "/tmp/mybank.bak");
  choose("/tmp/plain", 0);  // "*.*" names no extension
  ASSERT_EQ(selector_.run_save(), 0);
  EXPECT_EQ(selector_.get_path(), "/tmp/plain");
}

TEST_F(FileSelectorTest, CancelAndFailureKeepThePath) {
  selector_.set_path("/keep/me.pbk");
  ui_.next.status = 1;
  ui_.next.path = "/other.pbk";
  EXPECT_EQ(selector_.run_open(), 1);
  EXPECT_EQ(selector_.get_path(), "/keep/me.pbk");
  ui_.next.status = -7;  // any platform failure is reported as the dialog's failure
  EXPECT_EQ(selector_.run_open(), -1024);
  EXPECT_EQ(selector_.get_path(), "/keep/me.pbk");
  choose("", 0);  // "chosen" without a path is no choice
  EXPECT_EQ(selector_.run_open(), -1024);
  EXPECT_EQ(selector_.get_path(), "/keep/me.pbk");
}

TEST_F(FileSelectorTest, AnOutOfRangeFilterAnswerKeepsTheSelection) {
  selector_.set_filters({{"Setting file (*.cfg.txt)", "*.cfg.txt"}});
  choose("/tmp/settings", 5);
  ASSERT_EQ(selector_.run_save(), 0);
  EXPECT_EQ(selector_.get_filter_index(), 0);
  EXPECT_EQ(selector_.get_path(), "/tmp/settings.cfg.txt");
}

TEST(FileSelectorParts, PathsAndPatternsSplitAsTheDialogNeeds) {
  EXPECT_EQ(sys::FileSelector::directory_part("name.pbk"), "");
  EXPECT_EQ(sys::FileSelector::name_part("name.pbk"), "name.pbk");
  EXPECT_EQ(sys::FileSelector::name_part("/a/b/"), "");
  EXPECT_EQ(sys::FileSelector::directory_part("/a\\b/c.txt"), "/a\\b");
  EXPECT_EQ(sys::FileSelector::pattern_extension("*.pbk"), ".pbk");
  EXPECT_EQ(sys::FileSelector::pattern_extension("*.pbk,*.bak"), ".pbk");
  EXPECT_EQ(sys::FileSelector::pattern_extension("*.*"), "");
  EXPECT_EQ(sys::FileSelector::pattern_extension("bank.pbk"), "");
}

TEST_F(FileSelectorTest, MessageBoxesCheckTheirButtonsAndReachTheDesktop) {
  ui_.box_answer = 1;
  EXPECT_EQ(sys::SimpleMessageBox::show("Conflict", "x\nalready exists. Overwrite ?", 1, 1), 1);
  ASSERT_EQ(ui_.boxes.size(), 1u);
  EXPECT_EQ(ui_.boxes[0], "Conflict|x\nalready exists. Overwrite ?|11");
  EXPECT_EQ(sys::SimpleMessageBox::show("Error", "bad", 3, 0), -1);
  EXPECT_EQ(sys::SimpleMessageBox::show("Error", "bad", 0, 4), -1);
  EXPECT_EQ(ui_.boxes.size(), 1u);
  EXPECT_EQ(sys::open_url("https://example.invalid/x"), 0);
  EXPECT_EQ(sys::open_url(""), -1);
}

}  // namespace

// Setting files through the setting manager: layout, section check, clients, failures.
#include <gtest/gtest.h>

#include <sys/stat.h>

#include <string>

#include "config/conf_key.h"
#include "config/setting_mgr.h"
#include "config/temp_dir.h"

using basic::ConfKeyData;
using basic::ConfKeyMulti;

namespace {

// A client that keeps one text under its own key and can be told to fail.
class TextClient : public basic::SettingClientInterface {
 public:
  explicit TextClient(std::string key) : key_(std::move(key)) {}
  int save_settings(ConfKeyMulti& root) override {
    root.set_key(ConfKeyData(key_, value));
    return 0;
  }
  int load_settings(const ConfKeyMulti& root) override {
    ++loads;
    if (fail_load) return -77;
    if (root.find_key(key_) != nullptr) value = root.get_string(key_);
    return 0;
  }
  std::string value = "start";
  bool fail_load = false;
  int loads = 0;

 private:
  std::string key_;
};

plugcore::SettingMgr make_mgr() {
  plugcore::SettingMgr mgr;
  mgr.set_section("Brakmorph_config_section", "1.24");
  return mgr;
}

}  // namespace

TEST(SettingFile, SavesSectionVersionAndClientsInOrder) {
  TempDir dir;
  plugcore::SettingMgr mgr = make_mgr();
  TextClient first("first");
  TextClient second("second");
  first.value = "one two";
  second.value = "2";
  ASSERT_EQ(mgr.add_client(&first), 0);
  ASSERT_EQ(mgr.add_client(&second), 0);
  EXPECT_EQ(mgr.add_client(&first), -1023);
  const std::string path = dir.file("s.cfg.txt");
  ASSERT_EQ(mgr.save_file(path), 0);
  EXPECT_EQ(read_whole_file(path),
            "Brakmorph_config_section =\n{\n   version = 1.24\n   first = \"one two\"\n   second = 2\n}");
  first.value = second.value = "changed";
  ASSERT_EQ(mgr.load_file(path), 0);
  EXPECT_EQ(first.value, "one two");
  EXPECT_EQ(second.value, "2");
}

TEST(SettingFile, WithoutClientsTheFileHoldsOnlyTheVersion) {
  TempDir dir;
  plugcore::SettingMgr mgr = make_mgr();
  ASSERT_EQ(mgr.save_file(dir.file("e.cfg.txt")), 0);
  EXPECT_EQ(read_whole_file(dir.file("e.cfg.txt")), "Brakmorph_config_section =\n{\n   version = 1.24\n}");
  EXPECT_EQ(mgr.load_file(dir.file("e.cfg.txt")), 0);
}

TEST(SettingFile, RefusesForeignMissingAndDamagedFiles) {
  TempDir dir;
  plugcore::SettingMgr mgr = make_mgr();
  TextClient client("k");
  mgr.add_client(&client);
  write_whole_file(dir.file("other"), "Other_config_section =\n{\n   k = stolen\n}");
  EXPECT_EQ(mgr.load_file(dir.file("other")), -3071);
  write_whole_file(dir.file("empty_braces"), "x = { }");
  EXPECT_EQ(mgr.load_file(dir.file("empty_braces")), -3071);
  EXPECT_EQ(mgr.load_file(dir.file("missing")), -1020);
  write_whole_file(dir.file("quote"), "Brakmorph_config_section =\n{\n   k = \"open\n}");
  EXPECT_EQ(mgr.load_file(dir.file("quote")), -2044);
  write_whole_file(dir.file("blank"), "\n\n");
  EXPECT_EQ(mgr.load_file(dir.file("blank")), -2039);
  write_whole_file(dir.file("data"), "Brakmorph_config_section = 3");
  EXPECT_EQ(mgr.load_file(dir.file("data")), -1016);
  write_whole_file(dir.file("two"), "Brakmorph_config_section =\n{\n   k = a\n}\nmore = 1");
  EXPECT_EQ(mgr.load_file(dir.file("two")), -1015);
  EXPECT_EQ(client.value, "start");
  EXPECT_EQ(client.loads, 0);
  // Line ends of another system read the same.
  write_whole_file(dir.file("crlf"), "Brakmorph_config_section =\r\n{\r\n   k = fine\r\n}\r\n");
  EXPECT_EQ(mgr.load_file(dir.file("crlf")), 0);
  EXPECT_EQ(client.value, "fine");
}

TEST(SettingFile, AFailedLoadRestoresTheClientsAlreadyLoaded) {
  TempDir dir;
  plugcore::SettingMgr mgr = make_mgr();
  TextClient first("first");
  TextClient second("second");
  mgr.add_client(&first);
  mgr.add_client(&second);
  write_whole_file(dir.file("f"), "Brakmorph_config_section =\n{\n   first = new\n   second = new\n}");
  second.fail_load = true;
  EXPECT_EQ(mgr.load_file(dir.file("f")), -77);
  EXPECT_EQ(first.value, "start");
  EXPECT_EQ(first.loads, 2);  // loaded, then given its earlier settings back
}

TEST(SettingFile, AFailedSaveLeavesTheExistingFile) {
  TempDir dir;
  plugcore::SettingMgr mgr = make_mgr();
  const std::string path = dir.file("keep.cfg.txt");
  write_whole_file(path, "precious");
  // A client whose key cannot be written (anonymous) makes the save fail before the file.
  class Anonymous : public basic::SettingClientInterface {
    int save_settings(ConfKeyMulti& root) override {
      root.add_key(ConfKeyData("", "x"));
      return 0;
    }
    int load_settings(const ConfKeyMulti&) override { return 0; }
  } anonymous;
  mgr.add_client(&anonymous);
  EXPECT_EQ(mgr.save_file(path), -1015);
  EXPECT_EQ(read_whole_file(path), "precious");
  // A folder that cannot take the temporary file.
  EXPECT_EQ(make_mgr().save_file(dir.file("no/such/dir/x.cfg.txt")), -1018);
  struct stat info;
  EXPECT_NE(stat(dir.file("no").c_str(), &info), 0);
}

TEST(SettingFile, SectionAndVersionComeFromTheEngineProperties) {
  plugcore::SettingMgr mgr = make_mgr();
  EXPECT_EQ(mgr.get_section(), "Brakmorph_config_section");
  EXPECT_EQ(mgr.get_version(), "1.24");
}

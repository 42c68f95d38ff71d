// Per-user values: files below $XDG_CONFIG_HOME in the configuration text format.
#include <gtest/gtest.h>

#include <stdlib.h>
#include <sys/stat.h>

#include <stdexcept>
#include <string>
#include <thread>
#include <vector>

#include "config/conf_key.h"
#include "config/conf_key_factory.h"
#include "config/persistent_key_list.h"
#include "config/temp_dir.h"

namespace {

// Points XDG_CONFIG_HOME at a fresh folder for the test's lifetime.
class ConfigHome {
 public:
  ConfigHome() {
    const char* old = getenv("XDG_CONFIG_HOME");
    had_old_ = old != nullptr;
    if (had_old_) old_ = old;
    setenv("XDG_CONFIG_HOME", dir_.path().c_str(), 1);
  }
  ~ConfigHome() {
    if (had_old_) setenv("XDG_CONFIG_HOME", old_.c_str(), 1);
    else unsetenv("XDG_CONFIG_HOME");
  }
  std::string file(const std::string& name) const { return dir_.file(name); }

 private:
  TempDir dir_;
  std::string old_;
  bool had_old_ = false;
};

}  // namespace

TEST(PersistentKeys, ValuesRoundTripThroughATextFile) {
  ConfigHome home;
  {
    sys::PersistentKeyList key("Velmora/Brakmorph", true);
    EXPECT_EQ(key.set_string("NRPN Compatibility", "1"), 0);
    EXPECT_EQ(key.set_string("Autobind Mode", "0"), 0);
    EXPECT_EQ(key.set_string("NRPN Compatibility", "0"), 0);
  }
  const std::string text = read_whole_file(home.file("Velmora/Brakmorph.cfg.txt"));
  EXPECT_EQ(text, "Brakmorph =\n{\n   \"NRPN Compatibility\" = 0\n   \"Autobind Mode\" = 0\n}\n");
  // The file parses with the ordinary configuration reader.
  basic::ConfKeyFactory factory;
  auto root = factory.create_from_string(text);
  ASSERT_EQ(factory.get_status(), 0);
  EXPECT_EQ(dynamic_cast<basic::ConfKeyMulti&>(*root).get_string("Autobind Mode"), "0");

  sys::PersistentKeyList again("Velmora/Brakmorph", false);
  std::string value = "junk";
  EXPECT_EQ(again.get_string("Autobind Mode", value), 0);
  EXPECT_EQ(value, "0");
  EXPECT_EQ(again.get_string("Missing", value), -1);
  EXPECT_EQ(value, "");
  // Texts that the format cannot hold are refused, not mangled.
  EXPECT_EQ(again.set_string("q", "say \"hi\""), -1);
  EXPECT_EQ(again.set_string("n", "two\nlines"), -1);
  EXPECT_EQ(again.set_string("a/b", "x"), -1);
  std::string long_text(3000, 'x');
  EXPECT_EQ(again.set_string("long", long_text), 0);
  EXPECT_EQ(again.get_string("long", value), 0);
  EXPECT_EQ(value.size(), sys::PersistentKeyList::kValueCapacity - 1);
}

TEST(PersistentKeys, OpeningWithoutCreateNeedsThePath) {
  ConfigHome home;
  try {
    sys::PersistentKeyList key("Velmora/Nothing/Here", false);
    FAIL();
  } catch (const std::runtime_error& error) {
    EXPECT_STREQ(error.what(), "sys::PersistentKeyList::PersistentKeyList () : Cannot open path.");
  }
  EXPECT_THROW(sys::PersistentKeyList("../escape", true), std::runtime_error);
  EXPECT_THROW(sys::PersistentKeyList("", true), std::runtime_error);
  // A file where a folder must go cannot be created over.
  write_whole_file(home.file("Blocked"), "x");
  try {
    sys::PersistentKeyList key("Blocked/Inner", true);
    FAIL();
  } catch (const std::runtime_error& error) {
    EXPECT_STREQ(error.what(), "sys::PersistentKeyList::PersistentKeyList () : Cannot create path.");
  }
}

TEST(PersistentKeys, SwitchesReplaceDamagedOrMissingValues) {
  ConfigHome home;
  EXPECT_EQ(sys::read_persistent_switch("Velmora/Brakmorph", "Autobind Mode", 1), 1);
  EXPECT_EQ(read_whole_file(home.file("Velmora/Brakmorph.cfg.txt")),
            "Brakmorph =\n{\n   \"Autobind Mode\" = 1\n}\n");
  EXPECT_TRUE(sys::write_persistent_switch("Velmora/Brakmorph", "Autobind Mode", 0));
  EXPECT_EQ(sys::read_persistent_switch("Velmora/Brakmorph", "Autobind Mode", 1), 0);
  {
    sys::PersistentKeyList key("Velmora/Brakmorph", true);
    key.set_string("Autobind Mode", "maybe");
  }
  EXPECT_EQ(sys::read_persistent_switch("Velmora/Brakmorph", "Autobind Mode", 1), 1);
  std::string value;
  sys::PersistentKeyList key("Velmora/Brakmorph", false);
  key.get_string("Autobind Mode", value);
  EXPECT_EQ(value, "1");
  // A damaged file reads as empty and is rewritten whole on the next write.
  write_whole_file(home.file("Velmora/Brakmorph.cfg.txt"), "Brakmorph = { \"broken");
  EXPECT_EQ(sys::read_persistent_switch("Velmora/Brakmorph", "NRPN Compatibility", 0), 0);
  EXPECT_EQ(read_whole_file(home.file("Velmora/Brakmorph.cfg.txt")),
            "Brakmorph =\n{\n   \"NRPN Compatibility\" = 0\n}\n");
}

TEST(PersistentKeys, ConcurrentWritersNeverLeaveAPartialFile) {
  ConfigHome home;
  std::vector<std::thread> writers;
  for (int t = 0; t < 2; ++t) {
    writers.emplace_back([t] {
      sys::PersistentKeyList key("Velmora/Race", true);
      for (int i = 0; i < 100; ++i) key.set_string("v" + std::to_string(t), std::to_string(i));
    });
  }
  std::thread reader([] {
    for (int i = 0; i < 200; ++i) {
      try {
        sys::PersistentKeyList key("Velmora/Race", true);
        std::string value;
        if (key.get_string("v0", value) == 0) {
          ASSERT_FALSE(value.empty());
          ASSERT_LT(std::stoi(value), 100);
        }
      } catch (const std::runtime_error&) {
      }
    }
  });
  for (auto& writer : writers) writer.join();
  reader.join();
  sys::PersistentKeyList key("Velmora/Race", false);
  std::string value;
  basic::ConfKeyFactory factory;
  factory.create_from_string(read_whole_file(home.file("Velmora/Race.cfg.txt")));
  EXPECT_EQ(factory.get_status(), 0);
}

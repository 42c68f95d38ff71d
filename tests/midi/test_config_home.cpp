// The tests create many plug-in instances, each reading its per-user MIDI
// switches; they get a throw-away config home instead of the user's own.
#include <stdlib.h>
#include <unistd.h>

#include <string>

namespace {

class TestConfigHome {
 public:
  TestConfigHome() {
    char pattern[] = "/tmp/brakmorph_home_XXXXXX";
    if (mkdtemp(pattern) != nullptr) {
      path_ = pattern;
      setenv("XDG_CONFIG_HOME", path_.c_str(), 1);
    }
  }
  ~TestConfigHome() {
    if (!path_.empty()) {
      const std::string command = "rm -rf '" + path_ + "'";
      if (std::system(command.c_str()) != 0) {
      }
    }
  }

 private:
  std::string path_;
};

TestConfigHome g_test_config_home;

}  // namespace

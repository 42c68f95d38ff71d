// The desktop services on Linux: dialogs and message boxes through a dialog
// program on PATH (stand-ins written by the test answer as the real ones would),
// the browser launcher, and plain failure without a display.
#include <gtest/gtest.h>

#include <sys/stat.h>
#include <unistd.h>

#include <chrono>
#include <cstdlib>
#include <fstream>
#include <sstream>
#include <string>
#include <thread>

#include "config/system_ui.h"

namespace {

// Sets an environment variable for the scope of a test.
class ScopedEnv {
 public:
  ScopedEnv(const char* name, const char* value) : name_(name) {
    const char* old = std::getenv(name);
    had_ = old != nullptr;
    if (had_) old_ = old;
    if (value) {
      setenv(name, value, 1);
    } else {
      unsetenv(name);
    }
  }
  ~ScopedEnv() {
    if (had_) {
      setenv(name_.c_str(), old_.c_str(), 1);
    } else {
      unsetenv(name_.c_str());
    }
  }

 private:
  std::string name_, old_;
  bool had_ = false;
};

// A folder of stand-in programs that is the whole PATH.
class FakeTools {
 public:
  FakeTools() {
    char tmpl[] = "/tmp/brakmorph_tools_XXXXXX";
    dir_ = mkdtemp(tmpl);
  }
  ~FakeTools() {
    std::string cmd = "rm -rf '" + dir_ + "'";
    if (std::system(cmd.c_str()) != 0) {
    }
  }
  void add(const std::string& name, const std::string& body) {
    const std::string path = dir_ + "/" + name;
    std::ofstream(path) << "#!/bin/sh\n" << body << "\n";
    chmod(path.c_str(), 0755);
  }
  std::string file(const std::string& name) const { return dir_ + "/" + name; }
  const std::string& dir() const { return dir_; }

 private:
  std::string dir_;
};

std::string read_file(const std::string& path) {
  std::ifstream in(path);
  std::stringstream s;
  s << in.rdbuf();
  return s.str();
}

}  // namespace

TEST(X11SystemUi, TheBrowserLauncherGetsTheAddress) {
  FakeTools tools;
  tools.add("xdg-open", "printf '%s' \"$1\" > '" + tools.file("opened.tmp") + "'; mv '" + tools.file("opened.tmp") +
                            "' '" + tools.file("opened") + "'");
  ScopedEnv path("PATH", (tools.dir() + ":/bin:/usr/bin").c_str());
  EXPECT_EQ(0, sys::platform_system_ui().open_url("http://example.invalid/jump.php?type=product&skin=1"));
  std::string seen;
  for (int i = 0; i < 200 && seen.empty(); ++i) {
    std::this_thread::sleep_for(std::chrono::milliseconds(10));
    seen = read_file(tools.file("opened"));
  }
  EXPECT_EQ("http://example.invalid/jump.php?type=product&skin=1", seen);

  ScopedEnv nothing("PATH", tools.file("empty").c_str());
  EXPECT_EQ(-1, sys::platform_system_ui().open_url("http://example.invalid/"));
}

TEST(X11SystemUi, DialogProgramsAnswerChosenCancelledOrFailed) {
  FakeTools tools;
  ScopedEnv display("DISPLAY", ":0");  // the stand-ins need none
  ScopedEnv allowed("BRAKMORPH_NO_DESKTOP_TOOLS", nullptr);
  ScopedEnv path("PATH", (tools.dir() + ":/bin:/usr/bin").c_str());
  // Records its arguments, answers with the file given in the answer file.
  tools.add("zenity", "for a in \"$@\"; do echo \"$a\"; done > '" + tools.file("args") + "'\n" +
                          "cat '" + tools.file("answer") + "'; exit $(cat '" + tools.file("status") + "')");
  auto answer = [&](const std::string& out, int status) {
    std::ofstream(tools.file("answer")) << out;
    std::ofstream(tools.file("status")) << status;
  };
  sys::FileDialogRequest request;
  request.save = true;
  request.title = "Save bank";
  request.directory = "/home/u/banks";
  request.file_name = "mine.pbk";
  request.filters = {{"Preset bank (*.pbk)", "*.pbk"}, {"All files", "*.txt,*.*"}};
  request.filter_index = 0;

  answer("/home/u/banks/new.pbk\n", 0);
  sys::FileDialogResult r = sys::platform_system_ui().run_file_dialog(request);
  EXPECT_EQ(0, r.status);
  EXPECT_EQ("/home/u/banks/new.pbk", r.path);
  const std::string args = read_file(tools.file("args"));
  EXPECT_NE(std::string::npos, args.find("--save\n"));
  EXPECT_NE(std::string::npos, args.find("--filename=/home/u/banks/mine.pbk\n"));
  EXPECT_NE(std::string::npos, args.find("--file-filter=All files | *.txt *.*\n")) << args;

  answer("", 1);
  EXPECT_EQ(1, sys::platform_system_ui().run_file_dialog(request).status);
  answer("", 5);
  EXPECT_EQ(-1024, sys::platform_system_ui().run_file_dialog(request).status);

  answer("", 0);
  EXPECT_EQ(0, sys::platform_system_ui().show_message_box("Error", "Bad bank\n\nCode -1002", 2, 0));
  EXPECT_NE(std::string::npos, read_file(tools.file("args")).find("--ok-label=Yes\n"));
  answer("", 1);
  EXPECT_EQ(1, sys::platform_system_ui().show_message_box("Error", "Bad bank", 1, 1));
  EXPECT_NE(std::string::npos, read_file(tools.file("args")).find("--default-cancel\n"));
}

TEST(X11SystemUi, WithoutADisplayNothingCanBeShown) {
  ScopedEnv display("DISPLAY", nullptr);
  sys::FileDialogRequest request;
  EXPECT_EQ(-1024, sys::platform_system_ui().run_file_dialog(request).status);
  EXPECT_EQ(-1, sys::platform_system_ui().show_message_box("Error", "text", 0, 0));
}

// The dialogs drawn by the plug-in itself when the desktop has no dialog program:
// asked for through the desktop services with the programs switched off, while a
// second thread plays the user on a connection of its own (the dialogs run their
// own modal loop) and always leaves them closed, with Escape as a last resort.
#include "x11_screenshot_file.h"
#include "x11_test_support.h"

#include <png.h>
#include <sys/stat.h>
#include <unistd.h>

#include <atomic>
#include <cstdio>
#include <fstream>
#include <functional>
#include <string>
#include <thread>
#include <vector>

#include "config/linux/dialog_window_x11.h"
#include "config/linux/fallback_dialogs_x11.h"
#include "config/system_ui.h"

using x11_test::User;

namespace {

class ScopedEnv {
 public:
  ScopedEnv(const char* name, const char* value) : name_(name) {
    const char* old = std::getenv(name);
    had_ = old != nullptr;
    if (had_) old_ = old;
    setenv(name, value, 1);
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

class TempFolder {
 public:
  TempFolder() {
    char tmpl[] = "/tmp/brakmorph_dialog_XXXXXX";
    const char* made = mkdtemp(tmpl);
    path_ = made ? made : "";
  }
  ~TempFolder() {
    const std::string cmd = "rm -rf '" + path_ + "'";
    if (std::system(cmd.c_str()) != 0) {
    }
  }
  std::string file(const std::string& name) const { return path_ + "/" + name; }
  const std::string& path() const { return path_; }

 private:
  std::string path_;
};

using Act = std::function<void(Display*, User&, Window)>;

// The user's side of one dialog: waits for its window (by title) to be shown and
// to have the keyboard, acts, then presses Escape while the window stays.
class DialogUser {
 public:
  DialogUser(std::string title, Act act) {
    thread_ = std::thread([this, title, act] {
      Display* d = guikit::open_x_display();
      if (!d) return;
      User user(d);
      const Window w = x11_test::wait_for_window(d, title.c_str());
      if (w && wait_for_focus(d, w)) {
        found = true;
        act(d, user, w);
      }
      for (int i = 0; i < 10 && x11_test::find_named_window(d, title.c_str()); ++i) {
        std::this_thread::sleep_for(std::chrono::milliseconds(100));
        if (x11_test::find_named_window(d, title.c_str())) {
          escaped = true;
          user.tap(XK_Escape);
        }
      }
      XCloseDisplay(d);
    });
  }
  ~DialogUser() { join(); }
  void join() {
    if (thread_.joinable()) thread_.join();
  }
  std::atomic<bool> found{false};
  std::atomic<bool> escaped{false};  // the act did not close it

 private:
  static bool wait_for_focus(Display* d, Window w) {
    for (int i = 0; i < 200; ++i) {
      Window focus = 0;
      int revert = 0;
      XGetInputFocus(d, &focus, &revert);
      if (focus == w) return true;
      std::this_thread::sleep_for(std::chrono::milliseconds(10));
    }
    return false;
  }
  std::thread thread_;
};

struct Shown {
  int32_t answer = -2;
  bool found = false;
  bool escaped = false;
};

Shown message_box(const std::string& title, const std::string& text, int32_t buttons, int32_t default_button,
                  Act act) {
  DialogUser user(title, std::move(act));
  Shown shown;
  shown.answer = sys::use_system_ui().show_message_box(title, text, buttons, default_button);
  user.join();
  shown.found = user.found;
  shown.escaped = user.escaped;
  return shown;
}

struct Chosen {
  sys::FileDialogResult result;
  bool found = false;
  bool escaped = false;
};

Chosen file_dialog(const sys::FileDialogRequest& request, const std::string& title, Act act) {
  DialogUser user(title, std::move(act));
  Chosen chosen;
  chosen.result = sys::use_system_ui().run_file_dialog(request);
  user.join();
  chosen.found = user.found;
  chosen.escaped = user.escaped;
  return chosen;
}

Act tap(KeySym key) {
  return [key](Display*, User& u, Window) { u.tap(key); };
}

guikit::Size window_size(Display* d, Window w) {
  XWindowAttributes a{};
  XGetWindowAttributes(d, w, &a);
  return guikit::Size{a.width, a.height};
}

void click_button(Display* d, User& u, Window w, int count, int index) {
  const guikit::Rect r = sys::message_box_button_rect(window_size(d, w), count, index);
  u.click(w, (r.left + r.right) / 2, (r.top + r.bottom) / 2);
}

// The colour on the left edge of a button, where the frame is drawn.
uint32_t button_edge(Display* d, Window w, int count, int index) {
  const guikit::Size s = window_size(d, w);
  const std::vector<uint32_t> px = x11_test::grab_pixels(d, w, s.width, s.height);
  const guikit::Rect r = sys::message_box_button_rect(s, count, index);
  return px.empty() ? 0 : px[static_cast<size_t>((r.top + r.bottom) / 2) * s.width + r.left];
}

using x11_test::screenshot_dir;

// Grabs the dialog once its pixels pass the check (or after 2 s), keeps it as a
// PNG and answers its pixels. The window's own background is white until the
// first paint.
std::vector<uint32_t> screenshot(Display* d, Window w, const std::string& name,
                                 const std::function<bool(const std::vector<uint32_t>&)>& ready = nullptr) {
  const guikit::Size s = window_size(d, w);
  std::vector<uint32_t> px;
  for (int i = 0; i < 200; ++i) {
    px = x11_test::grab_pixels(d, w, s.width, s.height);
    if (!px.empty() && px[0] != 0xFFFFFFu && (!ready || ready(px))) break;
    std::this_thread::sleep_for(std::chrono::milliseconds(10));
  }
  EXPECT_TRUE(x11_test::write_png(screenshot_dir(), name, px, s.width, s.height));
  return px;
}

// Pixels clearly red: the note under the path field.
int reddish(const std::vector<uint32_t>& px) {
  int n = 0;
  for (uint32_t p : px) n += ((p >> 16) & 0xFF) > 140 && ((p >> 8) & 0xFF) < 90 && (p & 0xFF) < 90;
  return n;
}

class X11FallbackDialog : public ::testing::Test {
 protected:
  void SetUp() override {
    if (!x11_test::display_available()) GTEST_SKIP() << "DISPLAY is not set";
    XInitThreads();
    XSetErrorHandler(x11_test::ignore_x_errors);
  }
  ScopedEnv no_tools_{"BRAKMORPH_NO_DESKTOP_TOOLS", "1"};
};

}  // namespace

TEST(X11FallbackText, WrappingKeepsLineFeedsAndWordsWithinTheWidth) {
  auto width = [](const std::string& s) { return 7 * static_cast<int>(s.size()); };
  const std::string text =
      "Cannot read the bank file.\n\nCode -1002\nAVeryLongWordWithoutAnyBlankThatCannotFitOnOneLine ends it";
  const int max_width = 7 * 12;
  const std::vector<std::string> lines = sys::wrap_text(text, max_width, width);

  std::vector<std::string> expected_words;
  std::string rejoined;
  for (const std::string& line : lines) {
    EXPECT_LE(width(line), max_width) << line;
    EXPECT_FALSE(!line.empty() && (line.front() == ' ' || line.back() == ' ')) << "'" << line << "'";
    rejoined += line + "|";
  }
  // Each paragraph on its own lines, the empty one kept; long words cut to whole lines.
  EXPECT_EQ(
      "Cannot read|the bank|file.||Code -1002|AVeryLongWor|dWithoutAnyB|lankThatCann|otFitOnOneLi|ne ends it|",
      rejoined);
  EXPECT_EQ(std::vector<std::string>{""}, sys::wrap_text("", max_width, width));
  EXPECT_EQ((std::vector<std::string>{"a", "b"}), sys::wrap_text("a\r\nb", max_width, width));
}

TEST_F(X11FallbackDialog, MessageBoxReturnChoosesTheDefaultButton) {
  for (int32_t buttons : {1, 2}) {
    for (int32_t def : {0, 1}) {
      const Shown s = message_box("Question", "Store the program?", buttons, def, tap(XK_Return));
      EXPECT_TRUE(s.found);
      EXPECT_FALSE(s.escaped);
      EXPECT_EQ(def, s.answer) << "buttons " << buttons << " default " << def;
    }
  }
  const Shown ok = message_box("Error", "Bad bank\n\nCode -1002", 0, 0, tap(XK_Return));
  EXPECT_TRUE(ok.found);
  EXPECT_EQ(0, ok.answer);
}

TEST_F(X11FallbackDialog, MessageBoxEscapeOrCloseGivesTheSecondButtonOrTheOnlyOne) {
  EXPECT_EQ(1, message_box("Question", "Replace?", 1, 0, tap(XK_Escape)).answer);
  EXPECT_EQ(1, message_box("Question", "Replace?", 2, 0, tap(XK_Escape)).answer);
  EXPECT_EQ(0, message_box("Error", "Nothing to do", 0, 0, tap(XK_Escape)).answer);
  // The window manager's close button, as a window manager sends it.
  Act close = [](Display* d, User&, Window w) {
    XEvent e{};
    e.xclient.type = ClientMessage;
    e.xclient.window = w;
    e.xclient.message_type = XInternAtom(d, "WM_PROTOCOLS", False);
    e.xclient.format = 32;
    e.xclient.data.l[0] = static_cast<long>(XInternAtom(d, "WM_DELETE_WINDOW", False));
    e.xclient.data.l[1] = CurrentTime;
    XSendEvent(d, w, False, NoEventMask, &e);
    XSync(d, False);
  };
  const Shown closed = message_box("Question", "Replace?", 2, 0, close);
  EXPECT_FALSE(closed.escaped);
  EXPECT_EQ(1, closed.answer);
}

TEST_F(X11FallbackDialog, MessageBoxClickChoosesTheButtonUnderThePointer) {
  const Shown cancel = message_box("Question", "Replace the bank?", 1, 0,
                                   [](Display* d, User& u, Window w) { click_button(d, u, w, 2, 1); });
  EXPECT_FALSE(cancel.escaped);
  EXPECT_EQ(1, cancel.answer);
  // A click beside the buttons chooses nothing; Yes then wins over the default No.
  const Shown yes = message_box("Question", "Replace the bank?", 2, 1, [](Display* d, User& u, Window w) {
    u.click(w, 20, 10);
    std::this_thread::sleep_for(std::chrono::milliseconds(80));
    click_button(d, u, w, 2, 0);
  });
  EXPECT_FALSE(yes.escaped);
  EXPECT_EQ(0, yes.answer);
  const Shown no = message_box("Question", "Replace the bank?", 2, 0,
                               [](Display* d, User& u, Window w) { click_button(d, u, w, 2, 1); });
  EXPECT_EQ(1, no.answer);
}

TEST_F(X11FallbackDialog, MessageBoxTabMovesTheDefaultAndItsMark) {
  uint32_t before[2] = {0, 0}, after[2] = {0, 0};
  guikit::Size size;
  const std::string text =
      "The bank file could not be read: it is shorter than its header says, so none of its programs were "
      "loaded.\n\nCode -1004";
  const Shown s = message_box("Error", text, 2, 0, [&](Display* d, User& u, Window w) {
    size = window_size(d, w);
    screenshot(d, w, "x11_fallback_message_box.png");
    before[0] = button_edge(d, w, 2, 0);
    before[1] = button_edge(d, w, 2, 1);
    u.tap(XK_Tab);
    for (int i = 0; i < 100 && button_edge(d, w, 2, 0) == before[0]; ++i)
      std::this_thread::sleep_for(std::chrono::milliseconds(10));
    after[0] = button_edge(d, w, 2, 0);
    after[1] = button_edge(d, w, 2, 1);
    u.tap(XK_Return);
  });
  EXPECT_TRUE(s.found);
  EXPECT_EQ(1, s.answer) << "Return took the default that Tab moved to No";
  EXPECT_NE(before[0], before[1]) << "the default button looks different";
  EXPECT_EQ(before[0], after[1]);
  EXPECT_EQ(before[1], after[0]);
  // Wrapped into several lines: narrower than the text in one line, taller than
  // a box of two lines (margins 16, button row 24 + 12, lines of the 12-row font).
  EXPECT_LT(size.width, 450);
  EXPECT_GT(size.height, 16 + 2 * 12 + 16 + 24 + 12);
}

TEST_F(X11FallbackDialog, FileDialogTakesATypedPathOrIsCancelled) {
  TempFolder folder;
  sys::FileDialogRequest request;
  request.save = true;
  request.title = "Save bank";
  request.directory = folder.path();
  request.file_name = "mine.pbk";
  request.filters = {{"All files", "*.*"}, {"Preset bank (*.pbk)", "*.pbk"}};
  request.filter_index = 1;

  const std::string typed = folder.file("typed_Bank.pbk");
  Chosen c = file_dialog(request, "Save bank", [&](Display*, User& u, Window) {
    u.type(typed);  // replaces the proposal, which is selected
    u.tap(XK_Return);
  });
  EXPECT_TRUE(c.found);
  EXPECT_FALSE(c.escaped);
  EXPECT_EQ(0, c.result.status);
  EXPECT_EQ(typed, c.result.path);
  EXPECT_EQ(1, c.result.filter_index);

  c = file_dialog(request, "Save bank", tap(XK_Escape));
  EXPECT_TRUE(c.found);
  EXPECT_EQ(1, c.result.status);

  // BackSpace takes the whole selection; Return on nothing is a cancel.
  c = file_dialog(request, "Save bank", [](Display*, User& u, Window) {
    u.tap(XK_BackSpace);
    u.tap(XK_Return);
  });
  EXPECT_FALSE(c.escaped);
  EXPECT_EQ(1, c.result.status);

  // A bare name is taken in the dialog's folder.
  c = file_dialog(request, "Save bank", [](Display*, User& u, Window) {
    u.tap(XK_BackSpace);
    u.type("other.pbk");
    u.tap(XK_Return);
  });
  EXPECT_EQ(0, c.result.status);
  EXPECT_EQ(folder.file("other.pbk"), c.result.path);
}

TEST_F(X11FallbackDialog, SaveDialogProposesTheFolderAndFileName) {
  TempFolder folder;
  sys::FileDialogRequest request;
  request.save = true;
  request.directory = folder.path() + "/";
  request.file_name = "default bank.pbk";
  request.filters = {{"Preset bank (*.pbk)", "*.pbk"}};
  std::vector<uint32_t> shot;
  const Chosen c = file_dialog(request, "Save file", [&](Display* d, User& u, Window w) {
    shot = screenshot(d, w, "x11_fallback_save_dialog.png");
    u.tap(XK_Return);
  });
  EXPECT_TRUE(c.found) << "untitled save dialogs are called Save file";
  EXPECT_EQ(0, c.result.status);
  EXPECT_EQ(folder.file("default bank.pbk"), c.result.path);
  EXPECT_FALSE(shot.empty());

  // Right leaves the selection at the end, so typing appends to the proposal.
  const Chosen appended = file_dialog(request, "Save file", [](Display*, User& u, Window) {
    u.tap(XK_Right);
    u.tap(XK_Left);
    u.tap(XK_Left);
    u.tap(XK_Left);
    u.tap(XK_Left);
    u.type("2");
    u.tap(XK_Return);
  });
  EXPECT_EQ(folder.file("default bank2.pbk"), appended.result.path);

  // Into a folder that does not exist nothing is saved; the proposal stays
  // selected, so the corrected path replaces it.
  request.directory = folder.file("gone");
  std::atomic<bool> stayed{false};
  const Chosen corrected = file_dialog(request, "Save file", [&](Display* d, User& u, Window w) {
    u.tap(XK_Return);
    std::this_thread::sleep_for(std::chrono::milliseconds(150));
    stayed = x11_test::find_named_window(d, "Save file") == w;
    u.type(folder.file("here.pbk"));
    u.tap(XK_Return);
  });
  EXPECT_TRUE(stayed);
  EXPECT_FALSE(corrected.escaped);
  EXPECT_EQ(0, corrected.result.status);
  EXPECT_EQ(folder.file("here.pbk"), corrected.result.path);
}

TEST_F(X11FallbackDialog, OpenDialogRefusesAMissingFileThenTakesAnExistingOne) {
  TempFolder folder;
  std::ofstream(folder.file("bank.pbk")) << "x";
  sys::FileDialogRequest request;
  request.directory = folder.path();
  request.file_name = "bankX.pbk";
  request.filters = {{"Preset bank (*.pbk)", "*.pbk"}};
  std::atomic<bool> stayed{false};
  int red_before = -1, red_after = -1;
  const Chosen c = file_dialog(request, "Open file", [&](Display* d, User& u, Window w) {
    red_before = reddish(screenshot(d, w, "x11_fallback_open_dialog.png"));
    u.tap(XK_Return);  // bankX.pbk does not exist
    std::this_thread::sleep_for(std::chrono::milliseconds(150));
    stayed = x11_test::find_named_window(d, "Open file") == w;
    red_after = reddish(screenshot(d, w, "x11_fallback_open_dialog_refused.png",
                                   [](const std::vector<uint32_t>& px) { return reddish(px) > 20; }));
    u.tap(XK_End);
    for (int i = 0; i < 4; ++i) u.tap(XK_Left);  // before ".pbk"
    u.tap(XK_BackSpace);                          // the X
    u.tap(XK_Return);
  });
  EXPECT_TRUE(c.found);
  EXPECT_TRUE(stayed) << "a missing file keeps the dialog open";
  EXPECT_EQ(0, red_before);
  EXPECT_GT(red_after, 20) << "the note is shown";
  EXPECT_FALSE(c.escaped);
  EXPECT_EQ(0, c.result.status);
  EXPECT_EQ(folder.file("bank.pbk"), c.result.path);
}

// The line editor and the pop-up menu of the X11 window, typed into and clicked
// through XTest. A menu runs its own loop inside the click that opened it, so
// the user's side of a menu test runs on a thread with its own connection.
#include "x11_test_support.h"

#include <atomic>
#include <string>
#include <thread>

#include "guikit/linux/menu_x11.h"
#include "support/skin_test_scene.h"

using guikit::MenuX11;
using guikit::Size;
using guikit::WindowX11;
using scene_test::SceneLayout;
using scene_test::SkinTestScene;
using x11_test::HostWindow;
using x11_test::pump;
using x11_test::pump_until;
using x11_test::User;

namespace {

struct OpenScene {
  explicit OpenScene(const HostWindow& host) : window(Size{100, 100}) {
    scene.attach(window);
    opened = window.open(host.handle());
    if (opened == 0) pump(window, 30);
  }
  ~OpenScene() { scene.detach(); }
  SkinTestScene scene;
  WindowX11 window;
  int32_t opened = -1;
};

void click_text_box(User& user, OpenScene& s) {
  user.click(s.window.get_x_window(), SceneLayout::kTextBox.left + 10, SceneLayout::kTextBox.top + 5);
  ASSERT_TRUE(pump_until(s.window, [&] { return s.window.line_editor().is_active(); }));
}

// The user's side of a menu: waits for it, acts, and always leaves it closed
// (Escape as a last resort), so a failing test cannot hang in the menu loop.
class MenuUser {
 public:
  template <typename Act>
  explicit MenuUser(Act act) {
    thread_ = std::thread([this, act] {
      Display* d = guikit::open_x_display();
      if (!d) return;
      User user(d);
      Window menu = x11_test::wait_for_window(d, MenuX11::kWindowName);
      if (menu) {
        found = true;
        act(d, user, menu);
      }
      for (int i = 0; i < 3 && x11_test::find_named_window(d, MenuX11::kWindowName); ++i) {
        std::this_thread::sleep_for(std::chrono::milliseconds(100));
        if (x11_test::find_named_window(d, MenuX11::kWindowName)) user.tap(XK_Escape);
      }
      XCloseDisplay(d);
    });
  }
  ~MenuUser() { join(); }
  void join() {
    if (thread_.joinable()) thread_.join();
  }
  std::atomic<bool> found{false};

 private:
  std::thread thread_;
};

int row_middle(const guikit::MenuList& list, const std::string& text) {
  for (const MenuX11::Row& r : MenuX11::layout(list)) {
    if (r.entry.text == text) return r.top + r.height / 2;
  }
  return -1;
}

// Presses the menu button and runs the window until the menu has come and gone.
void open_menu(OpenScene& s, User& user) {
  const int before = s.scene.get_menu_requests();
  user.click(s.window.get_x_window(), SceneLayout::kMenuButton.x + 20, SceneLayout::kMenuButton.y + 7);
  ASSERT_TRUE(pump_until(s.window, [&] { return s.scene.get_menu_requests() > before; }, 4000));
}

}  // namespace

TEST(X11LineEditor, ReturnAppliesTheTextAndEscapeDropsIt) {
  X11_REQUIRE_DISPLAY();
  HostWindow host;
  ASSERT_TRUE(host.ok());
  OpenScene s(host);
  ASSERT_EQ(0, s.opened);
  User user(host.display());

  click_text_box(user, s);
  // Laid exactly over the text box, with all of the text selected.
  int x = 0, y = 0;
  Window child = 0;
  XTranslateCoordinates(host.display(), s.window.line_editor().get_x_window(), s.window.get_x_window(), 0, 0, &x, &y,
                        &child);
  EXPECT_EQ(SceneLayout::kTextBox.left, x);
  EXPECT_EQ(SceneLayout::kTextBox.top, y);
  EXPECT_EQ("Brakmorph", s.window.line_editor().get_text());
  EXPECT_TRUE(s.window.line_editor().is_all_selected());

  user.type("Mix 2");  // replaces the selection
  user.tap(XK_Return);
  ASSERT_TRUE(pump_until(s.window, [&] { return !s.window.line_editor().is_active(); }));
  EXPECT_EQ("Mix 2", s.scene.text_box().get_text());
  EXPECT_FALSE(s.scene.text_box().is_editing());

  click_text_box(user, s);
  user.type("zzz");
  ASSERT_TRUE(pump_until(s.window, [&] { return s.window.line_editor().get_text() == "zzz"; }));
  user.tap(XK_Escape);
  ASSERT_TRUE(pump_until(s.window, [&] { return !s.window.line_editor().is_active(); }));
  EXPECT_EQ("Mix 2", s.scene.text_box().get_text()) << "Escape keeps the old text";
  EXPECT_FALSE(s.scene.text_box().is_editing());

  // Caret keys, then a click beside the field accepts.
  click_text_box(user, s);
  user.tap(XK_Right);  // to the end, selection gone
  user.tap(XK_BackSpace);
  user.tap(XK_Left);
  user.tap(XK_Left);
  user.type("a");
  ASSERT_TRUE(pump_until(s.window, [&] { return s.window.line_editor().get_text() == "Miax "; }));
  EXPECT_EQ(3u, s.window.line_editor().get_caret());
  user.click(s.window.get_x_window(), 300, 100);
  ASSERT_TRUE(pump_until(s.window, [&] { return !s.window.line_editor().is_active(); }));
  EXPECT_EQ("Miax ", s.scene.text_box().get_text());
}

TEST(X11LineEditor, TextIsCutTo1023Characters) {
  X11_REQUIRE_DISPLAY();
  HostWindow host;
  ASSERT_TRUE(host.ok());
  OpenScene s(host);
  ASSERT_EQ(0, s.opened);
  User user(host.display());
  s.scene.text_box().set_text(std::string(1500, 'q'));
  click_text_box(user, s);
  EXPECT_EQ(1023u, s.window.line_editor().get_text().size());
  user.tap(XK_End);
  user.type("w");  // no room left
  user.tap(XK_Return);
  ASSERT_TRUE(pump_until(s.window, [&] { return !s.window.line_editor().is_active(); }));
  EXPECT_EQ(std::string(1023, 'q'), s.scene.text_box().get_text());
}

TEST(X11Menu, RowsFollowTheTreeWithTheSharedTexts) {
  SkinTestScene scene;
  std::vector<MenuX11::Row> rows = MenuX11::layout(scene.menu());
  ASSERT_EQ(7u, rows.size());
  EXPECT_EQ("--- Modes ", rows[3].entry.text);
  EXPECT_TRUE(rows[3].entry.grayed);
  EXPECT_EQ(guikit::MenuEntry::kSeparator, rows[5].entry.kind);
  EXPECT_EQ(MenuX11::kSeparatorHeight, rows[5].height);
  EXPECT_EQ(guikit::MenuEntry::kSubMenuBegin, rows[6].entry.kind);
  EXPECT_EQ(scene.menu().get_child(6), rows[6].sub_menu) << "the sub-menu row opens the child list";
  for (size_t i = 1; i < rows.size(); ++i) EXPECT_EQ(rows[i - 1].top + rows[i - 1].height, rows[i].top);
}

TEST(X11Menu, AClickOnARowChoosesItsItem) {
  X11_REQUIRE_DISPLAY();
  HostWindow host;
  ASSERT_TRUE(host.ok());
  OpenScene s(host);
  ASSERT_EQ(0, s.opened);
  User user(host.display());
  const int locked = row_middle(s.scene.menu(), "Locked");
  const int mid = row_middle(s.scene.menu(), "Mid");
  MenuUser menu_user([&](Display*, User& u, Window menu) {
    u.click(menu, 30, locked);  // greyed: nothing happens
    std::this_thread::sleep_for(std::chrono::milliseconds(50));
    u.click(menu, 30, mid);
  });
  open_menu(s, user);
  menu_user.join();
  EXPECT_TRUE(menu_user.found);
  ASSERT_EQ(1u, s.scene.get_chosen().size());
  EXPECT_EQ("Mid", s.scene.get_chosen()[0]);
  EXPECT_EQ(0, s.scene.get_last_menu_answer());
  EXPECT_FALSE(s.window.menu().is_shown());
}

TEST(X11Menu, KeyboardChoosesAndEscapeOrAClickOutsideChoosesNothing) {
  X11_REQUIRE_DISPLAY();
  HostWindow host;
  ASSERT_TRUE(host.ok());
  OpenScene s(host);
  ASSERT_EQ(0, s.opened);
  User user(host.display());
  {
    MenuUser menu_user([](Display*, User& u, Window) {
      u.tap(XK_Down);  // Low
      u.tap(XK_Down);  // Mid
      u.tap(XK_Return);
    });
    open_menu(s, user);
  }
  ASSERT_EQ(1u, s.scene.get_chosen().size());
  EXPECT_EQ("Mid", s.scene.get_chosen()[0]);

  {
    // Up wraps to the sub-menu, Right opens it on its first item, Return picks it.
    MenuUser menu_user([](Display*, User& u, Window) {
      u.tap(XK_Up);
      u.tap(XK_Right);
      u.tap(XK_Down);
      u.tap(XK_Return);
    });
    open_menu(s, user);
  }
  ASSERT_EQ(2u, s.scene.get_chosen().size());
  EXPECT_EQ("Beta", s.scene.get_chosen()[1]);

  {
    MenuUser menu_user([](Display*, User& u, Window) {
      u.tap(XK_Down);
      u.tap(XK_Escape);
    });
    open_menu(s, user);
    menu_user.join();
    EXPECT_TRUE(menu_user.found);
  }
  {
    MenuUser menu_user([&](Display*, User& u, Window) { u.click(s.window.get_x_window(), 500, 150); });
    open_menu(s, user);
    menu_user.join();
    EXPECT_TRUE(menu_user.found);
  }
  EXPECT_EQ(4, s.scene.get_menu_requests());
  EXPECT_EQ(2u, s.scene.get_chosen().size()) << "Escape and the outside click chose nothing";
}

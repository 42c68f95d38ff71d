// The editor window on a real X server (a virtual one under CTest): a child of a
// host-like window, painted from the skin, driven by XTest as a user would, with
// its events and timers pumped from idle.
#include "x11_test_support.h"

#include <vector>

#include "guikit/messages.h"
#include "support/skin_test_scene.h"

using guikit::Size;
using guikit::WindowX11;
using scene_test::SceneLayout;
using scene_test::SkinTestScene;
using x11_test::HostWindow;
using x11_test::pump;
using x11_test::pump_until;
using x11_test::User;

namespace {

const Size kEditor{SceneLayout::kWidth, SceneLayout::kHeight};

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

// Records what reaches the control tree's root.
class RecordingRoot : public guikit::MessageHandlerInterface {
 public:
  struct Click {
    guikit::Point position;
    uint32_t buttons, modifiers, double_click;
  };
  int32_t process_message(guikit::MessageInterface& m) override {
    if (auto* c = dynamic_cast<guikit::MouseClick*>(&m)) clicks.push_back({c->position, c->buttons, c->modifiers, c->double_click});
    if (auto* v = dynamic_cast<guikit::MouseMove*>(&m)) moves.push_back(v->position);
    if (auto* n = dynamic_cast<guikit::Notify*>(&m)) notified.push_back(n->timer_id);
    if (dynamic_cast<guikit::MouseCaptureLost*>(&m)) ++lost;
    return 0;
  }
  std::vector<Click> clicks;
  std::vector<guikit::Point> moves;
  std::vector<int32_t> notified;
  int lost = 0;
};

Window parent_of(Display* d, Window w) {
  Window root = 0, parent = 0, *children = nullptr;
  unsigned int n = 0;
  XQueryTree(d, w, &root, &parent, &children, &n);
  if (children) XFree(children);
  return parent;
}

}  // namespace

TEST(X11Window, OpensOnceAsAChildOfTheHostWindowAtTheChosenSize) {
  X11_REQUIRE_DISPLAY();
  HostWindow host;
  ASSERT_TRUE(host.ok());
  SkinTestScene scene;
  WindowX11 window(Size{100, 100});
  scene.attach(window);
  window.set_window_size(Size{650, 300});  // larger than the editor: the rest is face colour
  ASSERT_EQ(0, window.open(host.handle()));
  const Window first = window.get_x_window();
  EXPECT_EQ(0, window.open(host.handle())) << "opening twice answers 0";
  EXPECT_EQ(first, window.get_x_window()) << "and makes nothing new";
  EXPECT_EQ(host.window(), parent_of(host.display(), first));
  XWindowAttributes a;
  ASSERT_TRUE(XGetWindowAttributes(host.display(), first, &a));
  EXPECT_EQ(650, a.width);
  EXPECT_EQ(300, a.height);
  EXPECT_EQ(IsViewable, a.map_state);

  pump(window, 50);
  std::vector<uint32_t> px = x11_test::grab_pixels(host.display(), first, 650, 300);
  ASSERT_EQ(650u * 300u, px.size());
  EXPECT_EQ(WindowX11::kFaceColour, px[10 * 650 + 630]) << "right of the editor";
  EXPECT_EQ(WindowX11::kFaceColour, px[290 * 650 + 10]) << "below the editor";
  int painted = 0;
  for (int y = 0; y < kEditor.height; y += 7) {
    for (int x = 0; x < kEditor.width; x += 7) painted += px[y * 650 + x] != 0 && px[y * 650 + x] != 0x203040;
  }
  EXPECT_GT(painted, 3000) << "the skin covers the editor area";
  window.close();
  EXPECT_FALSE(window.is_open());

  // Allowed to resize, it takes the editor's size.
  window.set_can_resize(true);
  ASSERT_EQ(0, window.open(host.handle()));
  ASSERT_TRUE(XGetWindowAttributes(host.display(), window.get_x_window(), &a));
  EXPECT_EQ(kEditor.width, a.width);
  EXPECT_EQ(kEditor.height, a.height);
  scene.detach();
}

TEST(X11Window, ABadOrMissingParentAnswersMinusOne) {
  X11_REQUIRE_DISPLAY();
  WindowX11 window(kEditor);
  EXPECT_EQ(-1, window.open(reinterpret_cast<void*>(uintptr_t{0x7FFFFFF0})));
  EXPECT_FALSE(window.is_open());
  EXPECT_EQ(-1, window.open(nullptr));
  EXPECT_FALSE(window.is_open());
}

TEST(X11Window, ClicksReachTheSwitchAndADragGlidesTheKnob) {
  X11_REQUIRE_DISPLAY();
  HostWindow host;
  ASSERT_TRUE(host.ok());
  OpenScene s(host);
  ASSERT_EQ(0, s.opened);
  User user(host.display());
  const Window w = s.window.get_x_window();

  user.click(w, SceneLayout::kFlipFlop.x + 8, SceneLayout::kFlipFlop.y + 8);
  ASSERT_TRUE(pump_until(s.window, [&] { return s.scene.flip_flop().get_value() == 1.0; }));
  user.click(w, SceneLayout::kFlipFlop.x + 3, SceneLayout::kFlipFlop.y + 14);
  ASSERT_TRUE(pump_until(s.window, [&] { return s.scene.flip_flop().get_value() == 0.0; }));

  // Upwards by 40 pixels in steps; the knob follows on its 30 ms glide timer.
  user.move(w, SceneLayout::kKnobA.x, SceneLayout::kKnobA.y);
  user.button(Button1, true);
  pump(s.window, 20);
  std::vector<double> seen;
  for (int i = 1; i <= 8; ++i) {
    user.move(w, SceneLayout::kKnobA.x, SceneLayout::kKnobA.y - 5 * i);
    pump(s.window, 25);
    seen.push_back(s.scene.knob_a().get_value());
  }
  user.button(Button1, false);
  for (int i = 0; i < 10; ++i) {
    pump(s.window, 30);
    seen.push_back(s.scene.knob_a().get_value());
  }
  for (size_t i = 1; i < seen.size(); ++i) EXPECT_GE(seen[i], seen[i - 1]) << "step " << i;
  std::vector<double> distinct;
  for (double v : seen) {
    if (distinct.empty() || v != distinct.back()) distinct.push_back(v);
  }
  EXPECT_GE(distinct.size(), 4u) << "the value moves in glide steps, not at once";
  EXPECT_GT(seen.back(), 0.2) << "40 pixels of a 100-pixel drag range";
  EXPECT_EQ(0.0, s.scene.knob_b().get_value());
  EXPECT_EQ(0u, s.window.core().get_timer_count()) << "the glide ended and gave its timer back";
}

TEST(X11Window, ButtonsModifiersAndDoubleClicksAreReportedAsTheToolkitCountsThem) {
  X11_REQUIRE_DISPLAY();
  HostWindow host;
  ASSERT_TRUE(host.ok());
  RecordingRoot root;
  WindowX11 window(kEditor);
  window.set_roots(nullptr, &root);
  ASSERT_EQ(0, window.open(host.handle()));
  pump(window, 20);
  User user(host.display());
  const Window w = window.get_x_window();

  user.move(w, 40, 30);
  ASSERT_TRUE(pump_until(window, [&] { return !root.moves.empty(); }));
  EXPECT_EQ(40, root.moves.back().x);
  EXPECT_EQ(30, root.moves.back().y);

  user.button(Button3, true);
  user.button(Button3, false);
  user.key(XK_Control_L, true);
  user.button(Button1, true);
  user.button(Button2, true);  // middle while left is held
  user.button(Button2, false);
  user.button(Button1, false);
  user.key(XK_Control_L, false);
  user.key(XK_Shift_L, true);
  user.move(w, 200, 100);
  user.button(Button1, true);
  user.button(Button1, false);
  user.key(XK_Shift_L, false);
  ASSERT_TRUE(pump_until(window, [&] { return root.clicks.size() >= 8; }));
  struct Want {
    uint32_t buttons, modifiers, dbl;
  };
  const Want want[8] = {{2, 0, 0}, {0, 0, 0}, {1, 1, 0}, {5, 1, 0}, {1, 1, 0}, {0, 1, 0}, {1, 2, 0}, {0, 2, 0}};
  for (int i = 0; i < 8; ++i) {
    EXPECT_EQ(want[i].buttons, root.clicks[i].buttons) << "click " << i;
    EXPECT_EQ(want[i].modifiers, root.clicks[i].modifiers) << "click " << i;
    EXPECT_EQ(want[i].dbl, root.clicks[i].double_click) << "click " << i;
  }
  EXPECT_EQ(200, root.clicks[7].position.x);
  EXPECT_EQ(100, root.clicks[7].position.y);

  // Far in time from the last press: a plain press; then a quick second one is a double-click.
  std::this_thread::sleep_for(std::chrono::milliseconds(WindowX11::kDoubleClickMs + 50));
  root.clicks.clear();
  user.click(w, 300, 100, Button1);
  user.click(w, 302, 101, Button1);
  user.click(w, 302, 101, Button1);  // a third press starts over
  user.click(w, 100, 100, Button3);
  user.click(w, 100, 100, Button3);
  user.click(w, 150, 100, Button2);
  user.click(w, 150, 100, Button2);
  user.click(w, 150, 100, Button1);
  user.click(w, 150, 140, Button1);  // too far away
  ASSERT_TRUE(pump_until(window, [&] { return root.clicks.size() >= 18; }));
  const uint32_t presses[9] = {0, 1, 0, 0, 2, 0, 4, 0, 0};
  for (int i = 0; i < 9; ++i) EXPECT_EQ(presses[i], root.clicks[2 * i].double_click) << "press " << i;
}

TEST(X11Window, CaptureIsAPointerGrabAndItsLossIsReported) {
  X11_REQUIRE_DISPLAY();
  HostWindow host;
  ASSERT_TRUE(host.ok());
  RecordingRoot root;
  WindowX11 window(kEditor);
  window.set_roots(nullptr, &root);
  ASSERT_EQ(0, window.open(host.handle()));
  pump(window, 20);
  auto other_client_can_grab = [&] {
    const int r = XGrabPointer(host.display(), host.window(), False, ButtonPressMask, GrabModeAsync, GrabModeAsync,
                               None, None, CurrentTime);
    if (r == GrabSuccess) XUngrabPointer(host.display(), CurrentTime);
    XSync(host.display(), False);
    return r == GrabSuccess;
  };
  EXPECT_TRUE(other_client_can_grab());

  guikit::MouseCapture capture(1, &root);
  ASSERT_EQ(0, window.process_message(capture));
  EXPECT_FALSE(other_client_can_grab()) << "the window holds the pointer";
  guikit::MouseRelease release(&root, guikit::Point{0, 0});
  EXPECT_EQ(0, window.process_message(release));
  EXPECT_EQ(1, root.lost) << "giving the capture back reports it";
  EXPECT_TRUE(other_client_can_grab());

  // The host hides its window: the server ends the grab, the handler hears it.
  ASSERT_EQ(0, window.process_message(capture));
  XUnmapWindow(host.display(), host.window());
  XSync(host.display(), False);
  ASSERT_TRUE(pump_until(window, [&] { return root.lost == 2; }));
  EXPECT_EQ(nullptr, window.core().get_capture_handler());
}

TEST(X11Window, TimersTickFromIdleUntilCleared) {
  X11_REQUIRE_DISPLAY();
  HostWindow host;
  ASSERT_TRUE(host.ok());
  RecordingRoot root;
  WindowX11 window(kEditor);
  window.set_roots(nullptr, &root);
  ASSERT_EQ(0, window.open(host.handle()));
  int32_t id = 0;
  guikit::SetTimer set(0.02f, &root, &id);
  ASSERT_EQ(0, window.process_message(set));
  std::this_thread::sleep_for(std::chrono::milliseconds(60));
  EXPECT_TRUE(root.notified.empty()) << "nothing runs between idle calls";
  pump(window, 200);
  EXPECT_GE(root.notified.size(), 5u);
  EXPECT_LE(root.notified.size(), 11u) << "about one tick per 20 ms, no catching up";
  for (int32_t n : root.notified) EXPECT_EQ(id, n);
  guikit::ClearTimer clear(id);
  EXPECT_EQ(0, window.process_message(clear));
  const size_t count = root.notified.size();
  pump(window, 60);
  EXPECT_EQ(count, root.notified.size());
  EXPECT_EQ(-1, window.process_message(clear)) << "an unknown timer";
  window.close();
  EXPECT_EQ(-1, window.process_message(set)) << "a closed window carries out nothing";
}

TEST(X11Window, TwoWindowsAtOnceAndReopening) {
  X11_REQUIRE_DISPLAY();
  HostWindow host_a(0, 0), host_b(0, 360);
  ASSERT_TRUE(host_a.ok() && host_b.ok());
  const int before = WindowX11::get_open_count();
  auto a = std::make_unique<OpenScene>(host_a);
  auto b = std::make_unique<OpenScene>(host_b);
  ASSERT_EQ(0, a->opened);
  ASSERT_EQ(0, b->opened);
  EXPECT_EQ(before + 2, WindowX11::get_open_count());
  User user(host_a.display());
  user.click(b->window.get_x_window(), SceneLayout::kFlipFlop.x + 8, SceneLayout::kFlipFlop.y + 8);
  ASSERT_TRUE(pump_until(b->window, [&] { return b->scene.flip_flop().get_value() == 1.0; }));
  pump(a->window, 20);
  EXPECT_EQ(0.0, a->scene.flip_flop().get_value()) << "the click went to the other window";

  a->window.close();
  EXPECT_EQ(before + 1, WindowX11::get_open_count());
  user.click(b->window.get_x_window(), SceneLayout::kFlipFlop.x + 8, SceneLayout::kFlipFlop.y + 8);
  ASSERT_TRUE(pump_until(b->window, [&] { return b->scene.flip_flop().get_value() == 0.0; }));

  ASSERT_EQ(0, a->window.open(host_a.handle()));
  EXPECT_EQ(before + 2, WindowX11::get_open_count());
  pump(a->window, 30);
  user.click(a->window.get_x_window(), SceneLayout::kFlipFlop.x + 8, SceneLayout::kFlipFlop.y + 8);
  ASSERT_TRUE(pump_until(a->window, [&] { return a->scene.flip_flop().get_value() == 1.0; }));
  b.reset();
  a.reset();
  EXPECT_EQ(before, WindowX11::get_open_count());
}

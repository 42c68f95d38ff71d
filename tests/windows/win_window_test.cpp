// The editor window on a real Windows desktop (or Wine with an X server): a
// host-like top-level window holds the toolkit's child window showing the skin
// test scene. Mouse and keyboard input is posted to the windows as the system
// would deliver it; modal loops (pop-up menus, message boxes) are driven from
// thread timers that fire inside them. Screenshots are read back from the
// window's device context and compared with the off-screen rendering of the
// same state, pixel for pixel.
//
//   win_window_test [SCREENSHOT_FOLDER]
//
// Prints PASS/FAIL lines; exits 0 when everything passed, 1 on a failure and
// 77 when no window can be shown at all (no display).
#include <windows.h>

#include <cmath>
#include <cstdio>
#include <cstring>
#include <memory>
#include <string>
#include <vector>

#include "config/system_ui.h"
#include "guikit/headless/offscreen_window.h"
#include "guikit/messages.h"
#include "guikit/win32/menu_win32.h"
#include "guikit/win32/window_win32.h"
#include "support/skin_test_scene.h"
#include "win_test_desktop.h"

using guikit::Size;
using guikit::WindowWin32;
using scene_test::SceneLayout;
using scene_test::SkinTestScene;

namespace {

int g_failures = 0;

void check(bool ok, const std::string& what) {
  std::printf("%s: %s\n", ok ? "PASS" : "FAIL", what.c_str());
  std::fflush(stdout);
  if (!ok) ++g_failures;
}

const Size kEditorSize{SceneLayout::kWidth, SceneLayout::kHeight};

// The scene's pixels as the off-screen window paints them for a state.
std::vector<uint32_t> offscreen_reference(double a, double b, double fader, double flip, const std::string& text) {
  SkinTestScene scene;
  guikit::OffscreenWindow window(kEditorSize);
  scene.attach(window);
  scene.set_state(a, b, fader, flip, text);
  window.paint_all();
  std::vector<uint32_t> pixels;
  for (int y = 0; y < kEditorSize.height; ++y) {
    for (int x = 0; x < kEditorSize.width; ++x) pixels.push_back(window.pixel(x, y) & 0x00FFFFFFu);
  }
  scene.detach();
  return pixels;
}

// The knob's value after a drag of `steps` moves of `dy` pixels, each followed
// by 20 ms, then the release and the rest of the glide, off screen.
double offscreen_drag(int steps, int dy) {
  SkinTestScene scene;
  guikit::OffscreenWindow window(kEditorSize);
  scene.attach(window);
  window.click_at(SceneLayout::kKnobA.x, SceneLayout::kKnobA.y);
  for (int i = 1; i <= steps; ++i) {
    window.mouse_move(SceneLayout::kKnobA.x, SceneLayout::kKnobA.y + dy * i);
    window.advance_ms(20);
  }
  window.button_up();
  window.advance_ms(600);
  const double value = scene.knob_a().get_value();
  scene.detach();
  return value;
}

int count_differences(const std::vector<uint32_t>& a, const std::vector<uint32_t>& b) {
  if (a.size() != b.size()) return -1;
  int n = 0;
  for (size_t i = 0; i < a.size(); ++i) n += a[i] != b[i];
  return n;
}

// Keeps the mouse messages the window sends it.
class MouseRecorder : public guikit::MessageHandlerInterface {
 public:
  int32_t process_message(guikit::MessageInterface& message) override {
    if (auto* click = dynamic_cast<guikit::MouseClick*>(&message)) clicks.push_back(*click);
    if (auto* move = dynamic_cast<guikit::MouseMove*>(&message)) moves.push_back(*move);
    if (dynamic_cast<guikit::MouseCaptureLost*>(&message)) ++lost;
    return 0;
  }
  std::vector<guikit::MouseClick> clicks;
  std::vector<guikit::MouseMove> moves;
  int lost = 0;
};

// The window procedure's reading of buttons, modifiers, double-clicks and
// positions, and a capture another window takes away.
void check_mouse_messages(win_test::Desktop& desktop, WindowWin32& window, HWND child) {
  MouseRecorder recorder;
  window.set_roots(nullptr, &recorder);
  struct Case {
    UINT message;
    WPARAM keys;
    uint32_t buttons, modifiers, double_click;
  };
  const Case cases[] = {
      {WM_LBUTTONDOWN, MK_LBUTTON | MK_CONTROL, guikit::kButtonLeft, guikit::kModControl, 0},
      {WM_LBUTTONUP, MK_SHIFT, 0, guikit::kModShift, 0},
      {WM_LBUTTONDBLCLK, MK_LBUTTON, guikit::kButtonLeft, 0, guikit::kDoubleLeft},
      {WM_RBUTTONDBLCLK, MK_RBUTTON | MK_SHIFT | MK_CONTROL, guikit::kButtonRight, 3, guikit::kDoubleRight},
      {WM_MBUTTONDOWN, MK_MBUTTON | MK_LBUTTON, guikit::kButtonMiddle | guikit::kButtonLeft, 0, 0},
      {WM_MBUTTONDBLCLK, MK_MBUTTON, guikit::kButtonMiddle, 0, guikit::kDoubleMiddle},
      {WM_RBUTTONUP, MK_MBUTTON, guikit::kButtonMiddle, 0, 0},
  };
  for (const Case& c : cases) PostMessageA(child, c.message, c.keys, MAKELPARAM(-5, 300));
  PostMessageA(child, WM_MOUSEMOVE, 0, MAKELPARAM(12, -7));
  desktop.pump(50);
  bool all = recorder.clicks.size() == sizeof cases / sizeof cases[0];
  for (size_t i = 0; all && i < recorder.clicks.size(); ++i) {
    const guikit::MouseClick& m = recorder.clicks[i];
    all = m.buttons == cases[i].buttons && m.modifiers == cases[i].modifiers &&
          m.double_click == cases[i].double_click && m.position.x == -5 && m.position.y == 300;
  }
  check(all, "mouse buttons, modifiers and double-clicks come from the key-state word; positions are signed");
  check(recorder.moves.size() == 1 && recorder.moves[0].position.x == 12 && recorder.moves[0].position.y == -7,
        "a mouse move reaches the control tree with its signed position");

  guikit::MouseCapture capture(1, &recorder);
  check(window.process_message(capture) == 0 && GetCapture() == child, "a capture request takes the system capture");
  SetCapture(GetParent(child));
  desktop.pump(20);
  check(recorder.lost == 1 && window.core().get_capture_handler() == nullptr,
        "another window taking the capture tells the handler it lost it");
  ReleaseCapture();
  window.set_roots(nullptr, nullptr);
}

// --- Pop-up menus: a timer inside the menu's modal loop reads the menu the
// system shows and answers with keys.
struct MenuDriver {
  std::vector<WPARAM> keys;
  bool seen = false;
  std::vector<std::string> texts;
  std::vector<UINT> states;
  std::vector<std::string> sub_texts;
};
MenuDriver* g_menu_driver = nullptr;

void CALLBACK drive_menu(HWND, UINT, UINT_PTR timer, DWORD) {
  HWND popup = FindWindowA("#32768", nullptr);
  if (!popup || !IsWindowVisible(popup) || !g_menu_driver) return;
  KillTimer(nullptr, timer);
  MenuDriver& d = *g_menu_driver;
  d.seen = true;
  HMENU menu = reinterpret_cast<HMENU>(SendMessageA(popup, MN_GETHMENU, 0, 0));
  if (menu) {
    for (int i = 0; i < GetMenuItemCount(menu); ++i) {
      char text[256] = {0};
      GetMenuStringA(menu, static_cast<UINT>(i), text, sizeof text, MF_BYPOSITION);
      d.texts.push_back(text);
      d.states.push_back(GetMenuState(menu, static_cast<UINT>(i), MF_BYPOSITION));
      if (HMENU sub = GetSubMenu(menu, i)) {
        for (int j = 0; j < GetMenuItemCount(sub); ++j) {
          GetMenuStringA(sub, static_cast<UINT>(j), text, sizeof text, MF_BYPOSITION);
          d.sub_texts.push_back(text);
        }
      }
    }
  }
  for (WPARAM key : d.keys) {
    PostMessageA(popup, WM_KEYDOWN, key, 1);
    PostMessageA(popup, WM_KEYUP, key, 0xC0000001);
  }
}

// Presses the scene's menu button; the driver picks with keys.
void press_menu_button(win_test::Desktop& desktop, HWND child, MenuDriver& driver) {
  g_menu_driver = &driver;
  SetTimer(nullptr, 0, 30, &drive_menu);
  desktop.press(child, SceneLayout::kMenuButton.x + 20, SceneLayout::kMenuButton.y + 7);
  desktop.pump(100);  // the menu runs (and returns) inside this
  desktop.release(child, SceneLayout::kMenuButton.x + 20, SceneLayout::kMenuButton.y + 7);
  desktop.pump(50);
  g_menu_driver = nullptr;
}

void check_menus(win_test::Desktop& desktop, SkinTestScene& scene, HWND child) {
  MenuDriver pick;
  pick.keys = {VK_DOWN, VK_DOWN, VK_RETURN};
  press_menu_button(desktop, child, pick);
  check(pick.seen, "menu: the pop-up menu is shown at the button's press");
  check(scene.get_chosen() == std::vector<std::string>{"Mid"},
        "menu: Down, Down, Return chooses the second item and calls its listener");
  check(scene.get_last_menu_answer() == 0, "menu: the request answers 0");
  const std::vector<std::string> texts{"Low", "Mid", "High", "--- Modes ", "Locked", "", "More"};
  check(pick.texts == texts, "menu: items, labelled delimiter (three dashes, the label, a blank), separator, sub-menu");
  if (pick.states.size() == texts.size()) {
    check((pick.states[2] & MF_CHECKED) && !(pick.states[0] & MF_CHECKED), "menu: only the checked item has a tick");
    check((pick.states[3] & MF_GRAYED) && (pick.states[4] & MF_GRAYED) && !(pick.states[1] & MF_GRAYED),
          "menu: the labelled delimiter and the greyed item are greyed, others not");
    check((pick.states[5] & MF_SEPARATOR) != 0, "menu: the unlabelled delimiter is a separator");
    check((pick.states[6] & MF_POPUP) != 0, "menu: the sub-list is a sub-menu");
  }
  check(pick.sub_texts == std::vector<std::string>{"Alpha", "Beta"}, "menu: the sub-menu holds its items in order");

  MenuDriver escape;
  escape.keys = {VK_DOWN, VK_ESCAPE};
  press_menu_button(desktop, child, escape);
  check(escape.seen && scene.get_chosen().size() == 1 && scene.get_menu_requests() == 2,
        "menu: Escape closes the menu and calls no listener");
  check(!FindWindowA("VelmoraAudioPluginMenu", nullptr) && !IsWindow(FindWindowExA(child, nullptr, "VelmoraAudioPluginMenu", nullptr)),
        "menu: the helper window is gone after the menu");

  // A sub-menu item: Up wraps to "More", Right opens it on "Alpha", Down to "Beta".
  MenuDriver sub;
  sub.keys = {VK_UP, VK_RIGHT, VK_DOWN, VK_RETURN};
  press_menu_button(desktop, child, sub);
  check(scene.get_chosen().size() == 2 && scene.get_chosen().back() == "Beta",
        "menu: an item of the sub-menu reaches its listener");
}

// --- Message boxes and file dialogs: a timer finds the dialog and presses a button.
struct DialogDriver {
  std::string title;
  int button = 0;           // the control id to press
  std::string file_name = std::string();  // typed into the file name field before pressing, if any
  bool seen = false;
  int default_id = 0;
  std::string initial_name = std::string();
};
DialogDriver* g_dialog_driver = nullptr;

BOOL CALLBACK set_file_field(HWND control, LPARAM text) {
  // The file name field of either dialog layout.
  const int id = GetDlgCtrlID(control);
  if (id == 0x47C || id == 0x480) SetWindowTextA(control, reinterpret_cast<const char*>(text));
  return TRUE;
}

void CALLBACK drive_dialog(HWND, UINT, UINT_PTR timer, DWORD) {
  if (!g_dialog_driver) return;
  DialogDriver& d = *g_dialog_driver;
  HWND dialog = FindWindowA("#32770", d.title.c_str());
  if (!dialog || !IsWindowVisible(dialog)) return;
  KillTimer(nullptr, timer);
  d.seen = true;
  // The default button is the one drawn as the default push button.
  for (int id : {IDOK, IDCANCEL, IDYES, IDNO}) {
    HWND button = GetDlgItem(dialog, id);
    if (button && (GetWindowLongA(button, GWL_STYLE) & 0x0F) == BS_DEFPUSHBUTTON) d.default_id = id;
  }
  char field[256] = {0};
  if (HWND name = GetDlgItem(dialog, 0x47C)) GetWindowTextA(name, field, sizeof field);
  d.initial_name = field;
  if (!d.file_name.empty()) EnumChildWindows(dialog, &set_file_field, reinterpret_cast<LPARAM>(d.file_name.c_str()));
  PostMessageA(dialog, WM_COMMAND, MAKEWPARAM(d.button, BN_CLICKED), 0);
}

void arm_dialog(DialogDriver& driver) {
  g_dialog_driver = &driver;
  SetTimer(nullptr, 0, 50, &drive_dialog);
}

void check_system_ui(const std::string& folder) {
  sys::SystemUiInterface& ui = sys::platform_system_ui();
  DialogDriver yes_no{"Brakmorph window test: Yes/No", IDNO};
  arm_dialog(yes_no);
  const int32_t no = ui.show_message_box(yes_no.title, "Second button, second by default?", 2, 1);
  check(yes_no.seen && no == 1, "message box: No of Yes/No answers 1");
  check(yes_no.default_id == IDNO, "message box: default button 1 is the second button (No)");

  DialogDriver ok_cancel{"Brakmorph window test: OK/Cancel", IDOK};
  arm_dialog(ok_cancel);
  const int32_t ok = ui.show_message_box(ok_cancel.title, "First button?", 1, 0);
  check(ok_cancel.seen && ok == 0 && ok_cancel.default_id == IDOK, "message box: OK answers 0, OK is the default");

  sys::FileDialogRequest open;
  open.title = "Brakmorph window test: open";
  open.filters = {{"Preset bank (*.pbk)", "*.pbk,*.fxb"}, {"All files", "*.*"}};
  DialogDriver cancel{open.title, IDCANCEL};
  arm_dialog(cancel);
  const sys::FileDialogResult cancelled = ui.run_file_dialog(open);
  check(cancel.seen && cancelled.status == 1, "file dialog: Cancel answers 1 (no dialog error)");

  sys::FileDialogRequest save;
  save.save = true;
  save.title = "Brakmorph window test: save";
  save.directory = folder;
  save.file_name = "old.pbk";
  save.filters = {{"All files", "*.*"}, {"Preset bank (*.pbk)", "*.pbk"}};
  save.filter_index = 1;
  DialogDriver typed{save.title, IDOK, folder + "\\typed_bank"};
  arm_dialog(typed);
  const sys::FileDialogResult saved = ui.run_file_dialog(save);
  g_dialog_driver = nullptr;
  const std::string tail = "typed_bank";
  check(typed.seen && saved.status == 0 && saved.path.size() >= tail.size() &&
            saved.path.compare(saved.path.size() - tail.size(), tail.size(), tail) == 0,
        "file dialog: a typed name comes back as the chosen path (" + saved.path + ")");
  check(saved.filter_index == 1, "file dialog: the selected filter comes back from 0");
  check(typed.initial_name == "old.pbk", "file dialog: the name field starts with the current file name (" +
                                             typed.initial_name + ")");
}

}  // namespace

int main(int argc, char** argv) {
  win_test::Desktop desktop;
  if (!desktop.start()) {
    std::printf("SKIP: no window can be shown here (no display)\n");
    return 77;
  }
  const std::string folder = argc > 1 ? argv[1] : win_test::default_screenshot_folder();
  CreateDirectoryA(folder.c_str(), nullptr);

  HWND host = desktop.make_host("Brakmorph window test host", 0, 0);
  check(host != nullptr, "a host-like top-level window");
  if (!host) return 1;

  auto scene = std::make_unique<SkinTestScene>();
  auto window = std::make_unique<WindowWin32>(Size{100, 100});
  scene->attach(*window);
  check(window->open(host) == 0, "open answers 0");
  HWND child = window->get_handle();
  check(child != nullptr && GetParent(child) == host, "the editor is a child window of the host's window");
  check(window->open(host) == 0 && window->get_handle() == child && WindowWin32::get_open_count() == 1,
        "opening twice answers 0 and creates nothing");
  char text[256] = {0};
  GetClassNameA(child, text, sizeof text);
  const std::string class_name = text;
  check(class_name == WindowWin32::window_class_name() && class_name.size() == 26 &&
            class_name.compare(0, 18, "VelmoraAudioPlugin") == 0 &&
            class_name.find_first_not_of("0123456789ABCDEF", 18) == std::string::npos,
        "window class VelmoraAudioPlugin + 8 hex digits (" + class_name + ")");
  GetWindowTextA(child, text, sizeof text);
  check(std::string(text) == "Velmora Audio Plug-in", "window title");
  RECT client;
  GetClientRect(child, &client);
  check(client.right == kEditorSize.width && client.bottom == kEditorSize.height, "the window takes the editor size");

  // It paints: the screen shows what the off-screen window paints.
  desktop.pump(150);
  const std::vector<uint32_t> first_reference = offscreen_reference(0, 0, 0, 0, "Brakmorph");
  const std::vector<uint32_t> first_shot = desktop.screenshot(child, kEditorSize);
  check(count_differences(first_shot, first_reference) == 0, "it paints: the first screen equals the off-screen rendering");

  // A click on the flip-flop.
  desktop.click(child, SceneLayout::kFlipFlop.x + 8, SceneLayout::kFlipFlop.y + 8);
  check(scene->flip_flop().get_value() == 1.0, "a click on the flip-flop switches it on");
  desktop.pump(100);
  check(count_differences(desktop.screenshot(child, kEditorSize), offscreen_reference(0, 0, 0, 1, "Brakmorph")) == 0,
        "the switched flip-flop is on the screen");

  check_mouse_messages(desktop, *window, child);
  scene->attach(*window);

  // A drag upwards on the first knob, in relative mode, and its glide.
  {
    const int steps = 10, dy = -3;
    const double expected = offscreen_drag(steps, dy);
    desktop.set_cursor(child, SceneLayout::kKnobA.x, SceneLayout::kKnobA.y);
    desktop.press(child, SceneLayout::kKnobA.x, SceneLayout::kKnobA.y);
    std::vector<double> seen{scene->knob_a().get_value()};
    for (int i = 1; i <= steps; ++i) {
      desktop.move(child, SceneLayout::kKnobA.x, SceneLayout::kKnobA.y + dy * i, true);
      desktop.pump(20);
      seen.push_back(scene->knob_a().get_value());
    }
    check(window->core().get_capture_mode() == 2 && GetCapture() == child, "the knob holds the capture in relative mode");
    desktop.release(child, SceneLayout::kKnobA.x, SceneLayout::kKnobA.y + dy * steps);
    desktop.pump(600);
    const double final_value = scene->knob_a().get_value();
    int distinct = 0;
    bool rising = true;
    for (size_t i = 1; i < seen.size(); ++i) {
      distinct += seen[i] != seen[i - 1];
      rising = rising && seen[i] >= seen[i - 1];
    }
    check(rising && distinct >= 3 && final_value >= seen.back(), "the knob glides upwards through several values");
    check(std::fabs(final_value - expected) < 1e-9 && expected > 0.1,
          "the drag ends at the off-screen window's value (" + std::to_string(final_value) + " vs " +
              std::to_string(expected) + ")");
    check(scene->knob_b().get_value() == 0.0, "only the dragged knob moves");
    check(GetCapture() != child && window->core().get_capture_handler() == nullptr, "the release gives the capture back");
  }

  // The line editor: typing replaces the selected text; Return applies it.
  {
    const int x = SceneLayout::kTextBox.left + 5, y = SceneLayout::kTextBox.top + 5;
    desktop.click(child, x, y);
    HWND edit = window->line_editor().get_edit_window();
    check(window->line_editor().is_active() && edit != nullptr, "a click on the text box opens the line editor");
    GetClassNameA(edit, text, sizeof text);
    GetWindowTextA(edit, text + 128, 128);
    check(lstrcmpiA(text, "Edit") == 0 && std::string(text + 128) == "Brakmorph", "an EDIT field with the box's text");
    RECT er;
    GetWindowRect(edit, &er);
    POINT origin{0, 0};
    ClientToScreen(child, &origin);
    check(er.left == origin.x + SceneLayout::kTextBox.left && er.top == origin.y + SceneLayout::kTextBox.top &&
              er.right - er.left == SceneLayout::kTextBox.width(),
          "the field lies over the text box");
    desktop.type(edit, "Edited");
    desktop.key_char(edit, VK_RETURN);
    check(!window->line_editor().is_active() && !IsWindow(edit), "Return ends the edit and removes the field");
    check(scene->text_box().get_text() == "Edited", "Return applies the typed text");

    desktop.click(child, x, y);
    edit = window->line_editor().get_edit_window();
    desktop.type(edit, "Dropped");
    desktop.key_char(edit, VK_ESCAPE);
    check(!window->line_editor().is_active() && scene->text_box().get_text() == "Edited", "Escape drops the text");

    desktop.click(child, x, y);
    edit = window->line_editor().get_edit_window();
    desktop.type(edit, "Focus");
    SetFocus(child);
    desktop.pump(50);
    check(!window->line_editor().is_active() && scene->text_box().get_text() == "Focus", "losing the focus applies it");

    desktop.click(child, x, y);
    edit = window->line_editor().get_edit_window();
    SetWindowTextA(edit, std::string(1500, 'w').c_str());
    desktop.key_char(edit, VK_RETURN);
    check(window->line_editor().get_text().size() == 1023, "a text longer than 1023 characters is cut to 1023");
    scene->text_box().set_text("Brakmorph");
  }

  check_menus(desktop, *scene, child);

  // The same state on both windows paints the same pixels.
  const std::string shot = folder + "\\window_" + win_test::build_name() + ".bmp";
  {
    scene->set_state(0.3, 0.8, 0.5, 1.0, "Same");
    desktop.pump(100);
    const std::vector<uint32_t> reference = offscreen_reference(0.3, 0.8, 0.5, 1.0, "Same");
    const std::vector<uint32_t> pixels = desktop.screenshot(child, kEditorSize);
    const int differing = count_differences(pixels, reference);
    check(differing == 0, "screenshot equals the off-screen rendering (" + std::to_string(differing) + " pixels differ)");
    check(win_test::write_bmp(shot, pixels, kEditorSize), "screenshot written to " + shot);
    if (differing != 0) {
      win_test::write_bmp(folder + "\\window_" + win_test::build_name() + "_reference.bmp", reference, kEditorSize);
    }
  }

  // Close and reopen.
  window->close();
  check(window->get_handle() == nullptr && !IsWindow(child) && WindowWin32::get_open_count() == 0,
        "close destroys the window");
  check(window->core().get_timer_count() == 0, "close stops the window's timers");
  check(WindowWin32::is_class_registered(), "the class stays while the window object exists");
  check(window->open(host) == 0 && window->get_handle() != nullptr, "the window opens again");
  child = window->get_handle();
  desktop.pump(150);
  check(count_differences(desktop.screenshot(child, kEditorSize), offscreen_reference(0.3, 0.8, 0.5, 1.0, "Same")) == 0,
        "the reopened window paints the same pixels");
  desktop.click(child, SceneLayout::kFlipFlop.x + 8, SceneLayout::kFlipFlop.y + 8);
  check(scene->flip_flop().get_value() == 0.0, "the reopened window takes clicks");

  // A second editor in a second host window, open at the same time.
  {
    HWND host2 = desktop.make_host("Brakmorph window test host 2", 40, 340);
    SkinTestScene scene2;
    auto window2 = std::make_unique<WindowWin32>(Size{100, 100});
    scene2.attach(*window2);
    check(window2->open(host2) == 0 && WindowWin32::get_open_count() == 2, "two editor windows open at once");
    GetClassNameA(window2->get_handle(), text, sizeof text);
    check(std::string(text) == class_name, "both share one window class");
    desktop.click(window2->get_handle(), SceneLayout::kFlipFlop.x + 8, SceneLayout::kFlipFlop.y + 8);
    check(scene2.flip_flop().get_value() == 1.0 && scene->flip_flop().get_value() == 0.0,
          "a click reaches only the window it was given to");
    window2->close();
    scene2.detach();
    window2.reset();
    check(WindowWin32::is_class_registered() && WindowWin32::get_open_count() == 1,
          "closing one keeps the class for the other");
    InvalidateRect(child, nullptr, FALSE);
    desktop.pump(100);
    check(count_differences(desktop.screenshot(child, kEditorSize), offscreen_reference(0.3, 0.8, 0.5, 0.0, "Same")) == 0,
          "the other window still paints");
    DestroyWindow(host2);
  }

  // The host destroys its window with ours in it.
  DestroyWindow(host);
  check(window->get_handle() == nullptr && WindowWin32::get_open_count() == 0,
        "the host's destruction of the parent closes the editor window");
  scene->detach();
  window.reset();
  scene.reset();
  WNDCLASSA info;
  check(!WindowWin32::is_class_registered() &&
            !GetClassInfoA(GetModuleHandleA(nullptr), class_name.c_str(), &info),
        "the class is unregistered when the last window object goes");

  check_system_ui(folder);

  std::printf("%s: %d check(s) failed\n", g_failures == 0 ? "PASS" : "FAIL", g_failures);
  return g_failures == 0 ? 0 : 1;
}

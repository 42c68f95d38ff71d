// A small editor built from the real skin pictures, for the window tests of every
// platform: the editor's backgrounds (609 x 282, split as the editor splits them),
// two knobs, the horizontal fader, a stereo flip-flop, an editable text box and a
// push button that opens a pop-up menu. Portable C++17: the Windows window tests
// build it too.
#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "guikit/background_item.h"
#include "guikit/ctrl_group_item.h"
#include "guikit/default_event_listener.h"
#include "guikit/fader.h"
#include "guikit/font_interface.h"
#include "guikit/knob.h"
#include "guikit/menu_nodes.h"
#include "guikit/pic_data_interface.h"
#include "guikit/push_button.h"
#include "guikit/sp_tree_node.h"
#include "guikit/text_box.h"
#include "guikit/window_interface.h"

namespace scene_test {

// The scene's controls and where a test clicks them, in editor pixels.
struct SceneLayout {
  static constexpr int32_t kWidth = 609;
  static constexpr int32_t kHeight = 282;
  static constexpr guikit::Point kKnobA{73, 70};      // centre of the first knob (master panel)
  static constexpr guikit::Point kKnobB{204, 110};    // centre of the second knob (band 1)
  static constexpr guikit::Point kFader{160, 18};     // the fader's zero point (top panel)
  static constexpr int32_t kFaderTravel = 437;
  static constexpr guikit::Point kFlipFlop{50, 150};  // top-left corner of the switch (17 x 17)
  static constexpr guikit::Rect kTextBox{380, 250, 580, 268};
  static constexpr guikit::Point kMenuButton{30, 250};  // top-left corner of the button (57 x 14)
};

class SkinTestScene;

// Remembers what the pop-up menu chose.
class SceneMenuListener : public guikit::MenuListenerInterface {
 public:
  explicit SceneMenuListener(SkinTestScene& scene) : scene_(scene) {}
  void on_select() override;
  void set_item(guikit::MenuItem* item) override { item_ = item; }
  guikit::MenuItem* get_item() const override { return item_; }

 private:
  SkinTestScene& scene_;
  guikit::MenuItem* item_ = nullptr;
};

// The push button's listener: a press asks the window for the scene's menu.
class MenuButtonListener : public guikit::DefaultEventListener {
 public:
  explicit MenuButtonListener(SkinTestScene& scene) : scene_(scene) {}
  void on_event(int32_t code, int32_t argument) override;

 private:
  SkinTestScene& scene_;
};

class SkinTestScene {
 public:
  // Throws std::runtime_error when a skin picture or the font is missing.
  SkinTestScene();
  SkinTestScene(const SkinTestScene&) = delete;
  SkinTestScene& operator=(const SkinTestScene&) = delete;
  ~SkinTestScene();

  // Hangs both trees under the window, gives it the editor size and shows them.
  void attach(guikit::WindowInterface& window);
  // Hides the trees and stops every control (before the window goes away).
  void detach();

  // The same state on any window: values of the two knobs, the fader and the
  // flip-flop, and the text, set without listeners' vetoes (origin: synchronisation).
  void set_state(double knob_a, double knob_b, double fader, double flip_flop, const std::string& text);

  guikit::Knob& knob_a() { return knob_a_; }
  guikit::Knob& knob_b() { return knob_b_; }
  guikit::Fader& fader() { return fader_; }
  guikit::FlipFlop& flip_flop() { return flip_flop_; }
  guikit::TextBox& text_box() { return text_box_; }
  guikit::PushButton& menu_button() { return menu_button_; }

  // The pop-up menu: "Low", "Mid", "High" (checked), a labelled delimiter
  // "Modes", a greyed "Locked", a plain delimiter, and a sub-menu "More" with
  // "Alpha" and "Beta".
  guikit::MenuList& menu() { return menu_root_; }
  guikit::MenuItem& item(const std::string& label);
  // The label of every item chosen so far, in order.
  const std::vector<std::string>& get_chosen() const { return chosen_; }
  int get_menu_requests() const { return menu_requests_; }
  // The answer of the last menu request the button sent.
  int32_t get_last_menu_answer() const { return last_menu_answer_; }

 private:
  friend class SceneMenuListener;
  friend class MenuButtonListener;

  guikit::PicDataInterface* load(const std::string& name);
  void build_backgrounds();
  void build_controls();
  void build_menu();
  void place(guikit::ControlInterface& control, guikit::Point offset, guikit::Rect box);

  std::vector<std::unique_ptr<guikit::PicDataInterface>> pictures_;
  std::unique_ptr<guikit::FontInterface> font_;

  // Backgrounds: a column of the upper part (master panel | top panel over the
  // four bands) and the lower row (edit, presets, info).
  guikit::BackgroundSplit bg_root_{false};
  guikit::BackgroundSplit bg_upper_{true};
  guikit::BackgroundSplit bg_right_{false};
  guikit::BackgroundSplit bg_bands_{true};
  guikit::BackgroundSplit bg_lower_{true};
  std::vector<std::unique_ptr<guikit::BackgroundItem>> bg_items_;

  guikit::CtrlGroupItem controls_;
  guikit::Knob knob_a_;
  guikit::Knob knob_b_;
  guikit::Fader fader_{false};
  guikit::FlipFlop flip_flop_;
  guikit::TextBox text_box_;
  guikit::PushButton menu_button_;
  MenuButtonListener button_listener_{*this};

  guikit::MenuList menu_root_;
  guikit::MenuList sub_menu_{"More"};
  std::vector<std::unique_ptr<guikit::MenuItem>> items_;
  std::vector<std::unique_ptr<guikit::MenuDelimiter>> delimiters_;
  std::vector<std::unique_ptr<SceneMenuListener>> menu_listeners_;
  std::vector<std::string> chosen_;
  int menu_requests_ = 0;
  int32_t last_menu_answer_ = 0;
  guikit::WindowInterface* window_ = nullptr;
};

}  // namespace scene_test

#include "support/skin_test_scene.h"

#include <cstdio>
#include <stdexcept>

#include "guikit/font_factory.h"
#include "guikit/messages.h"
#include "guikit/pic_data_factory.h"

namespace scene_test {

using guikit::Picture;
using guikit::Point;
using guikit::Rect;

namespace {

// Where the skin's pictures sit relative to their control (the skin's anchors).
constexpr Point kKnobFrameAnchor{-15, -15};
constexpr Point kKnobBackAnchor{-19, -19};
constexpr Point kFaderAnchor{-4, -3};
constexpr int kKnobFrames = 97;
// Frame i of the knob strip points 0.625 + i * (-0.75773197 / 97) turns.
constexpr double kKnobFrame0Turns = 0.625;
constexpr double kKnobTurnsCovered = -0.75773197;

struct BackgroundPlace {
  const char* name;
  int32_t extent;
};

}  // namespace

void SceneMenuListener::on_select() {
  if (item_) scene_.chosen_.push_back(item_->get_label());
}

void MenuButtonListener::on_event(int32_t code, int32_t) {
  if (code != 0) return;
  ++scene_.menu_requests_;
  guikit::MenuRequest request(&scene_.menu_root_);
  scene_.last_menu_answer_ = scene_.menu_button_.process_message(request);
}

SkinTestScene::SkinTestScene() {
  font_ = guikit::FontFactory::instance().create_font("font_04");
  if (!font_) throw std::runtime_error("scene_test::SkinTestScene() : The skin font is missing.");
  build_backgrounds();
  build_controls();
  build_menu();
}

SkinTestScene::~SkinTestScene() { detach(); }

guikit::PicDataInterface* SkinTestScene::load(const std::string& name) {
  std::unique_ptr<guikit::PicDataInterface> pic = guikit::PicDataFactory::instance().create_picture(name.c_str());
  if (!pic) throw std::runtime_error("scene_test::SkinTestScene() : Missing skin picture " + name + ".");
  pictures_.push_back(std::move(pic));
  return pictures_.back().get();
}

void SkinTestScene::build_backgrounds() {
  auto add_items = [this](guikit::BackgroundSplit& split, const std::vector<BackgroundPlace>& places) {
    for (const BackgroundPlace& p : places) {
      bg_items_.push_back(std::make_unique<guikit::BackgroundItem>(load(p.name)));
      split.add_child(bg_items_.back().get(), p.extent);
    }
  };
  add_items(bg_bands_, {{"bkg_24_band1", 115}, {"bkg_24_band2", 114}, {"bkg_24_band3", 114}, {"bkg_24_band4", 119}});
  bg_items_.push_back(std::make_unique<guikit::BackgroundItem>(load("bkg_24_top")));
  bg_right_.add_child(bg_items_.back().get(), 36);
  bg_right_.add_child(&bg_bands_, 193);
  bg_items_.push_back(std::make_unique<guikit::BackgroundItem>(load("bkg_24_master")));
  bg_upper_.add_child(bg_items_.back().get(), 147);
  bg_upper_.add_child(&bg_right_, 462);
  add_items(bg_lower_, {{"bkg_24_edit", 117}, {"bkg_24_presets", 239}, {"bkg_24_info", 253}});
  bg_root_.add_child(&bg_upper_, 229);
  bg_root_.add_child(&bg_lower_, 53);
  bg_root_.set_position(Point{0, 0});
}

void SkinTestScene::place(guikit::ControlInterface& control, Point offset, Rect box) {
  control.set_offset(offset);
  control.set_bounding_box(box);
  control.set_placed(true);
  controls_.add_control(&control);
}

void SkinTestScene::build_controls() {
  std::vector<Picture> knob_frames;
  for (int i = 0; i < kKnobFrames; ++i) {
    char name[16];
    std::snprintf(name, sizeof name, "kn_26_%02d", i);
    knob_frames.emplace_back(load(name), kKnobFrameAnchor);
  }
  guikit::PicDataInterface* knob_back = load("kn_26_p");
  guikit::PicDataInterface* knob_active = load("kn_26_s");
  for (guikit::Knob* knob : {&knob_a_, &knob_b_}) {
    knob->set_frames(knob_frames, kKnobFrame0Turns, kKnobTurnsCovered);
    knob->set_background(Picture(knob_back, kKnobBackAnchor));
    knob->set_active_picture(Picture(knob_active, kKnobBackAnchor));
    knob->set_drag_range(100.0);
  }
  place(knob_a_, SceneLayout::kKnobA, Rect{-19, -19, 20, 20});
  place(knob_b_, SceneLayout::kKnobB, Rect{-19, -19, 20, 20});

  fader_.set_travel_length(SceneLayout::kFaderTravel);
  fader_.set_background(Picture(load("fd_09_s"), kFaderAnchor));
  fader_.set_cap(Picture(load("fd_09"), kFaderAnchor));
  place(fader_, SceneLayout::kFader, Rect{-4, -3, SceneLayout::kFaderTravel + 5, 4});

  std::vector<Picture> switch_frames;
  for (int i = 0; i < 5; ++i) switch_frames.emplace_back(load("ff_04_" + std::to_string(i)), Point{0, 0});
  flip_flop_.set_frames(switch_frames);
  place(flip_flop_, SceneLayout::kFlipFlop, Rect{0, 0, 17, 17});

  const Rect& t = SceneLayout::kTextBox;
  text_box_.set_font(font_.get());
  text_box_.set_colour(0x00F0E0C0);
  text_box_.set_margins(Rect{3, 1, 3, 1});
  text_box_.set_editable(true);
  text_box_.set_text("Brakmorph");
  place(text_box_, Point{t.left, t.top}, Rect{0, 0, t.width(), t.height()});

  menu_button_.set_frames({Picture(load("pb_53_0"), Point{0, 0}), Picture(load("pb_53_1"), Point{0, 0})});
  menu_button_.set_listener(&button_listener_);
  place(menu_button_, SceneLayout::kMenuButton, Rect{0, 0, 57, 14});

  controls_.set_position(Point{0, 0});
}

void SkinTestScene::build_menu() {
  auto add_item = [this](guikit::MenuList& list, const char* label) -> guikit::MenuItem& {
    items_.push_back(std::make_unique<guikit::MenuItem>(label));
    menu_listeners_.push_back(std::make_unique<SceneMenuListener>(*this));
    items_.back()->set_listener(menu_listeners_.back().get());
    list.add_child(items_.back().get());
    return *items_.back();
  };
  auto add_delimiter = [this](guikit::MenuList& list, const char* label) {
    delimiters_.push_back(std::make_unique<guikit::MenuDelimiter>(label));
    list.add_child(delimiters_.back().get());
  };
  add_item(menu_root_, "Low");
  add_item(menu_root_, "Mid");
  add_item(menu_root_, "High").set_checked(true);
  add_delimiter(menu_root_, "Modes");
  add_item(menu_root_, "Locked").set_grayed(true);
  add_delimiter(menu_root_, "");
  add_item(sub_menu_, "Alpha");
  add_item(sub_menu_, "Beta");
  menu_root_.add_child(&sub_menu_);
}

guikit::MenuItem& SkinTestScene::item(const std::string& label) {
  for (auto& i : items_) {
    if (i->get_label() == label) return *i;
  }
  throw std::runtime_error("scene_test::SkinTestScene::item() : No such item.");
}

void SkinTestScene::attach(guikit::WindowInterface& window) {
  detach();
  window_ = &window;
  bg_root_.set_parent(&window);
  controls_.set_parent(&window);
  window.set_roots(&bg_root_, &controls_);
  window.set_editor_size(guikit::Size{SceneLayout::kWidth, SceneLayout::kHeight});
  window.set_window_size(guikit::Size{SceneLayout::kWidth, SceneLayout::kHeight});
  guikit::ShowObject show(true);
  bg_root_.process_message(show);
  controls_.process_message(show);
}

void SkinTestScene::detach() {
  if (!window_) return;
  guikit::ShowObject hide(false);
  controls_.process_message(hide);
  bg_root_.process_message(hide);
  window_->set_roots(nullptr, nullptr);
  bg_root_.set_parent(nullptr);
  controls_.set_parent(nullptr);
  window_ = nullptr;
}

void SkinTestScene::set_state(double knob_a, double knob_b, double fader, double flip_flop, const std::string& text) {
  knob_a_.set_value(knob_a, guikit::kOriginSync);
  knob_b_.set_value(knob_b, guikit::kOriginSync);
  fader_.set_value(fader, guikit::kOriginSync);
  flip_flop_.set_value(flip_flop, guikit::kOriginSync);
  text_box_.set_text(text);
  text_box_.request_redraw();
}

}  // namespace scene_test

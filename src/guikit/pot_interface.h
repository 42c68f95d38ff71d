#pragma once

#include <cstdint>
#include <vector>

#include "guikit/control_interface.h"
#include "guikit/pot_behaviour.h"

namespace guikit {

// Knobs and faders: a control driven by a PotBehaviour. The gesture (click,
// ticks, button up, loss of capture) is the same for both; each kind adds its
// geometry and drawing.
class PotInterface : public ControlInterface {
 public:
  enum PotFlags : uint32_t { kFlagBackground = 2, kFlagActive = 4, kFlagHighlight = 64 };

  PotInterface() : behaviour_(*this) {}
  // A pot that goes away gives back its timer and any capture; its listeners
  // may be gone already and hear nothing.
  ~PotInterface() override {
    listeners_.clear();
    behaviour_.stop();
  }

  virtual void set_background(const Picture& p) { background_ = p; flags_ |= kFlagBackground; }
  virtual void clear_background() { background_.clear(); flags_ &= ~static_cast<uint32_t>(kFlagBackground); }
  virtual void set_active_picture(const Picture& p) { active_picture_ = p; flags_ |= kFlagActive; }
  virtual void clear_active_picture() { active_picture_.clear(); flags_ &= ~static_cast<uint32_t>(kFlagActive); }
  virtual void set_highlight_picture(const Picture& p) { highlight_picture_ = p; flags_ |= kFlagHighlight; }
  virtual void clear_highlight_picture() { highlight_picture_.clear(); flags_ &= ~static_cast<uint32_t>(kFlagHighlight); }
  // Not owned.
  virtual void set_magnets(const std::vector<double>* magnets) { behaviour_.set_magnets(magnets); }
  virtual void clear_magnets() { behaviour_.set_magnets(nullptr); }
  virtual void set_opacity(float opacity) {
    opacity_ = opacity;
    invalidate_self();
  }

  void stop() override;
  void set_active(bool) override { invalidate_self(); }
  void on_highlight() override { invalidate_self(); }
  int32_t on_notify(Notify& msg) override;
  int32_t on_mouse_capture_lost(MouseCaptureLost& msg) override;

  void set_flags(uint32_t flags) { flags_ = flags; }
  uint32_t get_flags() const { return flags_; }
  void set_secondary_factor(float factor) { secondary_factor_ = factor; }
  void set_spin_speed(double speed) { spin_speed_ = speed; }
  const PotBehaviour& behaviour() const { return behaviour_; }
  bool is_released() const { return released_; }
  bool is_button_held() const { return button_held_; }

 protected:
  // Ends the motion without ending the click gesture that may be starting.
  void halt();
  // Button up: the end of the drag; the timer finishes the glide or the spin.
  void button_released();
  // Sends a value computed by the behaviour; a refused change stops the pot.
  bool send_value(double value, int32_t origin);
  void draw_layer(Redraw& msg, const Picture& p, double x, double y) const;

  PotBehaviour behaviour_;
  Picture background_;
  Picture active_picture_;
  Picture highlight_picture_;
  uint32_t flags_ = 0;
  float opacity_ = 1.0f;
  float secondary_factor_ = 0.0f;
  double spin_speed_ = 1.0;
  bool released_ = false;
  bool button_held_ = false;
  Point click_;
};

}  // namespace guikit

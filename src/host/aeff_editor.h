#pragma once

#include <cstdint>

#include "host/vst2_abi.h"

class AudioEffect;

// Base of an editor that the host shows in a window of its own.
class AEffEditor {
 public:
  explicit AEffEditor(AudioEffect* effect) : effect_(effect) {}
  virtual ~AEffEditor() = default;
  virtual bool getRect(ERect** rect) { *rect = nullptr; return false; }
  virtual bool open(void* parent) { system_window_ = parent; return false; }
  virtual void close() { system_window_ = nullptr; }
  virtual void idle() {}
  virtual void update() {}
  virtual void postUpdate() { update_flag_ = 1; }
  virtual int32_t onKeyDown(int32_t key, int32_t virtual_key, int32_t modifier) { return -1; }
  virtual int32_t onKeyUp(int32_t key, int32_t virtual_key, int32_t modifier) { return -1; }
  virtual int32_t setKnobMode(int32_t mode) { return 0; }
  virtual bool onWheel(float distance) { return false; }

 protected:
  AudioEffect* effect_;
  void* system_window_ = nullptr;
  int update_flag_ = 0;
};

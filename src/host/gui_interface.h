#pragma once

namespace guikit {
class WindowInterface;
}

namespace plugcore {

class DspInterface;
class HostGuiInterface;

// The editor object as the core and the editor bridge see it.
class GuiInterface {
 public:
  virtual ~GuiInterface() = default;
  virtual void init() = 0;
  virtual void set_default_state() = 0;
  virtual void close() = 0;
  virtual HostGuiInterface* get_host_gui() = 0;
  virtual void set_host_gui(HostGuiInterface* host_gui) = 0;
  virtual DspInterface* get_dsp() = 0;
  virtual void set_dsp(DspInterface* dsp) = 0;
  virtual void notify_param_change(int index, float norm, int priority) = 0;
  virtual void set_window(guikit::WindowInterface* window) = 0;
  virtual void get_size(int& width, int& height) = 0;
  virtual void get_resizable_size(int& width, int& height) = 0;
  virtual int open_window(void* parent) = 0;
  virtual void close_window() = 0;
  virtual void set_tempo(float bpm) = 0;
  // Shows marker 0 (none), 1 or 2 beside the control bound to the parameter.
  virtual void set_control_marker(int index, int marker) = 0;
};

}  // namespace plugcore

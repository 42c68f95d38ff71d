#pragma once

#include <cstdint>

#include "guikit/default_event_listener.h"

namespace plugcore {

class HostGuiInterface;
class NormalizedParamInterface;

// Binds one control to one parameter index. The control's protocol becomes the
// parameter commands of the host-GUI adapter: the origin code of a change is the
// writer's priority, so the arbitration of the core decides whether the control
// may move. A change pushed from outside (set_value) never writes the parameter
// again, which is what keeps the editor from echoing host or MIDI writes.
class ListenerBase : public guikit::DefaultEventListener {
 public:
  // Answers the adapter's can_set_param(index, origin); true while unbound and
  // during refresh.
  bool can_change(int32_t origin) override;
  // lock_param(index, origin): a held mouse button keeps the parameter.
  void hold_change(int32_t origin) override;
  // release_param(index, origin).
  void end_change(int32_t origin) override;
  // set_param_automated(index, float(value), origin); the value passes unchanged.
  double filter_user_value(double value, int32_t origin) override;
  // A change from outside: no write, the value passes unchanged.
  double filter_set_value(double value, int32_t origin) override { return value; }

  HostGuiInterface* get_host_gui() const { return host_gui_; }
  void set_host_gui(HostGuiInterface* host_gui) { host_gui_ = host_gui; }
  // The parameter is not owned; index -1 unbinds.
  void bind_param(int32_t index, NormalizedParamInterface* param);
  int32_t get_param_index() const { return index_; }
  NormalizedParamInterface* use_param() const { return param_; }

  // Pushes the parameter's normalised value into the control as a change from
  // outside with the synchronisation origin (1). It writes nothing, so it is not
  // arbitrated: a bare set_value(v, 1) would be refused for 0.5 s after any
  // stronger write and leave the control stale. Answers false when there is no
  // control or parameter, or when another listener of the control refused.
  bool refresh();

 private:
  bool is_bound() const { return host_gui_ != nullptr && index_ >= 0; }

  HostGuiInterface* host_gui_ = nullptr;
  int32_t index_ = -1;
  NormalizedParamInterface* param_ = nullptr;
  bool refreshing_ = false;
};

}  // namespace plugcore

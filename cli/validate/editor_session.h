// A plug-in's editor opened the way a host opens it: the size from
// effEditGetRect, effEditOpen with the parent's native handle, effEditIdle
// from the host's loop, effEditClose when done. Shared by the validator and
// the editor commands.
#pragma once

#include "cli/editor_parent.h"
#include "cli/hosted_plugin.h"

namespace plugcore {

struct EditorSize {
  int width = 0;
  int height = 0;
};

// The editor's size as effEditGetRect reports it. Throws std::runtime_error
// when the plug-in declares no editor or answers no usable rectangle.
EditorSize query_editor_size(HostedPlugin& plugin);

class EditorSession {
 public:
  // Opens the editor in parent; throws std::runtime_error when it refuses.
  EditorSession(HostedPlugin& plugin, EditorParentInterface& parent);
  ~EditorSession();  // effEditClose, then the parent's pending events
  EditorSession(const EditorSession&) = delete;
  EditorSession& operator=(const EditorSession&) = delete;

  // One effEditIdle and the parent's events.
  void idle();
  // Idles every period_ms for seconds (0: without end) or until the parent is closed.
  void run_for(double seconds, int period_ms);

 private:
  HostedPlugin& plugin_;
  EditorParentInterface& parent_;
};

}  // namespace plugcore

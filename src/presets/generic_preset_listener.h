#pragma once

#include "guikit/default_event_listener.h"

namespace plugcore {

class PresetListenerRefList;

// Base of every preset listener: a control listener that knows the hub.
class GenericPresetListener : public virtual guikit::DefaultEventListener {
 public:
  void set_hub(PresetListenerRefList* hub) { hub_ = hub; }
  PresetListenerRefList* use_hub() const { return hub_; }

 protected:
  PresetListenerRefList* hub_ = nullptr;
};

}  // namespace plugcore

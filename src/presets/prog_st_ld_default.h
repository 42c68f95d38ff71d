#pragma once

#include "presets/prog_st_ld_interface.h"

namespace plugcore {

// Continuous parameters glide on the straight line between the two programs;
// stepped ones (on/off, solo, curve selectors) take the target at once.
class ProgStLdDefault : public ProgStLdInterface {
 public:
  void mix(ProgramSlot& out, const ProgramSlot& from, const ProgramSlot& to, double position) override;
};

}  // namespace plugcore

#pragma once

#include "params/normalized_param_interface.h"

namespace plugcore {

// Marker kinds the registry sorts parameters by: ones a MIDI modulation may
// drive, and ones several modulation sources may drive. Both stay abstract.
class MidiModParam : public NormalizedParamInterface {};

class MultiModParam : public NormalizedParamInterface {};

}  // namespace plugcore

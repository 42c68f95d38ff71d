#include "presets/factory_programs.h"

#include <stdexcept>
#include <string>

namespace plugcore {

namespace {

const char* const kProgramNames[kNbrFactoryPrograms] = {
    "Light distortion", "Distortion + Compression", "Distortion + Expansion", "Lipo-flatulence",
    "Gravel Drive",     "Mikey Duck",               "Fuzzy Bass",             "Blues Breaker",
};

// One row per parameter index, one column per program: reads like the sound
// designer's sheet, where a row shows how one control varies across programs.
const float kProgramValues[kNbrFactoryValues][kNbrFactoryPrograms] = {
    {0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f},  // 0 Stereo Boost
    {0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f},  // 1 Oversampling
    {0.5000f, 0.5000f, 0.5000f, 0.5000f, 0.5000f, 0.5000f, 0.0f, 0.1249f},  // 2 Tone Freq
    {0.0f, 0.0f, 0.0f, 0.0f, 0.1000f, 0.2034f, 1.0f, 0.6289f},  // 3 Tone Shape
    {0.5000f, 0.5000f, 0.5000f, 0.5000f, 0.5000f, 0.5000f, 0.5000f, 0.5000f},  // 4 Stereo Phase
    {0.0f, 0.0f, 0.0f, 0.0f, 0.3200f, 0.0f, 0.0f, 0.0f},  // 5 Fdbk Amnt
    {0.5078f, 0.5078f, 0.5078f, 0.5078f, 0.8384f, 0.5078f, 0.5078f, 0.5078f},  // 6 Fdbk Freq
    {0.8103f, 0.8103f, 0.7836f, 0.6782f, 0.8103f, 0.6782f, 0.8371f, 0.5902f},  // 7 Master Vol
    {0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f},  // 8 Reserved
    {1.0f, 1.0f, 1.0f, 0.2907f, 1.0f, 0.5644f, 0.2929f, 0.2348f},  // 9 B1 Upper Freq
    {1.0f, 1.0f, 1.0f, 0.4907f, 1.0f, 0.7695f, 0.5650f, 0.7690f},  // 10 B2 Upper Freq
    {1.0f, 1.0f, 1.0f, 0.7966f, 1.0f, 1.0f, 1.0f, 1.0f},  // 11 B3 Upper Freq
    {0.5001f, 0.0f, 1.0f, 0.6173f, 0.3983f, 0.2147f, 0.5001f, 0.0039f},  // 12 B1 Character
    {0.5001f, 0.9999f, 0.7811f, 1.0f, 0.2000f, 1.0f, 0.5001f, 0.0234f},  // 13 B1 Intensity
    {0.6667f, 0.6667f, 0.6667f, 0.5333f, 0.6667f, 0.4834f, 1.0f, 0.7734f},  // 14 B1 Dist Amnt
    {0.0f, 0.0f, 0.0f, 0.0f, 0.8389f, 0.6500f, 0.4167f, 0.0f},  // 15 B1 Dist Type
    {0.5187f, 0.5187f, 0.5187f, 0.4518f, 0.4518f, 0.4521f, 0.3469f, 0.5187f},  // 16 B1 Volume
    {0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f},  // 17 B1 Solo
    {0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f},  // 18 Reserved
    {0.5001f, 0.5001f, 0.5001f, 0.0f, 0.5001f, 0.9999f, 0.5001f, 0.1327f},  // 19 B2 Character
    {0.5001f, 0.5001f, 0.5001f, 0.8047f, 0.5001f, 1.0f, 0.5001f, 1.0f},  // 20 B2 Intensity
    {0.3345f, 0.3345f, 0.3345f, 0.4833f, 0.3345f, 0.4457f, 0.3333f, 0.6714f},  // 21 B2 Dist Amnt
    {0.0f, 0.0f, 0.0f, 0.3846f, 0.0f, 0.9444f, 0.0f, 0.9167f},  // 22 B2 Dist Type
    {0.5193f, 0.5193f, 0.5193f, 0.5878f, 0.5193f, 0.5187f, 0.5187f, 0.5187f},  // 23 B2 Volume
    {0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f},  // 24 B2 Solo
    {0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f},  // 25 Reserved
    {0.5001f, 0.5001f, 0.5001f, 0.9921f, 0.5001f, 0.0f, 0.9999f, 0.5039f},  // 26 B3 Character
    {0.5001f, 0.5001f, 0.5001f, 0.4376f, 0.5001f, 1.0f, 1.0f, 1.0f},  // 27 B3 Intensity
    {0.3345f, 0.3345f, 0.3345f, 0.6333f, 0.3345f, 0.2333f, 0.7333f, 1.0f},  // 28 B3 Dist Amnt
    {0.0f, 0.0f, 0.0f, 0.9231f, 0.0f, 0.4944f, 0.0f, 0.0f},  // 29 B3 Dist Type
    {0.5193f, 0.5193f, 0.5193f, 0.5193f, 0.5193f, 0.6585f, 0.2712f, 0.4367f},  // 30 B3 Volume
    {0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f},  // 31 B3 Solo
    {0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f},  // 32 Reserved
    {0.5001f, 0.5001f, 0.5001f, 0.5001f, 0.5001f, 0.5001f, 0.5001f, 0.0f},  // 33 B4 Character
    {0.5001f, 0.5001f, 0.5001f, 0.5001f, 0.5001f, 0.5001f, 0.5001f, 1.0f},  // 34 B4 Intensity
    {0.3345f, 0.3345f, 0.3345f, 1.0f, 0.3345f, 0.3345f, 0.3339f, 0.5737f},  // 35 B4 Dist Amnt
    {0.0f, 0.0f, 0.0f, 0.1667f, 0.0f, 0.0f, 0.0f, 0.0f},  // 36 B4 Dist Type
    {0.5193f, 0.5193f, 0.5193f, 0.1494f, 0.5193f, 0.5193f, 0.5187f, 0.5187f},  // 37 B4 Volume
    {0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f},  // 38 B4 Solo
    {0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f},  // 39 Reserved
};

void check_program(int program, const char* operation) {
  if (program < 0 || program >= kNbrFactoryPrograms) {
    throw std::runtime_error(std::string("plugcore::") + operation + "() : Invalid program.");
  }
}

}  // namespace

const char* factory_program_name(int program) {
  check_program(program, "factory_program_name");
  return kProgramNames[program];
}

float factory_program_value(int program, int index) {
  check_program(program, "factory_program_value");
  if (index < 0 || index >= kNbrFactoryValues) {
    throw std::runtime_error("plugcore::factory_program_value() : Invalid index.");
  }
  return kProgramValues[index][program];
}

void make_factory_bank(BankManager& bank) {
  bank.resize(kNbrFactoryPrograms);
  for (int program = 0; program < kNbrFactoryPrograms; ++program) {
    ProgramSlot slot;
    slot.set_name(kProgramNames[program]);
    slot.set_tag(0);
    slot.set_extra_size(0);
    slot.set_nbr_values(kNbrFactoryValues);
    for (int index = 0; index < kNbrFactoryValues; ++index) {
      slot.set_value(index, kProgramValues[index][program]);
    }
    bank.set_program(program, slot);
  }
}

}  // namespace plugcore

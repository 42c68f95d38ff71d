#include <gtest/gtest.h>

#include <cmath>
#include <set>
#include <string>

#include "dsp/param_band.h"
#include "dsp/param_master_vol.h"
#include "presets/factory_programs.h"

using namespace plugcore;

namespace {

// Band gain in dB for a normalised Volume value, computed here in double.
double volume_db(float n) { return 20.0 * std::log10(10.0 * (std::pow(100.0, n) - 1.0) / 99.0); }

}  // namespace

TEST(FactoryPrograms, EightNamedProgramsOfFortyValues) {
  BankManager bank;
  bank.resize(3);
  make_factory_bank(bank);
  ASSERT_EQ(bank.get_nbr_programs(), kNbrFactoryPrograms);
  std::set<std::string> names;
  for (int p = 0; p < kNbrFactoryPrograms; ++p) {
    const ProgramSlot& slot = bank.use_program(p);
    EXPECT_EQ(slot.get_nbr_values(), 40);
    EXPECT_EQ(slot.get_extra_size(), 0);
    EXPECT_EQ(slot.get_tag(), 0u);
    EXPECT_EQ(slot.get_serialized_size(), 236);
    EXPECT_EQ(slot.get_name(), factory_program_name(p));
    EXPECT_FALSE(slot.get_name().empty());
    EXPECT_LE(slot.get_name().size(), 63u);
    EXPECT_NE(slot.get_name(), "Default");
    names.insert(slot.get_name());
    for (int i = 0; i < 40; ++i) {
      const float v = slot.get_value(i);
      EXPECT_TRUE(v >= 0.0f && v <= 1.0f) << p << " " << i;
      EXPECT_EQ(v, factory_program_value(p, i));
    }
  }
  EXPECT_EQ(names.size(), 8u);
  EXPECT_EQ(std::string(factory_program_name(0)), "Light distortion");
  EXPECT_EQ(std::string(factory_program_name(7)), "Blues Breaker");
  EXPECT_THROW(factory_program_name(8), std::runtime_error);
  EXPECT_THROW(factory_program_value(0, 40), std::runtime_error);
}

TEST(FactoryPrograms, ValuesMeanWhatTheSoundDesignerSet) {
  // Switches, reserved slots and solos are off everywhere.
  for (int p = 0; p < kNbrFactoryPrograms; ++p) {
    for (int i : {0, 1, 8, 17, 18, 24, 25, 31, 32, 38, 39}) EXPECT_EQ(factory_program_value(p, i), 0.0f) << p << " " << i;
    // Every Dist Type value selects one of the curves.
    ParamDistoType type;
    for (int band = 0; band < 4; ++band) {
      const double curve = type.conv_norm_to_value(factory_program_value(p, 15 + 7 * band));
      EXPECT_TRUE(curve >= 0.0 && curve <= 12.0) << p << " " << band;
    }
  }
  // The plain programs leave band 1 at unity gain and drive it by +20 dB.
  ParamDistoAmount amount;
  for (int p : {0, 1, 2}) {
    EXPECT_NEAR(volume_db(factory_program_value(p, 16)), 0.0, 0.05);
    EXPECT_NEAR(20.0 * std::log10(amount.conv_norm_to_value(factory_program_value(p, 14))), 20.0, 0.01);
  }
  // Program 2 is the expander: full character on band 1.
  EXPECT_EQ(factory_program_value(2, 12), 1.0f);
  EXPECT_EQ(factory_program_value(1, 12), 0.0f);
}

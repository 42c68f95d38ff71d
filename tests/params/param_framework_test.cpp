#include <gtest/gtest.h>

#include <cmath>
#include <cstring>
#include <memory>
#include <stdexcept>
#include <string>

#include "params/mod_param_kinds.h"
#include "params/normalized_param_interface.h"
#include "params/param_numbered.h"
#include "params/param_reserved.h"
#include "params/plugin_internal.h"
#include "params/text_copy.h"

using plugcore::copy_text;

namespace {

// A parameter with a mapping that is not the identity (v = 10 n), counting
// the hooks so their order and number can be checked.
class TenTimesParam : public plugcore::NormalizedParamInterface {
 public:
  void get_name(char* text, int capacity) const override { copy_text(text, "Ten", capacity); }
  void get_unit(char* text, int capacity) const override { copy_text(text, "", capacity); }
  void apply() override { log += "a"; }
  void update() override { log += "u"; }
  double conv_norm_to_value(float norm) const override { return 10.0 * norm; }
  float conv_value_to_norm(double value) const override { return static_cast<float>(value / 10.0); }
  void conv_value_to_text(char* text, int capacity, double) const override { copy_text(text, "", capacity); }
  double conv_text_to_value(const char*, bool&) const override { return 0.0; }
  int state() const { return state_; }
  std::string log;
};

class Numbered : public plugcore::ParamNumbered {
 public:
  explicit Numbered(const char* suffix) : suffix_(suffix) {}
  void get_name_prefix(char* text, int capacity) const override { copy_text(text, "B", capacity); }
  void get_name_suffix(char* text, int capacity) const override { copy_text(text, suffix_, capacity); }
  void get_unit(char* text, int capacity) const override { copy_text(text, "", capacity); }
  double conv_norm_to_value(float norm) const override { return norm; }
  float conv_value_to_norm(double value) const override { return static_cast<float>(value); }
  void conv_value_to_text(char* text, int capacity, double) const override { copy_text(text, "", capacity); }
  double conv_text_to_value(const char*, bool&) const override { return 0.0; }

 private:
  const char* suffix_;
};

class Recorder : public plugcore::NotifiedInterface {
 public:
  void notify(plugcore::NotifierInterface* notifier) override {
    last = notifier;
    ++count;
  }
  plugcore::NotifierInterface* last = nullptr;
  int count = 0;
};

class MidiModKind : public plugcore::MidiModParam {
 public:
  void get_name(char* text, int capacity) const override { copy_text(text, "M", capacity); }
  void get_unit(char* text, int capacity) const override { copy_text(text, "", capacity); }
  double conv_norm_to_value(float norm) const override { return norm; }
  float conv_value_to_norm(double value) const override { return static_cast<float>(value); }
  void conv_value_to_text(char* text, int capacity, double) const override { copy_text(text, "", capacity); }
  double conv_text_to_value(const char*, bool&) const override { return 0.0; }
};

class MultiModKind : public plugcore::MultiModParam {
 public:
  void get_name(char* text, int capacity) const override { copy_text(text, "X", capacity); }
  void get_unit(char* text, int capacity) const override { copy_text(text, "", capacity); }
  double conv_norm_to_value(float norm) const override { return norm; }
  float conv_value_to_norm(double value) const override { return static_cast<float>(value); }
  void conv_value_to_text(char* text, int capacity, double) const override { copy_text(text, "", capacity); }
  double conv_text_to_value(const char*, bool&) const override { return 0.0; }
};

class Registry : public plugcore::PluginInternal {
 public:
  using plugcore::PluginInternal::add_input_group;
  using plugcore::PluginInternal::add_output_group;
};

}  // namespace

TEST(CopyText, BoundsAndTerminates) {
  char buffer[8];
  std::memset(buffer, 'x', sizeof(buffer));
  copy_text(buffer, "abcdefghij", 5);
  EXPECT_STREQ(buffer, "abcd");
  EXPECT_EQ(buffer[5], 'x');  // nothing written past the capacity

  copy_text(buffer, "ab", 8);
  EXPECT_STREQ(buffer, "ab");

  std::memset(buffer, 'x', sizeof(buffer));
  copy_text(buffer, "abc", 0);
  copy_text(buffer, "abc", -3);
  EXPECT_EQ(buffer[0], 'x');

  copy_text(buffer, "abc", 1);
  EXPECT_STREQ(buffer, "");
  EXPECT_EQ(buffer[1], 'x');

  copy_text(buffer, nullptr, 8);
  EXPECT_STREQ(buffer, "");
}

TEST(NormalizedParam, InitStoresDefaultThroughTheMapping) {
  TenTimesParam param;
  EXPECT_EQ(param.get_priority(), -1);
  param.init(4.0, 1);
  EXPECT_DOUBLE_EQ(param.get_value(), 4.0);
  EXPECT_FLOAT_EQ(param.get_norm(), 0.4f);
  EXPECT_EQ(param.get_priority(), 1);
  EXPECT_EQ(param.state(), 0);
  EXPECT_EQ(param.log, "");  // init runs no hooks
}

TEST(NormalizedParam, WritesKeepThePairAndRunHooksThenNotify) {
  TenTimesParam param;
  Recorder recorder;
  param.init(0.0, 0);
  param.set_norm_and_notify(0.25f);  // no notified object yet: must not crash
  EXPECT_DOUBLE_EQ(param.get_value(), 2.5);
  EXPECT_EQ(param.log, "au");

  param.set_notified(&recorder);
  param.set_norm_and_notify(0.75f);
  EXPECT_DOUBLE_EQ(param.get_value(), 7.5);
  EXPECT_FLOAT_EQ(param.get_norm(), 0.75f);
  EXPECT_EQ(recorder.count, 1);
  EXPECT_EQ(recorder.last, &param);

  param.set_value_and_notify(3.0);
  EXPECT_DOUBLE_EQ(param.get_value(), 3.0);
  EXPECT_FLOAT_EQ(param.get_norm(), 0.3f);
  EXPECT_EQ(param.log, "auauau");
  EXPECT_EQ(recorder.count, 2);
}

TEST(ParamNumbered, ComposesPrefixNumberSuffixWithinCapacity) {
  Numbered param(" Dist Type");
  EXPECT_EQ(param.get_number(), -1);
  param.init(0.0, 0, 3);
  EXPECT_EQ(param.get_number(), 3);
  char name[32];
  param.get_name(name, sizeof(name));
  EXPECT_STREQ(name, "B4 Dist Type");
  param.get_name(name, 3);
  EXPECT_STREQ(name, "B4");
  param.get_name(name, 2);
  EXPECT_STREQ(name, "B");
  param.get_name(name, 6);
  EXPECT_STREQ(name, "B4 Di");
  param.get_name(name, 13);
  EXPECT_STREQ(name, "B4 Dist Type");
  param.get_name(name, 12);
  EXPECT_STREQ(name, "B4 Dist Typ");

  Numbered wide(" Volume");
  wide.init(0.0, 0, 11);
  wide.get_name(name, sizeof(name));
  EXPECT_STREQ(name, "B12 Volume");
  wide.get_name(name, 3);
  EXPECT_STREQ(name, "B1");  // the number itself is cut too
}

TEST(ParamReserved, NameUnitAndIdentityMapping) {
  plugcore::ParamReserved param;
  char text[32];
  param.get_name(text, sizeof(text));
  EXPECT_STREQ(text, "Reserved");
  param.get_unit(text, sizeof(text));
  EXPECT_STREQ(text, "");
  EXPECT_EQ(param.get_type(), 0);
  for (int i = 0; i <= 16; ++i) {
    const float n = static_cast<float>(i) / 16.0f;
    EXPECT_EQ(param.conv_norm_to_value(n), static_cast<double>(n));
    EXPECT_EQ(param.conv_value_to_norm(n), n);
  }
}

TEST(ParamReserved, TextsCutToSixCharacters) {
  plugcore::ParamReserved param;
  char text[32];
  param.conv_value_to_text(text, sizeof(text), 0.25);
  EXPECT_STREQ(text, "0.2500");
  param.conv_value_to_text(text, sizeof(text), 9999.4);
  EXPECT_STREQ(text, "9999.4");
  param.conv_value_to_text(text, sizeof(text), 9999.5);  // outside the window: an integer
  EXPECT_STREQ(text, "10000");
  param.conv_value_to_text(text, sizeof(text), -1234.4);
  EXPECT_STREQ(text, "-1234");
  param.conv_value_to_text(text, sizeof(text), 1e300);  // saturates, stays bounded
  EXPECT_EQ(std::strlen(text), 6u);
  param.conv_value_to_text(text, 4, 0.25);
  EXPECT_STREQ(text, "0.2");
}

TEST(ParamReserved, ReadingClampsAndFlagsOnlyNumbers) {
  plugcore::ParamReserved param;
  bool ok = false;
  EXPECT_DOUBLE_EQ(param.conv_text_to_value("2", ok), 1.0);
  EXPECT_TRUE(ok);
  ok = false;
  EXPECT_DOUBLE_EQ(param.conv_text_to_value("-3", ok), 0.0);
  EXPECT_TRUE(ok);
  ok = false;
  EXPECT_DOUBLE_EQ(param.conv_text_to_value(" 0.375", ok), 0.375);
  EXPECT_TRUE(ok);
  ok = false;
  param.conv_text_to_value("abc", ok);
  EXPECT_FALSE(ok);
  param.conv_text_to_value("", ok);
  EXPECT_FALSE(ok);
}

TEST(PluginInternal, RegistersInOrderAndSortsModulationKinds) {
  Registry registry;
  auto first = std::make_shared<plugcore::ParamReserved>();
  auto midi = std::make_shared<MidiModKind>();
  auto multi = std::make_shared<MultiModKind>();
  registry.add_param(first);
  registry.add_param(midi);
  registry.add_param(multi);
  EXPECT_EQ(registry.get_nbr_registered_params(), 3);
  EXPECT_EQ(&registry.use_registered_param(0), first.get());
  EXPECT_EQ(&registry.use_registered_param(2), multi.get());
  EXPECT_EQ(registry.get_nbr_midi_mod_params(), 1);
  EXPECT_EQ(registry.get_nbr_multi_mod_params(), 1);
  EXPECT_THROW(registry.use_registered_param(3), std::runtime_error);
  EXPECT_THROW(registry.use_registered_param(-1), std::runtime_error);
  EXPECT_THROW(registry.add_param(nullptr), std::runtime_error);
  EXPECT_EQ(registry.use_inner_object(), nullptr);
}

TEST(PluginInternal, ExtraControlsAreCountedAndInitialised) {
  Registry registry;
  auto counter = std::make_shared<int>(0);
  registry.add_extra_control(std::make_shared<int>(1));
  registry.add_extra_control_with_init(counter, [counter] { ++*counter; });
  registry.add_aux_object_a(std::make_shared<int>(2));
  registry.add_aux_object_b(std::make_shared<int>(3));
  registry.add_aux_object_b(std::make_shared<int>(4));
  EXPECT_EQ(registry.get_nbr_extra_controls(), 2);
  EXPECT_EQ(registry.get_nbr_aux_objects_a(), 1);
  EXPECT_EQ(registry.get_nbr_aux_objects_b(), 2);
  registry.init_extra_controls();
  registry.init_extra_controls();
  EXPECT_EQ(*counter, 2);
}

TEST(PluginInternal, PinGroups) {
  Registry registry;
  registry.add_input_group({"Stereo In", {"Left In", "Right In"}});
  registry.add_output_group({"Stereo Out", {"Left Out", "Right Out"}});
  registry.add_output_group({"Mono Out", {"Out"}});
  EXPECT_EQ(registry.get_nbr_input_groups(), 1);
  ASSERT_EQ(registry.get_nbr_output_groups(), 2);
  EXPECT_EQ(registry.get_input_group(0).pins.at(1), "Right In");
  EXPECT_EQ(registry.get_output_group(1).name, "Mono Out");
  EXPECT_THROW(registry.get_input_group(1), std::runtime_error);
  EXPECT_THROW(registry.get_output_group(-1), std::runtime_error);
}

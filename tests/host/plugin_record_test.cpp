// The effect record and the host's questions: what a host sees when it loads us.
#include <gtest/gtest.h>

#include <cmath>
#include <cstring>
#include <string>

#include "host/instance_factory.h"
#include "support/mock_host.h"

namespace {

const char* const kExpectedNames[40] = {
    "Stereo Boost",   "Oversampling",  "Tone Freq",     "Tone Shape",    "Stereo Phase",  "Fdbk Amnt",
    "Fdbk Freq",      "Master Vol",    "Reserved",      "B1 Upper Freq", "B2 Upper Freq", "B3 Upper Freq",
    "B1 Character",   "B1 Intensity",  "B1 Dist Amnt",  "B1 Dist Type",  "B1 Volume",     "B1 Solo",
    "Reserved",       "B2 Character",  "B2 Intensity",  "B2 Dist Amnt",  "B2 Dist Type",  "B2 Volume",
    "B2 Solo",        "Reserved",      "B3 Character",  "B3 Intensity",  "B3 Dist Amnt",  "B3 Dist Type",
    "B3 Volume",      "B3 Solo",       "Reserved",      "B4 Character",  "B4 Intensity",  "B4 Dist Amnt",
    "B4 Dist Type",   "B4 Volume",     "B4 Solo",       "Reserved"};

class PluginRecord : public ::testing::Test {
 protected:
  void SetUp() override {
    effect_ = plugcore::create_instance(&MockHost::callback);
    ASSERT_NE(effect_, nullptr);
  }
  void TearDown() override {
    if (effect_ != nullptr) {
      close_instance(effect_);
    }
  }
  MockHost host_;
  AEffect* effect_ = nullptr;
};

TEST(PluginEntry, HostThatReportsNoVersionGetsNoInstance) {
  MockHost host;
  host.version = 0;
  EXPECT_EQ(plugcore::create_instance(&MockHost::callback), nullptr);
  EXPECT_EQ(plugcore::create_instance(nullptr), nullptr);
}

TEST_F(PluginRecord, DescribesTheEffect) {
  EXPECT_EQ(effect_->magic, 0x56737450);
  EXPECT_EQ(effect_->uniqueID, 0x56626D78);  // 'Vbmx'
  EXPECT_EQ(effect_->numParams, 40);
  EXPECT_EQ(effect_->numPrograms, 8);
  EXPECT_EQ(effect_->numInputs, 2);
  EXPECT_EQ(effect_->numOutputs, 2);
  EXPECT_NE(effect_->flags & effFlagsCanReplacing, 0);
  EXPECT_NE(effect_->flags & effFlagsCanMono, 0);
  EXPECT_EQ(effect_->flags & effFlagsProgramChunks, 0);
  EXPECT_EQ(effect_->flags & effFlagsIsSynth, 0);
  EXPECT_FLOAT_EQ(effect_->ioRatio, 1.0f);
  EXPECT_NE(effect_->processReplacing, nullptr);
}

TEST_F(PluginRecord, ParameterNamesInHostOrder) {
  for (int i = 0; i < 40; ++i) {
    EXPECT_EQ(param_text(effect_, effGetParamName, i), kExpectedNames[i]) << "index " << i;
  }
}

TEST_F(PluginRecord, OutOfRangeIndicesLeaveTextsAlone) {
  for (int index : {-1, 40, 1000}) {
    for (int opcode : {effGetParamName, effGetParamLabel, effGetParamDisplay}) {
      char text[32];
      std::memset(text, 'Q', sizeof(text));
      dispatch(effect_, opcode, index, 0, text);
      EXPECT_EQ(text[0], 'Q') << "opcode " << opcode << " index " << index;
    }
  }
  EXPECT_FLOAT_EQ(effect_->getParameter(effect_, 40), 0.0f);
  EXPECT_FLOAT_EQ(effect_->getParameter(effect_, -3), 0.0f);
  effect_->setParameter(effect_, 40, 0.5f);  // ignored, must not crash
  // A null text pointer is ignored as well.
  for (int opcode : {effGetParamName, effGetParamLabel, effGetParamDisplay, effGetProgramName, effGetEffectName,
                     effGetVendorString, effGetProductString, effCanDo, effGetProgramNameIndexed,
                     effGetInputProperties, effGetParameterProperties, effGetChunk, effSetChunk}) {
    dispatch(effect_, opcode, 0, 0, nullptr);
  }
}

TEST_F(PluginRecord, TextsStayWithinTheirCapacity) {
  // Host buffers for parameter texts are small; every text ends within 23 bytes.
  for (int i = 0; i < 40; ++i) {
    for (int opcode : {effGetParamName, effGetParamLabel, effGetParamDisplay}) {
      EXPECT_LT(param_text(effect_, opcode, i).size(), 23u);
    }
  }
  EXPECT_LT(param_text(effect_, effGetProgramName, 0).size(), 23u);
  EXPECT_LT(param_text(effect_, effGetEffectName, 0).size(), 31u);
}

TEST_F(PluginRecord, IdentityTexts) {
  EXPECT_EQ(param_text(effect_, effGetEffectName, 0), "Brakmorph");
  EXPECT_EQ(param_text(effect_, effGetVendorString, 0), "Velmora");
  EXPECT_EQ(param_text(effect_, effGetProductString, 0), "Velmora Brakmorph 1.24");
  EXPECT_EQ(dispatch(effect_, effGetVendorVersion), 0x124);
  EXPECT_EQ(dispatch(effect_, effGetVstVersion), 2200);
  EXPECT_EQ(dispatch(effect_, effIdentify), 0x4E764566);
  EXPECT_EQ(dispatch(effect_, effGetPlugCategory), kPlugCategEffect);
  EXPECT_EQ(dispatch(effect_, effGetNumProgramCategories), 1);
  EXPECT_EQ(dispatch(effect_, effGetCurrentMidiProgram), -1);
  EXPECT_EQ(dispatch(effect_, effGetTailSize), 0);
  EXPECT_EQ(dispatch(effect_, effKeysRequired), 0);
  EXPECT_EQ(dispatch(effect_, effConnectInput, 0, 1), 1);
  // The editor answers its size before it opens (opening is tested with the
  // editor, since it depends on a display), and key presses stay with the host.
  ERect* rect = nullptr;
  EXPECT_EQ(dispatch(effect_, effEditGetRect, 0, 0, &rect), 1);
  ASSERT_NE(rect, nullptr);
  EXPECT_EQ(rect->right, 609);
  EXPECT_EQ(rect->bottom, 282);
  EXPECT_EQ(dispatch(effect_, effEditKeyDown, 65), -1);
}

// The effect takes MIDI, so the MIDI abilities answer yes; the answers of an
// instance without MIDI are checked with the MIDI tests.
TEST_F(PluginRecord, CanDoAnswersWithMidi) {
  char text[64];
  std::strcpy(text, "receiveVstTimeInfo");
  EXPECT_EQ(dispatch(effect_, effCanDo, 0, 0, text), 1);
  for (const char* ability : {"sendVstEvents", "sendVstMidiEvent", "receiveVstEvents", "receiveVstMidiEvent"}) {
    std::strcpy(text, ability);
    EXPECT_EQ(dispatch(effect_, effCanDo, 0, 0, text), 1) << ability;
  }
  std::strcpy(text, "bypass");
  EXPECT_EQ(dispatch(effect_, effCanDo, 0, 0, text), 0);
  std::strcpy(text, "receiveVstTimeInfo ");  // compared exactly
  EXPECT_EQ(dispatch(effect_, effCanDo, 0, 0, text), 0);
}

TEST_F(PluginRecord, PinProperties) {
  const char* const inputs[] = {"Left input", "Right input"};
  const char* const outputs[] = {"Left output", "Right output"};
  for (int pin = 0; pin < 2; ++pin) {
    VstPinProperties p;
    std::memset(&p, 0x55, sizeof(p));
    ASSERT_EQ(dispatch(effect_, effGetInputProperties, pin, 0, &p), 1);
    EXPECT_STREQ(p.label, inputs[pin]);
    EXPECT_EQ(p.flags, kVstPinIsActive | kVstPinIsStereo);
    ASSERT_EQ(dispatch(effect_, effGetOutputProperties, pin, 0, &p), 1);
    EXPECT_STREQ(p.label, outputs[pin]);
    EXPECT_EQ(p.flags, kVstPinIsActive | kVstPinIsStereo);
  }
  VstPinProperties p;
  EXPECT_EQ(dispatch(effect_, effGetInputProperties, 2, 0, &p), 0);
  EXPECT_EQ(dispatch(effect_, effGetOutputProperties, -1, 0, &p), 0);
}

TEST_F(PluginRecord, ParameterPropertiesFollowTheParameterKind) {
  VstParameterProperties p;
  std::memset(&p, 0x7F, sizeof(p));
  ASSERT_EQ(dispatch(effect_, effGetParameterProperties, 15, 0, &p), 1);  // B1 Dist Type, 0..12
  EXPECT_STREQ(p.label, "B1 Dist Type");
  EXPECT_STREQ(p.shortLabel, "B1 Dist");
  EXPECT_EQ(p.flags, kVstParameterUsesIntegerMinMax);
  EXPECT_EQ(p.minInteger, 0);
  EXPECT_EQ(p.maxInteger, 12);
  EXPECT_EQ(p.stepInteger, 0);
  EXPECT_EQ(p.future[15], 0);  // the reserved tail is cleared

  ASSERT_EQ(dispatch(effect_, effGetParameterProperties, 17, 0, &p), 1);  // B1 Solo, 0..1
  EXPECT_EQ(p.flags, kVstParameterIsSwitch);
  ASSERT_EQ(dispatch(effect_, effGetParameterProperties, 0, 0, &p), 1);  // Stereo Boost
  EXPECT_EQ(p.flags, kVstParameterIsSwitch);
  ASSERT_EQ(dispatch(effect_, effGetParameterProperties, 2, 0, &p), 1);  // Tone Freq, continuous
  EXPECT_EQ(p.flags, kVstParameterCanRamp);
  EXPECT_EQ(dispatch(effect_, effGetParameterProperties, 40, 0, &p), 0);
}

TEST_F(PluginRecord, ProgramNamesAndSelection) {
  const char* const names[] = {"Light distortion", "Distortion + Compression", "Distortion + Expansion",
                               "Lipo-flatulence",  nullptr,                    "Mikey Duck",
                               "Fuzzy Bass",       "Blues Breaker"};
  for (int p = 0; p < 8; ++p) {
    char text[80];
    ASSERT_EQ(dispatch(effect_, effGetProgramNameIndexed, p, 0, text), 1);
    if (names[p] != nullptr) {
      EXPECT_STREQ(text, names[p]);
    } else {
      EXPECT_GT(std::strlen(text), 0u);
    }
  }
  char text[80];
  EXPECT_EQ(dispatch(effect_, effGetProgramNameIndexed, 8, 0, text), 0);

  dispatch(effect_, effSetProgram, 0, 3);
  EXPECT_EQ(dispatch(effect_, effGetProgram), 3);
  EXPECT_EQ(param_text(effect_, effGetProgramName, 0), "Lipo-flatulence");
  // The parameters now hold program 3's values (B1 Upper Freq 0.2907, B4 Dist Amnt 1).
  EXPECT_NEAR(effect_->getParameter(effect_, 9), 0.2907f, 5e-5f);
  EXPECT_FLOAT_EQ(effect_->getParameter(effect_, 35), 1.0f);
  // A host program change is not reported back as automation.
  EXPECT_TRUE(host_.automations.empty());

  dispatch(effect_, effSetProgram, 0, 8);  // out of range: ignored
  EXPECT_EQ(dispatch(effect_, effGetProgram), 3);

  char name[] = "My own sound";
  dispatch(effect_, effSetProgramName, 0, 0, name);
  EXPECT_EQ(param_text(effect_, effGetProgramName, 0), "My own sound");
  ASSERT_EQ(dispatch(effect_, effGetProgramNameIndexed, 3, 0, text), 1);
  EXPECT_STREQ(text, "My own sound");
}

TEST_F(PluginRecord, CopyProgramCopiesTheCurrentOne) {
  dispatch(effect_, effSetProgram, 0, 6);
  effect_->setParameter(effect_, 7, 0.25f);
  ASSERT_EQ(dispatch(effect_, effCopyProgram, 2), 1);
  dispatch(effect_, effSetProgram, 0, 2);
  EXPECT_FLOAT_EQ(effect_->getParameter(effect_, 7), 0.25f);
  char text[80];
  dispatch(effect_, effGetProgramNameIndexed, 2, 0, text);
  EXPECT_STREQ(text, "Fuzzy Bass");
  EXPECT_EQ(dispatch(effect_, effCopyProgram, 8), 0);
}

TEST_F(PluginRecord, StringToParameter) {
  EXPECT_EQ(dispatch(effect_, effString2Parameter, 15, 0, nullptr), 1);
  char hardclip[] = "Hardclip";
  EXPECT_EQ(dispatch(effect_, effString2Parameter, 15, 0, hardclip), 1);
  EXPECT_NEAR(effect_->getParameter(effect_, 15), 6.0f / 12.0f, 1e-6f);
  EXPECT_EQ(param_text(effect_, effGetParamDisplay, 15), "Hardclip");
  char minus_six[] = "-6";
  EXPECT_EQ(dispatch(effect_, effString2Parameter, 7, 0, minus_six), 1);
  EXPECT_EQ(param_text(effect_, effGetParamDisplay, 7), "-6.0");
  char junk[] = "loud";
  EXPECT_EQ(dispatch(effect_, effString2Parameter, 2, 0, junk), 0);
  EXPECT_EQ(dispatch(effect_, effString2Parameter, 40, 0, hardclip), 0);
}

TEST_F(PluginRecord, HostSetParameterIsClampedAndNeverReportedBack) {
  effect_->setParameter(effect_, 3, 1.5f);
  EXPECT_FLOAT_EQ(effect_->getParameter(effect_, 3), 1.0f);
  effect_->setParameter(effect_, 3, -2.0f);
  EXPECT_FLOAT_EQ(effect_->getParameter(effect_, 3), 0.0f);
  const float before = effect_->getParameter(effect_, 4);
  effect_->setParameter(effect_, 4, std::nanf(""));
  EXPECT_FLOAT_EQ(effect_->getParameter(effect_, 4), before);
  EXPECT_TRUE(host_.automations.empty());
}

}  // namespace

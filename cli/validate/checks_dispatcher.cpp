// The dispatcher asked everything: every opcode 0..80 with in- and
// out-of-range indices and null pointers wherever a legal host might pass
// them, every text answer in a guarded buffer, and the instance still
// working afterwards.
#include <climits>
#include <cstddef>
#include <cstring>
#include <string>
#include <vector>

#include "cli/validate/check_groups.h"
#include "cli/validate/guarded_buffer.h"
#include "cli/validate/plugin_driver.h"
#include "cli/validate/test_signal.h"

namespace plugcore {
namespace {

constexpr double kRate = 44100.0;
constexpr int kBlock = 512;
constexpr int kLastOpcode = 80;

// What an opcode's pointer argument is, so each gets what a host would pass.
enum class PointerKind {
  none,         // legal hosts pass null
  text,         // a text buffer of the table's capacity
  opaque,       // a structure we do not interpret: zeroed bytes
  chunk_out,    // void** receiving the chunk address
  rect_out,     // ERect** receiving the editor rectangle
  events,       // an empty event list
  can_do,       // a capability text
  pin,          // VstPinProperties
  param,        // VstParameterProperties
  name_in,      // a program name to take
  speaker_out,  // two VstSpeakerArrangement** (value and ptr)
  host_lifecycle,  // driven by the check itself (close, editor, mains, chunks)
};

struct OpcodeUse {
  int32_t opcode;
  PointerKind kind;
  size_t capacity;  // text capacity the host offers
};

// Texts get the capacities hosts commonly offer: 24 for parameter and program
// texts, 32 for the effect name, 64 for the longer names.
const OpcodeUse kOpcodeUses[] = {
    {effClose, PointerKind::host_lifecycle, 0},
    {effSetProgramName, PointerKind::name_in, 0},
    {effGetProgramName, PointerKind::text, 24},
    {effGetParamLabel, PointerKind::text, 24},
    {effGetParamDisplay, PointerKind::text, 24},
    {effGetParamName, PointerKind::text, 24},
    {effMainsChanged, PointerKind::host_lifecycle, 0},
    {effSetSampleRate, PointerKind::host_lifecycle, 0},
    {effSetBlockSize, PointerKind::host_lifecycle, 0},
    {effSetBlockSizeAndSampleRate, PointerKind::host_lifecycle, 0},
    {effEditGetRect, PointerKind::rect_out, 0},
    {effEditOpen, PointerKind::host_lifecycle, 0},
    {effEditClose, PointerKind::host_lifecycle, 0},
    {effEditDraw, PointerKind::opaque, 64},
    {effEditMouse, PointerKind::none, 0},
    {effEditKey, PointerKind::none, 0},
    {effGetChunk, PointerKind::chunk_out, 0},
    {effSetChunk, PointerKind::host_lifecycle, 0},
    {effProcessEvents, PointerKind::events, 0},
    {effString2Parameter, PointerKind::none, 0},
    {effGetProgramNameIndexed, PointerKind::text, 64},
    {effGetInputProperties, PointerKind::pin, 0},
    {effGetOutputProperties, PointerKind::pin, 0},
    {effOfflineNotify, PointerKind::opaque, 512},
    {effOfflinePrepare, PointerKind::opaque, 512},
    {effOfflineRun, PointerKind::opaque, 512},
    {effProcessVarIo, PointerKind::opaque, 512},
    {effSetSpeakerArrangement, PointerKind::opaque, 2048},
    {effGetEffectName, PointerKind::text, 32},
    {effGetErrorText, PointerKind::text, 256},
    {effGetVendorString, PointerKind::text, 64},
    {effGetProductString, PointerKind::text, 64},
    {effCanDo, PointerKind::can_do, 0},
    {effGetIcon, PointerKind::none, 0},
    {effGetParameterProperties, PointerKind::param, 0},
    {effGetMidiProgramName, PointerKind::opaque, 512},
    {effGetCurrentMidiProgram, PointerKind::opaque, 512},
    {effGetMidiProgramCategory, PointerKind::opaque, 512},
    {effHasMidiProgramsChanged, PointerKind::none, 0},
    {effGetMidiKeyName, PointerKind::opaque, 512},
    {69, PointerKind::speaker_out, 0},   // get speaker arrangement
    {71, PointerKind::text, 64},         // shell: next sub-plug-in's name
};

OpcodeUse use_of(int32_t opcode) {
  for (const OpcodeUse& use : kOpcodeUses) {
    if (use.opcode == opcode) return use;
  }
  return OpcodeUse{opcode, PointerKind::none, 0};
}

std::vector<int32_t> sweep_indices(const HostedPlugin& plugin) {
  return {0, 1, -1, plugin.num_params(), plugin.num_params() + 1, plugin.num_programs(),
          1000000, INT_MAX, INT_MIN};
}

std::string where(int32_t opcode, int32_t index) {
  return "opcode " + std::to_string(opcode) + " index " + std::to_string(index);
}

// One call of opcode with index; empty when the answer is acceptable.
std::string call_once(PluginDriver& driver, const OpcodeUse& use, int32_t index) {
  HostedPlugin& plugin = driver.plugin();
  const int32_t opcode = use.opcode;
  switch (use.kind) {
    case PointerKind::none:
      plugin.dispatch(opcode, index, 0, nullptr, 0.0f);
      return "";
    case PointerKind::text: {
      GuardedBuffer buffer(use.capacity);
      plugin.dispatch(opcode, index, 0, buffer.data(), 0.0f);
      const std::string problem = buffer.text_problem();
      return problem.empty() ? "" : where(opcode, index) + ": " + problem;
    }
    case PointerKind::opaque: {
      GuardedBuffer buffer(use.capacity, true);
      plugin.dispatch(opcode, index, 0, buffer.data(), 0.0f);
      const std::string problem = buffer.overrun();
      return problem.empty() ? "" : where(opcode, index) + ": " + problem;
    }
    case PointerKind::chunk_out: {
      void* address = nullptr;
      const intptr_t size = plugin.dispatch(opcode, index, 0, &address, 0.0f);
      if (size < 0) return where(opcode, index) + ": negative chunk size " + std::to_string(size);
      if (size > 0 && address == nullptr) return where(opcode, index) + ": a size but no chunk";
      return "";
    }
    case PointerKind::rect_out: {
      ERect* rect = nullptr;
      const intptr_t answer = plugin.dispatch(opcode, index, 0, &rect, 0.0f);
      if (answer != 0 && rect != nullptr && (rect->right < rect->left || rect->bottom < rect->top)) {
        return where(opcode, index) + ": editor rectangle with negative size";
      }
      return "";
    }
    case PointerKind::events: {
      VstEvents events{};
      events.numEvents = 0;
      plugin.dispatch(opcode, index, 0, &events, 0.0f);
      return "";
    }
    case PointerKind::can_do: {
      for (const char* text : {"receiveVstTimeInfo", "sendVstEvents", "receiveVstMidiEvent",
                               "bypass", "", "no such capability at all"}) {
        std::vector<char> copy(text, text + std::strlen(text) + 1);
        const intptr_t answer = plugin.dispatch(opcode, index, 0, copy.data(), 0.0f);
        if (answer < -1 || answer > 1) {
          return where(opcode, index) + ": canDo \"" + text + "\" answered " + std::to_string(answer) +
                 " (not -1, 0 or 1)";
        }
      }
      return "";
    }
    case PointerKind::pin: {
      GuardedBuffer buffer(sizeof(VstPinProperties), true);
      const intptr_t answer = plugin.dispatch(opcode, index, 0, buffer.data(), 0.0f);
      std::string problem = buffer.overrun();
      if (problem.empty() && answer != 0) {
        problem = buffer.field_problem(offsetof(VstPinProperties, label), 64, "pin label");
        if (problem.empty() && !buffer.untouched()) {
          problem = buffer.field_problem(offsetof(VstPinProperties, shortLabel), 8, "pin short label");
        }
      }
      return problem.empty() ? "" : where(opcode, index) + ": " + problem;
    }
    case PointerKind::param: {
      GuardedBuffer buffer(sizeof(VstParameterProperties), true);
      const intptr_t answer = plugin.dispatch(opcode, index, 0, buffer.data(), 0.0f);
      std::string problem = buffer.overrun();
      if (problem.empty() && answer != 0) {
        problem = buffer.field_problem(offsetof(VstParameterProperties, label), 64, "label");
        if (problem.empty()) {
          problem = buffer.field_problem(offsetof(VstParameterProperties, shortLabel), 8, "short label");
        }
        if (problem.empty()) {
          problem = buffer.field_problem(offsetof(VstParameterProperties, categoryLabel), 24,
                                         "category label");
        }
      }
      if (problem.empty() && answer != 0 && (index < 0 || index >= plugin.num_params())) {
        problem = "answered properties for a parameter that does not exist";
      }
      return problem.empty() ? "" : where(opcode, index) + ": " + problem;
    }
    case PointerKind::name_in: {
      char name[] = "Checked Name";
      plugin.dispatch(opcode, index, 0, name, 0.0f);
      return "";
    }
    case PointerKind::speaker_out: {
      void* inputs = nullptr;
      void* outputs = nullptr;
      plugin.dispatch(opcode, index, reinterpret_cast<intptr_t>(&inputs), &outputs, 0.0f);
      return "";
    }
    case PointerKind::host_lifecycle:
      return "";
  }
  return "";
}

// The opcodes a host sends only in a certain state, sent the way it would.
void lifecycle_calls(PluginDriver& driver) {
  HostedPlugin& plugin = driver.plugin();
  plugin.suspend();
  plugin.dispatch(effSetSampleRate, 0, 0, nullptr, static_cast<float>(kRate));
  plugin.dispatch(effSetBlockSize, 0, kBlock);
  plugin.dispatch(effSetBlockSizeAndSampleRate, 0, kBlock, nullptr, static_cast<float>(kRate));
  plugin.resume();
  // The program number arrives in value; out-of-range numbers must be ignored.
  for (intptr_t value : {intptr_t{-1}, intptr_t{plugin.num_programs()}, intptr_t{1} << 20}) {
    plugin.dispatch(effSetProgram, 0, value);
  }
  plugin.dispatch(effString2Parameter, 0, 0, nullptr);  // null text asks "can you convert?"
  plugin.dispatch(effString2Parameter, -1, 0, const_cast<char*>("0.5"));
  plugin.dispatch(effString2Parameter, plugin.num_params(), 0, const_cast<char*>("0.5"));
}

void check_sweep(const ValidateOptions& options, CheckRecorder& recorder) {
  const char* name = "dispatcher.sweep";
  PluginDriver driver(options.plugin_path, kRate, kBlock);
  HostedPlugin& plugin = driver.plugin();
  lifecycle_calls(driver);
  int calls = 0;
  for (int32_t opcode = 0; opcode <= kLastOpcode; ++opcode) {
    const OpcodeUse use = use_of(opcode);
    if (use.kind == PointerKind::host_lifecycle) continue;
    for (int32_t index : sweep_indices(plugin)) {
      const std::string problem = call_once(driver, use, index);
      ++calls;
      if (!problem.empty()) {
        recorder.fail(name, problem);
        return;
      }
    }
  }
  const intptr_t program = plugin.dispatch(effGetProgram);
  if (plugin.num_programs() > 0 && (program < 0 || program >= plugin.num_programs())) {
    recorder.fail(name, "after out-of-range program numbers the current program is " +
                            std::to_string(program));
    return;
  }
  for (int channel = 0; channel < 2; ++channel) {
    fill_test_signal(driver.input(channel), kBlock, channel, 0, kRate);
  }
  driver.process(kBlock, ProcessMode::replacing);
  const std::string problem = driver.check_outputs(kBlock, db_to_amplitude(80.0));
  if (!problem.empty()) {
    recorder.fail(name, "after the sweep: " + problem);
    return;
  }
  recorder.pass(name, std::to_string(calls) + " calls of opcodes 0.." + std::to_string(kLastOpcode) +
                          " with odd indices and null pointers; instance still processes");
}

// Every text of every parameter and program, in range and just beyond.
void check_texts(const ValidateOptions& options, CheckRecorder& recorder) {
  const char* name = "dispatcher.texts";
  PluginDriver driver(options.plugin_path, kRate, kBlock);
  HostedPlugin& plugin = driver.plugin();
  BatteryRandom random(options.seed);
  int texts = 0;
  const int rounds = scaled_count(options, 10);
  for (int round = 0; round < rounds; ++round) {
    if (round > 0) driver.randomize_parameters(random);  // displays change with the values
    for (int index = -1; index <= plugin.num_params(); ++index) {
      for (int32_t opcode : {effGetParamName, effGetParamLabel, effGetParamDisplay}) {
        const std::string problem = call_once(driver, use_of(opcode), index);
        ++texts;
        if (!problem.empty()) {
          recorder.fail(name, problem);
          return;
        }
      }
      if (index >= 0 && index < plugin.num_params() && plugin.param_name(index).empty()) {
        recorder.fail(name, "parameter " + std::to_string(index) + " has an empty name");
        return;
      }
    }
  }
  for (int index = -1; index <= plugin.num_programs(); ++index) {
    if (index >= 0 && index < plugin.num_programs()) plugin.set_program(index);
    for (int32_t opcode : {effGetProgramNameIndexed, effGetProgramName}) {
      const std::string problem = call_once(driver, use_of(opcode), index);
      ++texts;
      if (!problem.empty()) {
        recorder.fail(name, problem);
        return;
      }
    }
  }
  // A name longer than any capacity must come back cut and terminated.
  std::string long_name(200, 'x');
  plugin.dispatch(effSetProgramName, 0, 0, &long_name[0]);
  const std::string problem = call_once(driver, use_of(effGetProgramName), 0);
  if (!problem.empty()) {
    recorder.fail(name, "after a 200-character program name: " + problem);
    return;
  }
  recorder.pass(name, std::to_string(texts + 1) + " texts terminated within their capacities");
}

}  // namespace

void run_dispatcher_checks(const ValidateOptions& options, CheckRecorder& recorder) {
  guarded(recorder, "dispatcher.sweep", [&] { check_sweep(options, recorder); });
  guarded(recorder, "dispatcher.texts", [&] { check_texts(options, recorder); });
}

}  // namespace plugcore
